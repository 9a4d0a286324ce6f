#include "ui/vbalProgressBar.h"

#include <QFont>
#include <QMouseEvent>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

namespace {

constexpr quint32 kBack = 0x40A060; // OLE 0x00BBGGRR; a colour no border uses
constexpr quint32 kBlue = 0xFF0000;
const QRgb back = qRgb(0x60, 0xA0, 0x40);
const QRgb blue = qRgb(0, 0, 255);

QImage render(vbalProgressBar& bar) {
    return bar.grab().toImage().convertToFormat(QImage::Format_RGB32);
}

void plain(vbalProgressBar& bar, int w, int h, int borderStyle = 0) {
    bar.resize(w, h);
    bar.setBackColor(kBack);
    bar.setBarColor(kBlue);
    bar.setBorderStyle(borderStyle);
}

// A row (or a column, read bottom up) as runs: "B8 W2 ..." for bar, background, other.
std::string runs(const QImage& img, int at, bool column = false) {
    QString out;
    QChar last;
    int count = 0;
    const int n = column ? img.height() : img.width();
    for (int i = 0; i < n; ++i) {
        const QRgb px = column ? img.pixel(at, n - 1 - i) : img.pixel(i, at);
        const QChar c = px == blue ? 'B' : px == back ? 'W' : 'X';
        if (c != last && count > 0) {
            out += QString("%1%2 ").arg(last).arg(count);
            count = 0;
        }
        last = c;
        ++count;
    }
    return (out + QString("%1%2").arg(last).arg(count)).toStdString();
}

void sendMouse(QWidget& w, QEvent::Type type, double x, Qt::MouseButton button,
               Qt::MouseButtons buttons) {
    QMouseEvent event(type, QPointF(x, 8), QPointF(x, 8), button, buttons, Qt::NoModifier);
    QCoreApplication::sendEvent(&w, &event);
}

} // namespace

TEST(ProgressBar, PercentClampsAndAnEmptyRangeIsZero) {
    struct Case {
        int value, min, max;
        double percent;
    };
    const Case cases[] = {{55, 0, 100, 55},
                          {-10, 0, 100, 0},
                          {150, 0, 100, 100},
                          {4608, 4500, 4700, 54},
                          {100, 7, 7, 0},
                          {25, 100, 0, 75},
                          {INT_MAX, INT_MIN, INT_MAX, 100}};
    for (const Case& c : cases) {
        vbalProgressBar bar;
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        EXPECT_EQ(bar.Value(), c.value); // stored as set
        EXPECT_DOUBLE_EQ(bar.Percent(), c.percent) << c.value << " " << c.min << ".." << c.max;
    }
}

TEST(ProgressBar, BarExtentSegmentsAndOrientation) {
    struct Case {
        int w, h, border, min, max, value;
        bool segments;
        std::string line; // the middle row, or the middle column from the bottom
    };
    const Case cases[] = {
        // Inner width 100 at 55 %: cut to 50, five 8-pixel chunks each with a 2-pixel gap.
        {102, 20, 1, 0, 100, 55, true, "X1 B8 W2 B8 W2 B8 W2 B8 W2 B8 W52 X1"},
        {102, 20, 1, 0, 100, 55, false, "X1 B55 W45 X1"},
        {41, 40, 0, 0, 100, 50, false, "B20 W21"}, // 20.5 rounds to even
        {40, 40, 0, 0, 100, 50, false, "B20 W20"}, // square: vertical
        {20, 60, 0, 0, 100, 50, true, "B8 W2 B8 W2 B8 W32"},
        {60, 10, 0, 0, 100, -10, false, "W60"},
        {60, 10, 0, 10, 20, 25, false, "B60"},
        {60, 10, 0, 7, 7, 7, false, "W60"}, // an empty range: an empty bar
    };
    for (const Case& c : cases) {
        vbalProgressBar bar;
        plain(bar, c.w, c.h, c.border);
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        bar.setSegments(c.segments);
        const QImage img = render(bar);
        const bool vertical = c.w <= c.h;
        EXPECT_EQ(runs(img, vertical ? c.w / 2 : c.h / 2, vertical), c.line) << c.w << "x" << c.h;
        if (vertical) { // the bar spans the whole width
            EXPECT_EQ(runs(img, c.w - 1, true), runs(img, 0, true));
        }
    }
}

TEST(ProgressBar, BorderLooksLeaveTheirFrames) {
    struct Case {
        int style, appearance, frame;
    };
    const Case cases[] = {{0, 2, 0}, {1, 0, 1}, {1, 1, 1}, {2, 0, 1},
                          {2, 1, 1}, {1, 2, 2}, {2, 2, 2}};
    for (const Case& c : cases) {
        vbalProgressBar bar;
        plain(bar, 50, 16, c.style);
        bar.setAppearance(c.appearance);
        bar.setValue(100);
        const QImage img = render(bar);
        const std::string row = runs(img, 8), column = runs(img, 25, true);
        const std::string f = "X" + std::to_string(c.frame) + " ";
        const std::string b = "B" + std::to_string(50 - 2 * c.frame);
        const std::string frame = c.frame == 0 ? "" : f;
        EXPECT_EQ(row, c.frame == 0 ? b : f + b + " X" + std::to_string(c.frame))
            << c.style << "/" << c.appearance;
        EXPECT_EQ(column.substr(0, frame.size() + 1), frame + "B");
        if (c.appearance == 0) {
            EXPECT_EQ(img.pixel(49, 15), qRgb(0, 0, 0));
        }
    }
}

TEST(ProgressBar, TextChangesColourWhereTheBarEnds) {
    vbalProgressBar bar;
    plain(bar, 240, 40);
    bar.setBackColor(0xFFFFFF);
    QFont font(QStringLiteral("DejaVu Sans"));
    font.setPixelSize(30);
    font.setBold(true);
    bar.setFont(font);
    bar.setForeColor(0x0000FF);    // red
    bar.setBarForeColor(0x00FF00); // green
    bar.setValue(50);
    bar.setShowText(true); // with no text: nothing
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
    QImage checks(2, 2, QImage::Format_RGB32);
    const QRgb colours[2][2] = {{qRgb(255, 0, 0), qRgb(0, 255, 0)}, {qRgb(0, 0, 0), qRgb(9, 9, 9)}};
    for (int i = 0; i < 4; ++i)
        checks.setPixel(i % 2, i / 2, colours[i / 2][i % 2]);
    vbalProgressBar bar;
    plain(bar, 30, 10);
    bar.setPicture(checks);
    QImage img = render(bar);
    for (int y = 0; y < 10; ++y)
        for (int x = 0; x < 30; ++x)
            ASSERT_EQ(img.pixel(x, y), colours[y % 2][x % 2]) << x << "," << y;

    bar.setBackPictureMode(0); // stretched: each picture pixel fills a quarter
    img = render(bar);
    EXPECT_EQ(img.pixel(0, 0), qRgb(255, 0, 0));
    EXPECT_EQ(img.pixel(29, 0), qRgb(0, 255, 0));
    EXPECT_EQ(img.pixel(0, 9), qRgb(0, 0, 0));

    // A tiled bar picture starts at the bar's own left edge, so it covers all of the bar.
    QImage stripes(3, 1, QImage::Format_RGB32);
    const QRgb stripe[3] = {qRgb(255, 0, 0), qRgb(0, 255, 0), qRgb(255, 255, 0)};
    for (int x = 0; x < 3; ++x)
        stripes.setPixel(x, 0, stripe[x]);
    plain(bar, 42, 10, 1);
    bar.setPicture(QImage());
    bar.setBarPicture(stripes);
    bar.setValue(100);
    img = render(bar);
    for (int x = 1; x <= 40; ++x)
        ASSERT_EQ(img.pixel(x, 5), stripe[x % 3]) << x;

    // Modify changes what is drawn, each time from the picture, which itself is kept.
    QImage red(4, 4, QImage::Format_ARGB32);
    red.fill(qRgb(255, 0, 0));
    bar.setBarPicture(red);
    bar.ModifyBarPicture(1.0, 0.0);
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(128, 128, 128));
    bar.ModifyBarPicture(2.0);
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(255, 255, 255));
    EXPECT_EQ(bar.BarPicture().pixel(0, 0), qRgb(255, 0, 0));
}

TEST(ProgressBar, XpStyleUsesTheStyleUnlessThereIsABackgroundPicture) {
    for (const QSize size : {QSize(120, 20), QSize(20, 120)}) {
        vbalProgressBar bar;
        plain(bar, size.width(), size.height(), 1);
        bar.setValue(60);
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

namespace {

class PaintCounter : public QObject {
public:
    int paints = 0;
    int lastPaintedValue = -1;
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() == QEvent::Paint) {
            ++paints;
            lastPaintedValue = static_cast<vbalProgressBar*>(watched)->Value();
        }
        return false;
    }
};

} // namespace

TEST(ProgressBar, SetsRepaintAtOnceButOnlyWhenThePictureChanges) {
    vbalProgressBar bar;
    plain(bar, 202, 20, 1);
    bar.setShowText(true);
    bar.show();
    QCoreApplication::processEvents();
    PaintCounter counter;
    bar.installEventFilter(&counter);

    QTest::qWait(20); // a frame after the last paint
    counter.paints = 0;
    bar.setBarColor(0x00FF00);
    EXPECT_EQ(counter.paints, 1); // at once, without the event loop
    bar.setBarColor(0x00FF00);
    bar.setValue(0);
    bar.setText(QString());
    EXPECT_EQ(counter.paints, 1);

    // A refresh of 100,000 items that never returns to the event loop: the bar shows its
    // progress, but draws no more than a frame every 16 ms, and the last picture shows once
    // the loop runs again.
    for (const bool xp : {false, true}) {
        bar.setXpStyle(xp);
        bar.setValue(0);
        QTest::qWait(20);
        counter.paints = 0;
        const int items = 100000;
        bar.setMax(items);
        QElapsedTimer clock;
        clock.start();
        for (int i = 1; i <= items; ++i) {
            bar.setText(QString::number(i * 100 / items) + QLatin1Char('%'));
            bar.setValue(i);
        }
        const qint64 elapsed = clock.elapsed();
        EXPECT_GE(counter.paints, 1) << xp;
        EXPECT_LE(counter.paints, elapsed / 16 + 1) << xp;
        // The last change was either drawn at once or is queued for the loop.
        counter.paints = 0;
        QCoreApplication::processEvents();
        EXPECT_LE(counter.paints, 1) << xp;
        EXPECT_EQ(counter.lastPaintedValue, items) << xp;
    }
}

TEST(ProgressBar, InteractiveMouseAndKeys) {
    vbalProgressBar bar;
    plain(bar, 102, 16, 1); // the bar runs from x 1 to x 100
    bar.setMin(10);
    bar.setMax(20);
    bar.setValue(12);
    QSignalSpy changes(&bar, &vbalProgressBar::Change);
    QSignalSpy rights(&bar, &vbalProgressBar::RightClick);
    QSignalSpy doubles(&bar, &vbalProgressBar::DblClick);
    QSignalSpy keys(&bar, &vbalProgressBar::KeyPress);

    sendMouse(bar, QEvent::MouseButtonPress, 100, Qt::LeftButton, Qt::LeftButton);
    EXPECT_EQ(bar.Value(), 12); // not interactive: nothing
    bar.setInteractive(true);

    const std::pair<double, int> presses[] = {{101, 20}, {500, 20},  {100, 20}, {1, 10},
                                              {-40, 10}, {50.5, 15}, {45, 14}};
    for (const auto& [x, value] : presses) {
        changes.clear();
        sendMouse(bar, QEvent::MouseButtonPress, x, Qt::LeftButton, Qt::LeftButton);
        EXPECT_EQ(bar.Value(), value) << x;
        EXPECT_EQ(changes.count(), 1) << x; // once per press, changed or not
        sendMouse(bar, QEvent::MouseButtonRelease, x, Qt::LeftButton, {});
    }

    // A drag stops at Max and Min, raising Change only when the value moves.
    changes.clear();
    sendMouse(bar, QEvent::MouseButtonPress, 50, Qt::LeftButton, Qt::LeftButton);
    for (const auto& [x, value] : {std::pair{52.0, 15}, {300.0, 20}, {400.0, 20}, {-5.0, 10}}) {
        sendMouse(bar, QEvent::MouseMove, x, Qt::NoButton, Qt::LeftButton);
        EXPECT_EQ(bar.Value(), value) << x;
    }
    EXPECT_EQ(changes.count(), 3);
    sendMouse(bar, QEvent::MouseButtonRelease, 0, Qt::LeftButton, {});

    // The right button raises RightClick and leaves Value.
    changes.clear();
    sendMouse(bar, QEvent::MouseButtonPress, 90, Qt::RightButton, Qt::RightButton);
    sendMouse(bar, QEvent::MouseMove, 70, Qt::NoButton, Qt::RightButton);
    EXPECT_EQ(rights.count(), 1);
    EXPECT_EQ(bar.Value(), 10);
    EXPECT_EQ(changes.count(), 0);

    QTest::mouseDClick(&bar, Qt::LeftButton, {}, QPoint(10, 8));
    EXPECT_EQ(doubles.count(), 1);
    for (const Qt::Key key : {Qt::Key_Plus, Qt::Key_Minus, Qt::Key_A, Qt::Key_Shift})
        QTest::keyClick(&bar, key);
    ASSERT_EQ(keys.count(), 3); // Shift has no character
    EXPECT_EQ(keys[0][0].toInt(), 43);
    EXPECT_EQ(keys[1][0].toInt(), 45);
    EXPECT_EQ(keys[2][0].toInt(), 'a');
}
