#include "AppFixture.h"
#include "support/Boxes.h"
#include "support/DiskFull.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include "emulator/ConfigRecord.h"
#include "library/RomListModel.h"
#include "platform/SettingsStore.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/Twips.h"
#include "ui/vbalProgressBar.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QLabel>
#include <QMenu>
#include <QScreen>

#include <functional>

#include <gtest/gtest.h>

namespace {

const QString kSettings = QStringLiteral("Settings");

QByteArray png(int width, int height) {
    return encodedPicture(width, height, "PNG");
}

// A PNG header that claims a picture of the given size, with no picture data after it.
QByteArray claimedPng(quint32 width, quint32 height) {
    QByteArray header = png(1, 1).left(24);
    for (int i = 0; i < 4; ++i) {
        header[16 + i] = static_cast<char>((width >> (24 - 8 * i)) & 0xFF);
        header[20 + i] = static_cast<char>((height >> (24 - 8 * i)) & 0xFF);
    }
    return header;
}

} // namespace

// Placement values that convert but make no sense (a damaged or hand-edited store): the
// window still opens at a size the user can work with, on the screen.
TEST(BadInputMainWindow, AbsurdPlacementValuesStillGiveAUsableWindow) {
    const struct {
        const char *height, *width, *top, *left;
    } cases[] = {
        {"1e30", "1e30", "1e30", "1e30"}, {"-1e30", "-1e30", "-1e30", "-1e30"},
        {"3e9", "3e9", "3e9", "3e9"},     {"0", "0", "-5000", "-5000"},
        {"nan", "inf", "tall", ""},
    };
    const QSize screen = QGuiApplication::primaryScreen()->virtualSize();
    const int desktop = std::max(screen.width(), screen.height());
    for (const auto& c : cases) {
        SCOPED_TRACE(c.height);
        AppFixture app;
        app.fake.store.SaveSetting("winpos", "height", c.height);
        app.fake.store.SaveSetting("winpos", "width", c.width);
        app.fake.store.SaveSetting("winpos", "top", c.top);
        app.fake.store.SaveSetting("winpos", "left", c.left);
        frmMain& w = app.load();
        EXPECT_GE(w.width(), twips::toPixelsX(2700) - 1);
        EXPECT_GE(w.height(), twips::toPixelsY(2700) - 1);
        EXPECT_LE(w.width(), 2 * desktop);
        EXPECT_LE(w.height(), 2 * desktop);
        EXPECT_FALSE(w.grab().isNull()); // paints the whole window, as the screen would
    }
}

// Background pictures in bad shapes: the list shows no picture, nothing is reported and
// the stored name is kept for a later fix of the file.
TEST(BadInputMainWindow, BadBackgroundPicturesShowNone) {
    const struct {
        const char* name;
        std::function<QString(FakePlatform&)> make;
    } cases[] = {
        {"missing", [](FakePlatform& f) { return f.root() + "/gone.png"; }},
        {"empty", [](FakePlatform& f) { return f.writeFile("empty.png"); }},
        {"truncated", [](FakePlatform& f) { return f.writeFile("cut.png", png(64, 64).left(60)); }},
        {"oversized",
         [](FakePlatform& f) { return f.writeFile("huge.png", claimedPng(100000, 100000)); }},
        {"garbage", [](FakePlatform& f) { return f.writeFile("junk.png", "not a picture"); }},
        {"absurd header",
         [](FakePlatform& f) { return f.writeFile("bad.png", claimedPng(0xFFFFFFFF, 1)); }},
        {"unreadable",
         [](FakePlatform& f) { return makeUnreadable(f.root() + "/locked.png", png(4, 4)); }},
        {"a folder", [](FakePlatform& f) { return f.makeFolder("folder.png"); }},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        AppFixture app;
        const QString path = c.make(app.fake);
        app.fake.store.SaveSetting(kSettings, "BackImg", path);
        frmMain& w = app.load();
        EXPECT_TRUE(w.mnuBackImgEnabled->isChecked());
        EXPECT_FALSE(w.vbalListViewCtl1->hasPicture());
        EXPECT_TRUE(w.vbalProgressBar1->BarPicture().isNull());
        EXPECT_EQ(app.fake.dialogs.boxes.size(), 1u); // only the first-run question
        EXPECT_EQ(app.fake.reopenStore()->GetSetting(kSettings, "BackImg"), path);
        w.grab();
    }
}

// ROM folders that are not readable folders, and a flag that is no Boolean: the list is
// empty, the caption says so, and no message interrupts the start.
TEST(BadInputMainWindow, RomFoldersThatListNothing) {
    AppFixture app;
    app.fake.store.SaveSetting(kSettings, "Z26Path", app.fake.root());
    app.storeFolder(1, app.fake.writeFile("file.bin", "x"));
    app.storeFolder(2, app.fake.root() + "/gone");
    app.storeFolder(3, app.fake.makeFolder("empty"));
    app.storeFolder(4, app.romFolder("roms", {"a.bin"}));
    app.fake.store.SaveSetting(kSettings, "ROM4Checked", "maybe");
    frmMain& w = app.load();
    EXPECT_EQ(w.windowTitle(), "lum - 0 ROM's Found");
    EXPECT_TRUE(app.fake.dialogs.boxes.empty());
}

// CRCID.dat in place but not a readable file: a right-click shows only Refresh and says
// nothing.
TEST(BadInputMainWindow, ABrokenGameDatabaseIdentifiesNothing) {
    for (const bool folder : {true, false}) {
        AppFixture app;
        const QString database = app.fake.programFolder() + "/CRCID.dat";
        if (folder)
            QDir().mkpath(database);
        else
            makeUnreadable(database, QByteArray(56, '\0'));
        app.storePaths();
        frmMain& w = app.load();
        w.vbalListViewCtl1->setCurrentIndex(w.listModel().index(0, 0));
        w.vbalListViewCtl1_MouseDown(Qt::RightButton, QPoint(10, 10));
        EXPECT_FALSE(w.mnuMainGameInfo->isVisible());
        EXPECT_TRUE(app.fake.dialogs.boxes.empty());
        w.mnuMainPopup->close();
    }
}

// Nothing lost, nothing crashes: a settings folder that cannot be written (a file stands
// where the folder belongs, as with a read-only or vanished location) lets the program
// run and close normally; the settings of this session stay in memory until then.
TEST(BadInputMainWindow, ClosesNormallyWhenTheSettingsFolderCannotBeWritten) {
    FakePlatform fake;
    const QString blocker = fake.writeFile("config-file", "not a folder");
    IniSettingsStore store(blocker + "/lum/lum.ini");
    store.SaveSetting(kSettings, "Z26Path", fake.root());
    const QString roms = fake.makeFolder("roms");
    fake.writeFile("roms/a.bin");
    store.SaveSetting(kSettings, "ROMPath", roms);
    store.SaveSetting(kSettings, "ROMChecked", "True");
    Platform platform{store,        fake.dialogs, fake.shell, fake.programFolder(),
                      fake.network, fake.registry};
    {
        frmMain w(platform);
        w.Form_Load();
        w.show();
        EXPECT_EQ(w.windowTitle(), "lum - 1 ROM Found");
        w.close();
    }
    EXPECT_EQ(fileBytes(blocker), "not a folder");
}

// The same with a store file that exists but cannot grow (a full disk): the file on disk
// is left whole, and no temporary file is left beside it.
TEST(BadInputMainWindow, ClosingOnAFullDiskLeavesTheStoreFileWhole) {
    AppFixture app;
    app.storePaths();
    frmMain& w = app.load();
    w.resize(w.width() + 40, w.height() + 40);
    const QByteArray before = fileBytes(app.fake.iniPath());
    const QString folder = QFileInfo(app.fake.iniPath()).absolutePath();
    {
        const DiskFull full(0);
        w.close();
        app.window.reset();
    }
    EXPECT_EQ(fileBytes(app.fake.iniPath()), before);
    EXPECT_EQ(QDir(folder).entryList(QDir::Files | QDir::Hidden), QStringList{"lum.ini"});
}

// Default.lum in every shape at start-up: the start goes on; a good or oversized file loads
// its first record quietly; a corrupt one is said in one box and the settings window opens
// on its first tab with the caption saying so.
TEST(BadInputMainWindow, DefaultOptionSetInEveryShape) {
    const std::string corruptBox = "lum | .lum file is corrupt\r\nPlease verify settings and "
                                   "re-save to correct this problem | Ok | None";
    const QString loaded = "Default.lum was succesfully loaded";
    const QString corrupt =
        "Default.lum is corrupt.  Please verify settings and re-save to correct the problem.";
    QByteArray badField = ConfigRecord().encode();
    badField[14] = 3; // a check box state that does not exist
    const auto holding = [](const QByteArray& bytes) {
        return [bytes](FakePlatform& f) { f.writeFile("program/Default.lum", bytes); };
    };
    const struct {
        const char* name;
        std::function<void(FakePlatform&)> make;
        QString caption;
    } cases[] = {
        {"missing", [](FakePlatform&) {}, "Default.lum couldn't be loaded"},
        {"valid", holding(ConfigRecord().encode()), loaded},
        {"empty", holding({}), corrupt},
        {"truncated", holding(ConfigRecord().encode().left(100)), corrupt},
        {"a bad field", holding(badField), corrupt},
        {"garbage", holding(QByteArray(172, '\xFF')), corrupt},
        {"unreadable",
         [](FakePlatform& f) {
             makeUnreadable(f.programFolder() + "/Default.lum", QByteArray(172, '\0'));
         },
         corrupt},
        {"a folder", [](FakePlatform& f) { f.makeFolder("program/Default.lum"); }, corrupt},
        {"oversized",
         [](FakePlatform& f) {
             QFile file(f.programFolder() + "/Default.lum");
             file.open(QIODevice::WriteOnly);
             file.write(ConfigRecord().encode());
             file.resize(qint64(1) << 30); // a gigabyte, sparse
         },
         loaded},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        AppFixture app;
        app.storePaths();
        c.make(app.fake);
        frmMain& w = app.load();
        EXPECT_EQ(w.windowTitle(), "lum - 1 ROM Found"); // the start went on
        frmSettings& settings = w.settingsWindow();
        EXPECT_EQ(settings.lblConfig->text(), c.caption);
        EXPECT_EQ(settings.lblConfig->toolTip(),
                  std::string(c.name) == "missing"
                      ? "Default.lum need's to be in the same folder as lum.exe"
                      : "");
        const bool bad = c.caption == corrupt;
        EXPECT_EQ(boxLines(app.fake.dialogs), bad ? Lines{corruptBox} : Lines{});
        EXPECT_EQ(settings.isVisible(), bad);
        if (bad) {
            EXPECT_EQ(settings.SelectedTabKey(), "Settings");
        }
    }
}

// The emulator's documents where a folder takes the document's name: the usual message,
// and no editor is started on a folder.
TEST(BadInputMainWindow, ADocumentThatIsAFolderIsReported) {
    AppFixture app;
    app.fake.makeFolder("emu/README.TXT");
    app.fake.makeFolder("emu/copying.txt");
    app.fake.writeFile("emu/z26");
    app.fake.store.SaveSetting(kSettings, "Z26Path", app.fake.root() + "/emu");
    frmMain& w = app.load();
    app.fake.dialogs.boxes.clear();
    w.mnuAboutz26Readme->trigger();
    w.mnuAboutCopying->trigger();
    EXPECT_TRUE(app.fake.shell.textFiles.isEmpty());
    EXPECT_EQ(boxLines(app.fake.dialogs),
              (Lines{"Error | Error loading README.TXT | Ok | Exclamation",
                     "Error | Error loading COPYING.TXT | Ok | Exclamation"}));
}

// The emulator path in bad shapes when a game is started: a path that leads nowhere is
// reported; one that exists but does not lead to the emulator program (the emulator's
// name taken by a folder, some other file) ends the launch without a word. Nothing starts.
TEST(BadInputMainWindow, TheEmulatorPathInBadShapesAtLaunch) {
    AppFixture app;
    app.storePaths();
    frmMain& w = app.load();
    w.vbalListViewCtl1->setCurrentIndex(w.listModel().index(0, 0));
    const struct {
        const char* name;
        QString stored;
        bool reported;
    } cases[] = {
        {"empty", QString(), true},
        {"garbage", QStringLiteral("\x01<?>|\n"), true},
        {"missing", app.fake.root() + "/gone/z26", true},
        {"a folder without the emulator", app.fake.makeFolder("other"), false},
        {"a folder named like the emulator", app.fake.makeFolder("emu/z26").chopped(4), false},
        {"another file", app.fake.writeFile("notes.txt", "hello"), false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        app.fake.dialogs.boxes.clear();
        app.fake.store.SaveSetting(kSettings, "Z26Path", c.stored);
        w.LoadROM();
        EXPECT_EQ(boxLines(app.fake.dialogs),
                  c.reported ? Lines{"Invalid z26 Path | z26 path isn't valid.\n\nTry removing the "
                                     "z26 path and re-adding it to correct the problem. | Ok | "
                                     "Exclamation"}
                             : Lines{});
    }
    EXPECT_TRUE(app.fake.shell.started.empty());
}
