#include "ui/vbalProgressBar.h"

#include <QFont>
#include <QMouseEvent>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <random>
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
std::string runs(const QImage& img, int at, bool column = false) {
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

void sendMouse(QWidget& w, QEvent::Type type, double x, Qt::MouseButton button,
               Qt::MouseButtons buttons) {
    QMouseEvent event(type, QPointF(x, 8), QPointF(x, 8), button, buttons, Qt::NoModifier);
    QCoreApplication::sendEvent(&w, &event);
}

class PaintCounter : public QObject {
public:
    int paints = 0;
    int lastPaintedValue = -1;
    QString lastPaintedText;
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() == QEvent::Paint) {
            ++paints;
            const auto* bar = static_cast<vbalProgressBar*>(watched);
            lastPaintedValue = bar->Value();
            lastPaintedText = bar->Text();
        }
        return false;
    }
};

} // namespace

TEST(ProgressBar, ExtentPercentSegmentsOrientationAndBorders) {
    const struct {
        int w, h, border, min, max, value;
        bool segments;
        double percent;
        std::string line; // the middle row, or the middle column from the bottom
    } cases[] = {
        // Inner width 100 at 55 %: cut to 50, five 8-pixel chunks each with a 2-pixel gap.
        {102, 20, 1, 0, 100, 55, true, 55, "X1 B8 W2 B8 W2 B8 W2 B8 W2 B8 W52 X1"},
        {102, 20, 1, 0, 100, 55, false, 55, "X1 B55 W45 X1"},
        {41, 40, 0, 0, 100, 50, false, 50, "B20 W21"}, // 20.5 rounds to even
        {40, 40, 0, 0, 100, 50, false, 50, "B20 W20"}, // square: vertical
        {20, 60, 0, 0, 100, 50, true, 50, "B8 W2 B8 W2 B8 W32"},
        {60, 10, 0, 0, 100, -10, false, 0, "W60"},
        {60, 10, 0, 10, 20, 25, false, 100, "B60"},
        {60, 10, 0, 7, 7, 7, false, 0, "W60"}, // an empty range: an empty bar
        {60, 10, 0, INT_MIN, INT_MAX, INT_MAX, false, 100, "B60"},
    };
    for (const auto& c : cases) {
        vbalProgressBar bar;
        plain(bar, c.w, c.h, c.border);
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        bar.setSegments(c.segments);
        EXPECT_EQ(bar.Value(), c.value); // stored as set
        EXPECT_DOUBLE_EQ(bar.Percent(), c.percent) << c.value << " " << c.min << ".." << c.max;
        const QImage img = render(bar);
        const bool vertical = c.w <= c.h;
        EXPECT_EQ(runs(img, vertical ? c.w / 2 : c.h / 2, vertical), c.line) << c.w << "x" << c.h;
        if (vertical) { // the bar spans the whole width
            EXPECT_EQ(runs(img, c.w - 1, true), runs(img, 0, true));
        }
    }

    // Border style and appearance leave a frame of 0, 1 or 2 pixels all round.
    for (const auto& [style, appearance, frame] :
         {std::tuple{0, 2, 0}, {1, 0, 1}, {1, 1, 1}, {2, 0, 1}, {2, 1, 1}, {1, 2, 2}, {2, 2, 2}}) {
        vbalProgressBar bar;
        plain(bar, 50, 16, style, 100);
        bar.setAppearance(appearance);
        const QImage img = render(bar);
        const auto line = [frame](int size) {
            const std::string f = "X" + std::to_string(frame);
            const std::string b = "B" + std::to_string(size - 2 * frame);
            return frame ? f + " " + b + " " + f : b;
        };
        EXPECT_EQ(runs(img, 8), line(50)) << style << "/" << appearance;
        EXPECT_EQ(runs(img, 25, true), line(16)) << style << "/" << appearance;
        if (appearance == 0) {
            EXPECT_EQ(img.pixel(49, 15), qRgb(0, 0, 0));
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
    bar.setShowText(true);         // with no text: nothing
    const QImage empty = render(bar);
    bar.setText(QStringLiteral("MMMMMMMMMM"));
    const QImage img = render(bar);
    EXPECT_NE(img, empty);
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

    // A tiled bar picture starts at the bar's own left edge, so it covers all of the bar.
    QImage stripes(3, 1, QImage::Format_RGB32);
    for (int x = 0; x < 3; ++x)
        stripes.setPixel(x, 0, colours[x]);
    plain(bar, 42, 10, 1, 100);
    bar.setPicture(QImage());
    bar.setBarPicture(stripes);
    img = render(bar);
    for (int x = 1; x <= 40; ++x)
        ASSERT_EQ(img.pixel(x, 5), colours[x % 3]) << x;

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

TEST(ProgressBar, SetsRepaintAtOnceButOnlyWhenThePictureChanges) {
    vbalProgressBar bar;
    plain(bar, 202, 20, 1);
    bar.setShowText(true);
    bar.show();
    PaintCounter counter;
    bar.installEventFilter(&counter);
    // Until a whole frame has passed without a paint: a busy machine may paint late. Gives
    // the paints seen meanwhile, and starts the count again.
    const auto settle = [&counter] {
        counter.paints = 0;
        for (int seen = -1; seen != counter.paints;) {
            seen = counter.paints;
            QTest::qWait(20);
        }
        return std::exchange(counter.paints, 0);
    };
    settle();
    bar.setBarColor(0x00FF00);
    EXPECT_EQ(counter.paints, 1); // at once, without the event loop
    bar.setBarColor(0x00FF00);
    bar.setValue(0);
    bar.setText(QString());
    EXPECT_EQ(counter.paints, 1);

    // A refresh of 100,000 items that never returns to the event loop: the bar shows its
    // progress, but draws no more than a frame every 16 ms, and the last picture shows once
    // the loop runs again.
    const int items = 100000;
    bar.setMax(items);
    for (const bool xp : {false, true}) {
        bar.setXpStyle(xp);
        bar.setValue(0);
        settle();
        QElapsedTimer clock;
        clock.start();
        for (int i = 1; i <= items; ++i) {
            bar.setText(QString::number(i * 100 / items) + QLatin1Char('%'));
            bar.setValue(i);
        }
        const qint64 elapsed = clock.elapsed();
        EXPECT_GE(counter.paints, 1) << xp;
        EXPECT_LE(counter.paints, elapsed / 16 + 1) << xp;
        // The last change was either drawn at once or is queued for the loop, which may
        // hold an update request back for a few milliseconds. The last Value need not be
        // drawn itself when it draws the same bar as the Value before it.
        EXPECT_LE(settle(), 1) << xp;
        EXPECT_EQ(counter.lastPaintedText, QStringLiteral("100%")) << xp;
        const QImage final = render(bar);
        bar.setValue(counter.lastPaintedValue);
        EXPECT_EQ(render(bar), final) << xp << " drawn at " << counter.lastPaintedValue;
        bar.setValue(items);
    }
}

// A set of Value works the bar out again only when the bar's end may move, so a redraw must
// follow every move of the end and no other: whichever way Value goes, and after Min, Max,
// the size, the border or the segments change what each Value draws.
TEST(ProgressBar, RedrawsWheneverTheBarsEndMovesAndOnlyThen) {
    vbalProgressBar bar;
    plain(bar, 202, 20, 1);
    bar.setMax(1000);
    bar.show();
    PaintCounter counter;
    bar.installEventFilter(&counter);
    // The paints since the last call, until a whole frame has passed without one.
    const auto paintsUntilQuiet = [&counter] {
        int total = counter.paints;
        do {
            counter.paints = 0;
            QTest::qWait(20);
            total += counter.paints;
        } while (counter.paints != 0);
        return total;
    };
    const auto drawn = [&bar](int value) {
        const QRect inner =
            progressbar::innerRect(bar.rect(), bar.BorderStyle(), bar.Appearance(), false);
        return progressbar::barRect(inner, progressbar::fraction(value, bar.Min(), bar.Max()), true,
                                    bar.Segments() ? 10 : 0);
    };
    paintsUntilQuiet();
    std::mt19937 random(2026);
    for (int step = 0; step < 60; ++step) {
        const QRect before = drawn(bar.Value());
        const int pick = static_cast<int>(random() % 10);
        if (pick < 6) {
            // Mostly small moves, which end inside the same span or just past its end.
            const int jump = pick < 4 ? static_cast<int>(random() % 7) - 3
                                      : static_cast<int>(random() % 1200) - 600;
            bar.setValue(bar.Value() + jump);
        } else if (pick == 6) {
            bar.setMax(bar.Max() == 1000 ? 700 : 1000);
        } else if (pick == 7) {
            bar.setMin(bar.Min() == 0 ? -50 : 0);
        } else if (pick == 8) {
            bar.resize(bar.width() == 202 ? 150 : 202, 20);
        } else {
            bar.setSegments(!bar.Segments());
        }
        const int paints = paintsUntilQuiet();
        if (pick <= 7) { // a resize or a new look always repaints
            EXPECT_EQ(paints > 0, drawn(bar.Value()) != before)
                << "step " << step << ", value " << bar.Value();
        }
        if (paints > 0) {
            EXPECT_EQ(counter.lastPaintedValue, bar.Value()) << "step " << step;
        }
    }
}

// The bar's memo and the refresh's percent text both skip the values that change nothing:
// the run of values with the same rounded percent must end exactly where a scan says.
TEST(ProgressBar, RunEndFindsWhereTheRoundedPercentNextChanges) {
    for (const int max : {1, 3, 7, 100, 101, 999, 65537}) {
        const auto percent = [max](int v) {
            return std::llround(progressbar::fraction(v, 0, max) * 100.0);
        };
        const int stride = max > 1000 ? 97 : 1;
        for (int v = 0; v <= max; v += stride) {
            int last = v;
            while (last < max && percent(last + 1) == percent(v))
                ++last;
            if (last == max) // past Max the bar stays full
                last = INT_MAX;
            int first = v;
            while (first > 0 && percent(first - 1) == percent(v))
                --first;
            if (first == 0) // below Min it stays empty
                first = INT_MIN;
            const auto same = [&](int u) { return percent(u) == percent(v); };
            ASSERT_EQ(progressbar::runEnd(v, +1, same), last) << max << " " << v;
            ASSERT_EQ(progressbar::runEnd(v, -1, same), first) << max << " " << v;
        }
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
    sendMouse(bar, QEvent::MouseButtonPress, 100, Qt::LeftButton, Qt::LeftButton);
    EXPECT_EQ(bar.Value(), 12); // not interactive: nothing

    // Presses clamp to the bar and round halves to even, raising Change each time; a drag
    // raises it only when the value moves; the right button only raises RightClick.
    bar.setInteractive(true);
    for (const auto& [x, value] : {std::pair{101.0, 20}, {500.0, 20}, {1.0, 10}, {50.5, 15}}) {
        sendMouse(bar, QEvent::MouseButtonPress, x, Qt::LeftButton, Qt::LeftButton);
        EXPECT_EQ(bar.Value(), value) << x;
    }
    EXPECT_EQ(changes.count(), 4);
    sendMouse(bar, QEvent::MouseMove, 52, Qt::NoButton, Qt::LeftButton);
    EXPECT_EQ(changes.count(), 4);
    sendMouse(bar, QEvent::MouseButtonPress, 90, Qt::RightButton, Qt::RightButton);
    sendMouse(bar, QEvent::MouseMove, 70, Qt::NoButton, Qt::RightButton);
    EXPECT_EQ(rights.count(), 1);
    EXPECT_EQ(bar.Value(), 15);
    EXPECT_EQ(changes.count(), 4);

    QSignalSpy doubles(&bar, &vbalProgressBar::DblClick);
    QTest::mouseDClick(&bar, Qt::LeftButton, {}, QPoint(10, 8));
    EXPECT_EQ(doubles.count(), 1);
    for (const Qt::Key key : {Qt::Key_Plus, Qt::Key_Minus, Qt::Key_A, Qt::Key_Shift})
        QTest::keyClick(&bar, key);
    ASSERT_EQ(keys.count(), 3); // Shift has no character
    EXPECT_EQ(QList<int>({keys[0][0].toInt(), keys[1][0].toInt(), keys[2][0].toInt()}),
              QList<int>({'+', '-', 'a'}));
}
