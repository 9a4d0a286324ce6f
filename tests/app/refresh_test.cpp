#include "AppFixture.h"

#include "library/GameDatabase.h"
#include "ui/vbalProgressBar.h"

#include <QGroupBox>
#include <QLineEdit>
#include <QMenu>
#include <QTest>

#include <malloc.h>

#include <functional>

namespace {

// Runs `look` each time the widget it watches is shown.
struct OnShow : QObject {
    std::function<void()> look;
    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Show)
            look();
        return false;
    }
};

class Refresh : public AppFixture {
protected:
    QLineEdit* search() const { return control<QLineEdit>(*window, "txtSearch"); }
    void searchFor(const QString& text) const {
        search()->setText(text);
        QTest::keyClick(search(), Qt::Key_Return);
    }
};

} // namespace

// The captions of the first load and of a search, the bar over the search box meanwhile;
// again and again, from the list's popup menu, a refresh holds on to no more memory.
TEST_F(Refresh, CaptionsTheBarAndNoMoreMemory) {
    QStringList files{"Pitfall.bin", "notes.txt"}; // *.bin while no pattern is stored
    for (int i = 0; i < 2000; ++i)
        files << QString("Game %1.bin").arg(i);
    storePaths(files);
    window = std::make_unique<frmMain>(fake.platform);
    // Each time the bar appears: the search frame's caption, and whether the bar has taken
    // the search box's place.
    QStringList seen;
    OnShow watch;
    auto* bar = control<vbalProgressBar>(*window, "vbalProgressBar1");
    watch.look = [&] {
        seen << control<QGroupBox>(*window, "fraSearch")->title() +
                    (search()->isHidden() && bar->geometry() == search()->geometry() ? " instead"
                                                                                     : " beside");
    };
    bar->installEventFilter(&watch);
    frmMain& w = load();
    EXPECT_EQ(w.windowTitle(), "lum - 2001 ROM's Found");
    searchFor("pit");
    EXPECT_EQ(w.windowTitle(), "lum - 1 Match out of 2001");
    searchFor("  ");
    EXPECT_EQ(w.windowTitle(), "lum - 2001 Matches out of 2001");
    EXPECT_EQ(seen, (QStringList{"Loading ROM's List... instead", "Finding ROM's... instead",
                                 "Finding ROM's... instead"}));
    // At rest again: the bar ended full and is hidden, the search box is back with the focus.
    EXPECT_EQ(control<QGroupBox>(w, "fraSearch")->title(), "Only show filenames containing...");
    EXPECT_TRUE(bar->isHidden() && search()->isVisible());
    EXPECT_EQ(QString("%1/%2 %3").arg(bar->Value()).arg(bar->Max()).arg(bar->Text()),
              "2001/2001 100%");
    EXPECT_EQ(w.focusWidget(), search());
    EXPECT_TRUE(boxes().empty());

    bar->removeEventFilter(&watch);
    const auto heapInUse = [] { return mallinfo2().uordblks; };
    action("mnuMainRefresh")->trigger();
    const size_t before = heapInUse();
    for (int i = 0; i < 30; ++i)
        action("mnuMainRefresh")->trigger();
    EXPECT_EQ(w.listModel().rowCount(), 2001);
    EXPECT_LT(heapInUse(), before + 64 * 1024); // a leaked name a row would be a megabyte
}

// The enabled folders up to the first empty path, in order, each row with its own folder;
// the pattern as stored at each refresh; the search box's text, also for F5 in the list.
TEST_F(Refresh, FoldersPatternAndSearchDecideTheRows) {
    storePaths(
        {"Asteroids.bin", "Asteroids [PAL].bin", "Pac-Man.bin", "Ms. Pac-Man.bin", "Pacific.a26"});
    storeFolder(2, romFolder("off", {"Off.bin"}));
    fake.store.SaveSetting("Settings", "ROM2Checked", "maybe"); // no Boolean: off
    storeFolder(3, romFolder("third", {"Combat.bin"}));
    storeFolder(4, QString());
    storeFolder(5, romFolder("fifth", {"Late.bin"}));
    frmMain& w = load();
    EXPECT_EQ(names(), (QStringList{"Asteroids [PAL].bin", "Asteroids.bin", "Ms. Pac-Man.bin",
                                    "Pac-Man.bin", "Combat.bin"}));
    EXPECT_EQ(w.listModel().rowPath(4), fake.root() + "/third/Combat.bin");
    searchFor("asteroids AND NOT [pal]");
    EXPECT_EQ(names(), QStringList{"Asteroids.bin"});

    fake.store.SaveSetting("Settings", "ROMFilter", "*.BIN;*.A26");
    search()->setText("pac");
    QTest::keyClick(list(), Qt::Key_F5);
    EXPECT_EQ(names(), (QStringList{"Ms. Pac-Man.bin", "Pac-Man.bin", "Pacific.a26"}));
    EXPECT_EQ(w.windowTitle(), "lum - 3 Matches out of 6");
}

// The listing started as the window is built serves the first load only, and only for the
// folders and pattern it was made for.
TEST_F(Refresh, TheFirstListingServesOnlyTheFirstLoadOfTheSameFolders) {
    storePaths({"a.bin", "b.a26"});
    window = std::make_unique<frmMain>(fake.platform);
    storeFolder(2, romFolder("more", {"c.bin"}));
    load();
    EXPECT_EQ(names(), (QStringList{"a.bin", "c.bin"}));
    fake.writeFile("roms/d.bin");
    searchFor("");
    EXPECT_EQ(names(), (QStringList{"a.bin", "d.bin", "c.bin"}));

    window = std::make_unique<frmMain>(fake.platform);
    fake.store.SaveSetting("Settings", "ROMFilter", "*.a26");
    load();
    EXPECT_EQ(names(), QStringList{"b.a26"});
}

TEST_F(Refresh, RightClickOffersGameInfoOnlyForAnIdentifiedRow) {
    storePaths({"Unknown.bin"});
    fake.writeFile("roms/Known.bin", "123456789");
    GameRecord record;
    record.SoftwareID = 57;
    record.CRC = qint32(0xCBF43926u); // the CRC-32 of "123456789"
    fake.writeFile("program/CRCID.dat", encodeGameDatabase({record}));
    frmMain& w = load();
    ASSERT_EQ(names(), (QStringList{"Known.bin", "Unknown.bin"}));
    const auto rightClick = [&](int row) {
        const QRect r = list()->visualRect(w.listModel().index(row, 0));
        QTest::mouseClick(list()->viewport(), Qt::RightButton, {}, r.center());
        QMenu* popup = control<QMenu>(w, "mnuMainPopup");
        const bool bShown = popup->isVisible();
        popup->hide();
        return bShown && action("mnuMainRefresh")->isVisible();
    };
    EXPECT_TRUE(rightClick(1));
    EXPECT_FALSE(action("mnuMainGameInfo")->isVisible());
    EXPECT_TRUE(rightClick(0));
    EXPECT_TRUE(action("mnuMainGameInfo")->isVisible());
    action("mnuMainGameInfo")->trigger();
    EXPECT_EQ(fake.shell.urls.join(' ').section('/', -1), "software_page.html?SoftwareID=57");
    EXPECT_TRUE(boxes().empty());
}

TEST_F(Refresh, SearchBoxKeysInsertOperatorsAndADoubleClickExplains) {
    storePaths();
    load();
    search()->setText("pacman");
    const struct {
        Qt::Key key;
        int caret;
        const char* text;
        int after;
    } keys[] = {{Qt::Key_A, 3, "pac AND man", 8},
                {Qt::Key_N, 8, "pac AND  NOT man", 13},
                {Qt::Key_O, 0, " OR pac AND  NOT man", 4}};
    for (const auto& k : keys) {
        search()->setCursorPosition(k.caret);
        QTest::keyClick(search(), k.key, Qt::ControlModifier);
        EXPECT_EQ(search()->text(), k.text);
        EXPECT_EQ(search()->cursorPosition(), k.after);
    }
    EXPECT_TRUE(search()->selectedText().isEmpty()); // Ctrl+A selects nothing here
    QTest::mouseDClick(search(), Qt::LeftButton);
    EXPECT_EQ(balloon(search()),
              "1 | Advanced Search | You can use the following logic operations in your search: "
              "AND, OR, XOR, NOT\r\nBut the Operations must be capitalized.\r\nfor example...  pac "
              "AND man... asteroids AND NOT [pal].");
}
