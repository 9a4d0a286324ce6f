#include "SettingsFixture.h"

#include "ui/PictureBox.h"
#include "ui/Twips.h"

namespace {

using SettingsWindow = SettingsFixture;

} // namespace

// Every caption, tool tip, list entry and start state of every page.
TEST_F(SettingsWindow, StartsAsTheGoldenDumpShows) {
    fake.store.SaveSetting("Settings", "Z26Path", "/opt/emulators/z26");
    auto w = open();
    expectGolden("frmSettings", dumpWidgetTree(*w));
}

TEST_F(SettingsWindow, PagesAreChosenByKeyAndNamedInTheSideStrip) {
    auto w = open();
    auto* tabs = control<QTabWidget>(*w, "vbalDTabControl1");
    const int draws = w->Logo().drawCount();
    for (const auto& [key, caption] : {std::pair{"Controls", "Controls"},
                                       {"PaddlesAudio", "Paddles / Audio"},
                                       {"Debug", "Debugging"},
                                       {"DefaultPaths", "Default Paths"},
                                       {"Settings", "Settings"}}) {
        w->selectPage(key);
        EXPECT_EQ(w->selectedPage(), key);
        EXPECT_EQ(tabs->tabText(tabs->currentIndex()), caption);
        EXPECT_EQ(w->Logo().Caption(), caption);
    }
    EXPECT_GT(w->Logo().drawCount(), draws);
    w->selectPage("Nowhere");
    EXPECT_EQ(w->selectedPage(), "Settings");
}

TEST_F(SettingsWindow, SizeFollowsTheSideStripAndTheTabControl) {
    auto w = open();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    const QRect tab = control<QTabWidget>(*w, "vbalDTabControl1")->geometry();
    const QWidget* strip = control<PictureBox>(*w, "picSideText");
    EXPECT_EQ(tab.topLeft(), QPoint(strip->width(), 0));
    EXPECT_GE(tab.width(), twips::toPixelsX(6495));
    EXPECT_GE(tab.height(), twips::toPixelsY(4095));
    EXPECT_EQ(w->width(), strip->width() + tab.width() + twips::toPixelsX(100));
    EXPECT_EQ(w->height(), tab.height() + twips::toPixelsY(500));
    EXPECT_EQ(strip->height(), w->height());
    // Every tab shows without scrolling the tab bar.
    EXPECT_LE(control<QTabWidget>(*w, "vbalDTabControl1")->tabBar()->sizeHint().width(),
              tab.width());
    // The hidden balloon anchors lie over the controls their tips are about.
    EXPECT_EQ(control<QLineEdit>(*w, "txtVidModeBalloon")->geometry(),
              control<QComboBox>(*w, "comboVideoMode")->geometry());
    w->selectPage("Controls");
    EXPECT_EQ(control<QLineEdit>(*w, "txtIPC4Balloon")->geometry(),
              control<QCheckBox>(*w, "chkIPCStella")->geometry());
}

TEST_F(SettingsWindow, ClosingHidesKeepingTheOptionsAndUnloadSavesThePlace) {
    const QPoint start(twips::toPixelsX(250), twips::toPixelsY(250));
    EXPECT_EQ(frmSettings(fake.platform).pos(), start); // the first run
    fake.store.SaveSetting("setpos", "top", "1500");
    fake.store.SaveSetting("setpos", "left", "3000");
    EXPECT_EQ(frmSettings(fake.platform).pos(),
              QPoint(twips::toPixelsX(3000), twips::toPixelsY(1500)));

    storeFolder(1, romFolder("a"), true);
    storeFolder(3, romFolder("c"), true); // behind a gap
    auto w = open();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    control<QCheckBox>(*w, "chkBW")->click();
    w->move(twips::toPixelsX(2400), twips::toPixelsY(1200));
    EXPECT_FALSE(w->close());
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(stored("top", "setpos"), "1500");
    w->show();
    EXPECT_EQ(w->options().blackAndWhite, Check::On);

    // Unload saves the place and the folder list, whose save ends it after the first.
    w->Unload();
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(stored("ROM2Path"), "");
    EXPECT_EQ(open()->pos(), QPoint(twips::toPixelsX(2400), twips::toPixelsY(1200)));
}
