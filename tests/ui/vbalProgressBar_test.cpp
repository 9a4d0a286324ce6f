#include "ui/vbalProgressBar.h"

#include <QTest>

#include <gtest/gtest.h>

static QImage render(vbalProgressBar& bar) {
    return bar.grab().toImage().convertToFormat(QImage::Format_RGB32);
}

// A bar of the usual inset border, blue on a colour no border uses.
static void plain(vbalProgressBar& bar, int w, int h, int value = 0, int min = 0, int max = 100) {
    bar.resize(w, h);
    bar.setBackColor(0x40A060); // OLE 0x00BBGGRR
    bar.setBarColor(0xFF0000);
    bar.setMin(min);
    bar.setMax(max);
    bar.setValue(value);
}

// A bar that counts its paints and keeps what the last one showed.
struct CountedBar : vbalProgressBar {
    int paints = 0, value = -1;
    QString text;
    void paintEvent(QPaintEvent* event) override {
        ++paints, value = Value(), text = Text();
        vbalProgressBar::paintEvent(event);
    }
    // The paints since the last call, once a frame passes without one (painting may be late).
    int settle() {
        int total = std::exchange(paints, 0);
        for (QTest::qWait(20); paints != 0; QTest::qWait(20))
            total += std::exchange(paints, 0);
        return total;
    }
};

// Value, Percent, then the bar's middle line from where it grows (its left end, or the
// bottom when it stands) as runs: "B8 W2 X1" for bar, background, other (the frame).
TEST(ProgressBar, ExtentPercentAndOrientation) {
    const std::tuple<int, int, int, int, int, std::string> cases[] = {
        {102, 20, 0, 100, 55, "55 55% X1 B55 W45 X1"},
        {43, 20, 0, 100, 50, "50 50% X1 B20 W21 X1"}, // 20.5 rounds to even
        {42, 42, 0, 100, 50, "50 50% X1 B20 W20 X1"}, // square: standing
        {60, 10, 0, 100, -10, "-10 0% X1 W58 X1"},    // stored as set, drawn held
        {60, 10, 10, 20, 25, "25 100% X1 B58 X1"},
        {60, 10, 7, 7, 7, "7 0% X1 W58 X1"},                  // an empty range: an empty bar
        {60, 10, INT_MIN, INT_MAX, 0, "0 50% X1 B29 W29 X1"}, // the widest range, no overflow
    };
    for (const auto& [w, h, min, max, value, expected] : cases) {
        vbalProgressBar bar;
        plain(bar, w, h, value, min, max);
        const QImage img = render(bar);
        const auto kind = [&](int i) {
            const QRgb px = w > h ? img.pixel(i, h / 2) : img.pixel(w / 2, h - 1 - i);
            return px == qRgb(0, 0, 255) ? 'B' : px == qRgb(0x60, 0xA0, 0x40) ? 'W' : 'X';
        };
        std::ostringstream out;
        out << bar.Value() << ' ' << bar.Percent() << '%';
        for (int i = 0, run = 1, end = std::max(w, h); i < end; ++i, ++run)
            if (i + 1 == end || kind(i + 1) != kind(i))
                out << ' ' << kind(i) << std::exchange(run, 0);
        EXPECT_EQ(out.str(), expected);
    }
}

TEST(ProgressBar, TextChangesColourWhereTheBarEnds) {
    vbalProgressBar bar;
    plain(bar, 240, 40, 50);
    bar.setBackColor(0xFFFFFF);
    bar.setFont(QFont(QStringLiteral("DejaVu Sans"), 22, QFont::Bold));
    bar.setForeColor(0x0000FF);    // red
    bar.setBarForeColor(0x00FF00); // green
    bar.setShowText(true);
    bar.setText(QStringLiteral("MMMMMMMMMM"));
    const QImage img = render(bar);
    int green = 0, red = 0;
    for (int y = 1; y < 39; ++y) // within the frame
        for (int x = 1; x < 239; ++x) {
            const QRgb px = img.pixel(x, y);
            // Over the bar: blue and green, never red; over the background: white and red.
            ASSERT_EQ(qRed(px), x < 120 ? 0 : 255) << x << "," << y;
            (x < 120 ? green : red) += (qGreen(px) > 128) == (x < 120);
        }
    EXPECT_GT(std::min(green, red), 50);
}

// Both pictures are tiled from the corner (0, 0), so they join without a seam; the bar's
// covers all of the bar.
TEST(ProgressBar, PicturesTileFromTheCorner) {
    const QRgb colours[4] = {qRgb(255, 0, 0), qRgb(0, 255, 0), qRgb(0, 0, 0), qRgb(9, 9, 9)};
    const QImage checks(reinterpret_cast<const uchar*>(colours), 2, 2, QImage::Format_RGB32);
    vbalProgressBar bar;
    plain(bar, 42, 10, 50); // the bar covers x 1 to 20
    bar.setPicture(checks);
    bar.setBarPicture(checks.mirrored(true, false));
    const QImage img = render(bar);
    for (int y = 1; y < 9; ++y)
        for (int x = 1; x < 41; ++x)
            ASSERT_EQ(img.pixel(x, y), colours[y % 2 * 2 + (x + (x <= 20)) % 2]) << x << "," << y;
}

TEST(ProgressBar, RepaintsAtOnceButOnlyWhenThePictureChanges) {
    CountedBar bar;
    plain(bar, 202, 20, 0, 0, 1000); // 200 pixels for Values 0..1000: one pixel per 5
    bar.show();
    const std::pair<std::function<void()>, int> steps[] = {
        {[&] { bar.setValue(2); }, 0},    // 0.4 pixels rounds to none
        {[&] { bar.setValue(3); }, 1},    // 0.6 rounds to one
        {[&] { bar.setValue(-5); }, 1},   // held at the empty end
        {[&] { bar.setValue(500); }, 1},  // 100 pixels
        {[&] { bar.setMax(1001); }, 0},   // 99.9
        {[&] { bar.setMax(2000); }, 1},   // 50
        {[&] { bar.setMin(-2); }, 0},     // 50.15
        {[&] { bar.setMin(-400); }, 1},   // 75
        {[&] { bar.setText("50%"); }, 0}, // not shown
        {[&] { bar.setShowText(true); }, 1},
        {[&] { bar.setText("51%"); }, 1},
        {[&] { bar.setText("51%"); }, 0},
        {[&] { bar.setBarColor(0xFF0000); }, 0},
        {[&] { bar.setBarColor(0x00FF00); }, 1},
    };
    bar.settle();
    for (size_t i = 0; i < std::size(steps); ++i) {
        steps[i].first();
        EXPECT_EQ(bar.paints, steps[i].second) << i; // at once, without the event loop
        EXPECT_TRUE(bar.paints == 0 || bar.value == bar.Value()) << i; // the new Value drawn
        EXPECT_EQ(bar.settle(), steps[i].second) << i;
    }

    // A long operation that never returns to the event loop: the bar shows its progress,
    // but no more than a frame every 16 ms, and its final picture once the loop runs again.
    bar.setMax(100000);
    bar.settle();
    QElapsedTimer clock;
    clock.start();
    for (int i = 1; i <= 100000; ++i)
        bar.setText(QString::number(i / 1000) + u'%'), bar.setValue(i);
    const int paints = std::exchange(bar.paints, 0);
    EXPECT_TRUE(paints >= 1 && paints <= clock.elapsed() / 16 + 1) << paints;
    EXPECT_LE(bar.settle(), 1); // the last change, if it was queued
    // The last paint may show an earlier Value that draws the same bar.
    EXPECT_EQ(bar.text, "100%");
    const QImage final = render(bar);
    bar.setValue(bar.value);
    EXPECT_EQ(render(bar), final) << "drawn at " << bar.value;
}

// Presses clamp to the bar and raise Change each time; a drag raises it only when the value
// moves; the right button only raises RightClick; keys without a character raise nothing.
TEST(ProgressBar, InteractiveMouseAndKeys) {
    vbalProgressBar bar;
    plain(bar, 102, 16, 12, 10, 20); // the bar runs from x 1 to x 100
    std::string seen;
    const auto note = [&](const std::string& what) {
        seen += what + " " + std::to_string(bar.Value()) + ", ";
    };
    QObject::connect(&bar, &vbalProgressBar::Change, [&] { note("change"); });
    QObject::connect(&bar, &vbalProgressBar::RightClick, [&] { note("right"); });
    QObject::connect(&bar, &vbalProgressBar::DblClick, [&] { note("double"); });
    QObject::connect(&bar, &vbalProgressBar::KeyPress, [&](int key) { note({char(key)}); });
    QTest::mouseClick(&bar, Qt::LeftButton, {}, QPoint(100, 8)); // not interactive: nothing
    bar.setInteractive(true);
    for (const int x : {101, 500, 1, 51})
        QTest::mouseClick(&bar, Qt::LeftButton, {}, QPoint(x, 8));
    QTest::mousePress(&bar, Qt::LeftButton, {}, QPoint(52, 8));
    QTest::mouseMove(&bar, QPoint(53, 8));
    QTest::mouseMove(&bar, QPoint(60, 8));
    QTest::mouseRelease(&bar, Qt::LeftButton, {}, QPoint(60, 8));
    QTest::mousePress(&bar, Qt::RightButton, {}, QPoint(90, 8));
    QTest::mouseMove(&bar, QPoint(70, 8));
    QTest::mouseRelease(&bar, Qt::RightButton, {}, QPoint(70, 8));
    QTest::mouseDClick(&bar, Qt::LeftButton, {}, QPoint(10, 8));
    for (const Qt::Key key : {Qt::Key_Plus, Qt::Key_Minus, Qt::Key_A, Qt::Key_Shift})
        QTest::keyClick(&bar, key);
    EXPECT_EQ(seen, "change 20, change 20, change 10, change 15, change 15, change 16, right 16, "
                    "double 16, + 16, - 16, a 16, ");
}
