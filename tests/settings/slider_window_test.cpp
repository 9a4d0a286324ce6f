#include "support/FakePlatform.h"

#include "settings/frmSettings.h"
#include "ui/vbalProgressBar.h"

#include <QAction>
#include <QGroupBox>
#include <QLabel>
#include <QLocale>
#include <QMenu>
#include <QMouseEvent>
#include <QSignalSpy>
#include <QTabWidget>
#include <QTest>

#include <gtest/gtest.h>

#include <memory>

namespace {

struct Range {
    int min;
    int max;
    int value;
    bool operator==(const Range&) const = default;
};

void PrintTo(const Range& r, std::ostream* os) {
    *os << r.min << ".." << r.max << " at " << r.value;
}

Range rangeOf(const vbalProgressBar* bar) {
    return {bar->Min(), bar->Max(), bar->Value()};
}

class SliderBars : public ::testing::Test {
protected:
    void SetUp() override {
        // The sound queue's text follows the locale; these tests read it in English.
        m_savedLocale = QLocale();
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates));
        w = std::make_unique<frmSettings>(fake.platform);
        w->show();
    }
    void TearDown() override {
        w.reset();
        QLocale::setDefault(m_savedLocale);
    }

    // The switch in the preview of the command line that starts with prefix ("-s"), or an
    // empty text.
    QString previewSwitch(const QString& prefix) const {
        for (const QString& part : w->lblDOSOutput->text().split(u' ', Qt::SkipEmptyParts))
            if (part.startsWith(prefix))
                return part;
        return {};
    }

    static void sendMouse(vbalProgressBar* bar, QEvent::Type type, double x, Qt::MouseButton button,
                          Qt::MouseButtons buttons) {
        const QPointF local(x, bar->height() / 2.0);
        QMouseEvent event(type, local, bar->mapToGlobal(local), button, buttons, {});
        QCoreApplication::sendEvent(bar, &event);
    }

    // A left-button press at x, then a drag over each of xs, then the release.
    static void drag(vbalProgressBar* bar, double x, std::initializer_list<double> xs = {}) {
        sendMouse(bar, QEvent::MouseButtonPress, x, Qt::LeftButton, Qt::LeftButton);
        double last = x;
        for (const double at : xs) {
            sendMouse(bar, QEvent::MouseMove, at, Qt::NoButton, Qt::LeftButton);
            last = at;
        }
        sendMouse(bar, QEvent::MouseButtonRelease, last, Qt::LeftButton, {});
    }

    // What a double-click with the left button at x delivers: a click, then the second
    // press as a double-click.
    static void doubleClick(vbalProgressBar* bar, double x) {
        drag(bar, x);
        sendMouse(bar, QEvent::MouseButtonDblClick, x, Qt::LeftButton, Qt::LeftButton);
        sendMouse(bar, QEvent::MouseButtonRelease, x, Qt::LeftButton, {});
    }

    void showTab(const char* page) {
        w->vbalDTabControl1->setCurrentWidget(w->findChild<QWidget*>(QLatin1String(page)));
    }

    FakePlatform fake;
    std::unique_ptr<frmSettings> w;

private:
    QLocale m_savedLocale;
};

TEST_F(SliderBars, StartOnTheirPagesWithRangesAndTexts) {
    struct Case {
        vbalProgressBar* bar;
        const char* name;
        QGroupBox* frame;
        QWidget* page;
        Range range;
        const char* text;
    };
    const Case cases[] = {
        {w->BarColorPaddle, "BarColorPaddle", w->fraPaddleSens, w->picControls, {1, 15, 8}, "8"},
        {w->BarColorPhos, "BarColorPhos", w->fraPhos, w->picVideo, {0, 100, 77}, "77"},
        {w->BarColorSoundQueue,
         "BarColorSoundQueue",
         w->fraSoundQueue,
         w->picPaddlesAudio,
         {4500, 4700, 4608},
         "4,608"},
    };
    for (const Case& c : cases) {
        ASSERT_NE(c.bar, nullptr) << c.name;
        EXPECT_EQ(c.bar->objectName(), c.name);
        EXPECT_EQ(w->findChild<vbalProgressBar*>(QLatin1String(c.name)), c.bar);
        EXPECT_TRUE(c.frame->isAncestorOf(c.bar)) << c.name;
        EXPECT_TRUE(c.page->isAncestorOf(c.bar)) << c.name;
        EXPECT_EQ(rangeOf(c.bar), c.range) << c.name;
        EXPECT_EQ(c.bar->Text(), c.text);
        EXPECT_TRUE(c.bar->ShowText()) << c.name;
        EXPECT_TRUE(c.bar->Interactive()) << c.name;
    }
    EXPECT_EQ(w->BarColorSoundQueue->toolTip(), "Double click to reset value to the default");
}

TEST_F(SliderBars, SoundQueuePopupMenu) {
    ASSERT_NE(w->mnuSQPopup, nullptr);
    const QList<QAction*> actions = w->mnuSQPopup->actions();
    ASSERT_EQ(actions.size(), 4);
    EXPECT_EQ(actions[0], w->mnuSQShiftUp);
    EXPECT_EQ(actions[1], w->mnuSQShiftDown);
    EXPECT_EQ(actions[2], w->mnuSQBar);
    EXPECT_EQ(actions[3], w->mnuSQReset);
    EXPECT_EQ(w->mnuSQShiftUp->text(), "Shift Scale Up                      (+)");
    EXPECT_EQ(w->mnuSQShiftDown->text(), "Shift Scale Down                  (-)");
    EXPECT_TRUE(w->mnuSQBar->isSeparator());
    EXPECT_EQ(w->mnuSQReset->text(), "Reset to Default Value (Double Click)");
    for (QAction* action : actions)
        EXPECT_FALSE(action->objectName().isEmpty());

    // The right button pops the menu up and leaves the value; the menu's items act on the bar.
    showTab("picPaddlesAudio");
    vbalProgressBar* bar = w->BarColorSoundQueue;
    QSignalSpy changes(bar, &vbalProgressBar::Change);
    sendMouse(bar, QEvent::MouseButtonPress, bar->width() - 2.0, Qt::RightButton, Qt::RightButton);
    EXPECT_TRUE(w->mnuSQPopup->isVisible());
    w->mnuSQPopup->hide();
    sendMouse(bar, QEvent::MouseButtonRelease, bar->width() - 2.0, Qt::RightButton, {});
    EXPECT_EQ(rangeOf(bar), (Range{4500, 4700, 4608}));
    EXPECT_EQ(changes.count(), 0);

    w->mnuSQShiftUp->trigger();
    w->mnuSQShiftDown->trigger();
    w->mnuSQShiftDown->trigger();
    EXPECT_EQ(rangeOf(bar), (Range{4400, 4600, 4595}));
    EXPECT_EQ(bar->Text(), "4,595");
    w->mnuSQReset->trigger();
    EXPECT_EQ(rangeOf(bar), (Range{4500, 4700, 4608}));
    EXPECT_EQ(bar->Text(), "4,608");
}

TEST_F(SliderBars, SoundQueueKeysShiftTheScaleAndDoubleClickResets) {
    showTab("picPaddlesAudio");
    vbalProgressBar* bar = w->BarColorSoundQueue;
    QTest::keyClick(bar, '+');
    EXPECT_EQ(rangeOf(bar), (Range{4600, 4800, 4608}));
    EXPECT_EQ(bar->Text(), "4,608");
    EXPECT_EQ(previewSwitch("-s"), "");
    QTest::keyClick(bar, '+');
    EXPECT_EQ(rangeOf(bar), (Range{4700, 4900, 4705}));
    EXPECT_EQ(bar->Text(), "4,705");
    EXPECT_EQ(previewSwitch("-s"), "-s4705");

    // Another key shifts nothing but still refreshes the preview.
    w->lblDOSOutput->clear();
    QTest::keyClick(bar, 'a');
    EXPECT_EQ(rangeOf(bar), (Range{4700, 4900, 4705}));
    EXPECT_EQ(previewSwitch("-s"), "-s4705");

    for (int i = 0; i < 700; ++i)
        QTest::keyClick(bar, '+');
    EXPECT_EQ(rangeOf(bar), (Range{65339, 65536, 65344}));
    EXPECT_EQ(bar->Text(), "65,344");
    EXPECT_EQ(previewSwitch("-s"), "-s65344"); // the switch has no separator

    doubleClick(bar, 3.0);
    EXPECT_EQ(rangeOf(bar), (Range{4500, 4700, 4608}));
    EXPECT_EQ(bar->Text(), "4,608");
    EXPECT_EQ(previewSwitch("-s"), "");
}

TEST_F(SliderBars, DraggingClampsAndUpdatesTextAndPreview) {
    struct Case {
        vbalProgressBar* bar;
        const char* page;
        const char* prefix;
        QString atMax;
        QString atMin;
        const char* switchAtMax;
        const char* switchAtMin;
    };
    const Case cases[] = {
        {w->BarColorPaddle, "picControls", "-p", "15", "1", "-p15", "-p1"},
        {w->BarColorPhos, "picVideo", "-f", "100", "0", "-f100", "-f0"},
        {w->BarColorSoundQueue, "picPaddlesAudio", "-s", "4,700", "4,500", "-s4700", "-s4500"},
    };
    for (const Case& c : cases) {
        showTab(c.page);
        vbalProgressBar* bar = c.bar;
        ASSERT_GT(bar->width(), bar->height()) << c.page; // a horizontal bar
        QSignalSpy changes(bar, &vbalProgressBar::Change);

        drag(bar, bar->width() + 50.0);
        EXPECT_EQ(bar->Value(), bar->Max()) << c.page;
        EXPECT_EQ(bar->Text(), c.atMax);
        EXPECT_EQ(previewSwitch(c.prefix), c.switchAtMax);
        EXPECT_EQ(changes.count(), 1) << c.page;

        changes.clear();
        drag(bar, bar->width() / 2.0, {-40.0, -80.0});
        EXPECT_EQ(bar->Value(), bar->Min()) << c.page;
        EXPECT_EQ(bar->Text(), c.atMin);
        EXPECT_EQ(previewSwitch(c.prefix), c.switchAtMin);
        EXPECT_EQ(changes.count(), 2) << c.page; // the press, and the one step that moved it

        // The middle of the bar gives a value halfway, within a step of rounding.
        drag(bar, (bar->width() - 1) / 2.0);
        EXPECT_NEAR(bar->Value(), (bar->Min() + bar->Max()) / 2.0, 1.0) << c.page;
    }

    // The phosphor bar resets on a double-click, which drops its switch.
    doubleClick(w->BarColorPhos, 1.0);
    EXPECT_EQ(w->BarColorPhos->Value(), 77);
    EXPECT_EQ(w->BarColorPhos->Text(), "77");
    EXPECT_EQ(previewSwitch("-f"), "");
}

} // namespace
