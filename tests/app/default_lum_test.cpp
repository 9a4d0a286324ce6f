#include "AppFixture.h"

#include "emulator/ConfigRecord.h"
#include "settings/frmSettings.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QFile>
#include <QLabel>
#include <QRadioButton>

#include <gtest/gtest.h>

namespace {

// A valid option set that differs from the settings window's start.
ConfigRecord sampleRecord() {
    ConfigRecord r;
    r.optVMDefault = r.optDSPDefault = r.optSCPCX = r.optFPSDefault = r.optNarrowNot = true;
    r.optCPPAL = true;
    r.comboGT = 5;
    r.BarColorPaddle = 4;
    r.BarColorSoundQueue = 4608;
    r.BarColorPhos = 77;
    return r;
}

} // namespace

TEST(DefaultLumAtStart, FileMenuSavesAndLoadsOptionSets) {
    AppFixture app;
    frmMain& w = app.load();
    frmSettings& settings = w.settingsWindow();
    ASSERT_TRUE(w.mnuFileSaveSettings->isEnabled());
    ASSERT_TRUE(w.mnuFileLoadSettings->isEnabled());

    const QString path = app.fake.root() + "/menu.lum";
    settings.comboGT->setCurrentIndex(7);
    app.fake.dialogs.paths.push_back(path);
    w.mnuFileSaveSettings->trigger();
    EXPECT_EQ(settings.lblConfig->text(), "menu.lum was succesfully saved");
    EXPECT_TRUE(QFile::exists(path));

    settings.comboGT->setCurrentIndex(0);
    app.fake.dialogs.paths.push_back(path);
    w.mnuFileLoadSettings->trigger();
    EXPECT_EQ(settings.lblConfig->text(), "menu.lum was succesfully loaded");
    EXPECT_EQ(settings.comboGT->currentIndex(), 7);

    ASSERT_EQ(app.fake.dialogs.fileRequests.size(), 2u);
    EXPECT_TRUE(app.fake.dialogs.fileRequests[0].save);
    EXPECT_FALSE(app.fake.dialogs.fileRequests[1].save);
}

// The settings window is built on first use, with the options Default.lum held at start-up
// even when the file has changed since; a session that never opened it leaves its stored
// place alone.
TEST(DefaultLumAtStart, TheSettingsWindowIsBuiltOnFirstUseWithTheStartOptions) {
    const auto settingsWindows = [] {
        int count = 0;
        for (const QWidget* window : QApplication::topLevelWidgets())
            count += window->objectName() == "frmSettings";
        return count;
    };
    {
        AppFixture app;
        app.storePaths();
        app.fake.writeFile("program/Default.lum", sampleRecord().encode());
        app.fake.store.SaveSetting("Settings", "BackColor", "255");
        frmMain& w = app.load();
        EXPECT_EQ(settingsWindows(), 0);
        app.fake.writeFile("program/Default.lum", ConfigRecord().encode());

        frmSettings& settings = w.settingsWindow();
        EXPECT_EQ(settingsWindows(), 1);
        EXPECT_EQ(settings.comboGT->currentIndex(), 5);
        EXPECT_TRUE(settings.optCPPAL->isChecked());
        EXPECT_TRUE(settings.lblDOSOutput->text().contains("-g5"));
        EXPECT_TRUE(settings.lblDOSOutput->text().contains("-p4"));
        EXPECT_EQ(settings.lblConfig->text(), "Default.lum was succesfully loaded");
        EXPECT_EQ(settings.BarColorPhos->BarColor(), 255u); // the list's colours, as at start
    }
    AppFixture app;
    app.storePaths();
    app.load().close();
    EXPECT_EQ(app.fake.store.GetSetting("setpos", "top"), "");
    EXPECT_EQ(settingsWindows(), 0);
}
