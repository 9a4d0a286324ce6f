#include "support/Files.h"

#include "library/RomCatalogue.h"
#include "library/RomListModel.h"

#include <QAbstractItemModelTester>
#include <QTemporaryDir>
#include <QThread>

#include <gtest/gtest.h>

namespace {

// A folder under `root` holding empty files with these names.
QString folderWith(const QTemporaryDir& root, const QString& name, const QStringList& files) {
    QDir(root.path()).mkpath(name);
    for (const QString& file : files)
        putFile(root.filePath(name + "/" + file), {});
    return root.filePath(name);
}

using Calls = std::vector<std::pair<qint64, qint64>>;

} // namespace

// Folders in their order, each name with its folder; a folder that is gone and a file in a
// folder's place list nothing. `listed` counts every name the pattern let through.
TEST(RomCatalogue, ListsTheFoldersInOrderAndKeepsWhatTheSearchMatches) {
    QTemporaryDir root;
    const QString a = folderWith(root, "a", {"Pitfall.bin", "Combat.bin", "notes.txt", "b.A26"});
    const QStringList folders = {a, root.filePath("gone"), a + "/notes.txt",
                                 folderWith(root, "b", {"Combat.bin"})};
    const struct {
        const char* pattern;
        const char* search;
        QStringList names;
        std::vector<int> rowFolders;
        qint64 listed;
    } cases[] = {
        {"*.bin", "", {"Combat.bin", "Pitfall.bin", "Combat.bin"}, {0, 0, 3}, 3},
        {"*.BIN;*.a26", "", {"b.A26", "Combat.bin", "Pitfall.bin", "Combat.bin"}, {0, 0, 0, 3}, 4},
        {"*.bin", "combat", {"Combat.bin", "Combat.bin"}, {0, 3}, 3},
        {"*.bin", "kong", {}, {}, 3},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.pattern) + " " + c.search);
        Calls calls;
        const RomRows rows =
            RomCatalogue().refresh(folders, c.pattern, c.search, [&](qint64 done, qint64 total) {
                calls.emplace_back(done, total);
            });
        EXPECT_EQ(rows.folders, folders);
        EXPECT_EQ(rows.names.toStringList(), c.names);
        EXPECT_EQ(rows.rowFolders, c.rowFolders);
        EXPECT_EQ(rows.listed, c.listed);
        EXPECT_EQ(calls.front(), Calls::value_type(0, c.listed));
        EXPECT_EQ(calls.back(), Calls::value_type(c.listed, c.listed));
    }
}

// Progress starts at 0, never goes back, comes at least every thousandth of the names and
// ends with all of them done.
TEST(RomCatalogue, ReportsProgressAtLeastEveryThousandthOfTheNames) {
    QTemporaryDir root;
    QStringList files;
    for (int i = 0; i < 2500; ++i)
        files << QString("Game %1.bin").arg(i);
    const QStringList folders = {folderWith(root, "one", files.mid(0, 1200)),
                                 folderWith(root, "two", files.mid(1200))};
    Calls calls;
    const RomRows rows =
        RomCatalogue().refresh(folders, "*.bin", "game",
                               [&](qint64 done, qint64 total) { calls.emplace_back(done, total); });
    EXPECT_EQ(rows.names.size(), 2500);
    ASSERT_GE(calls.size(), 1000u);
    EXPECT_EQ(calls.front(), Calls::value_type(0, 2500));
    EXPECT_EQ(calls.back(), Calls::value_type(2500, 2500));
    for (std::size_t i = 1; i < calls.size(); ++i) {
        EXPECT_EQ(calls[i].second, 2500) << i;
        EXPECT_GE(calls[i].first, calls[i - 1].first) << i;
        EXPECT_LE((calls[i].first - calls[i - 1].first) * 1000, 2500) << i;
    }
}

// A listing started ahead serves the next refresh of the same folders and pattern, once.
TEST(RomCatalogue, APrefetchServesOneRefreshOfTheSameFoldersAndPattern) {
    QTemporaryDir root;
    const QString a = folderWith(root, "a", {"a.bin", "b.a26"});
    const QString b = folderWith(root, "b", {"c.bin"});
    const auto names = [](const RomRows& rows) { return rows.names.toStringList(); };
    const RefreshProgress ignore = [](qint64, qint64) {};
    RomCatalogue catalogue;
    catalogue.prefetch({a}, "*.bin");
    EXPECT_EQ(names(catalogue.refresh({a, b}, "*.bin", "", ignore)),
              QStringList({"a.bin", "c.bin"}));
    catalogue.prefetch({a}, "*.bin");
    EXPECT_EQ(names(catalogue.refresh({a}, "*.a26", "", ignore)), QStringList{"b.a26"});

    // Taken, it does not see a file added once it is done; the refresh after it does.
    bool bTaken = false;
    for (int attempt = 1; attempt <= 5 && !bTaken; ++attempt) {
        catalogue.prefetch({a}, "*.bin");
        QThread::msleep(20 * attempt); // the listing's own thread has finished by now
        const QString late = QString("late %1.bin").arg(attempt);
        putFile(a + "/" + late, {});
        bTaken = !names(catalogue.refresh({a}, "*.bin", "", ignore)).contains(late);
        EXPECT_TRUE(names(catalogue.refresh({a}, "*.bin", "", ignore)).contains(late));
    }
    EXPECT_TRUE(bTaken);
}

TEST(RomCatalogue, RefreshCaptionCountsRomsAtTheFirstLoadAndMatchesLater) {
    const struct {
        bool bFirstLoad;
        int rows;
        qint64 listed;
        const char* caption;
    } cases[] = {
        {true, 1, 1, "lum - 1 ROM Found"},
        {true, 13, 20, "lum - 13 ROM's Found"},
        {true, 0, 0, "lum - 0 ROM's Found"},
        {true, 100000, 100000, "lum - 100000 ROM's Found"},
        {false, 1, 5, "lum - 1 Match out of 5"},
        {false, 2, 5, "lum - 2 Matches out of 5"},
        {false, 0, 120, "lum - 0 Matches out of 120"},
        {false, 0, 0, "lum - 0 Matches out of 0"},
        {false, 37, 1234567, "lum - 37 Matches out of 1234567"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(refreshCaption(c.bFirstLoad, c.rows, c.listed), c.caption);
}

TEST(RomListModel, KeepsTheModelRulesThroughColumnsRowsAndResets) {
    RomListModel model;
    const QAbstractItemModelTester tester(&model,
                                          QAbstractItemModelTester::FailureReportingMode::Fatal);
    model.addColumn({"Name", "Name", "ROM Name"});
    model.addColumn({"Path", "Path", "ROM Path"});
    NameList names;
    for (const char16_t* name : {u"a.bin", u"b.bin", u"a.bin"})
        names.append(QStringView(name));
    model.setRows({"/roms/one", "/roms/two"}, std::move(names), {0, 0, 1});
    ASSERT_EQ(model.rowCount(), 3);
    EXPECT_EQ(model.rowPath(2), "/roms/two/a.bin");
    EXPECT_EQ(model.data(model.index(2, 1), Qt::DisplayRole).toString(), "/roms/two");
    EXPECT_EQ(model.rowPath(3) + model.name(-1), "");
    model.clear();
    EXPECT_EQ(model.rowCount(), 0);
    model.setRows({"/roms"}, NameList(), {});
    EXPECT_EQ(model.rowCount(), 0);
}
