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

const QString kCorruptBox =
    ".lum file is corrupt\r\nPlease verify settings and re-save to correct this problem";

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

int corruptBoxes(const AppFixture& app) {
    int count = 0;
    for (const FakeDialogs::Box& box : app.fake.dialogs.boxes)
        count += box.text == kCorruptBox;
    return count;
}

// Both paths known, so that the start-up goes straight to the list.
void storePaths(AppFixture& app) {
    app.fake.store.SaveSetting("Settings", "Z26Path", app.fake.root());
    app.storeFolder(1, app.romFolder("roms", {"a.bin"}));
}

} // namespace

TEST(DefaultLumAtStart, CaptionSaysHowTheLoadWent) {
    QByteArray corrupt = sampleRecord().encode();
    corrupt[14] = 3; // a check box state that does not exist
    const struct {
        const char* name;
        std::optional<QByteArray> file;
        const char* caption;
        const char* toolTip;
        int boxes;
    } cases[] = {
        {"absent", std::nullopt, "Default.lum couldn't be loaded",
         "Default.lum need's to be in the same folder as lum.exe", 0},
        {"valid", sampleRecord().encode(), "Default.lum was succesfully loaded", "", 0},
        {"corrupt", corrupt,
         "Default.lum is corrupt.  Please verify settings and re-save to correct the problem.", "",
         1},
        {"short", sampleRecord().encode().left(100),
         "Default.lum is corrupt.  Please verify settings and re-save to correct the problem.", "",
         1},
    };
    for (const auto& c : cases) {
        AppFixture app;
        storePaths(app);
        if (c.file)
            app.fake.writeFile("program/Default.lum", *c.file);
        frmMain& w = app.load();
        frmSettings& settings = w.settingsWindow();
        EXPECT_EQ(settings.lblConfig->text(), c.caption) << c.name;
        EXPECT_EQ(settings.lblConfig->toolTip(), c.toolTip) << c.name;
        EXPECT_EQ(corruptBoxes(app), c.boxes) << c.name;
        // A good file loads without showing the window; a corrupt one shows its first tab.
        EXPECT_EQ(settings.isVisible(), c.boxes != 0) << c.name;
        if (c.boxes != 0) {
            EXPECT_EQ(settings.SelectedTabKey(), "Settings") << c.name;
        }
    }
}

TEST(DefaultLumAtStart, SetsTheStartOptions) {
    AppFixture app;
    app.fake.writeFile("program/Default.lum", sampleRecord().encode());
    frmSettings& settings = app.load().settingsWindow();
    EXPECT_EQ(settings.comboGT->currentIndex(), 5);
    EXPECT_TRUE(settings.optCPPAL->isChecked());
    EXPECT_TRUE(settings.lblDOSOutput->text().contains("-g5"));
    EXPECT_TRUE(settings.lblDOSOutput->text().contains("-p4"));
}

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
        storePaths(app);
        app.fake.writeFile("program/Default.lum", sampleRecord().encode());
        app.fake.store.SaveSetting("Settings", "BackColor", "255");
        frmMain& w = app.load();
        EXPECT_EQ(settingsWindows(), 0);
        app.fake.writeFile("program/Default.lum", ConfigRecord().encode());

        frmSettings& settings = w.settingsWindow();
        EXPECT_EQ(settingsWindows(), 1);
        EXPECT_EQ(settings.comboGT->currentIndex(), 5);
        EXPECT_EQ(settings.lblConfig->text(), "Default.lum was succesfully loaded");
        EXPECT_EQ(settings.BarColorPhos->BarColor(), 255u); // the list's colours, as at start
    }
    AppFixture app;
    storePaths(app);
    app.load().close();
    EXPECT_EQ(app.fake.store.GetSetting("setpos", "top"), "");
    EXPECT_EQ(settingsWindows(), 0);
}
