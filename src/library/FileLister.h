#pragma once

#include "library/NameList.h"

#include <QString>
#include <QStringList>

#include <string>
#include <string_view>
#include <vector>

// A file-name pattern: wildcards ('*', '?') separated by ';', matched against a whole
// name without regard to case. "*.*" stands for every name, as it always has.
class FilePattern {
public:
    explicit FilePattern(const QString& pattern = QStringLiteral("*.*"));
    bool matches(QStringView name) const;
    // Whether every wildcard is plain ASCII, so that ASCII names can be matched as bytes.
    bool asciiOnly() const { return m_asciiOnly; }
    // The match for an ASCII name already in lower case.
    bool matchesFoldedAscii(std::string_view foldedName) const;
    const QString& text() const { return m_text; }

private:
    QString m_text;
    std::vector<QString> m_wildcards; // case-folded
    // The ASCII wildcards, each with the shape it has: most are "*.ext", which is just a
    // check of the name's end.
    struct AsciiWildcard {
        enum Shape { Any, Suffix, Exact, General } shape;
        std::string text; // for Suffix, the part after the star
    };
    std::vector<AsciiWildcard> m_asciiWildcards;
    bool m_asciiOnly = true;
};

// Lists one folder at a time: the regular, non-hidden files whose names match the
// pattern, sorted by name without regard to case. A folder that does not exist or cannot
// be read lists nothing. Setting the folder lists it once; reading the names costs nothing.
class FileLister {
public:
    void setPattern(const QString& pattern);
    QString pattern() const { return m_pattern.text(); }

    void setPath(const QString& folder);
    const QString& path() const { return m_path; }

    int ListCount() const { return static_cast<int>(m_names.size()); }
    // The i-th name, or the empty text past the end.
    QString List(int index) const;
    const NameList& names() const { return m_names; }
    // Hands the current listing over, leaving the lister empty.
    NameList takeNames();

private:
    FilePattern m_pattern;
    QString m_path;
    NameList m_names;
};

// Lists `folder` with `pattern` (the lister's work, without a lister).
NameList listMatchingFiles(const QString& folder, const FilePattern& pattern);

// One folder's matching files.
struct FolderListing {
    QString folder;
    NameList names;
};

// Lists each folder in turn. With `bSubfolders`, each is followed by the folders below it
// (depth first, in name order without regard to case), every one its own listing; links to
// folders are not followed, and a folder met twice is listed once.
std::vector<FolderListing> listFolders(const QStringList& folders, const FilePattern& pattern,
                                       bool bSubfolders);
