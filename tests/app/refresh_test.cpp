#include "AppFixture.h"

#include "library/GameDatabase.h"

#include <QRegularExpression>

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

} // namespace

// The enabled folders up to an empty path, also those stored after the listing started,
// each row with its own folder: Game Info finds the game in the third.
TEST_F(MainWindow, FoldersPatternSearchCaptionsAndThePopupMenu) {
    storePaths({"Asteroids.bin", "Asteroids [PAL].bin", "Pac-Man.bin", "Pacific.a26"});
    const GameRecord known{.SoftwareID = 57, .Title = {}, .CRC = qint32(0xCBF43926u)};
    fake.writeFile("program/CRCID.dat", encodeGameDatabase({known}));
    window = std::make_unique<frmMain>(fake.platform);
    storeFolder(2, "off", {"Off.bin"}, "maybe");    // no Boolean: off
    fake.writeFile("third/Known.bin", "123456789"); // whose CRC-32 is CBF43926
    storeFolder(3, "third");
    storeFolder(4, "");
    storeFolder(5, "fifth", {"Late.bin"});
    // Each time the bar shows: the caption, and whether it took the search box's place.
    QStringList seen;
    OnShow watch;
    auto* bar = control<vbalProgressBar>(*window, "vbalProgressBar1");
    auto* search = control<QLineEdit>(*window, "txtSearch");
    const auto caption = [this] { return control<QGroupBox>(*window, "fraSearch")->title(); };
    watch.look = [&] {
        const bool bInstead = search->isHidden() && bar->geometry() == search->geometry();
        seen << caption() + (bInstead ? " instead" : " beside");
    };
    bar->installEventFilter(&watch);
    search->setText("  "); // blanks alone are no search
    load();
    seen << listing();

    const auto rightClick = [this](int row) { // what the popup menu offers
        const QRect r = list()->visualRect(window->listModel().index(row, 0));
        QTest::mouseClick(list()->viewport(), Qt::RightButton, {}, r.center());
        auto* popup = control<QMenu>(*window, "mnuMainPopup");
        const bool bShown = popup->isVisible() && action("mnuMainRefresh")->isVisible();
        popup->hide();
        return !bShown                                  ? "nothing"
               : action("mnuMainGameInfo")->isVisible() ? "Game Info"
                                                        : "Refresh";
    };
    EXPECT_STREQ(rightClick(2), "Refresh");
    EXPECT_STREQ(rightClick(3), "Game Info"); // and Refresh
    action("mnuMainGameInfo")->trigger();
    EXPECT_TRUE(happened().contains(
        QRegularExpression("^open https://\\S+/software_page\\.html\\?SoftwareID=57$")));

    search->setText("asteroids AND NOT [pal]");
    QTest::keyClick(search, Qt::Key_Return);
    seen << listing() + " | " + caption() + ' ' + QString::number(bar->Value()) + '/' +
                QString::number(bar->Max()) + ' ' + bar->Text();
    bar->removeEventFilter(&watch);
    EXPECT_EQ(seen.join('\n'),
              "Loading ROM's List... instead\nlum - 4 ROM's Found | Asteroids [PAL].bin, "
              "Asteroids.bin, Pac-Man.bin, Known.bin\nFinding ROM's... instead\nlum - 1 Match "
              "out of 4 | Asteroids.bin | Only show filenames containing... 4/4 100%");
    EXPECT_TRUE(bar->isHidden() && window->focusWidget() == search);
    // F5 in the list applies the search box's text and the pattern as now stored.
    set("ROMFilter", "*.BIN;*.A26");
    search->setText("pac");
    QTest::keyClick(list(), Qt::Key_F5);
    EXPECT_EQ(listing(), "lum - 2 Matches out of 5 | Pac-Man.bin, Pacific.a26");

    search->setText("pacman");
    const std::tuple<Qt::Key, int, const char*> keys[] = {{Qt::Key_A, 3, "pac AND |man"},
                                                          {Qt::Key_N, 8, "pac AND  NOT |man"},
                                                          {Qt::Key_O, 0, " OR |pac AND  NOT man"}};
    for (const auto& [key, caret, after] : keys) { // "|" marks the caret
        search->setCursorPosition(caret);
        QTest::keyClick(search, key, Qt::ControlModifier);
        EXPECT_EQ(search->text().insert(search->cursorPosition(), '|'), after);
    }
    QTest::mouseDClick(search, Qt::LeftButton);
    EXPECT_EQ(happened(),
              "tip txtSearch 1 | Advanced Search | You can use the following logic operations "
              "in your search: AND, OR, XOR, NOT\r\nBut the Operations must be capitalized.\r\n"
              "for example...  pac AND man... asteroids AND NOT [pal].");
}
