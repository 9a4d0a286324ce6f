#include "AppFixture.h"

#include "library/CCRC32.h"
#include "library/GameDatabase.h"
#include "library/RomListModel.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/cTextBoxXP.h"

#include "ui/vbalProgressBar.h"
#include <QGroupBox>
#include <QLineEdit>
#include <QMenu>
#include <QTest>

#include <gtest/gtest.h>

#include <malloc.h>

namespace {

// A main window whose first refresh already ran over the given folders.
class RefreshTest : public ::testing::Test {
protected:
    void SetUp() override {
        app.fake.store.SaveSetting("Settings", "Z26Path", app.fake.root());
        app.fake.store.SaveSetting("Settings", "ROMFilter", "*.bin");
    }
    QStringList names() {
        QStringList out;
        for (int i = 0; i < app.window->listModel().rowCount(); ++i)
            out << app.window->listModel().name(i);
        return out;
    }
    void search(const QString& text) {
        app.window->txtSearch->setText(text);
        QTest::keyClick(app.window->txtSearch, Qt::Key_Return);
    }
    AppFixture app;
};

} // namespace

// With both paths known the start adds the columns and fills the list without a word.
TEST_F(RefreshTest, CaptionsCountRowsInBothModes) {
    app.storeFolder(1,
                    app.romFolder("roms", {"Pac-Man.bin", "Pitfall.bin", "Combat.bin", "c.txt"}));
    frmMain& w = app.load();
    EXPECT_TRUE(app.fake.dialogs.boxes.empty());
    EXPECT_FALSE(w.settingsWindow().isVisible());
    EXPECT_FALSE(w.m_bInitialLoad);
    const QAbstractItemModel& model = w.listModel();
    ASSERT_EQ(model.columnCount(), 2);
    EXPECT_EQ(model.headerData(0, Qt::Horizontal, Qt::DisplayRole), "Name");
    EXPECT_EQ(model.headerData(0, Qt::Horizontal, Qt::ToolTipRole), "ROM Name");
    EXPECT_EQ(model.headerData(1, Qt::Horizontal, Qt::DisplayRole), "Path");
    EXPECT_EQ(model.headerData(1, Qt::Horizontal, Qt::ToolTipRole), "ROM Path");
    EXPECT_EQ(w.windowTitle(), "lum - 3 ROM's Found");
    search("pit");
    EXPECT_EQ(w.windowTitle(), "lum - 1 Match out of 3");
    search("kong");
    EXPECT_EQ(w.windowTitle(), "lum - 0 Matches out of 3");
    search("  ");
    EXPECT_EQ(w.windowTitle(), "lum - 3 Matches out of 3");
    EXPECT_EQ(w.fraSearch->title(), "Only show filenames containing...");
    EXPECT_TRUE(w.txtSearch->isVisible());
    EXPECT_FALSE(w.vbalProgressBar1->isVisible());
    EXPECT_TRUE(w.txtSearch->hasFocus() || !w.isActiveWindow());
}

// Folders are listed in their order, each with its own path; a disabled one is skipped and
// the first empty path ends the list.
TEST_F(RefreshTest, EnabledFoldersUpToTheFirstEmptyPathAreListedInOrder) {
    const QString first = app.romFolder("first", {"Combat.bin", "a.bin"});
    const QString third = app.romFolder("third", {"d.bin", "Combat.bin"});
    app.storeFolder(1, first);
    app.storeFolder(2, app.romFolder("second", {"b.bin"}), false);
    app.storeFolder(3, third);
    app.storeFolder(4, QString());
    app.storeFolder(5, app.romFolder("fifth", {"e.bin"}));
    frmMain& w = app.load();
    ASSERT_EQ(names(), (QStringList{"a.bin", "Combat.bin", "Combat.bin", "d.bin"}));
    EXPECT_EQ(w.listModel().rowPath(1), first + "/Combat.bin");
    EXPECT_EQ(w.listModel().rowPath(2), third + "/Combat.bin");
    EXPECT_EQ(w.listModel().data(w.listModel().index(2, 1), Qt::DisplayRole).toString(), third);
    search("bin");
    EXPECT_EQ(w.windowTitle(), "lum - 4 Matches out of 4");
    EXPECT_EQ(w.vbalProgressBar1->Value(), 4); // the bar ends at the total
    EXPECT_EQ(w.vbalProgressBar1->Max(), 4);
}

TEST_F(RefreshTest, ThePatternComesFromTheSettingsWindow) {
    app.storeFolder(1, app.romFolder("roms", {"a.bin", "b.a26", "c.txt"}));
    frmMain& w = app.load();
    w.settingsWindow().txtDefPathFilter->setText("*.BIN;*.A26");
    search("");
    EXPECT_EQ(names(), (QStringList{"a.bin", "b.a26"}));
}

TEST_F(RefreshTest, SearchExpressionsNarrowTheList) {
    app.storeFolder(1, app.romFolder("roms", {"Asteroids.bin", "Asteroids [PAL].bin", "Pac-Man.bin",
                                              "Ms. Pac-Man.bin", "Pacific.bin"}));
    frmMain& w = app.load();
    search("asteroids AND NOT [pal]");
    EXPECT_EQ(names(), QStringList{"Asteroids.bin"});
    search("pac AND man");
    EXPECT_EQ(names(), (QStringList{"Ms. Pac-Man.bin", "Pac-Man.bin"}));
    // F5 in the list applies the expression in the box as well.
    w.txtSearch->setText("pacific");
    QTest::keyClick(w.vbalListViewCtl1, Qt::Key_F5);
    EXPECT_EQ(names(), QStringList{"Pacific.bin"});
}

// Refreshing again and again neither duplicates rows nor holds on to memory.
TEST_F(RefreshTest, RefreshingAgainKeepsOneRowPerFileAndNoMoreMemory) {
    QStringList files;
    for (int i = 0; i < 2000; ++i)
        files << QString("Game %1.bin").arg(i);
    app.storeFolder(1, app.romFolder("roms", files));
    frmMain& w = app.load();
    const auto heapInUse = [] { return mallinfo2().uordblks; };
    for (int i = 0; i < 3; ++i)
        w.mnuMainRefresh->trigger();
    const size_t before = heapInUse();
    for (int i = 0; i < 30; ++i)
        w.mnuMainRefresh->trigger();
    EXPECT_EQ(w.listModel().rowCount(), 2000);
    // A leak of even one name per row and refresh would be over a megabyte here.
    EXPECT_LT(heapInUse(), before + 64 * 1024);
}

// The listing started with the window serves the first refresh only, and only for the
// folders and pattern it was made for.
TEST_F(RefreshTest, TheFirstListingServesOnlyTheLoadsRefreshOfTheSameFolders) {
    const QString roms = app.romFolder("roms", {"a.bin", "b.a26"});
    app.storeFolder(1, roms);
    app.window = std::make_unique<frmMain>(app.fake.platform);
    app.storeFolder(2, app.romFolder("more", {"c.bin"}));
    app.window->Form_Load();
    EXPECT_EQ(names(), (QStringList{"a.bin", "c.bin"}));

    app.fake.writeFile("roms/d.bin");
    search("");
    EXPECT_EQ(names(), (QStringList{"a.bin", "d.bin", "c.bin"}));

    app.window = std::make_unique<frmMain>(app.fake.platform);
    app.fake.store.SaveSetting("Settings", "ROMFilter", "*.a26");
    app.window->Form_Load();
    EXPECT_EQ(names(), QStringList{"b.a26"});
}

TEST(SearchBox, ControlKeysInsertOperatorsAtTheCaret) {
    AppFixture app;
    frmMain& w = app.load();
    w.txtSearch->setText("pacman");
    w.txtSearch->setCursorPosition(3);
    QTest::keyClick(w.txtSearch, Qt::Key_A, Qt::ControlModifier);
    EXPECT_EQ(w.txtSearch->text(), "pac AND man");
    EXPECT_EQ(w.txtSearch->cursorPosition(), 8);
    QTest::keyClick(w.txtSearch, Qt::Key_N, Qt::ControlModifier);
    EXPECT_EQ(w.txtSearch->text(), "pac AND  NOT man");
    EXPECT_EQ(w.txtSearch->cursorPosition(), 13);
    w.txtSearch->setCursorPosition(0);
    QTest::keyClick(w.txtSearch, Qt::Key_O, Qt::ControlModifier);
    EXPECT_EQ(w.txtSearch->text(), " OR pac AND  NOT man");
    EXPECT_EQ(w.txtSearch->cursorPosition(), 4);
    EXPECT_TRUE(w.txtSearch->selectedText().isEmpty()); // Ctrl+A selects nothing here
}

TEST(SearchBox, DoubleClickShowsTheSearchHelp) {
    AppFixture app;
    frmMain& w = app.load();
    QTest::mouseDClick(w.txtSearch, Qt::LeftButton);
    BalloonTip* tip = cTextBoxXP::shownOn(w.txtSearch);
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->icon(), 1);
    EXPECT_EQ(tip->title(), "Advanced Search");
    EXPECT_EQ(tip->text(),
              "You can use the following logic operations in your search: AND, OR, XOR, NOT\r\n"
              "But the Operations must be capitalized.\r\n"
              "for example...  pac AND man... asteroids AND NOT [pal].");
}

TEST_F(RefreshTest, RightClickOffersGameInfoOnlyForAnIdentifiedRow) {
    const QString folder = app.romFolder("roms", {"Unknown.bin"});
    app.fake.writeFile("roms/Known.bin", "known rom bytes");
    app.storeFolder(1, folder);
    CCRC32 crc(app.fake.dialogs);
    crc.setInputFileName(folder + "/Known.bin");
    GameRecord record;
    record.SoftwareID = 57;
    record.CRC = crc.GetCRCFromFile();
    app.fake.writeFile("program/CRCID.dat", encodeGameDatabase({record}));
    frmMain& w = app.load();
    ASSERT_EQ(names(), (QStringList{"Known.bin", "Unknown.bin"}));

    auto rightClick = [&](int row) {
        QWidget* viewport = w.vbalListViewCtl1->viewport();
        const QRect r = w.vbalListViewCtl1->visualRect(w.listModel().index(row, 0));
        QTest::mouseClick(viewport, Qt::RightButton, {}, r.center());
        const bool shown = w.mnuMainPopup->isVisible();
        w.mnuMainPopup->hide();
        return shown;
    };
    EXPECT_TRUE(rightClick(1));
    EXPECT_TRUE(w.mnuMainRefresh->isVisible());
    EXPECT_FALSE(w.mnuMainGameInfo->isVisible());
    EXPECT_TRUE(rightClick(0));
    EXPECT_TRUE(w.mnuMainGameInfo->isVisible());
    w.mnuMainGameInfo->trigger();
    ASSERT_EQ(app.fake.shell.urls.size(), 1);
    EXPECT_TRUE(app.fake.shell.urls[0].endsWith("/software_page.html?SoftwareID=57"));
    EXPECT_TRUE(app.fake.dialogs.boxes.empty());
}
