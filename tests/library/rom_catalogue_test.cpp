#include "support/FakePlatform.h"

#include "library/RomCatalogue.h"
#include "library/RomListModel.h"

#include <QAbstractItemModelTester>
#include <QFile>

#include <gtest/gtest.h>

#include <tuple>

// Folders in order, each name with its own; a folder gone or a file in its place lists nothing.
TEST(RomCatalogue, ListsTheFoldersInOrderAndKeepsWhatTheSearchMatches) {
    FakePlatform fake;
    for (const char* file :
         {"a/Pitfall.bin", "a/Combat.bin", "a/notes.txt", "a/b.A26", "b/Combat.bin"})
        fake.writeFile(file);
    for (int i = 0; i < 2500; ++i)
        fake.writeFile(QString("many/Game %1.rom").arg(i));
    const QString root = fake.root(), a = root + "/a";
    RomCatalogue catalogue;
    RomListModel model;
    const QAbstractItemModelTester tester(&model,
                                          QAbstractItemModelTester::FailureReportingMode::Fatal);
    model.addColumn({"Name", "Name", "ROM Name"});
    model.addColumn({"Path", "Path", "ROM Path"});
    // A refresh as the list model shows it: the rows' paths, the first and last progress calls,
    // the caption. Progress never goes back, nor, while searching, steps more than a thousandth.
    const auto refreshed = [&](const QStringList& folders, const QString& pattern,
                               const QString& search) -> QString {
        std::vector<std::pair<qint64, qint64>> calls;
        RomRows rows =
            catalogue.refresh(folders, pattern, false, {.search = search},
                              [&](qint64 done, qint64 all) { calls.emplace_back(done, all); });
        EXPECT_EQ(catalogue.narrow({.search = search}), rows); // the same, as typed
        if (calls.empty())
            return "no progress";
        model.clear(); // as the window does once the folders are listed
        model.setRows(rows.folders, std::move(rows.names), rows.rowFolders);
        QStringList shown;
        for (int row = 0; row < model.rowCount(); ++row)
            shown << QDir(root).relativeFilePath(model.rowPath(row));
        const auto call = [](auto c) { return QString("%1/%2").arg(c.first).arg(c.second); };
        QString line = shown.join(", ") + " | " + call(calls.front()) + ".." + call(calls.back()) +
                       " | " + refreshCaption(search.isEmpty(), model.rowCount(), rows.listed);
        for (std::size_t i = 1; i < calls.size(); ++i)
            if (const qint64 step = calls[i].first - calls[i - 1].first;
                calls[i].second != rows.listed || step < 0 || (!search.isEmpty() && step > 2))
                line += " then " + call(calls[i]); // 2 of 2500 names: a thousandth
        return line;
    };
    const QStringList folders = {a, root + "/gone", a + "/notes.txt", root + "/b", root + "/many"};
    const char* const cases[][3] = {
        {"*.bin", "", "a/Combat.bin, a/Pitfall.bin, b/Combat.bin | 0/3..3/3 | lum - 3 ROM's Found"},
        {"*.a26", "", "a/b.A26 | 0/1..1/1 | lum - 1 ROM Found"},
        {"*.x", "", " | 0/0..0/0 | lum - 0 ROM's Found"},
        {"*.bin", "combat", "a/Combat.bin, b/Combat.bin | 0/3..3/3 | lum - 2 Matches out of 3"},
        {"*.bin", "kong", " | 0/3..3/3 | lum - 0 Matches out of 3"},
        {"*.rom", "game 1234",
         "many/Game 1234.rom | 0/2500..2500/2500 | lum - 1 Match out of 2500"},
    };
    for (const auto& [pattern, search, expected] : cases) {
        catalogue.prefetch({a}, "*.bin", false); // for other folders: not taken
        EXPECT_EQ(refreshed(folders, pattern, search), expected);
    }
    EXPECT_EQ(model.index(0, 0).data().toString() + " in " + model.index(0, 1).data().toString() +
                  " tip " + model.index(0, 1).data(Qt::ToolTipRole).toString(),
              "Game 1234.rom in " + root + "/many tip " + root + "/many");
    EXPECT_EQ(model.rowPath(-1) + model.rowPath(1), "");

    // A listing started ahead serves one refresh of the same folders and pattern at most.
    catalogue.prefetch({a}, "*.bin", false);
    refreshed({a}, "*.bin", "");
    fake.writeFile("a/Late.bin");
    EXPECT_TRUE(
        refreshed({a}, "*.bin", "").startsWith("a/Combat.bin, a/Late.bin, a/Pitfall.bin |"));
}

// Each folder of a tree is its own, in name order after the files above it; a link to a file
// is listed, a link back up the tree is not followed, and a folder met twice is listed once.
TEST(RomCatalogue, ListsSubfoldersOnlyWhenAskedEachOnceWithItsOwnFolder) {
    FakePlatform fake;
    for (const char* file : {"tree/Top.bin", "tree/sub/B.bin", "tree/sub/deep/C.bin",
                             "tree/Alpha/A.bin", "tree/Alpha/x.txt"})
        fake.writeFile(file);
    const QString root = fake.root(), tree = root + "/tree";
    ASSERT_TRUE(QFile::link(tree, tree + "/loop"));
    ASSERT_TRUE(QFile::link(tree + "/sub/B.bin", tree + "/link.bin"));
    RomCatalogue catalogue;
    const auto listed = [&](const QStringList& folders, bool bSubfolders) {
        catalogue.prefetch(folders, "*.bin", !bSubfolders); // for the other choice: not taken
        const RomRows rows = catalogue.refresh(folders, "*.bin", bSubfolders, {}, {});
        QStringList shown;
        for (qsizetype i = 0; i < rows.names.size(); ++i)
            shown << QDir(root).relativeFilePath(rows.folders[rows.rowFolders[size_t(i)]]) + ": " +
                         rows.names.at(i).toString();
        return shown.join(", ");
    };
    const std::tuple<QStringList, bool, QString> cases[] = {
        {{tree}, false, "tree: link.bin, tree: Top.bin"},
        {{tree},
         true,
         "tree: link.bin, tree: Top.bin, tree/Alpha: A.bin, tree/sub: B.bin, tree/sub/deep: C.bin"},
        {{tree + "/sub", tree},
         true,
         "tree/sub: B.bin, tree/sub/deep: C.bin, tree: link.bin, tree: Top.bin, tree/Alpha: A.bin"},
        {{tree + "/loop"},
         true, // a folder chosen by its link is followed, once
         "tree/loop: link.bin, tree/loop: Top.bin, tree/loop/Alpha: A.bin, tree/loop/sub: B.bin, "
         "tree/loop/sub/deep: C.bin"},
    };
    for (const auto& [folders, bSubfolders, expected] : cases)
        EXPECT_EQ(listed(folders, bSubfolders), expected) << qPrintable(folders.join(' '));
}
