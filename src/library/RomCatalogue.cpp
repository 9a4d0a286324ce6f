#include "library/RomCatalogue.h"

#include "library/FileLister.h"
#include "library/Search.h"

#include <algorithm>

namespace {

// Whether a listed row's full path is a favourite. The path is built in one buffer that keeps
// its folder between rows, so a pass over 100,000 rows allocates nothing per row.
class FavouriteTest {
public:
    FavouriteTest(const RomRows& all, const QSet<QString>& favourites)
        : m_all(all), m_favourites(favourites) {}

    bool operator()(qsizetype i) {
        if (m_favourites.isEmpty())
            return false;
        const int folder = m_all.rowFolders[static_cast<size_t>(i)];
        if (folder != m_folder) {
            m_folder = folder;
            m_path = m_all.folders[folder] + u'/';
            m_prefix = m_path.size();
        }
        m_path.resize(m_prefix);
        m_path.append(m_all.names.at(i));
        return m_favourites.contains(m_path);
    }

private:
    const RomRows& m_all;
    const QSet<QString>& m_favourites;
    int m_folder = -1;
    QString m_path;
    qsizetype m_prefix = 0;
};

// The rows of `all` that `filter` keeps, in their order; `progress`, when given, is called
// as the refresh promises.
RomRows keepMatches(const RomRows& all, const RowFilter& filter, const RefreshProgress& progress) {
    const qint64 total = all.listed;
    if (progress)
        progress(0, total);
    RomRows rows;
    rows.folders = all.folders;
    rows.listed = total;
    FavouriteTest isFavourite(all, filter.favourites);
    const bool bFlag = !filter.favourites.isEmpty();
    if (filter.search.isEmpty() && !filter.onlyFavourites) {
        rows.names = all.names;
        rows.rowFolders = all.rowFolders;
        if (bFlag) {
            rows.favourite.resize(static_cast<size_t>(total));
            for (qsizetype i = 0; i < total; ++i)
                rows.favourite[static_cast<size_t>(i)] = isFavourite(i);
        }
    } else {
        std::optional<SearchExpression> expression;
        if (!filter.search.isEmpty())
            expression.emplace(filter.search);
        const qint64 stride = std::max<qint64>(1, total / 1000);
        qint64 nextReport = stride;
        for (qsizetype i = 0; i < total; ++i) {
            const QStringView name = all.names.at(i);
            if (!expression || expression->matches(name)) {
                // Only a matched row's path is looked up: the search is the cheaper test.
                const bool bFavourite = isFavourite(i);
                if (bFavourite || !filter.onlyFavourites) {
                    rows.names.append(name);
                    rows.rowFolders.push_back(all.rowFolders[static_cast<size_t>(i)]);
                    if (bFlag)
                        rows.favourite.push_back(bFavourite);
                }
            }
            if (progress && i + 1 == nextReport) {
                progress(i + 1, total);
                nextReport += stride;
            }
        }
    }
    if (progress)
        progress(total, total);
    return rows;
}

} // namespace

RomCatalogue::~RomCatalogue() {
    dropPrefetch();
}

void RomCatalogue::prefetch(const QStringList& folders, const QString& pattern, bool bSubfolders) {
    dropPrefetch();
    m_prefetchFolders = folders;
    m_prefetchPattern = pattern;
    m_bPrefetchSubfolders = bSubfolders;
    m_prefetch = std::async(std::launch::async, [folders, pattern, bSubfolders] {
        return listFolders(folders, FilePattern(pattern), bSubfolders);
    });
}

void RomCatalogue::dropPrefetch() {
    if (m_prefetch.valid())
        m_prefetch.get();
}

RomRows RomCatalogue::refresh(const QStringList& folders, const QString& pattern, bool bSubfolders,
                              const RowFilter& filter, const RefreshProgress& progress,
                              const std::function<void()>& whileListing) {
    // Folders or a pattern changed since a listing started ahead: they are listed again.
    if (!m_prefetch.valid() || folders != m_prefetchFolders || pattern != m_prefetchPattern ||
        bSubfolders != m_bPrefetchSubfolders)
        prefetch(folders, pattern, bSubfolders);
    // A slow folder (a network share) is read on the other thread while the caller keeps
    // its window painted.
    if (whileListing) {
        whileListing();
        while (m_prefetch.wait_for(std::chrono::milliseconds(16)) != std::future_status::ready)
            whileListing();
    }
    std::vector<FolderListing> listings = m_prefetch.get();
    RomRows all;
    for (FolderListing& listing : listings) {
        const int folderIndex = static_cast<int>(all.folders.size());
        all.folders.push_back(listing.folder);
        all.rowFolders.insert(all.rowFolders.end(), static_cast<size_t>(listing.names.size()),
                              folderIndex);
        all.names.append(std::move(listing.names));
    }
    all.listed = all.names.size();
    m_listing = std::move(all);
    return keepMatches(*m_listing, filter, progress);
}

std::optional<RomRows> RomCatalogue::narrow(const RowFilter& filter) const {
    if (!m_listing)
        return std::nullopt;
    return keepMatches(*m_listing, filter, {});
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
