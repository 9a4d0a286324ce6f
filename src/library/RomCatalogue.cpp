#include "library/RomCatalogue.h"

#include "library/FileLister.h"
#include "library/Search.h"

#include <algorithm>

RomCatalogue::~RomCatalogue() {
    dropPrefetch();
}

void RomCatalogue::prefetch(const QStringList& folders, const QString& pattern) {
    dropPrefetch();
    m_prefetchFolders = folders;
    m_prefetchPattern = pattern;
    m_prefetch = std::async(std::launch::async, [folders, pattern] {
        const FilePattern filePattern(pattern);
        std::vector<Listing> listings;
        for (const QString& folder : folders)
            listings.push_back({folder, listMatchingFiles(folder, filePattern)});
        return listings;
    });
}

void RomCatalogue::dropPrefetch() {
    if (m_prefetch.valid())
        m_prefetch.get();
}

RomRows RomCatalogue::refresh(const QStringList& folders, const QString& pattern,
                              const QString& search, const RefreshProgress& progress,
                              const std::function<void()>& whileListing) {
    // Folders or a pattern changed since a listing started ahead: they are listed again.
    if (!m_prefetch.valid() || folders != m_prefetchFolders || pattern != m_prefetchPattern)
        prefetch(folders, pattern);
    // A slow folder (a network share) is read on the other thread while the caller keeps
    // its window painted.
    if (whileListing) {
        whileListing();
        while (m_prefetch.wait_for(std::chrono::milliseconds(16)) != std::future_status::ready)
            whileListing();
    }
    std::vector<Listing> listings = m_prefetch.get();
    RomRows rows;
    for (const Listing& listing : listings)
        rows.listed += listing.names.size();

    const qint64 total = rows.listed;
    const qint64 stride = std::max<qint64>(1, total / 1000);
    qint64 done = 0;
    qint64 nextReport = stride;
    progress(0, total);
    const SearchExpression expression(search);
    for (Listing& listing : listings) {
        const int folderIndex = static_cast<int>(rows.folders.size());
        rows.folders.push_back(listing.folder);
        const qsizetype count = listing.names.size();
        if (search.isEmpty()) {
            // Every name is a row, so the folder's names are taken whole.
            rows.rowFolders.insert(rows.rowFolders.end(), static_cast<size_t>(count), folderIndex);
            rows.names.append(std::move(listing.names));
            done += count;
            continue;
        }
        for (qsizetype i = 0; i < count; ++i) {
            const QStringView name = listing.names.at(i);
            if (expression.matches(name)) {
                rows.names.append(name);
                rows.rowFolders.push_back(folderIndex);
            }
            if (++done == nextReport) {
                progress(done, total);
                nextReport += stride;
            }
        }
    }
    progress(total, total);
    return rows;
}

QString refreshCaption(bool bFirstLoad, int rows, qint64 listed) {
    if (bFirstLoad)
        return QStringLiteral("lum - %1 ROM%2 Found")
            .arg(rows)
            .arg(rows == 1 ? QString() : QStringLiteral("'s"));
    return QStringLiteral("lum - %1 Match%2 out of %3")
        .arg(rows)
        .arg(rows == 1 ? QString() : QStringLiteral("es"))
        .arg(listed);
}
