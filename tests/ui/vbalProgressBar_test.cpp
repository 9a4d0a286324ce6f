#include "ui/vbalProgressBar.h"

#include <QMouseEvent>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

#include <climits>
#include <functional>
#include <utility>

namespace {

const QRgb back = qRgb(0x60, 0xA0, 0x40); // a colour no border uses
const QRgb blue = qRgb(0, 0, 255);

QImage render(vbalProgressBar& bar) {
    return bar.grab().toImage().convertToFormat(QImage::Format_RGB32);
}

void plain(vbalProgressBar& bar, int w, int h, int borderStyle = 0, int value = 0) {
    bar.resize(w, h);
    bar.setBackColor(0x40A060); // OLE 0x00BBGGRR
    bar.setBarColor(0xFF0000);
    bar.setBorderStyle(borderStyle);
    bar.setValue(value);
}

// A row (or a column, read bottom up) as runs: "B8 W2 ..." for bar, background, other.
std::string runs(const QImage& img, int at, bool column) {
    const int n = column ? img.height() : img.width();
    const auto kind = [&](int i) {
        const QRgb px = column ? img.pixel(at, n - 1 - i) : img.pixel(i, at);
        return px == blue ? 'B' : px == back ? 'W' : 'X';
    };
    std::string out;
    for (int i = 0, start = 0; i < n; ++i)
        if (i + 1 == n || kind(i + 1) != kind(i)) {
            out +=
                (out.empty() ? "" : " ") + std::string(1, kind(i)) + std::to_string(i + 1 - start);
            start = i + 1;
        }
    return out;
}

// A bar that counts its paints and keeps what the last one showed.
struct CountedBar : vbalProgressBar {
    int paints = 0, value = -1;
    QString text;
    void paintEvent(QPaintEvent* event) override {
        ++paints, value = Value(), text = Text();
        vbalProgressBar::paintEvent(event);
    }
    // The paints since the last call, once a whole frame passes without one (a busy
    // machine may paint late).
    int settle() {
        int total = 0;
        do {
            total += std::exchange(paints, 0);
            QTest::qWait(20);
        } while (paints != 0);
        return total;
    }
};

} // namespace

TEST(ProgressBar, ExtentPercentSegmentsOrientationAndBorders) {
    const struct {
        int w, h, border, appearance, min, max, value;
        bool segments;
        double percent;
        std::string row, column; // through the middle; the column from the bottom
    } cases[] = {
        // Inner width 100 at 55 %: cut to 50, five 8-pixel chunks each with a 2-pixel gap.
        {102, 20, 1, 1, 0, 100, 55, true, 55, "X1 B8 W2 B8 W2 B8 W2 B8 W2 B8 W52 X1", "X1 W18 X1"},
        {102, 20, 1, 1, 0, 100, 55, false, 55, "X1 B55 W45 X1", "X1 B18 X1"},
        {41, 40, 0, 1, 0, 100, 50, false, 50, "B20 W21", "W40"}, // 20.5 rounds to even
        {40, 40, 0, 1, 0, 100, 50, false, 50, "B40", "B20 W20"}, // square: vertical
        {20, 60, 0, 1, 0, 100, 50, true, 50, "W20", "B8 W2 B8 W2 B8 W32"},
        {60, 10, 0, 1, 0, 100, -10, false, 0, "W60", "W10"},
        {60, 10, 0, 1, 10, 20, 25, false, 100, "B60", "B10"},
        {60, 10, 0, 1, 7, 7, 7, false, 0, "W60", "W10"}, // an empty range: an empty bar
        {60, 10, 0, 1, INT_MIN, INT_MAX, INT_MAX, false, 100, "B60", "B10"},
        // Border style and appearance leave a frame of 0, 1 or 2 pixels all round.
        {50, 16, 0, 2, 0, 100, 100, false, 100, "B50", "B16"},
        {50, 16, 1, 0, 0, 100, 100, false, 100, "X1 B48 X1", "X1 B14 X1"},
        {50, 16, 2, 0, 0, 100, 100, false, 100, "X1 B48 X1", "X1 B14 X1"},
        {50, 16, 2, 1, 0, 100, 100, false, 100, "X1 B48 X1", "X1 B14 X1"},
        {50, 16, 1, 2, 0, 100, 100, false, 100, "X2 B46 X2", "X2 B12 X2"},
        {50, 16, 2, 2, 0, 100, 100, false, 100, "X2 B46 X2", "X2 B12 X2"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(&c - cases);
        vbalProgressBar bar;
        plain(bar, c.w, c.h, c.border);
        bar.setAppearance(c.appearance);
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        bar.setSegments(c.segments);
        EXPECT_EQ(bar.Value(), c.value); // stored as set
        EXPECT_DOUBLE_EQ(bar.Percent(), c.percent);
        const QImage img = render(bar);
        EXPECT_EQ(runs(img, c.h / 2, false), c.row);
        EXPECT_EQ(runs(img, c.w / 2, true), c.column);
        if (c.appearance == 0 && c.border > 0) {
            EXPECT_EQ(img.pixel(c.w - 1, c.h - 1), qRgb(0, 0, 0));
        }
    }
}

TEST(ProgressBar, TextChangesColourWhereTheBarEnds) {
    vbalProgressBar bar;
    plain(bar, 240, 40, 0, 50);
    bar.setBackColor(0xFFFFFF);
    QFont font(QStringLiteral("DejaVu Sans"));
    font.setPixelSize(30);
    font.setBold(true);
    bar.setFont(font);
    bar.setForeColor(0x0000FF);    // red
    bar.setBarForeColor(0x00FF00); // green
    bar.setShowText(true);
    bar.setText(QStringLiteral("MMMMMMMMMM"));
    const QImage img = render(bar);
    int green = 0, red = 0;
    for (int y = 0; y < 40; ++y)
        for (int x = 0; x < 240; ++x) {
            const QRgb px = img.pixel(x, y);
            // Over the bar: blue and green, never red; over the background: white and red.
            ASSERT_EQ(qRed(px), x < 120 ? 0 : 255) << x << "," << y;
            green += x < 120 && qGreen(px) > 200;
            red += x >= 120 && qGreen(px) < 60;
        }
    EXPECT_GT(green, 50);
    EXPECT_GT(red, 50);
}

TEST(ProgressBar, PicturesTileStretchAndModify) {
    const QRgb colours[4] = {qRgb(255, 0, 0), qRgb(0, 255, 0), qRgb(0, 0, 0), qRgb(9, 9, 9)};
    QImage checks(2, 2, QImage::Format_RGB32);
    for (int i = 0; i < 4; ++i)
        checks.setPixel(i % 2, i / 2, colours[i]);
    vbalProgressBar bar;
    plain(bar, 30, 10);
    bar.setPicture(checks);
    QImage img = render(bar);
    for (int y = 0; y < 10; ++y)
        for (int x = 0; x < 30; ++x)
            ASSERT_EQ(img.pixel(x, y), colours[y % 2 * 2 + x % 2]) << x << "," << y;
    bar.setBackPictureMode(0); // stretched: each picture pixel fills a quarter
    EXPECT_EQ(render(bar).pixel(29, 9), colours[3]);

    // A tiled bar picture covers all of the bar, its tiles placed from the corner (0, 0).
    plain(bar, 42, 10, 1, 100);
    bar.setPicture(QImage());
    bar.setBarPicture(checks);
    img = render(bar);
    for (int x = 1; x <= 40; ++x)
        ASSERT_EQ(img.pixel(x, 5), colours[2 + x % 2]) << x;

    // Modify changes what is drawn, each time from the picture, which itself is kept.
    QImage red(4, 4, QImage::Format_ARGB32);
    red.fill(colours[0]);
    bar.setBarPicture(red);
    bar.ModifyBarPicture(1.0, 0.0);
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(128, 128, 128));
    bar.ModifyBarPicture(2.0);
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(255, 255, 255));
    EXPECT_EQ(bar.BarPicture().pixel(0, 0), colours[0]);
}

TEST(ProgressBar, XpStyleUsesTheStyleUnlessThereIsABackgroundPicture) {
    for (const QSize size : {QSize(120, 20), QSize(20, 120)}) {
        vbalProgressBar bar;
        plain(bar, size.width(), size.height(), 1, 60);
        const QImage unthemed = render(bar);
        bar.setXpStyle(true);
        const QImage themed = render(bar);
        EXPECT_NE(themed, unthemed);
        bar.setValue(0);
        EXPECT_NE(render(bar), themed); // the style's bar follows Value
        QImage picture(3, 3, QImage::Format_RGB32);
        picture.fill(qRgb(10, 200, 30));
        bar.setPicture(picture);
        const QImage withPicture = render(bar);
        bar.setXpStyle(false);
        EXPECT_EQ(render(bar), withPicture);
    }
}

TEST(ProgressBar, RepaintsAtOnceButOnlyWhenThePictureChanges) {
    CountedBar bar;
    plain(bar, 202, 20, 1); // 200 pixels for Values 0..1000: one pixel per 5
    bar.setMax(1000);
    bar.show();
    const std::pair<std::function<void()>, int> steps[] = {
        {[&] { bar.setValue(2); }, 0},   // 0.4 pixels rounds to none
        {[&] { bar.setValue(3); }, 1},   // 0.6 rounds to one
        {[&] { bar.setValue(-5); }, 1},  // held at the empty end
        {[&] { bar.setValue(500); }, 1}, // 100 pixels
        {[&] { bar.setMax(1001); }, 0},  // 99.9
        {[&] { bar.setMax(2000); }, 1},  // 50
        {[&] { bar.setMin(-2); }, 0},    // 50.15
        {[&] { bar.setMin(-400); }, 1},  // 75
        {[&] { bar.setSegments(true); }, 1},
        {[&] { bar.setValue(530); }, 0},  // 77.5 rounds to 78, cut to 70 as before
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
        if (bar.paints > 0) {
            EXPECT_EQ(bar.value, bar.Value()) << i; // the new Value is drawn
        }
        EXPECT_EQ(bar.settle(), steps[i].second) << i;
    }

    // A long operation that never returns to the event loop: the bar shows its progress,
    // but no more than a frame every 16 ms, and its final picture once the loop runs again.
    bar.setMin(0);
    bar.setMax(100000);
    for (const bool xp : {false, true}) {
        bar.setXpStyle(xp);
        bar.setValue(0);
        bar.settle();
        QElapsedTimer clock;
        clock.start();
        for (int i = 1; i <= 100000; ++i) {
            bar.setText(QString::number(i / 1000) + u'%');
            bar.setValue(i);
        }
        EXPECT_GE(bar.paints, 1) << xp;
        EXPECT_LE(bar.paints, clock.elapsed() / 16 + 1) << xp;
        bar.paints = 0;
        EXPECT_LE(bar.settle(), 1) << xp; // the last change, if it was queued
        // The last paint may show an earlier Value that draws the same bar.
        EXPECT_EQ(bar.text, "100%") << xp;
        const QImage final = render(bar);
        bar.setValue(bar.value);
        EXPECT_EQ(render(bar), final) << xp << " drawn at " << bar.value;
        bar.setValue(100000);
    }
}

TEST(ProgressBar, InteractiveMouseAndKeys) {
    vbalProgressBar bar;
    plain(bar, 102, 16, 1, 12); // the bar runs from x 1 to x 100
    bar.setMin(10);
    bar.setMax(20);
    QSignalSpy changes(&bar, &vbalProgressBar::Change);
    QSignalSpy rights(&bar, &vbalProgressBar::RightClick);
    QSignalSpy keys(&bar, &vbalProgressBar::KeyPress);
    QSignalSpy doubles(&bar, &vbalProgressBar::DblClick);
    const auto sendMouse = [&bar](QEvent::Type type, double x, Qt::MouseButton button,
                                  Qt::MouseButtons buttons) {
        QMouseEvent event(type, QPointF(x, 8), QPointF(x, 8), button, buttons, Qt::NoModifier);
        QCoreApplication::sendEvent(&bar, &event);
    };
    sendMouse(QEvent::MouseButtonPress, 100, Qt::LeftButton, Qt::LeftButton);
    EXPECT_EQ(bar.Value(), 12); // not interactive: nothing

    // Presses clamp to the bar and round halves to even, raising Change each time; a drag
    // raises it only when the value moves; the right button only raises RightClick.
    bar.setInteractive(true);
    for (const auto& [x, value] : {std::pair{101.0, 20}, {500.0, 20}, {1.0, 10}, {50.5, 15}}) {
        sendMouse(QEvent::MouseButtonPress, x, Qt::LeftButton, Qt::LeftButton);
        EXPECT_EQ(bar.Value(), value) << x;
    }
    sendMouse(QEvent::MouseMove, 52, Qt::NoButton, Qt::LeftButton);
    sendMouse(QEvent::MouseButtonPress, 90, Qt::RightButton, Qt::RightButton);
    sendMouse(QEvent::MouseMove, 70, Qt::NoButton, Qt::RightButton);
    EXPECT_EQ(bar.Value(), 15);
    EXPECT_EQ(changes.count(), 4);
    EXPECT_EQ(rights.count(), 1);

    QTest::mouseDClick(&bar, Qt::LeftButton, {}, QPoint(10, 8));
    EXPECT_EQ(doubles.count(), 1);
    for (const Qt::Key key : {Qt::Key_Plus, Qt::Key_Minus, Qt::Key_A, Qt::Key_Shift})
        QTest::keyClick(&bar, key);
    ASSERT_EQ(keys.count(), 3); // Shift has no character
    EXPECT_EQ(QList<int>({keys[0][0].toInt(), keys[1][0].toInt(), keys[2][0].toInt()}),
              QList<int>({'+', '-', 'a'}));
}
