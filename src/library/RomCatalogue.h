#pragma once

#include "library/FileLister.h"
#include "library/NameList.h"

#include <QSet>
#include <QString>
#include <QStringList>

#include <functional>
#include <future>
#include <optional>
#include <vector>

// The rows of a refresh: row i is names[i], found in folders[rowFolders[i]].
struct RomRows {
    QStringList folders;
    NameList names;
    std::vector<int> rowFolders;
    // Every name the folders listed, matched or not.
    qint64 listed = 0;
    // Whether row i is a favourite; empty when no favourite is known.
    std::vector<bool> favourite;

    bool operator==(const RomRows&) const = default;
};

// Which listed rows to keep: those the search matches (all for an empty one) and, with
// onlyFavourites, only the favourites among them. Favourites are full paths.
struct RowFilter {
    QString search;
    QSet<QString> favourites = {};
    bool onlyFavourites = false;
};

// How far a refresh is: `done` of `total` names looked at.
using RefreshProgress = std::function<void(qint64 done, qint64 total)>;

// The ROM list's source: lists the enabled ROM folders with the file pattern and keeps the
// names a search matches.
class RomCatalogue {
public:
    RomCatalogue() = default;
    RomCatalogue(const RomCatalogue&) = delete;
    RomCatalogue& operator=(const RomCatalogue&) = delete;
    ~RomCatalogue();

    // Starts listing the folders on another thread, so that a large collection is listed
    // while the window is built; the next refresh takes the listing over when it is for
    // the same folders, pattern and sub-folder choice.
    void prefetch(const QStringList& folders, const QString& pattern, bool bSubfolders);
    // Forgets a listing no refresh will take.
    void dropPrefetch();

    // Lists each folder once (with `bSubfolders`, each folder below it too, as a folder of
    // its own) and keeps the names the filter keeps, flagging the favourites. The folders are
    // read on another thread; `whileListing`, when given, is called once before and then
    // about every 16 ms until they are read. `progress` is called with done 0 once every
    // folder is listed, then at least every thousandth of the names while a search or the
    // favourites are matched (else the names are taken whole at once), and last with done
    // equal to total.
    RomRows refresh(const QStringList& folders, const QString& pattern, bool bSubfolders,
                    const RowFilter& filter, const RefreshProgress& progress,
                    const std::function<void()>& whileListing = {});

    // The rows of the last refresh's listing, before its filter, that `filter` keeps, in one
    // pass over the names and without reading a folder; nothing before the first refresh.
    std::optional<RomRows> narrow(const RowFilter& filter) const;

private:
    std::future<std::vector<FolderListing>> m_prefetch;
    QStringList m_prefetchFolders;
    QString m_prefetchPattern;
    bool m_bPrefetchSubfolders = false;
    // Every row the last refresh listed, whatever its search.
    std::optional<RomRows> m_listing;
};

// The main window's caption after a refresh: the first load counts the ROMs found, a
// refresh by the user the matches out of everything listed.
QString refreshCaption(bool bFirstLoad, int rows, qint64 listed);
