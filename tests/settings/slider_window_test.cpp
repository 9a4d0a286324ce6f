#include "support/FakePlatform.h"
#include "support/QtPrinters.h"

#include "settings/frmSettings.h"
#include "ui/vbalProgressBar.h"

#include <QAction>
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

// A bar's window, value and text, as one comparable line: "4500..4700 at 4608 '4,608'".
std::string state(const vbalProgressBar* bar) {
    return QStringLiteral("%1..%2 at %3 '%4'")
        .arg(bar->Min())
        .arg(bar->Max())
        .arg(bar->Value())
        .arg(bar->Text())
        .toStdString();
}

class SliderBars : public ::testing::Test {
protected:
    void SetUp() override {
        // The sound queue's text follows the locale; these tests read it in English.
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates));
        w = std::make_unique<frmSettings>(fake.platform);
        w->show();
    }
    void TearDown() override {
        w.reset();
        QLocale::setDefault(m_savedLocale);
    }

    // The switch in the preview that starts with prefix ("-s"), or an empty text.
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
        for (const double at : xs)
            sendMouse(bar, QEvent::MouseMove, at, Qt::NoButton, Qt::LeftButton);
        sendMouse(bar, QEvent::MouseButtonRelease, xs.size() ? *std::rbegin(xs) : x, Qt::LeftButton,
                  {});
    }

    // What a double-click delivers: a click, then the second press as a double-click.
    static void doubleClick(vbalProgressBar* bar, double x) {
        drag(bar, x);
        sendMouse(bar, QEvent::MouseButtonDblClick, x, Qt::LeftButton, Qt::LeftButton);
        sendMouse(bar, QEvent::MouseButtonRelease, x, Qt::LeftButton, {});
    }

    void showTab(QWidget* page) { w->vbalDTabControl1->setCurrentWidget(page); }

    FakePlatform fake;
    std::unique_ptr<frmSettings> w;

private:
    QLocale m_savedLocale;
};

TEST_F(SliderBars, StartWithTheirRangesAndTexts) {
    EXPECT_EQ(state(w->BarColorPaddle), "1..15 at 8 '8'");
    EXPECT_EQ(state(w->BarColorPhos), "0..100 at 77 '77'");
    EXPECT_EQ(state(w->BarColorSoundQueue), "4500..4700 at 4608 '4,608'");
    for (const vbalProgressBar* bar : {w->BarColorPaddle, w->BarColorPhos, w->BarColorSoundQueue})
        EXPECT_TRUE(bar->ShowText() && bar->Interactive()) << qPrintable(bar->objectName());
}

TEST_F(SliderBars, SoundQueuePopupMenu) {
    QStringList items;
    for (const QAction* action : w->mnuSQPopup->actions())
        items << (action->isSeparator() ? "-" : action->objectName() + ": " + action->text());
    EXPECT_EQ(items, QStringList({"mnuSQShiftUp: Shift Scale Up                      (+)",
                                  "mnuSQShiftDown: Shift Scale Down                  (-)", "-",
                                  "mnuSQReset: Reset to Default Value (Double Click)"}));
    EXPECT_EQ(w->mnuSQPopup->actions()[2], w->mnuSQBar);

    // The right button pops the menu up and leaves the value; the menu's items act on the bar.
    showTab(w->picPaddlesAudio);
    vbalProgressBar* bar = w->BarColorSoundQueue;
    QSignalSpy changes(bar, &vbalProgressBar::Change);
    sendMouse(bar, QEvent::MouseButtonPress, bar->width() - 2.0, Qt::RightButton, Qt::RightButton);
    EXPECT_TRUE(w->mnuSQPopup->isVisible());
    w->mnuSQPopup->hide();
    sendMouse(bar, QEvent::MouseButtonRelease, bar->width() - 2.0, Qt::RightButton, {});
    EXPECT_EQ(state(bar), "4500..4700 at 4608 '4,608'");
    EXPECT_EQ(changes.count(), 0);

    w->mnuSQShiftUp->trigger();
    w->mnuSQShiftDown->trigger();
    w->mnuSQShiftDown->trigger();
    EXPECT_EQ(state(bar), "4400..4600 at 4595 '4,595'");
    w->mnuSQReset->trigger();
    EXPECT_EQ(state(bar), "4500..4700 at 4608 '4,608'");
}

TEST_F(SliderBars, SoundQueueKeysShiftTheScaleAndDoubleClickResets) {
    showTab(w->picPaddlesAudio);
    vbalProgressBar* bar = w->BarColorSoundQueue;
    QTest::keyClick(bar, '+');
    EXPECT_EQ(state(bar), "4600..4800 at 4608 '4,608'");
    EXPECT_EQ(previewSwitch("-s"), "");
    QTest::keyClick(bar, '+');
    EXPECT_EQ(state(bar), "4700..4900 at 4705 '4,705'");
    EXPECT_EQ(previewSwitch("-s"), "-s4705");

    // Another key shifts nothing but still refreshes the preview.
    w->lblDOSOutput->clear();
    QTest::keyClick(bar, 'a');
    EXPECT_EQ(state(bar), "4700..4900 at 4705 '4,705'");
    EXPECT_EQ(previewSwitch("-s"), "-s4705");

    for (int i = 0; i < 700; ++i)
        QTest::keyClick(bar, '+');
    EXPECT_EQ(state(bar), "65339..65536 at 65344 '65,344'");
    EXPECT_EQ(previewSwitch("-s"), "-s65344"); // the switch has no separator

    doubleClick(bar, 3.0);
    EXPECT_EQ(state(bar), "4500..4700 at 4608 '4,608'");
    EXPECT_EQ(previewSwitch("-s"), "");
}

TEST_F(SliderBars, DraggingClampsAndUpdatesTextAndPreview) {
    const struct {
        vbalProgressBar* bar;
        QWidget* page;
        const char* prefix;
        const char* atMax;
        const char* atMin;
    } cases[] = {
        {w->BarColorPaddle, w->picControls, "-p", "1..15 at 15 '15'", "1..15 at 1 '1'"},
        {w->BarColorPhos, w->picVideo, "-f", "0..100 at 100 '100'", "0..100 at 0 '0'"},
        {w->BarColorSoundQueue, w->picPaddlesAudio, "-s", "4500..4700 at 4700 '4,700'",
         "4500..4700 at 4500 '4,500'"},
    };
    for (const auto& c : cases) {
        showTab(c.page);
        vbalProgressBar* bar = c.bar;
        ASSERT_GT(bar->width(), bar->height()) << c.prefix; // a horizontal bar
        QSignalSpy changes(bar, &vbalProgressBar::Change);
        drag(bar, bar->width() + 50.0);
        EXPECT_EQ(state(bar), c.atMax);
        EXPECT_EQ(previewSwitch(c.prefix), c.prefix + QString::number(bar->Max()));
        EXPECT_EQ(changes.count(), 1) << c.prefix;

        drag(bar, bar->width() / 2.0, {-40.0, -80.0});
        EXPECT_EQ(state(bar), c.atMin);
        EXPECT_EQ(previewSwitch(c.prefix), c.prefix + QString::number(bar->Min()));
        EXPECT_EQ(changes.count(), 3) << c.prefix; // the press, and the one step that moved it

        // The middle of the bar gives a value halfway, within a step of rounding.
        drag(bar, (bar->width() - 1) / 2.0);
        EXPECT_NEAR(bar->Value(), (bar->Min() + bar->Max()) / 2.0, 1.0) << c.prefix;
    }

    // The phosphor bar resets on a double-click, which drops its switch.
    doubleClick(w->BarColorPhos, 1.0);
    EXPECT_EQ(state(w->BarColorPhos), "0..100 at 77 '77'");
    EXPECT_EQ(previewSwitch("-f"), "");
}

} // namespace
