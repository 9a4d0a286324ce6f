#include "support/Boxes.h"
#include "ui/Hls.h"
#include "ui/pcDibSection.h"
#include "ui/pcMemDC.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QPainter>

#include <cmath>
#include <limits>
#include <set>

#include <gtest/gtest.h>

namespace {

const double kNaN = std::numeric_limits<double>::quiet_NaN();

// Pixels that run through reds, greys, darks and lights alike.
QImage gradient(int w = 37, int h = 23) {
    QImage img(w, h, QImage::Format_RGB32);
    for (int y = 0; y < h; ++y)
        for (int x = 0; x < w; ++x)
            img.setPixel(x, y, qRgb((x * 7) % 256, (y * 11) % 256, (x * y * 3 + 40) % 256));
    return img;
}

RgbColor pixelOf(const pcDibSection& dib, int x, int y) {
    const uchar* px = dib.hdc()->constScanLine(y) + 3 * x;
    return {px[2], px[1], px[0]};
}

RgbColor rgbOf(QRgb c) {
    return {qRed(c), qGreen(c), qBlue(c)};
}

int distance(RgbColor a, RgbColor b) {
    return std::abs(a.r - b.r) + std::abs(a.g - b.g) + std::abs(a.b - b.b);
}

pcDibSection dibOf(const QImage& img) {
    pcDibSection dib;
    EXPECT_TRUE(dib.CreateFromPicture(img));
    return dib;
}

} // namespace

TEST(Hls, ConvertsBothWaysWithHueFromMinusOneToFive) {
    const struct {
        RgbColor rgb;
        float h, l, s;
    } cases[] = {{{255, 0, 0}, 0, 0.5f, 1},  {{0, 255, 0}, 2, 0.5f, 1},
                 {{0, 0, 255}, 4, 0.5f, 1},  {{255, 0, 255}, -1, 0.5f, 1},
                 {{255, 255, 255}, 0, 1, 0}, {{51, 51, 51}, 0, 0.2f, 0}};
    for (const auto& c : cases) {
        const HlsColor hls = RGBToHLS(c.rgb.r, c.rgb.g, c.rgb.b);
        EXPECT_NEAR(hls.h, c.h, 1e-5) << c.rgb.r << "," << c.rgb.g << "," << c.rgb.b;
        EXPECT_NEAR(hls.l, c.l, 1e-5);
        EXPECT_NEAR(hls.s, c.s, 1e-5);
        EXPECT_EQ(HLSToRGB(hls.h, hls.s, hls.l), c.rgb);
    }
    // Channels round half to even and stay within a byte, whatever comes in.
    const std::pair<double, int> channels[] = {{126.5, 126}, {127.5, 128}, {-3, 0},
                                               {300, 255},   {kNaN, 0},    {HUGE_VAL, 255}};
    for (const auto& [value, channel] : channels)
        EXPECT_EQ(toChannel(value), channel) << value;
}

TEST(DibSection, ScanLinesArePaddedAndPicturesCopyInAndOut) {
    for (const auto& [width, bytes] : {std::pair{1, 4}, {4, 12}, {5, 16}, {8, 24}}) {
        pcDibSection dib;
        ASSERT_TRUE(dib.Create(width, 3));
        EXPECT_EQ(dib.BytesPerScanLine(), bytes) << width;
        EXPECT_EQ(dib.hdc()->constScanLine(1) - dib.hdc()->constScanLine(0), bytes) << width;
        EXPECT_EQ(pixelOf(dib, width - 1, 2), (RgbColor{0, 0, 0}));
    }
    pcDibSection empty;
    EXPECT_FALSE(empty.Create(0, 10));
    EXPECT_EQ(empty.DIBSectionBitsPtr(), nullptr);
    empty.Fade(10); // nothing to work on, and no crash

    const QImage src = gradient();
    pcDibSection dib = dibOf(src);
    EXPECT_EQ(pixelOf(dib, 5, 7), (RgbColor{35, 77, 145}));
    QImage out(src.size(), QImage::Format_RGB32);
    QPainter p(&out);
    dib.PaintPicture(p);
    p.end();
    EXPECT_EQ(out, src);
    ASSERT_TRUE(dib.Create(4, 4));
    dib.LoadPictureBlt(src, 10, 3);
    EXPECT_EQ(pixelOf(dib, 1, 0), rgbOf(src.pixel(11, 3)));
}

TEST(DibSection, PixelOperations) {
    QImage one(1, 1, QImage::Format_RGB32);
    one.setPixel(0, 0, qRgb(255, 1, 200));
    const std::pair<int, RgbColor> fades[] = {
        {128, {128, 0, 100}}, {255, {255, 1, 200}},
        {0, {0, 0, 0}},       {1000, {255, 3, 255}},
        {-40, {0, 0, 0}},     {std::numeric_limits<int>::max(), {255, 255, 255}}};
    for (const auto& [amount, expected] : fades) {
        pcDibSection dib = dibOf(one);
        dib.Fade(amount);
        EXPECT_EQ(pixelOf(dib, 0, 0), expected) << amount;
    }

    const QImage src = gradient();
    pcDibSection same = dibOf(src), grey = dibOf(src), bright = dibOf(src), lighter = dibOf(src);
    same.ModifyHLS(1, 1, 1);
    grey.ModifyHLS(1, 1, 0);
    bright.ModifyHLS(1, 2, 1);
    lighter.Lighten(100); // the same doubling
    // Factors and amounts out of range give black, never wrapped or undefined values.
    pcDibSection negative = dibOf(src), dark = dibOf(src), undefined = dibOf(src);
    negative.ModifyHLS(1, -1, 1);
    dark.Lighten(-300);
    undefined.ModifyHLS(1, kNaN, 1);
    for (int y = 0; y < src.height(); ++y)
        for (int x = 0; x < src.width(); ++x) {
            const RgbColor o = rgbOf(src.pixel(x, y));
            const HlsColor hls = RGBToHLS(o.r, o.g, o.b);
            ASSERT_LE(distance(pixelOf(same, x, y), o), 1) << x << "," << y;
            const int level = toChannel(hls.l * 255.0);
            ASSERT_EQ(pixelOf(grey, x, y), (RgbColor{level, level, level}));
            if (hls.l >= 0.5f) {
                ASSERT_EQ(pixelOf(bright, x, y), (RgbColor{255, 255, 255}));
            }
            ASSERT_EQ(pixelOf(bright, x, y), pixelOf(lighter, x, y));
            for (const pcDibSection* black : {&negative, &dark, &undefined})
                ASSERT_EQ(pixelOf(*black, x, y), (RgbColor{0, 0, 0}));
        }

    pcDibSection colour, greys;
    ASSERT_TRUE(colour.Create(16, 16) && greys.Create(16, 16));
    colour.RandomiseBits(false);
    greys.RandomiseBits(true);
    std::set<std::tuple<int, int, int>> distinct;
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x) {
            const RgbColor c = pixelOf(colour, x, y), g = pixelOf(greys, x, y);
            distinct.insert({c.r, c.g, c.b});
            EXPECT_EQ(c.b, 0);
            EXPECT_TRUE(g.r == g.g && g.g == g.b);
        }
    EXPECT_GT(distinct.size(), 200u);
}

TEST(DibSection, CopyToClipboard) {
    FakePlatform fake;
    pcDibSection dib = dibOf(gradient(6, 5));
    QGuiApplication::clipboard()->setText(QStringLiteral("before"));
    EXPECT_FALSE(dib.CopyToClipboard(fake.dialogs, true));
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"lum | I don't know how to put a DIB on the clipboard! "
                                            "Copy as bitmap instead!!! | Ok | None"});
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "before");

    EXPECT_TRUE(dib.CopyToClipboard(fake.dialogs));
    EXPECT_EQ(QGuiApplication::clipboard()->image().convertToFormat(QImage::Format_RGB32),
              gradient(6, 5));
    EXPECT_FALSE(pcDibSection().CopyToClipboard(fake.dialogs));
}

TEST(MemDC, GrowsOnlyWhenARequestDoesNotFitAndDrawsOneRectangle) {
    pcMemDC mem;
    EXPECT_EQ(mem.hdc(0, 0), nullptr);
    mem.hdc(100, 20)->setPixel(99, 19, qRgb(1, 2, 3));
    // Fits: the same surface, content kept; otherwise anew at exactly the request.
    EXPECT_EQ(mem.hdc(80, 20)->pixel(99, 19), qRgb(1, 2, 3));
    for (const QSize size : {QSize(120, 20), QSize(100, 30)}) {
        EXPECT_EQ(mem.hdc(size.width(), size.height())->size(), size);
        EXPECT_EQ(mem.Width(), size.width());
    }

    QImage* surface = mem.hdc(10, 10);
    surface->fill(qRgb(0, 0, 255));
    surface->setPixel(2, 3, qRgb(255, 0, 0));
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
                                       {99, 29, qRgb(0, 0, 255)},
                                       {100, 30, qRgb(255, 255, 255)}})
        EXPECT_EQ(target.pixel(x, y), colour) << x << "," << y;
}
