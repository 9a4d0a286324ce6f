#include "support/FakePlatform.h"

#include "settings/SliderRules.h"
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

#include <climits>
#include <limits>
#include <memory>

using sliders::Scale;

namespace sliders {
void PrintTo(const Scale& s, std::ostream* os) {
    *os << s.min << ".." << s.max << " at " << s.value;
}
} // namespace sliders

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

// (The shifts from the default window: see the bar's own tests above.)
TEST(SliderRules, SoundQueueShiftSequences) {
    const Scale start = sliders::SoundQueueDefault();
    EXPECT_EQ(start, (Scale{4500, 4700, 4608}));
    const struct {
        const char* what;
        Scale start;
        std::string keys;
        Scale expected;
    } cases[] = {
        {"down then up keeps a value inside", start, "-+", {4500, 4700, 4595}},
        {"the bottom window is 1..201", start, std::string(700, '-'), {1, 201, 196}},
        {"up at the top keeps the value", {65339, 65536, 65400}, "+", {65339, 65536, 65400}},
        {"partial step up to the top", {65300, 65500, 65310}, "+", {65339, 65536, 65344}},
        {"any key brings a high value in", {65339, 65536, 70000}, "x", {65339, 65536, 65536}},
        {"any key brings a low value in", {1, 201, -3}, "x", {1, 201, 1}},
        {"any key mends a window below", {-100, 100, 0}, "x", {1, 201, 1}},
        {"no overflow up", {INT_MAX - 200, INT_MAX, INT_MAX}, "+", {65339, 65536, 65536}},
        {"no overflow down", {INT_MIN, INT_MIN + 200, INT_MIN}, "-", {1, 201, 1}},
    };
    for (const auto& c : cases) {
        Scale scale = c.start;
        for (const char key : c.keys)
            scale = sliders::ShiftSoundQueue(scale, key);
        EXPECT_EQ(scale, c.expected) << c.what;
    }

    // Wander up and down across both ends: every shift leaves a window of the scale with
    // the value inside it.
    Scale scale = start;
    for (const char key :
         std::string(40, '-') + std::string(700, '+') + "+-+-" + std::string(650, '-')) {
        scale = sliders::ShiftSoundQueue(scale, key);
        ASSERT_TRUE(1 <= scale.min && scale.min <= scale.value && scale.value <= scale.max &&
                    scale.max <= 65536)
            << scale.min << ".." << scale.max << " at " << scale.value;
    }
}

TEST(SliderRules, BarTexts) {
    const std::tuple<qint64, const char16_t*, const char16_t*> grouped[] = {
        {999, u",", u"999"},
        {1000, u",", u"1,000"},
        {-4608, u",", u"-4,608"},
        {std::numeric_limits<qint64>::min(), u",", u"-9,223,372,036,854,775,808"},
        {1234567, u"\u202F", u"1\u202F234\u202F567"},
        {4608, u"", u"4608"},
    };
    for (const auto& [value, separator, expected] : grouped)
        EXPECT_EQ(sliders::FormatThousands(value, QString::fromUtf16(separator)),
                  QString::fromUtf16(expected))
            << value;
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::English, QLocale::UnitedStates)),
              "4,608");
    EXPECT_EQ(sliders::SoundQueueText(65536, QLocale(QLocale::German, QLocale::Germany)), "65.536");
    // Always grouped, even where the locale would leave a four-digit number alone.
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::Spanish, QLocale::Spain)), "4.608");
    EXPECT_EQ(sliders::PlainText(4608), "4608");
}

} // namespace
