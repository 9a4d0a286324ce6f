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

// The window is the side strip, which names the page shown, and the tab control beside it.
// Closing it hides it; Unload saves its place.
TEST_F(SettingsWindow, PagesAreChosenByKeyClosingHidesAndUnloadSavesThePlace) {
    fake.store.SaveSetting("setpos", "top", "1500");
    storeFolder(1, romFolder("a"), true);
    storeFolder(3, romFolder("c"), true); // behind a gap
    auto w = open();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    const int draws = w->Logo().drawCount();
    for (const auto& [key, caption] :
         {std::pair{"PaddlesAudio", "Paddles / Audio"}, {"Debug", "Debugging"}}) {
        w->selectPage(key);
        EXPECT_EQ(w->selectedPage() + ' ' + w->Logo().Caption(), QString(key) + ' ' + caption);
    }
    EXPECT_GT(w->Logo().drawCount(), draws);
    w->selectPage("Nowhere");
    EXPECT_EQ(w->selectedPage(), "Debug");

    const auto* tabs = control<QTabWidget>(*w, "vbalDTabControl1");
    const QRect tab = tabs->geometry();
    const QWidget* strip = control<PictureBox>(*w, "picSideText");
    // No band around the tab control: Qt's size has no title bar or borders in it.
    EXPECT_EQ(QRect(tab.topLeft(), w->size()),
              QRect(strip->width(), 0, strip->width() + tab.width(), tab.height()));
    EXPECT_TRUE(tab.width() >= twips::toPixelsX(6495) && tab.height() >= twips::toPixelsY(4095));
    EXPECT_EQ(strip->height(), w->height());
    // Every tab shows without scrolling the tab bar.
    EXPECT_LE(tabs->tabBar()->sizeHint().width(), tab.width());
    // The hidden balloon anchor lies over the control its tip is about.
    EXPECT_EQ(control<QLineEdit>(*w, "txtVidModeBalloon")->geometry(),
              control<QComboBox>(*w, "comboVideoMode")->geometry());

    control<QCheckBox>(*w, "chkBW")->click();
    w->move(twips::toPixelsX(2400), twips::toPixelsY(1200));
    EXPECT_FALSE(w->close());
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(stored("top", "setpos"), "1500");
    w->show();
    QTest::keyClick(control<QCheckBox>(*w, "chkBW"), Qt::Key_Escape); // as the close box
    EXPECT_TRUE(w->isHidden());
    w->show();
    EXPECT_EQ(w->options().blackAndWhite, Check::On);

    // Unload saves the place and the folder list, whose save ends it after the first.
    w->Unload();
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(stored("ROM2Path"), "");
    EXPECT_EQ(open()->pos(), QPoint(twips::toPixelsX(2400), twips::toPixelsY(1200)));

    // A place off every screen opens on one, and stays stored until the user moves it.
    fake.store.SaveSetting("setpos", "left", "-90000");
    auto off = open();
    EXPECT_TRUE(off->screen()->availableGeometry().contains(QRect(off->pos(), off->size())));
    off->Unload();
    EXPECT_EQ(stored("left", "setpos"), "-90000");
}
