#include "AppFixture.h"
#include "support/Boxes.h"

#include "library/RomListModel.h"
#include "platform/SettingsStore.h"
#include "settings/frmSettings.h"
#include "ui/Twips.h"

#include "ui/vbalProgressBar.h"
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QTabWidget>

#include <gtest/gtest.h>

// A start without the emulator or without ROM folders asks for the first one missing and
// opens Default Paths instead of filling the list.
TEST(MainWindowStart, AMissingPathIsAskedForAndDefaultPathsOpens) {
    for (const bool emulatorKnown : {false, true}) {
        SCOPED_TRACE(emulatorKnown);
        AppFixture app;
        if (emulatorKnown)
            app.fake.store.SaveSetting("Settings", "Z26Path", app.fake.root());
        frmMain& w = app.load();
        EXPECT_EQ(boxLines(app.fake.dialogs),
                  Lines{emulatorKnown ? "Choose ROM's Path | You need to select you ROM's path "
                                        "before you continue. | Ok | None"
                                      : "Choose z26 Path | You need to select you z26 path before "
                                        "you continue. | Ok | None"});
        EXPECT_TRUE(w.settingsWindow().isVisible());
        EXPECT_EQ(w.settingsWindow().SelectedTabKey(), "DefaultPaths");
        EXPECT_EQ(w.listModel().columnCount(), 0);
        EXPECT_EQ(w.windowTitle(), "lum"); // no refresh ran
    }
}

TEST(MainWindowPlacement, RestoresAndStoresThePlacementInTwips) {
    AppFixture app;
    SettingsStore& store = app.fake.store;
    store.SaveSetting("winpos", "height", "7200");
    store.SaveSetting("winpos", "width", "6000");
    store.SaveSetting("winpos", "top", "900");
    store.SaveSetting("winpos", "left", "1500");
    frmMain& w = app.load();
    EXPECT_EQ(w.height(), twips::toPixelsY(7200));
    EXPECT_EQ(w.width(), twips::toPixelsX(6000));
    EXPECT_EQ(w.y(), twips::toPixelsY(900));
    EXPECT_EQ(w.x(), twips::toPixelsX(1500));

    w.resize(twips::toPixelsX(5000), twips::toPixelsY(8000));
    w.close();
    auto stored = app.fake.reopenStore();
    EXPECT_EQ(stored->GetSetting("winpos", "max"), "False");
    EXPECT_EQ(readSingle(*stored, "winpos", "width", 0), twips::fromPixelsX(w.width()));
    EXPECT_EQ(readSingle(*stored, "winpos", "height", 0), twips::fromPixelsY(w.height()));
    EXPECT_EQ(readSingle(*stored, "winpos", "top", 0), 900);
    EXPECT_EQ(readSingle(*stored, "winpos", "left", 0), 1500);
}

TEST(MainWindowPlacement, MaximisedKeepsTheLastNormalPlacement) {
    AppFixture app;
    app.fake.store.SaveSetting("winpos", "width", "6000");
    app.fake.store.SaveSetting("winpos", "max", "False");
    frmMain& w = app.load();
    w.showMaximized();
    w.close();
    auto stored = app.fake.reopenStore();
    EXPECT_EQ(stored->GetSetting("winpos", "max"), "True");
    EXPECT_EQ(stored->GetSetting("winpos", "width"), "6000");
    EXPECT_EQ(stored->GetSetting("winpos", "top"), QString());

    // The next start opens maximised.
    AppFixture again;
    again.fake.store.SaveSetting("winpos", "max", "True");
    EXPECT_TRUE(again.load().windowState() & Qt::WindowMaximized);
}

TEST(MainWindowPlacement, MinimisedStoresNothing) {
    AppFixture app;
    frmMain& w = app.load();
    w.show();
    w.showMinimized();
    w.close();
    auto stored = app.fake.reopenStore();
    for (const char* key : {"max", "top", "left", "height", "width"})
        EXPECT_EQ(stored->GetSetting("winpos", key), QString()) << key;
}

TEST(MainWindowLayout, ResizingBelowTheMinimumSnapsBack) {
    AppFixture app;
    frmMain& w = app.load();
    w.resize(40, 500);
    EXPECT_EQ(w.width(), twips::toPixelsX(2700));
    EXPECT_EQ(w.height(), 500);
    w.resize(500, 10);
    EXPECT_EQ(w.height(), twips::toPixelsY(2700));
}

TEST(MainWindowLayout, TheProgressBarCoversTheSearchBoxExactly) {
    AppFixture app;
    frmMain& w = app.load();
    w.resize(twips::toPixelsX(6000), twips::toPixelsY(7000));
    EXPECT_EQ(w.vbalProgressBar1->geometry(), w.txtSearch->geometry());
    EXPECT_EQ(w.txtSearch->parentWidget(), w.vbalProgressBar1->parentWidget());
    EXPECT_NEAR(twips::fromPixelsX(w.fraSelectRom->width()), 6000 - 330, twips::perPixelX());
}

TEST(MainWindowUnload, ExitSavesAndClosesEveryWindow) {
    AppFixture app;
    frmMain& w = app.load();
    ASSERT_TRUE(w.settingsWindow().isVisible());
    w.settingsWindow().move(twips::toPixelsX(3000), twips::toPixelsY(1200));
    w.mnuFileExit->trigger();
    EXPECT_FALSE(w.isVisible());
    EXPECT_FALSE(w.settingsWindow().isVisible());
    auto stored = app.fake.reopenStore();
    EXPECT_EQ(stored->GetSetting("winpos", "max"), "False");
    EXPECT_EQ(readSingle(*stored, "setpos", "left", 0), 3000);
    EXPECT_EQ(readSingle(*stored, "setpos", "top", 0), 1200);
}

TEST(MainWindowMenus, CaptionsAndAccessKeys) {
    AppFixture app;
    frmMain& w = app.load();
    QStringList titles;
    for (QAction* a : w.menuBar()->actions())
        titles << a->text();
    EXPECT_EQ(titles, (QStringList{"&File", "&Settings", "&About"}));
    const std::pair<const char*, const char*> items[] = {
        {"mnuFileLoadSettings", "&Load Settings"},
        {"mnuFileSaveSettings", "&Save Settings"},
        {"mnuFileExit", "E&xit"},
        {"mnuSettingsConfiguration", "&Configuration"},
        {"mnuTextColor", "&Text Color"},
        {"mnuBackImgChange", "Change Background &Image"},
        {"mnuBackColorChange", "Change Background &Color"},
        {"mnuBackImgEnabled", "Background Image &Enabled"},
        {"mnuAboutz26Readme", "z26 &Readme"},
        {"mnuAboutCopying", "&Copying"},
        {"mnuAboutz26HomePage", "&z26 HomePage"},
        {"mnuAboutlumAbout", "&About lum"},
        {"mnuAboutlumHomePage", "&lum HomePage"},
        {"mnuMainRefresh", "Refresh"},
        {"mnuMainGameInfo", "Game Info"},
    };
    for (const auto& [name, caption] : items) {
        auto* action = w.findChild<QAction*>(name);
        ASSERT_NE(action, nullptr) << name;
        EXPECT_EQ(action->text(), caption) << name;
    }
    EXPECT_TRUE(w.mnuFileExit->icon().isNull()); // made when a menu first opens
    emit w.mnuFile->aboutToShow();
    EXPECT_FALSE(w.mnuFileExit->icon().isNull());
    EXPECT_FALSE(w.mnuAboutlumHomePage->icon().isNull());
    EXPECT_TRUE(w.mnuBackImgEnabled->isCheckable());
}
