#include "AppFixture.h"

#include "about/frmAbout.h"
#include "emulator/OptionFile.h"
#include "ui/vbalProgressBar.h"

#include <QFile>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPointer>

using MainWindow = AppFixture;

// Every caption, access key, column, icon and start state after a start that lists two ROMs.
TEST_F(MainWindow, StartsAsTheGoldenDumpShows) {
    storePaths({"a.bin", "b.bin"});
    frmMain& w = load();
    emit control<QMenu>(w, "mnuFile")->aboutToShow(); // the icons come with the first menu
    expectGolden("frmMain", dumpWidgetTree(w));
    EXPECT_EQ(list()->header()->sectionSize(1), 67); // 1000 twips at the offscreen 96 dpi
}

// A start without the emulator or without ROM folders asks for the first one missing and
// opens Default Paths instead of filling the list.
TEST_F(MainWindow, AMissingPathIsAskedForAndDefaultPathsOpens) {
    for (const bool bEmulatorKnown : {false, true}) {
        fake.dialogs.boxes.clear();
        if (bEmulatorKnown)
            fake.store.SaveSetting("Settings", "Z26Path", fake.root());
        window.reset();
        frmMain& w = load();
        EXPECT_EQ(boxes(),
                  Lines{bEmulatorKnown ? "Choose ROM's Path | You need to select you ROM's "
                                         "path before you continue. | Ok | None"
                                       : "Choose z26 Path | You need to select you z26 "
                                         "path before you continue. | Ok | None"});
        EXPECT_TRUE(settings().isVisible());
        EXPECT_EQ(settings().selectedPage(), "DefaultPaths");
        EXPECT_EQ(w.listModel().columnCount(), 0);
        EXPECT_EQ(w.windowTitle(), "lum"); // no refresh ran
    }
}

// Default.lum beside the program: its options as read at start wait for the settings
// window, built when first needed; a corrupt one is said at once, on the window's first page.
TEST_F(MainWindow, DefaultLumIsAppliedWhenTheSettingsWindowIsFirstBuilt) {
    storePaths();
    fake.store.SaveSetting("Settings", "BackColor", "255");
    EmulatorOptions sample;
    sample.gameType = 5;
    sample.palette = Palette::Pal;
    enum Outcome { Missing, Good, Corrupt };
    const struct {
        Outcome outcome;
        QByteArray bytes;
        const char* caption;
    } cases[] = {
        {Missing, {}, "Default.lum couldn't be loaded"},
        {Good, encodeOptions(sample), "Default.lum was succesfully loaded"},
        {Corrupt, encodeOptions(sample).left(100),
         "Default.lum is corrupt.  Please verify settings and re-save to correct the problem."},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.outcome);
        fake.dialogs.boxes.clear();
        QFile::remove(fake.programFolder() + "/Default.lum");
        if (!c.bytes.isEmpty())
            fake.writeFile("program/Default.lum", c.bytes);
        window.reset();
        EXPECT_EQ(load().windowTitle(), "lum - 1 ROM Found"); // the start went on
        const bool bCorrupt = c.outcome == Corrupt;
        fake.writeFile("program/Default.lum", encodeOptions(EmulatorOptions())); // not read
        EXPECT_EQ(encodeOptions(settings().options()),
                  encodeOptions(c.outcome == Good ? sample : EmulatorOptions()));
        EXPECT_EQ(control<QLabel>(settings(), "lblConfig")->text(), c.caption);
        EXPECT_EQ(control<QLabel>(settings(), "lblConfig")->toolTip(),
                  c.outcome == Missing ? "Default.lum need's to be in the same folder as lum.exe"
                                       : "");
        EXPECT_EQ(control<vbalProgressBar>(settings(), "BarColorPhos")->BarColor(), 255u);
        EXPECT_EQ(boxes(), bCorrupt ? Lines{"lum | .lum file is corrupt\r\nPlease verify settings "
                                            "and re-save to correct this problem | Ok | None"}
                                    : Lines{});
        EXPECT_EQ(settings().isVisible() ? settings().selectedPage() : "hidden",
                  bCorrupt ? "Settings" : "hidden");
    }
}

// The place is restored from twips (15 a pixel at the offscreen 96 dpi) and stored at the
// end: a maximised window keeps its last normal place and only says it was maximised, a
// minimised one stores nothing. Resizing keeps 2700 twips each way and lays the progress
// bar exactly over the search box.
TEST_F(MainWindow, PlaceAndSize) {
    storePaths();
    for (const auto& [key, value] :
         {std::pair{"height", "7200"}, {"width", "6000"}, {"top", "900"}, {"left", "1500"}})
        fake.store.SaveSetting("winpos", key, value);
    frmMain& w = load();
    EXPECT_EQ(QRect(w.pos(), w.size()), QRect(100, 60, 400, 480));
    w.resize(40, 500);
    EXPECT_EQ(w.size(), QSize(180, 500));
    w.resize(500, 10);
    EXPECT_EQ(w.size(), QSize(500, 180));
    w.resize(320, 530);
    const QWidget* search = control<QLineEdit>(w, "txtSearch");
    EXPECT_EQ(control<vbalProgressBar>(w, "vbalProgressBar1")->geometry(), search->geometry());
    EXPECT_EQ(search->parentWidget(),
              control<vbalProgressBar>(w, "vbalProgressBar1")->parentWidget());
    EXPECT_EQ(control<QGroupBox>(w, "fraSelectRom")->width(), 320 - 22);

    const auto place = [this] {
        QStringList values{stored("max", "winpos")};
        for (const char* key : {"top", "left", "height", "width"})
            values << stored(key, "winpos");
        return values.join(' ');
    };
    w.close();
    EXPECT_EQ(place(), "False 900 1500 7950 4800");
    window.reset();
    load().showMaximized();
    window->close();
    EXPECT_EQ(place(), "True 900 1500 7950 4800");
    window.reset();
    EXPECT_TRUE(load().isMaximized()); // as it was left
    window->showNormal();
    window->resize(600, 600);
    window->showMinimized();
    window->close();
    EXPECT_EQ(place(), "True 900 1500 7950 4800");
}

// The menus reach the other windows; Exit closes them all, the settings window storing its
// place, which a session that never opened it leaves alone.
TEST_F(MainWindow, MenusReachTheOtherWindowsAndExitClosesThemAll) {
    storePaths();
    load().close();
    EXPECT_EQ(stored("top", "setpos"), "<missing>"); // the settings window was never built

    window.reset();
    frmMain& w = load();
    EmulatorOptions options;
    options.gameType = 7;
    settings().setOptions(options);
    fake.dialogs.paths = {fake.root() + "/menu.lum", fake.root() + "/menu.lum"};
    action("mnuFileSaveSettings")->trigger();
    settings().setOptions(EmulatorOptions());
    action("mnuFileLoadSettings")->trigger();
    EXPECT_EQ(settings().options().gameType, 7);
    EXPECT_EQ(control<QLabel>(settings(), "lblConfig")->text(), "menu.lum was succesfully loaded");

    EXPECT_FALSE(settings().isVisible());
    action("mnuSettingsConfiguration")->trigger();
    EXPECT_TRUE(settings().isVisible());
    settings().move(200, 80);
    action("mnuAboutlumAbout")->trigger();
    const QPointer<frmAbout> about = w.findChild<frmAbout*>();
    ASSERT_TRUE(about && about->isVisible());
    action("mnuFileExit")->trigger();
    EXPECT_FALSE(w.isVisible() || settings().isVisible() || (about && about->isVisible()));
    EXPECT_EQ(stored("left", "setpos") + ' ' + stored("top", "setpos"), "3000 1200");
}

// The emulator's documents open in the text editor from the emulator's folder, whether the
// stored path names the folder or the program; anything else is one message. The home
// pages open in the browser.
TEST_F(MainWindow, AboutMenuOpensDocumentsAndPages) {
    const QString readme = fake.writeFile("emu/README.TXT", "read me");
    const QString copying = fake.writeFile("emu/copying.txt", "GPL"); // as often unpacked here
    fake.writeFile("emu/z26");
    fake.writeFile("emu/Z26");
    fake.makeFolder("odd/README.TXT");
    load();
    const QString readmeError = "Error | Error loading README.TXT | Ok | Exclamation";
    const QString copyingError = "Error | Error loading COPYING.TXT | Ok | Exclamation";
    const struct {
        const char* stored; // under the root, "" for no path
        const char* item;
        QString outcome; // the file opened, or the box
    } cases[] = {
        {"emu", "mnuAboutz26Readme", readme},
        {"emu/z26", "mnuAboutz26Readme", readme},
        {"emu/Z26", "mnuAboutz26Readme", readme},
        {"emu", "mnuAboutCopying", copying},
        {"", "mnuAboutz26Readme", readmeError},
        {"odd", "mnuAboutz26Readme", readmeError}, // a folder takes the document's name
        {"odd", "mnuAboutCopying", copyingError},
    };
    for (const auto& c : cases) {
        fake.dialogs.boxes.clear();
        fake.shell.textFiles.clear();
        fake.store.SaveSetting("Settings", "Z26Path",
                               *c.stored ? fake.root() + "/" + c.stored : "");
        action(c.item)->trigger();
        QString outcome = fake.shell.textFiles.join(' ');
        for (const std::string& box : boxes())
            outcome += QString::fromStdString(box);
        EXPECT_EQ(outcome, c.outcome) << c.stored << ' ' << c.item;
    }
    fake.store.SaveSetting("Settings", "Z26Path", fake.root() + "/emu");
    fake.shell.succeed = false; // the editor could not be started
    action("mnuAboutCopying")->trigger();
    EXPECT_EQ(QString::fromStdString(boxes().back()), copyingError);

    action("mnuAboutz26HomePage")->trigger();
    action("mnuAboutlumHomePage")->trigger();
    ASSERT_EQ(fake.shell.urls.size(), 2);
    EXPECT_TRUE(fake.shell.urls[0].startsWith("https://") &&
                fake.shell.urls[1].startsWith("https://"));
    EXPECT_NE(fake.shell.urls[0], fake.shell.urls[1]);
}
