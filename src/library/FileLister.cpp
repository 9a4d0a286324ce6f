#include "library/FileLister.h"

#include "library/Ascii.h"
#include "platform/FileSystem.h"

#include <QFile>

#include <algorithm>
#include <condition_variable>
#include <cstdint>
#include <cstring>
#include <deque>
#include <future>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <utility>

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Wildcard match of a case-folded pattern against a case-folded name, over QStringView
// or std::string_view alike.
template <typename View> bool wildcardMatch(View pattern, View name) {
    using Size = decltype(pattern.size());
    Size p = 0, n = 0;
    Size starP = 0, starN = 0;
    bool star = false;
    while (n < name.size()) {
        // A star is a wildcard even where the name holds a star of its own.
        if (p < pattern.size() && pattern[p] == '*') {
            star = true;
            starP = p++;
            starN = n;
        } else if (p < pattern.size() && (pattern[p] == '?' || pattern[p] == name[n])) {
            ++p;
            ++n;
        } else if (star) {
            p = starP + 1;
            n = ++starN;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == '*')
        ++p;
    return p == pattern.size();
}

QString foldCase(QStringView s) {
    if (isAscii(s))
        return s.toString().toLower();
    return s.toString().toCaseFolded();
}

// The first eight bytes of a key from `from` on, big-endian, zero-padded: comparing two of
// these compares those bytes as memcmp would, and most comparisons end there.
std::uint64_t bigEndianPrefix(std::string_view key, size_t from) {
    unsigned char bytes[8] = {};
    if (from < key.size())
        std::memcpy(bytes, key.data() + from, std::min<size_t>(8, key.size() - from));
    std::uint64_t prefix = 0;
    for (const unsigned char b : bytes)
        prefix = (prefix << 8) | b;
    return prefix;
}

// Names as they come out of the folder, each followed by a NUL (which no name holds).
struct NameBatch {
    std::string names;
    size_t count = 0;
};

// Hands batches of names from the thread reading the folder to the one matching them.
class BatchQueue {
public:
    void push(NameBatch batch) {
        {
            std::lock_guard lock(m_mutex);
            m_batches.push_back(std::move(batch));
        }
        m_ready.notify_one();
    }
    void close() {
        {
            std::lock_guard lock(m_mutex);
            m_closed = true;
        }
        m_ready.notify_one();
    }
    // The next batch, or nothing once the queue is closed and empty.
    std::optional<NameBatch> pop() {
        std::unique_lock lock(m_mutex);
        m_ready.wait(lock, [this] { return m_closed || !m_batches.empty(); });
        if (m_batches.empty())
            return std::nullopt;
        NameBatch batch = std::move(m_batches.front());
        m_batches.pop_front();
        return batch;
    }

private:
    std::mutex m_mutex;
    std::condition_variable m_ready;
    std::deque<NameBatch> m_batches;
    bool m_closed = false;
};

QString decodeName(std::string_view name) {
    const auto size = static_cast<qsizetype>(name.size());
    return isAscii(name) ? QString::fromLatin1(name.data(), size)
                         : nameFromFileSystem(QByteArrayView(name.data(), size));
}

struct SortEntry {
    static constexpr std::uint32_t kAscii = ~std::uint32_t{0};

    std::uint64_t prefix0, prefix1; // the key's first sixteen bytes
    const char* key;
    const char* name;
    std::uint32_t keySize, nameSize;
    std::uint32_t decoded; // the name's QString, or kAscii when its bytes are its text
    std::string_view keyView() const { return {key, keySize}; }
    std::string_view nameView() const { return {name, nameSize}; }
};

// The matching names of every batch and their sort keys: case-folded UTF-8, which for plain
// ASCII names is just their lower-case bytes. Only names that are not ASCII are decoded here.
class MatchedNames {
public:
    explicit MatchedNames(const FilePattern& pattern) : m_pattern(pattern) {}

    void add(NameBatch batch) {
        if (batch.count == 0)
            return;
        const std::string& raw = m_batchStore.emplace_back(std::move(batch.names));
        std::string& keys = m_keyStore.emplace_back();
        keys.reserve(raw.size());
        // Keys are placed by offset while their buffer may still grow, then pinned down.
        std::vector<std::pair<size_t, size_t>> keySpans;
        const size_t first = m_entries.size();
        for (size_t at = 0; at < raw.size();) {
            const std::string_view name(raw.data() + at);
            at += name.size() + 1;
            const size_t keyStart = keys.size();
            std::uint32_t decoded = SortEntry::kAscii;
            if (m_pattern.asciiOnly() && isAscii(name)) {
                keys.resize(keyStart + name.size());
                std::transform(
                    name.begin(), name.end(), keys.begin() + static_cast<std::ptrdiff_t>(keyStart),
                    [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; });
                if (!m_pattern.matchesFoldedAscii(std::string_view(keys).substr(keyStart))) {
                    keys.resize(keyStart);
                    continue;
                }
                m_charCount += static_cast<qsizetype>(name.size());
            } else {
                QString text = decodeName(name);
                if (!m_pattern.matches(text))
                    continue;
                keys += foldCase(text).toStdString();
                m_charCount += text.size();
                if (!isAscii(name)) {
                    decoded = static_cast<std::uint32_t>(m_decoded.size());
                    m_decoded.push_back(std::move(text));
                }
            }
            keySpans.emplace_back(keyStart, keys.size() - keyStart);
            m_entries.push_back(
                {0, 0, nullptr, name.data(), 0, static_cast<std::uint32_t>(name.size()), decoded});
        }
        for (size_t i = 0; i < keySpans.size(); ++i) {
            SortEntry& e = m_entries[first + i];
            const std::string_view key =
                std::string_view(keys).substr(keySpans[i].first, keySpans[i].second);
            e.prefix0 = bigEndianPrefix(key, 0);
            e.prefix1 = bigEndianPrefix(key, 8);
            e.key = key.data();
            e.keySize = static_cast<std::uint32_t>(key.size());
        }
        // Each batch becomes a sorted run, and runs of like length are merged as they come,
        // so that little of the sorting is left once the folder has been read.
        std::sort(m_entries.begin() + static_cast<std::ptrdiff_t>(first), m_entries.end(), less);
        m_runStarts.push_back(first);
        while (m_runStarts.size() >= 2 &&
               runLength(m_runStarts.size() - 2) <= runLength(m_runStarts.size() - 1))
            mergeTopRuns();
    }

    // Sorted by the folded name; equal keys keep a stable, case-sensitive order.
    NameList takeSorted() {
        while (m_runStarts.size() >= 2)
            mergeTopRuns();
        const auto names = [this](size_t from, size_t to) {
            NameList part;
            part.reserve(static_cast<qsizetype>(to - from), m_charCount);
            for (size_t i = from; i < to; ++i) {
                const SortEntry& e = m_entries[i];
                if (e.decoded == SortEntry::kAscii)
                    part.appendLatin1(e.name, e.nameSize);
                else
                    part.append(m_decoded[e.decoded]);
            }
            return part;
        };
        // A long list is written out in two halves at once.
        const size_t count = m_entries.size();
        if (count < kTwoHalvesFrom)
            return names(0, count);
        auto second = std::async(std::launch::async, names, count / 2, count);
        NameList sorted = names(0, count / 2);
        sorted.append(second.get());
        return sorted;
    }

private:
    static bool less(const SortEntry& a, const SortEntry& b) {
        if (a.prefix0 != b.prefix0)
            return a.prefix0 < b.prefix0;
        if (a.prefix1 != b.prefix1)
            return a.prefix1 < b.prefix1;
        const int c = a.keyView().compare(b.keyView());
        if (c != 0)
            return c < 0;
        return a.nameView() < b.nameView();
    }

    size_t runLength(size_t run) const {
        const size_t end = run + 1 < m_runStarts.size() ? m_runStarts[run + 1] : m_entries.size();
        return end - m_runStarts[run];
    }

    // Runs lie side by side in the entries, so the last two merge in place.
    void mergeTopRuns() {
        const auto at = [this](size_t i) {
            return m_entries.begin() + static_cast<std::ptrdiff_t>(i);
        };
        const size_t top = m_runStarts.back();
        m_runStarts.pop_back();
        std::inplace_merge(at(m_runStarts.back()), at(top), m_entries.end(), less);
    }

    static constexpr size_t kTwoHalvesFrom = 8192;

    const FilePattern& m_pattern;
    std::deque<std::string> m_batchStore; // the entries point into these two
    std::deque<std::string> m_keyStore;
    std::vector<SortEntry> m_entries;
    std::vector<size_t> m_runStarts; // the sorted runs still to merge, in order
    std::vector<QString> m_decoded;
    qsizetype m_charCount = 0;
};

} // namespace

FilePattern::FilePattern(const QString& pattern) : m_text(pattern) {
    for (const QString& part : pattern.split(u';', Qt::SkipEmptyParts)) {
        const QString w = part.trimmed();
        if (w.isEmpty())
            continue;
        m_wildcards.push_back(w == QLatin1String("*.*") ? QStringLiteral("*") : foldCase(w));
    }
    m_asciiOnly = std::all_of(m_wildcards.begin(), m_wildcards.end(),
                              [](const QString& w) { return isAscii(QStringView(w)); });
    if (!m_asciiOnly)
        return;
    for (const QString& w : m_wildcards) {
        const std::string text = w.toStdString();
        const auto plain = [](std::string_view t) {
            return t.find_first_of("*?") == std::string_view::npos;
        };
        if (text == "*")
            m_asciiWildcards.push_back({AsciiWildcard::Any, {}});
        else if (text.front() == '*' && plain(std::string_view(text).substr(1)))
            m_asciiWildcards.push_back({AsciiWildcard::Suffix, text.substr(1)});
        else if (plain(text))
            m_asciiWildcards.push_back({AsciiWildcard::Exact, text});
        else
            m_asciiWildcards.push_back({AsciiWildcard::General, text});
    }
}

bool FilePattern::matches(QStringView name) const {
    const QString folded = foldCase(name);
    return std::any_of(m_wildcards.begin(), m_wildcards.end(), [&](const QString& w) {
        return wildcardMatch(QStringView(w), QStringView(folded));
    });
}

bool FilePattern::matchesFoldedAscii(std::string_view foldedName) const {
    return std::any_of(
        m_asciiWildcards.begin(), m_asciiWildcards.end(), [&](const AsciiWildcard& w) {
            switch (w.shape) {
            case AsciiWildcard::Any:
                return true;
            case AsciiWildcard::Suffix:
                return foldedName.size() >= w.text.size() &&
                       foldedName.substr(foldedName.size() - w.text.size()) == w.text;
            case AsciiWildcard::Exact:
                return foldedName == w.text;
            case AsciiWildcard::General:
                break;
            }
            return wildcardMatch(std::string_view(w.text), foldedName);
        });
}

namespace {

// Lists the open folder `dir` with `pattern`. When `subfolders` is given, the names of the
// folders in it are added there; links to folders are neither listed nor added, so that a
// link back up the tree cannot make a walk endless.
NameList listOpenFolder(DIR* dir, const FilePattern& pattern,
                        std::vector<std::string>* subfolders) {
    const int dirFd = dirfd(dir);

    // Reading a large folder is mostly the kernel's work, so once a whole batch of names
    // has come in, another thread matches and decodes them while the rest is read. A small
    // folder is done here as it is read.
    constexpr size_t kBatchNames = 4096;
    MatchedNames matched(pattern);
    BatchQueue queue;
    std::future<void> matching;
    // However this ends, the matching thread is told that no more batches come before the
    // future waits for it.
    struct CloseOnExit {
        BatchQueue& queue;
        ~CloseOnExit() { queue.close(); }
    } closeOnExit{queue};
    const auto deliver = [&](NameBatch& batch) {
        if (!matching.valid() && batch.count == kBatchNames)
            matching = std::async(std::launch::async, [&] {
                while (std::optional<NameBatch> next = queue.pop())
                    matched.add(std::move(*next));
            });
        if (matching.valid())
            queue.push(std::move(batch));
        else
            matched.add(std::move(batch));
        batch = NameBatch{};
    };

    NameBatch batch;
    while (const dirent* entry = readdir(dir)) {
        if (entry->d_name[0] == '.')
            continue;
        unsigned char type = entry->d_type;
        struct stat st {};
        if (type == DT_UNKNOWN) {
            if (fstatat(dirFd, entry->d_name, &st, AT_SYMLINK_NOFOLLOW) != 0)
                continue;
            type = S_ISDIR(st.st_mode)   ? DT_DIR
                   : S_ISREG(st.st_mode) ? DT_REG
                   : S_ISLNK(st.st_mode) ? DT_LNK
                                         : DT_UNKNOWN;
        }
        if (type == DT_DIR && subfolders != nullptr)
            subfolders->emplace_back(entry->d_name);
        // A link is listed when it leads to a file.
        const bool regular =
            type == DT_REG ||
            (type == DT_LNK && fstatat(dirFd, entry->d_name, &st, 0) == 0 && S_ISREG(st.st_mode));
        if (!regular)
            continue;
        batch.names.append(entry->d_name).push_back('\0');
        if (++batch.count == kBatchNames)
            deliver(batch);
    }
    deliver(batch);
    if (matching.valid()) {
        queue.close();
        matching.get();
    }
    return matched.takeSorted();
}

// Opens the folder at `native`; a link is not followed unless `followLink`.
std::unique_ptr<DIR, int (*)(DIR*)> openFolder(const QByteArray& native, bool followLink) {
    std::unique_ptr<DIR, int (*)(DIR*)> dir(nullptr, closedir);
    const int fd = open(native.constData(),
                        O_RDONLY | O_DIRECTORY | O_CLOEXEC | (followLink ? 0 : O_NOFOLLOW));
    if (fd < 0)
        return dir;
    dir.reset(fdopendir(fd));
    if (!dir)
        close(fd);
    return dir;
}

// A folder met before, through another root or a mount of it, is not listed again.
class SeenFolders {
public:
    bool firstVisit(DIR* dir) {
        struct stat st {};
        if (fstat(dirfd(dir), &st) != 0)
            return true;
        return m_seen
            .emplace(static_cast<std::uint64_t>(st.st_dev), static_cast<std::uint64_t>(st.st_ino))
            .second;
    }

private:
    std::set<std::pair<std::uint64_t, std::uint64_t>> m_seen;
};

// Appends `root`'s tree to `listings`: the root, then each sub-folder's tree in the order of
// its name without regard to case, as files are.
void listTree(const QString& root, const FilePattern& pattern, SeenFolders& seen,
              std::vector<FolderListing>& listings) {
    struct Pending {
        QString folder;
        QByteArray native;
    };
    // The user's own folder may be a link; the folders found below it are not followed.
    std::vector<Pending> pending{{root, QFile::encodeName(root)}};
    bool bRoot = true;
    while (!pending.empty()) {
        Pending next = std::move(pending.back());
        pending.pop_back();
        const auto dir = openFolder(next.native, std::exchange(bRoot, false));
        if (!dir || !seen.firstVisit(dir.get()))
            continue;
        std::vector<std::string> subfolders;
        listings.push_back({next.folder, listOpenFolder(dir.get(), pattern, &subfolders)});

        struct Named {
            QString key, name;
            std::string bytes;
        };
        std::vector<Named> named;
        named.reserve(subfolders.size());
        for (std::string& bytes : subfolders) {
            QString name = decodeName(bytes);
            named.push_back({foldCase(name), std::move(name), std::move(bytes)});
        }
        std::sort(named.begin(), named.end(), [](const Named& a, const Named& b) {
            return a.key != b.key ? a.key < b.key : a.bytes < b.bytes;
        });
        const bool bSlash = next.folder.endsWith(u'/');
        // Last pushed is listed first.
        for (auto it = named.rbegin(); it != named.rend(); ++it)
            pending.push_back(
                {next.folder + (bSlash ? QString() : QStringLiteral("/")) + it->name,
                 next.native + (bSlash ? "" : "/") + QByteArray::fromStdString(it->bytes)});
    }
}

} // namespace

NameList listMatchingFiles(const QString& folder, const FilePattern& pattern) {
    if (folder.isEmpty())
        return {};
    const QByteArray native = QFile::encodeName(folder);
    std::unique_ptr<DIR, int (*)(DIR*)> dir(opendir(native.constData()), closedir);
    if (!dir)
        return {};
    return listOpenFolder(dir.get(), pattern, nullptr);
}

std::vector<FolderListing> listFolders(const QStringList& folders, const FilePattern& pattern,
                                       bool bSubfolders) {
    std::vector<FolderListing> listings;
    if (!bSubfolders) {
        for (const QString& folder : folders)
            listings.push_back({folder, listMatchingFiles(folder, pattern)});
        return listings;
    }
    SeenFolders seen;
    for (const QString& folder : folders)
        if (!folder.isEmpty())
            listTree(folder, pattern, seen, listings);
    return listings;
}

void FileLister::setPattern(const QString& pattern) {
    m_pattern = FilePattern(pattern);
}

void FileLister::setPath(const QString& folder) {
    m_path = folder;
    m_names = listMatchingFiles(m_path, m_pattern);
}

QString FileLister::List(int index) const {
    if (index < 0 || index >= m_names.size())
        return QString();
    return m_names.at(index).toString();
}

NameList FileLister::takeNames() {
    return std::exchange(m_names, NameList());
}
