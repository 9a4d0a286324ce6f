#include "AppFixture.h"

#include "library/GameDatabase.h"

#include <QRegularExpression>
#include <QTimer>

#include <functional>

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
    // Each time the bar shows: the caption, and whether it took the search box's place. A game
    // added then is listed: the bar shows before any folder is read.
    struct : QObject {
        std::function<bool()> on; // false: the event goes on
        bool eventFilter(QObject*, QEvent* e) override { return e->type() == QEvent::Show && on(); }
    } watch;
    QStringList seen;
    auto* bar = control<vbalProgressBar>(*window, "vbalProgressBar1");
    auto* search = control<QLineEdit>(*window, "txtSearch");
    const auto caption = [this] { return control<QGroupBox>(*window, "fraSearch")->title(); };
    watch.on = [&] {
        const bool bInstead = search->isHidden() && bar->geometry() == search->geometry();
        seen << caption() + (bInstead ? " instead" : " beside");
        if (caption() == "Finding ROM's...")
            fake.writeFile("roms/Asteroids (new).bin");
        return false;
    };
    bar->installEventFilter(&watch);
    search->setText("  "); // blanks alone are no search
    load();
    seen << listing();

    // What the popup menu offers, opened by a right click on a row or a key on the current one.
    const auto rightClick = [this](int row, Qt::Key key = {}, Qt::KeyboardModifier with = {}) {
        const QRect r = list()->visualRect(window->listModel().index(row, 0));
        if (key) {
            list()->setCurrentIndex(window->listModel().index(row, 0));
            QTest::keyClick(list(), key, with);
        } else {
            QTest::mouseClick(list()->viewport(), Qt::RightButton, {}, r.center());
        }
        auto* popup = control<QMenu>(*window, "mnuMainPopup");
        const QPoint at = list()->viewport()->mapFromGlobal(popup->pos());
        QString offers = !popup->isVisible() ? "no menu" : r.contains(at) || !key ? "menu" : "away";
        for (const char* item : {"mnuMainRefresh", "mnuMainGameInfo"})
            offers += action(item)->isVisible() ? ' ' + QString(item).mid(7) : "";
        popup->hide();
        return offers;
    };
    EXPECT_EQ(rightClick(2), "menu Refresh");
    EXPECT_EQ(rightClick(3, Qt::Key_Menu) + ", " + rightClick(3, Qt::Key_F10, Qt::ShiftModifier),
              "menu Refresh GameInfo, menu Refresh GameInfo");
    bool bServed = false; // the window is served while the ROM is read
    QTimer::singleShot(0, window.get(), [&] { bServed = true; });
    EXPECT_EQ(rightClick(3), "menu Refresh GameInfo"); // and stays selected for Game Info
    EXPECT_TRUE(bServed);
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
              "Asteroids.bin, Pac-Man.bin, Known.bin\nFinding ROM's... instead\nlum - 2 Matches "
              "out of 5 | Asteroids (new).bin, Asteroids.bin | Only show filenames containing... "
              "5/5 100%");
    EXPECT_TRUE(bar->isHidden() && window->focusWidget() == search);
    // F5 in the list applies the search box's text and the pattern as now stored.
    set("ROMFilter", "*.BIN;*.A26");
    search->setText("pac");
    QTest::keyClick(list(), Qt::Key_F5);
    EXPECT_EQ(listing(), "lum - 2 Matches out of 6 | Pac-Man.bin, Pacific.a26");

    search->setText("pacman");
    const std::tuple<char, int, const char*> keys[] = {
        {'a', 3, "pac AND |man"}, {'n', 8, "pac AND  NOT |man"}, {'o', 0, " OR |pac AND  NOT man"}};
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

// Typing narrows the last refresh's rows, reading no folder; Settings' item turns it off.
TEST_F(MainWindow, SearchAsYouTypeNarrowsTheLastListing) {
    storePaths({"Pa.bin", "Pl.bin", "K.bin"});
    auto* search = control<QLineEdit>(load(), "txtSearch");
    auto* pause = control<QTimer>(*window, "tmrSearch");
    const auto type = [&](const QString& text) { // the listing as typed, then after Enter
        search->clear();
        QTest::keyClicks(search, text);
        const QString typed = QTest::qWaitFor([&] { return !pause->isActive(); }) ? listing() : "";
        QTest::keyClick(search, Qt::Key_Return);
        return typed + " / " + listing();
    };
    fake.writeFile("roms/Px.bin");
    const QString one = type("p AND NOT l"), all = type("");
    action("mnuSearchAsYouType")->trigger();
    EXPECT_EQ(one + '\n' + all + '\n' + type("k") + ' ' + stored("SearchAsYouType"),
              "lum - 1 Match out of 3 | Pa.bin / lum - 2 Matches out of 4 | Pa.bin, Px.bin\n"
              "lum - 4 Matches out of 4 | K.bin, Pa.bin, Pl.bin, Px.bin / lum - 4 Matches out "
              "of 4 | K.bin, Pa.bin, Pl.bin, Px.bin\nlum - 4 Matches out of 4 | K.bin, Pa.bin, "
              "Pl.bin, Px.bin / lum - 1 Match out of 4 | K.bin False");
}

// Favourites are marked from the row popup by full path, starred, kept across a restart and,
// with Settings' item, all the list shows of what the search keeps, typed or entered.
TEST_F(MainWindow, FavouritesFromThePopupSurviveARestartAndNarrowTheList) {
    storePaths({"Pa.bin", "Pl.bin", "K.bin"});
    storeFolder(2, "more", {"Pa.bin"});
    load();
    const auto popup = [this](int row) { // the row's popup: its favourite item's caption
        list()->setCurrentIndex(window->listModel().index(row, 0));
        QTest::keyClick(list(), Qt::Key_Menu);
        control<QMenu>(*window, "mnuMainPopup")->hide();
        return action("mnuMainFavourite")->text() + " | ";
    };
    const auto shown = [this] { // as the Name column shows the rows
        QStringList names;
        for (int row = 0; row < window->listModel().rowCount(); ++row)
            names << window->listModel().index(row, 0).data().toString();
        return window->windowTitle() + " | " + names.join(", ");
    };
    const auto search = [this](const QString& text, bool bEnter) {
        auto* box = control<QLineEdit>(*window, "txtSearch");
        box->setText(text);
        if (bEnter)
            QTest::keyClick(box, Qt::Key_Return);
        EXPECT_TRUE(
            QTest::qWaitFor([&] { return !control<QTimer>(*window, "tmrSearch")->isActive(); }));
    };
    QStringList seen{popup(1)};
    action("mnuMainFavourite")->trigger();
    seen << popup(1);
    seen.last() += popup(0);
    action("mnuMainFavourite")->trigger();
    reload();
    seen << shown();
    action("mnuFavouritesOnly")->trigger();
    seen << shown();
    search("p", true);
    seen << shown();
    search("k OR pl", false);
    seen << shown();
    seen.last() += " | " + popup(0);
    action("mnuMainFavourite")->trigger();
    seen << shown();
    action("mnuFavouritesOnly")->trigger();
    seen << shown();
    action("mnuFavouritesOnly")->trigger();
    reload();
    seen << shown() + " | " + stored("ROM1", "Favourites").replace(fake.root(), "~") +
                stored("ROM2", "Favourites") + ' ' + stored("FavouritesOnly");
    EXPECT_EQ(seen.join('\n'),
              "Add to Favourites | \nRemove from Favourites | Add to Favourites | \n"
              "lum - 4 ROM's Found | \u2605 K.bin, \u2605 Pa.bin, Pl.bin, Pa.bin\n"
              "lum - 2 Matches out of 4 | \u2605 K.bin, \u2605 Pa.bin\n"
              "lum - 1 Match out of 4 | \u2605 Pa.bin\n"
              "lum - 1 Match out of 4 | \u2605 K.bin | Remove from Favourites | \n"
              "lum - 0 Matches out of 4 | \n"
              "lum - 2 Matches out of 4 | K.bin, Pl.bin\n"
              "lum - 1 ROM Found | \u2605 Pa.bin | ~/roms/Pa.bin<missing> True");
}
