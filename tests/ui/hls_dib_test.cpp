#include "support/Boxes.h"
#include "ui/Hls.h"
#include "ui/pcDibSection.h"
#include "ui/pcMemDC.h"

#include <QClipboard>
#include <QGuiApplication>

#include <climits>
#include <cmath>
#include <functional>
#include <limits>
#include <set>

#include <gtest/gtest.h>

namespace {

const double kNaN = std::numeric_limits<double>::quiet_NaN();

RgbColor pixelOf(const pcDibSection& dib, int x, int y) {
    const uchar* px = dib.hdc()->constScanLine(y) + 3 * x;
    return {px[2], px[1], px[0]};
}

} // namespace

TEST(Hls, ConvertsBothWaysWithHueFromMinusOneToFive) {
    const struct {
        int r, g, b;
        float h, l, s;
    } cases[] = {{255, 0, 0, 0, 0.5f, 1},    {0, 255, 0, 2, 0.5f, 1},  {0, 0, 255, 4, 0.5f, 1},
                 {255, 0, 255, -1, 0.5f, 1}, {255, 255, 255, 0, 1, 0}, {51, 51, 51, 0, 0.2f, 0}};
    for (const auto& c : cases) {
        const HlsColor hls = RGBToHLS(c.r, c.g, c.b);
        EXPECT_NEAR(hls.h, c.h, 1e-5) << c.r << "," << c.g << "," << c.b;
        EXPECT_NEAR(hls.l, c.l, 1e-5);
        EXPECT_NEAR(hls.s, c.s, 1e-5);
    }
    // Every colour comes back as it was, from each sixth of the hue circle.
    for (int r = 0; r < 256; r += 15)
        for (int g = 0; g < 256; g += 15)
            for (int b = 0; b < 256; b += 15) {
                const HlsColor hls = RGBToHLS(r, g, b);
                ASSERT_EQ(HLSToRGB(hls.h, hls.s, hls.l), (RgbColor{r, g, b}));
            }
    // Channels round half to even and stay within a byte, whatever comes in.
    for (const auto& [value, channel] :
         {std::pair{126.5, 126}, {127.5, 128}, {-3.0, 0}, {300.0, 255}, {kNaN, 0}, {HUGE_VAL, 255}})
        EXPECT_EQ(toChannel(value), channel) << value;
}

TEST(DibSection, PixelOperations) {
    using Op = std::function<void(pcDibSection&)>;
    const struct {
        QRgb in;
        Op op;
        RgbColor out;
    } cases[] = {
        {qRgb(255, 1, 200), [](pcDibSection& d) { d.Fade(128); }, {128, 0, 100}},
        {qRgb(255, 1, 200), [](pcDibSection& d) { d.Fade(1000); }, {255, 3, 255}},
        {qRgb(255, 1, 200), [](pcDibSection& d) { d.Fade(-40); }, {0, 0, 0}},
        {qRgb(255, 1, 200), [](pcDibSection& d) { d.Fade(INT_MAX); }, {255, 255, 255}},
        {qRgb(200, 100, 50), [](pcDibSection& d) { d.ModifyHLS(1, 1, 0); }, {125, 125, 125}},
        {qRgb(0, 255, 0), [](pcDibSection& d) { d.ModifyHLS(2, 1, 1); }, {0, 0, 255}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.ModifyHLS(1, 2, 1); }, {255, 255, 255}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.ModifyHLS(1, 0.5, 1); }, {128, 0, 0}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.ModifyHLS(1, -1, 1); }, {0, 0, 0}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.ModifyHLS(1, kNaN, 1); }, {0, 0, 0}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.Lighten(100); }, {255, 255, 255}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.Lighten(-50); }, {128, 0, 0}},
        {qRgb(255, 0, 0), [](pcDibSection& d) { d.Lighten(-300); }, {0, 0, 0}},
    };
    for (const auto& c : cases) {
        pcDibSection dib;
        ASSERT_TRUE(dib.Create(1, 1));
        dib.hdc()->setPixel(0, 0, c.in);
        c.op(dib);
        EXPECT_EQ(pixelOf(dib, 0, 0), c.out) << &c - cases;
    }

    pcDibSection colour, greys;
    ASSERT_TRUE(colour.Create(16, 16) && greys.Create(16, 16));
    colour.RandomiseBits(false);
    greys.RandomiseBits(true);
    std::set<int> distinct;
    for (int i = 0; i < 256; ++i) {
        const RgbColor c = pixelOf(colour, i % 16, i / 16), g = pixelOf(greys, i % 16, i / 16);
        distinct.insert(c.r << 8 | c.g);
        EXPECT_TRUE(c.b == 0 && g.r == g.g && g.g == g.b) << i;
    }
    EXPECT_GT(distinct.size(), 200u);
}

TEST(DibSection, ScanLinesArePaddedAndPicturesCopyInAndOut) {
    for (const auto& [width, bytes] : {std::pair{1, 4}, {4, 12}, {5, 16}, {8, 24}}) {
        pcDibSection dib;
        ASSERT_TRUE(dib.Create(width, 3));
        EXPECT_EQ(dib.BytesPerScanLine(), bytes) << width;
        EXPECT_EQ(dib.hdc()->constScanLine(1) - dib.hdc()->constScanLine(0), bytes) << width;
        EXPECT_EQ(pixelOf(dib, width - 1, 2), (RgbColor{0, 0, 0}));
    }
    pcDibSection dib;
    EXPECT_FALSE(dib.Create(0, 10));
    EXPECT_EQ(dib.DIBSectionBitsPtr(), nullptr);
    dib.Fade(10); // nothing to work on, and no crash

    // An odd width, so that each scan line is padded.
    QImage src(37, 23, QImage::Format_RGB32);
    for (int y = 0; y < 23; ++y)
        for (int x = 0; x < 37; ++x)
            src.setPixel(x, y, qRgb(x * 7, y * 11, (x * y * 3 + 40) % 256));
    ASSERT_TRUE(dib.CreateFromPicture(src));
    QImage out(src.size(), QImage::Format_RGB32);
    QPainter p(&out);
    dib.PaintPicture(p);
    p.end();
    EXPECT_EQ(out, src);

    // The clipboard takes a bitmap, but no DIB.
    FakePlatform fake;
    QGuiApplication::clipboard()->setText(QStringLiteral("before"));
    EXPECT_FALSE(dib.CopyToClipboard(fake.dialogs, true));
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"lum | I don't know how to put a DIB on the clipboard! "
                                            "Copy as bitmap instead!!! | Ok | None"});
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "before");
    EXPECT_TRUE(dib.CopyToClipboard(fake.dialogs));
    EXPECT_EQ(QGuiApplication::clipboard()->image().convertToFormat(QImage::Format_RGB32), src);
    EXPECT_FALSE(pcDibSection().CopyToClipboard(fake.dialogs));

    ASSERT_TRUE(dib.Create(4, 4));
    dib.LoadPictureBlt(src, 10, 3);
    EXPECT_EQ(pixelOf(dib, 1, 0), (RgbColor{77, 33, 139})); // src at (11, 3)
}

TEST(MemDC, GrowsOnlyWhenARequestDoesNotFitAndDrawsOneRectangle) {
    pcMemDC mem;
    EXPECT_EQ(mem.hdc(0, 0), nullptr);
    QImage* surface = mem.hdc(10, 10);
    surface->fill(qRgb(0, 0, 255));
    surface->setPixel(2, 3, qRgb(255, 0, 0));
    // Fits: the same surface, content kept; otherwise anew at exactly the request.
    EXPECT_EQ(mem.hdc(8, 10)->pixel(2, 3), qRgb(255, 0, 0));
    QImage target(120, 120, QImage::Format_RGB32);
    target.fill(Qt::white);
    QPainter p(&target);
    mem.Draw(p, 2, 3, 4, 4, 115, 115); // a part, at an offset
    mem.Draw(p);                       // 0 sizes: all of it
    p.end();
    // Red where the part starts, blue within, white beyond either.
    for (const auto& [x, y, colour] : {std::tuple{115, 115, qRgb(255, 0, 0)},
                                       {118, 118, qRgb(0, 0, 255)},
                                       {119, 119, qRgb(255, 255, 255)},
                                       {9, 9, qRgb(0, 0, 255)},
                                       {10, 10, qRgb(255, 255, 255)}})
        EXPECT_EQ(target.pixel(x, y), colour) << x << "," << y;
    for (const QSize size : {QSize(12, 10), QSize(10, 11)}) {
        EXPECT_EQ(mem.hdc(size.width(), size.height())->size(), size);
        EXPECT_EQ(QSize(mem.Width(), mem.Height()), size);
    }
}
