#include "ui/vbalProgressBar.h"

#include <QFont>
#include <QMouseEvent>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

namespace {

constexpr quint32 kBack = 0x40A060; // a colour no border uses
constexpr quint32 kBlue = 0xFF0000; // OLE colours are 0x00BBGGRR
constexpr quint32 kRed = 0x0000FF;
constexpr quint32 kGreen = 0x00FF00;

const QRgb back = qRgb(0x60, 0xA0, 0x40);
const QRgb blue = qRgb(0, 0, 255);

QImage render(vbalProgressBar& bar) {
    return bar.grab().toImage().convertToFormat(QImage::Format_RGB32);
}

// A plain bar: green-grey background, blue bar, no text.
void plain(vbalProgressBar& bar, int w, int h, int borderStyle = 0) {
    bar.resize(w, h);
    bar.setBackColor(kBack);
    bar.setBarColor(kBlue);
    bar.setBorderStyle(borderStyle);
}

// The pixels of one row as runs: "B8 W2 ..." (B bar, W background, X anything else).
std::string runs(const QImage& img, int y, bool column = false, int fixed = 0) {
    QString out;
    QChar last;
    int count = 0;
    const int n = column ? img.height() : img.width();
    for (int i = 0; i < n; ++i) {
        // Columns are read from the bottom up, the way a vertical bar grows.
        const QRgb px = column ? img.pixel(fixed, n - 1 - i) : img.pixel(i, y);
        const QChar c = px == blue ? 'B' : px == back ? 'W' : 'X';
        if (c != last && count > 0) {
            out += QString("%1%2 ").arg(last).arg(count);
            count = 0;
        }
        last = c;
        ++count;
    }
    out += QString("%1%2").arg(last).arg(count);
    return out.toStdString();
}

QMouseEvent mouse(QEvent::Type type, QPointF pos, Qt::MouseButton button,
                  Qt::MouseButtons buttons) {
    return QMouseEvent(type, pos, pos, button, buttons, Qt::NoModifier);
}

} // namespace

TEST(ProgressBar, NewInstanceDefaults) {
    vbalProgressBar bar;
    EXPECT_FALSE(bar.Segments());
    EXPECT_FALSE(bar.XpStyle());
    EXPECT_EQ(bar.Text(), "");
    EXPECT_EQ(bar.TextAlignX(), 1);
    EXPECT_EQ(bar.TextAlignY(), 1);
    EXPECT_FALSE(bar.ShowText());
    EXPECT_EQ(bar.Min(), 0);
    EXPECT_EQ(bar.Max(), 100);
    EXPECT_EQ(bar.Value(), 0);
    EXPECT_EQ(bar.BorderStyle(), 1);
    EXPECT_EQ(bar.Appearance(), 1);
    EXPECT_FALSE(bar.Interactive());
    EXPECT_EQ(bar.BackColor(), 0x8000000Fu);
    EXPECT_EQ(bar.ForeColor(), 0u);
    EXPECT_EQ(bar.BarColor(), 0x800000u);
    EXPECT_EQ(bar.BarForeColor(), 0xFFFFFFu);
    EXPECT_TRUE(bar.BarPicture().isNull());
    EXPECT_TRUE(bar.Picture().isNull());
    EXPECT_EQ(bar.BarPictureMode(), 1);
    EXPECT_EQ(bar.BackPictureMode(), 1);
    EXPECT_EQ(bar.Percent(), 0.0);
}

TEST(ProgressBar, PercentClampsAndAnEmptyRangeIsZero) {
    struct Case {
        int value, min, max;
        double percent;
    };
    const Case cases[] = {
        {55, 0, 100, 55.0},
        {-10, 0, 100, 0.0},
        {150, 0, 100, 100.0},
        {4608, 4500, 4700, 54.0},
        {7, 7, 7, 0.0},
        {100, 7, 7, 0.0},
        {25, 100, 0, 75.0}, // a reversed range
        {-2147483647 - 1, -2147483647 - 1, 2147483647, 0.0},
        {2147483647, -2147483647 - 1, 2147483647, 100.0},
    };
    for (const Case& c : cases) {
        vbalProgressBar bar;
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        EXPECT_EQ(bar.Value(), c.value); // stored as set, never clamped
        EXPECT_DOUBLE_EQ(bar.Percent(), c.percent) << c.value << " " << c.min << ".." << c.max;
    }
}

TEST(ProgressBar, SegmentsCutTheBarIntoChunksAndGaps) {
    vbalProgressBar bar;
    plain(bar, 102, 20, 1); // a 1-pixel border leaves an inner width of 100
    bar.setSegments(true);
    bar.setValue(55);
    // Five 8-pixel chunks, each followed by its 2-pixel gap, then the background.
    EXPECT_EQ(runs(render(bar), 10), "X1 B8 W2 B8 W2 B8 W2 B8 W2 B8 W52 X1");

    bar.setSegments(false);
    EXPECT_EQ(runs(render(bar), 10), "X1 B55 W45 X1");
}

TEST(ProgressBar, SquareAndTallControlsDrawUpwards) {
    struct Case {
        int w, h;
        bool segments;
        std::string column; // bottom to top
    };
    const Case cases[] = {
        {40, 40, false, "B20 W20"}, // a square control is vertical
        {20, 60, false, "B30 W30"},
        {20, 60, true, "B8 W2 B8 W2 B8 W32"},
    };
    for (const Case& c : cases) {
        vbalProgressBar bar;
        plain(bar, c.w, c.h);
        bar.setSegments(c.segments);
        bar.setValue(50);
        const QImage img = render(bar);
        EXPECT_EQ(runs(img, 0, true, c.w / 2), c.column) << c.w << "x" << c.h;
        EXPECT_EQ(runs(img, 0, true, c.w - 1), runs(img, 0, true, 0)); // across the whole width
    }
    vbalProgressBar wide;
    plain(wide, 41, 40);
    wide.setValue(50);
    EXPECT_EQ(runs(render(wide), 5), "B20 W21"); // one pixel wider: horizontal (20.5 to even)
}

TEST(ProgressBar, ValuesOutsideTheRangeDrawEmptyOrFull) {
    struct Case {
        int min, max, value;
        std::string row;
    };
    const Case cases[] = {
        {0, 100, -10, "W60"}, {0, 100, 500, "B60"}, {10, 20, 5, "W60"},
        {10, 20, 25, "B60"},  {7, 7, 7, "W60"},     {7, 7, 100, "W60"}, // an empty range: empty
    };
    for (const Case& c : cases) {
        vbalProgressBar bar;
        plain(bar, 60, 10);
        bar.setMin(c.min);
        bar.setMax(c.max);
        bar.setValue(c.value);
        EXPECT_EQ(runs(render(bar), 5), c.row) << c.value << " in " << c.min << ".." << c.max;
    }
}

TEST(ProgressBar, BorderLooksLeaveTheirFrames) {
    struct Case {
        int style, appearance, frame;
    };
    const Case cases[] = {
        {0, 0, 0}, {0, 2, 0}, {1, 0, 1}, {1, 1, 1}, {2, 0, 1}, {2, 1, 1}, {1, 2, 2}, {2, 2, 2},
    };
    for (const Case& c : cases) {
        vbalProgressBar bar;
        plain(bar, 50, 16, c.style);
        bar.setAppearance(c.appearance);
        bar.setValue(100); // the bar fills what the frame leaves
        const QImage img = render(bar);
        const int f = c.frame;
        const QString what = QString("style %1 appearance %2").arg(c.style).arg(c.appearance);
        // Each side: the frame's pixels are not the bar, the next one in is.
        const QPoint sides[][2] = {
            {{0, 8}, {1, 0}}, {{49, 8}, {-1, 0}}, {{25, 0}, {0, 1}}, {{25, 15}, {0, -1}}};
        for (const auto& side : sides) {
            for (int i = 0; i < f; ++i)
                EXPECT_NE(img.pixel(side[0] + side[1] * i), blue) << what.toStdString();
            EXPECT_EQ(img.pixel(side[0] + side[1] * f), blue) << what.toStdString();
        }
        // Every pixel of the frame is drawn: none keeps the background colour.
        for (int i = 0; i < f; ++i)
            for (int x = i; x < 50 - i; ++x)
                EXPECT_NE(img.pixel(x, i), back) << what.toStdString() << " x " << x;
        if (c.appearance == 0 && f > 0) {
            EXPECT_EQ(img.pixel(0, 0), qRgb(0, 0, 0));
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
    bar.setForeColor(kRed);
    bar.setBarForeColor(kGreen);
    bar.setText(QStringLiteral("MMMMMMMMMM"));
    bar.setShowText(true);
    bar.setValue(50);
    const QImage img = render(bar);

    int greenText = 0;
    int redText = 0;
    for (int y = 0; y < 40; ++y)
        for (int x = 0; x < 240; ++x) {
            const QRgb px = img.pixel(x, y);
            if (x < 120) { // over the bar: blue with green text, never any red
                ASSERT_EQ(qRed(px), 0) << x << "," << y;
                greenText += qGreen(px) > 200;
            } else { // over the background: white with red text
                ASSERT_EQ(qRed(px), 255) << x << "," << y;
                redText += qGreen(px) < 60;
            }
        }
    EXPECT_GT(greenText, 50);
    EXPECT_GT(redText, 50);

    // ShowText with no text draws none, and text without ShowText neither.
    vbalProgressBar none;
    plain(none, 240, 40);
    none.setValue(50);
    const QImage empty = render(none);
    none.setShowText(true);
    EXPECT_EQ(render(none), empty);
    none.setShowText(false);
    none.setText(QStringLiteral("MMMM"));
    EXPECT_EQ(render(none), empty);
}

TEST(ProgressBar, PicturesTileOrStretch) {
    // A 2 x 2 background picture: each pixel shows the picture at (x mod 2, y mod 2).
    QImage checks(2, 2, QImage::Format_RGB32);
    const QRgb colours[2][2] = {{qRgb(255, 0, 0), qRgb(0, 255, 0)},
                                {qRgb(0, 0, 0), qRgb(255, 255, 0)}};
    for (int y = 0; y < 2; ++y)
        for (int x = 0; x < 2; ++x)
            checks.setPixel(x, y, colours[y][x]);

    vbalProgressBar bar;
    plain(bar, 30, 10);
    bar.setPicture(checks);
    const QImage tiled = render(bar);
    for (int y = 0; y < 10; ++y)
        for (int x = 0; x < 30; ++x)
            ASSERT_EQ(tiled.pixel(x, y), colours[y % 2][x % 2]) << x << "," << y;

    // Stretched: a picture red over green fills the top and bottom halves.
    QImage halves(1, 2, QImage::Format_RGB32);
    halves.setPixel(0, 0, qRgb(255, 0, 0));
    halves.setPixel(0, 1, qRgb(0, 255, 0));
    bar.setPicture(halves);
    bar.setBackPictureMode(0);
    const QImage stretched = render(bar);
    EXPECT_EQ(stretched.pixel(0, 0), qRgb(255, 0, 0));
    EXPECT_EQ(stretched.pixel(29, 0), qRgb(255, 0, 0));
    EXPECT_EQ(stretched.pixel(15, 9), qRgb(0, 255, 0));
}

TEST(ProgressBar, ABarPictureCoversTheWholeBar) {
    QImage stripes(3, 1, QImage::Format_RGB32);
    const QRgb colours[3] = {qRgb(255, 0, 0), qRgb(0, 255, 0), qRgb(255, 255, 0)};
    for (int x = 0; x < 3; ++x)
        stripes.setPixel(x, 0, colours[x]);

    vbalProgressBar bar;
    plain(bar, 42, 10, 1);
    bar.setBarPicture(stripes);
    bar.setValue(100);
    const QImage img = render(bar);
    // Tiled from the bar's left edge: the last column inside the border is picture too.
    for (int x = 1; x <= 40; ++x)
        ASSERT_EQ(img.pixel(x, 5), colours[x % 3]) << x;

    bar.setValue(50);
    const std::string row = runs(render(bar), 5);
    EXPECT_EQ(row.substr(row.size() - 6), "W20 X1") << row;
}

TEST(ProgressBar, ModifyBarPictureChangesWhatIsDrawnNotThePicture) {
    QImage red(4, 4, QImage::Format_ARGB32);
    red.fill(qRgb(255, 0, 0));
    vbalProgressBar bar;
    plain(bar, 20, 10);
    bar.setBarPicture(red);
    bar.setValue(100);

    bar.ModifyBarPicture(1.0, 0.0); // no saturation: the grey of the same luminance
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(128, 128, 128));
    EXPECT_EQ(bar.BarPicture().pixel(0, 0), qRgb(255, 0, 0));

    bar.ModifyBarPicture(2.0); // starts from the picture again, not from the grey
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(255, 255, 255));

    QImage back(4, 4, QImage::Format_RGB32);
    back.fill(qRgb(0, 0, 255));
    bar.setPicture(back);
    bar.setValue(0);
    bar.ModifyPicture(0.5, 1.0);
    EXPECT_EQ(render(bar).pixel(10, 5), qRgb(0, 0, 128));
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
        bar.setValue(60);
        bar.setPicture(picture);
        const QImage withPicture = render(bar);
        bar.setXpStyle(false);
        EXPECT_EQ(render(bar), withPicture);
    }
}

namespace {

// Counts the paint events a widget receives.
class PaintCounter : public QObject {
public:
    int paints = 0;
    bool eventFilter(QObject*, QEvent* event) override {
        paints += event->type() == QEvent::Paint;
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

    bar.setBarColor(kGreen);
    EXPECT_EQ(counter.paints, 1); // at once, without the event loop
    bar.setBarColor(kGreen);
    bar.setValue(0);
    bar.setText(QString());
    EXPECT_EQ(counter.paints, 1); // nothing changed

    // A refresh of 100,000 items: one repaint per pixel the bar grows and per percent text.
    counter.paints = 0;
    const int items = 100000;
    bar.setMax(items);
    for (int i = 1; i <= items; ++i) {
        bar.setText(QString::number(i * 100 / items) + QLatin1Char('%'));
        bar.setValue(i);
    }
    EXPECT_GT(counter.paints, 200);
    EXPECT_LE(counter.paints, 301); // 200 pixels, "0%" and 100 more texts
    EXPECT_EQ(render(bar).pixel(200, 1), qRgb(0, 255, 0));

    // The themed bar too repaints only when its extent changes.
    bar.setXpStyle(true);
    bar.setValue(0);
    counter.paints = 0;
    for (int i = 1; i <= items; ++i)
        bar.setValue(i);
    EXPECT_GT(counter.paints, 50);
    EXPECT_LE(counter.paints, 202);
    bar.removeEventFilter(&counter);
}

TEST(ProgressBar, InteractiveDragSetsValueWithinMinAndMax) {
    vbalProgressBar bar;
    plain(bar, 102, 16, 1); // the bar runs from x 1 to x 100
    bar.setMin(10);
    bar.setMax(20);
    bar.setValue(12);
    QSignalSpy changes(&bar, &vbalProgressBar::Change);
    QSignalSpy rights(&bar, &vbalProgressBar::RightClick);

    // Not interactive: the mouse changes nothing.
    QTest::mousePress(&bar, Qt::LeftButton, {}, QPoint(100, 8));
    QTest::mouseRelease(&bar, Qt::LeftButton, {}, QPoint(100, 8));
    EXPECT_EQ(bar.Value(), 12);
    EXPECT_EQ(changes.count(), 0);

    bar.setInteractive(true);
    struct Press {
        double x;
        int value;
    };
    const Press presses[] = {{101, 20}, {500, 20},  {100, 20}, {1, 10},
                             {-40, 10}, {50.5, 15}, {45, 14}};
    for (const Press& p : presses) {
        changes.clear();
        auto press = mouse(QEvent::MouseButtonPress, {p.x, 8}, Qt::LeftButton, Qt::LeftButton);
        QCoreApplication::sendEvent(&bar, &press);
        EXPECT_EQ(bar.Value(), p.value) << p.x;
        EXPECT_EQ(changes.count(), 1) << p.x; // once per press, changed or not
        auto release = mouse(QEvent::MouseButtonRelease, {p.x, 8}, Qt::LeftButton, {});
        QCoreApplication::sendEvent(&bar, &release);
    }

    // A drag beyond both ends stops at Max and Min; moves within one step raise nothing.
    changes.clear();
    auto press = mouse(QEvent::MouseButtonPress, {50, 8}, Qt::LeftButton, Qt::LeftButton);
    QCoreApplication::sendEvent(&bar, &press);
    const std::pair<double, int> moves[] = {{52, 15}, {300, 20}, {400, 20}, {-5, 10}, {0, 10}};
    for (const auto& [x, value] : moves) {
        auto move = mouse(QEvent::MouseMove, {x, -30}, Qt::NoButton, Qt::LeftButton);
        QCoreApplication::sendEvent(&bar, &move);
        EXPECT_EQ(bar.Value(), value) << x;
    }
    EXPECT_EQ(changes.count(), 3); // the press, to Max, to Min
    auto release = mouse(QEvent::MouseButtonRelease, {0, 8}, Qt::LeftButton, {});
    QCoreApplication::sendEvent(&bar, &release);

    // The right button: RightClick, Value untouched; a move without the left button too.
    changes.clear();
    auto right = mouse(QEvent::MouseButtonPress, {90, 8}, Qt::RightButton, Qt::RightButton);
    QCoreApplication::sendEvent(&bar, &right);
    auto rightMove = mouse(QEvent::MouseMove, {70, 8}, Qt::NoButton, Qt::RightButton);
    QCoreApplication::sendEvent(&bar, &rightMove);
    EXPECT_EQ(rights.count(), 1);
    EXPECT_EQ(bar.Value(), 10);
    EXPECT_EQ(changes.count(), 0);
}

TEST(ProgressBar, DoubleClickAndKeysRaiseTheirEvents) {
    vbalProgressBar bar;
    plain(bar, 100, 16, 1);
    bar.setInteractive(true);
    bar.setValue(40);
    QSignalSpy doubles(&bar, &vbalProgressBar::DblClick);
    QSignalSpy keys(&bar, &vbalProgressBar::KeyPress);

    QTest::mouseDClick(&bar, Qt::LeftButton, {}, QPoint(10, 8));
    EXPECT_EQ(doubles.count(), 1);

    QTest::keyClick(&bar, Qt::Key_Plus);
    QTest::keyClick(&bar, Qt::Key_Minus);
    QTest::keyClick(&bar, Qt::Key_A);
    QTest::keyClick(&bar, Qt::Key_Shift); // no character
    ASSERT_EQ(keys.count(), 3);
    EXPECT_EQ(keys[0][0].toInt(), 43);
    EXPECT_EQ(keys[1][0].toInt(), 45);
    EXPECT_EQ(keys[2][0].toInt(), 'a');
}
