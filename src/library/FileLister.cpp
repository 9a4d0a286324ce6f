#include "library/FileLister.h"

#include <QFile>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <numeric>

#include <dirent.h>
#include <sys/stat.h>

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

bool isAscii(QStringView s) {
    return std::all_of(s.begin(), s.end(), [](QChar c) { return c.unicode() < 0x80; });
}

bool isAscii(std::string_view s) {
    return std::all_of(s.begin(), s.end(),
                       [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

QString foldCase(QStringView s) {
    if (isAscii(s))
        return s.toString().toLower();
    return s.toString().toCaseFolded();
}

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
    if (m_asciiOnly)
        for (const QString& w : m_wildcards)
            m_asciiWildcards.push_back(w.toStdString());
}

bool FilePattern::matches(QStringView name) const {
    const QString folded = foldCase(name);
    return std::any_of(m_wildcards.begin(), m_wildcards.end(), [&](const QString& w) {
        return wildcardMatch(QStringView(w), QStringView(folded));
    });
}

bool FilePattern::matchesFoldedAscii(std::string_view foldedName) const {
    return std::any_of(m_asciiWildcards.begin(), m_asciiWildcards.end(), [&](const std::string& w) {
        return wildcardMatch(std::string_view(w), foldedName);
    });
}

QStringList listMatchingFiles(const QString& folder, const FilePattern& pattern) {
    QStringList names;
    if (folder.isEmpty())
        return names;
    const QByteArray native = QFile::encodeName(folder);
    std::unique_ptr<DIR, int (*)(DIR*)> dir(opendir(native.constData()), closedir);
    if (!dir)
        return names;
    const int dirFd = dirfd(dir.get());

    // Names and their sort keys are gathered as bytes in two buffers; only the names that
    // match become QStrings, once, after sorting. Keys are the case-folded names in UTF-8,
    // which for plain ASCII names is just their lower-case bytes.
    struct Entry {
        std::uint64_t prefix; // the key's first eight bytes, big-endian: most comparisons end here
        size_t name, nameSize, key, keySize;
    };
    std::string rawNames;
    std::string keys;
    std::vector<Entry> entries;
    while (const dirent* entry = readdir(dir.get())) {
        if (entry->d_name[0] == '.')
            continue;
        bool regular = entry->d_type == DT_REG;
        if (entry->d_type == DT_UNKNOWN || entry->d_type == DT_LNK) {
            struct stat st {};
            regular = fstatat(dirFd, entry->d_name, &st, 0) == 0 && S_ISREG(st.st_mode);
        }
        if (!regular)
            continue;
        const std::string_view raw(entry->d_name);
        const size_t keyStart = keys.size();
        bool match = false;
        if (pattern.asciiOnly() && isAscii(raw)) {
            keys.resize(keyStart + raw.size());
            std::transform(
                raw.begin(), raw.end(), keys.begin() + static_cast<std::ptrdiff_t>(keyStart),
                [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; });
            match = pattern.matchesFoldedAscii(std::string_view(keys).substr(keyStart));
        } else {
            const QString name =
                QFile::decodeName(QByteArray(raw.data(), static_cast<qsizetype>(raw.size())));
            match = pattern.matches(name);
            if (match)
                keys += foldCase(name).toStdString();
        }
        if (!match) {
            keys.resize(keyStart);
            continue;
        }
        std::uint64_t prefix = 0;
        for (size_t i = 0; i < 8; ++i)
            prefix =
                (prefix << 8) |
                (keyStart + i < keys.size() ? static_cast<unsigned char>(keys[keyStart + i]) : 0u);
        entries.push_back({prefix, rawNames.size(), raw.size(), keyStart, keys.size() - keyStart});
        rawNames += raw;
    }

    const std::string_view allNames(rawNames);
    const std::string_view allKeys(keys);
    // Sort by the folded name; equal keys keep a stable, case-sensitive order.
    std::sort(entries.begin(), entries.end(), [&](const Entry& a, const Entry& b) {
        if (a.prefix != b.prefix)
            return a.prefix < b.prefix;
        const int c = allKeys.substr(a.key, a.keySize).compare(allKeys.substr(b.key, b.keySize));
        if (c != 0)
            return c < 0;
        return allNames.substr(a.name, a.nameSize) < allNames.substr(b.name, b.nameSize);
    });
    names.reserve(static_cast<qsizetype>(entries.size()));
    for (const Entry& e : entries) {
        const char* data = rawNames.data() + e.name;
        const auto size = static_cast<qsizetype>(e.nameSize);
        names.push_back(isAscii(allNames.substr(e.name, e.nameSize))
                            ? QString::fromLatin1(data, size)
                            : QFile::decodeName(QByteArray(data, size)));
    }
    return names;
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
    return m_names[index];
}

QStringList FileLister::takeNames() {
    return std::exchange(m_names, QStringList());
}
