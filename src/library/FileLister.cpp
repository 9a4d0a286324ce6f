#include "library/FileLister.h"

#include <QFile>

#include <algorithm>
#include <memory>
#include <numeric>

#include <dirent.h>
#include <sys/stat.h>

namespace {

// Wildcard match of a case-folded pattern against a case-folded name.
bool wildcardMatch(QStringView pattern, QStringView name) {
    qsizetype p = 0, n = 0;
    qsizetype starP = -1, starN = 0;
    while (n < name.size()) {
        // A star is a wildcard even where the name holds a star of its own.
        if (p < pattern.size() && pattern[p] == u'*') {
            starP = p++;
            starN = n;
        } else if (p < pattern.size() && (pattern[p] == u'?' || pattern[p] == name[n])) {
            ++p;
            ++n;
        } else if (starP >= 0) {
            p = starP + 1;
            n = ++starN;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == u'*')
        ++p;
    return p == pattern.size();
}

bool isAscii(QStringView s) {
    return std::all_of(s.begin(), s.end(), [](QChar c) { return c.unicode() < 0x80; });
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
}

bool FilePattern::matches(QStringView name) const {
    if (m_wildcards.empty())
        return false;
    const QString folded = foldCase(name);
    return std::any_of(m_wildcards.begin(), m_wildcards.end(),
                       [&](const QString& w) { return wildcardMatch(w, folded); });
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
    std::vector<QString> keys;
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
        QString name = QFile::decodeName(entry->d_name);
        QString key = foldCase(name);
        if (!std::any_of(pattern.wildcardsBegin(), pattern.wildcardsEnd(),
                         [&](const QString& w) { return wildcardMatch(w, key); }))
            continue;
        names.push_back(std::move(name));
        keys.push_back(std::move(key));
    }
    // Sort by the case-folded name; equal keys keep a stable, case-sensitive order.
    std::vector<int> order(names.size());
    std::iota(order.begin(), order.end(), 0);
    std::sort(order.begin(), order.end(), [&](int a, int b) {
        const int c = QStringView(keys[a]).compare(QStringView(keys[b]));
        return c != 0 ? c < 0 : names[a] < names[b];
    });
    QStringList sorted;
    sorted.reserve(names.size());
    for (int i : order)
        sorted.push_back(std::move(names[i]));
    return sorted;
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
