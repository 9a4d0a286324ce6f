#include "support/FakePlatform.h"
#include "ui/Hls.h"
#include "ui/pcDibSection.h"
#include "ui/pcMemDC.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QPainter>

#include <cmath>
#include <limits>

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

pcDibSection dibOf(const QImage& img) {
    pcDibSection dib;
    EXPECT_TRUE(dib.CreateFromPicture(img));
    return dib;
}

} // namespace

TEST(Hls, ConvertsBothWaysWithHueFromMinusOneToFive) {
    struct Case {
        int r, g, b;
        float h, l, s;
    };
    const Case cases[] = {
        {255, 0, 0, 0, 0.5f, 1},    {0, 255, 0, 2, 0.5f, 1},  {0, 0, 255, 4, 0.5f, 1},
        {255, 0, 255, -1, 0.5f, 1}, {255, 255, 255, 0, 1, 0}, {51, 51, 51, 0, 0.2f, 0},
    };
    for (const Case& c : cases) {
        const HlsColor hls = RGBToHLS(c.r, c.g, c.b);
        EXPECT_NEAR(hls.h, c.h, 1e-5) << c.r << "," << c.g << "," << c.b;
        EXPECT_NEAR(hls.l, c.l, 1e-5) << c.r << "," << c.g << "," << c.b;
        EXPECT_NEAR(hls.s, c.s, 1e-5) << c.r << "," << c.g << "," << c.b;
        EXPECT_EQ(HLSToRGB(hls.h, hls.s, hls.l), (RgbColor{c.r, c.g, c.b}));
    }
    for (int r = 0; r < 256; r += 15)
        for (int g = 0; g < 256; g += 15)
            for (int b = 0; b < 256; b += 15) {
                const HlsColor hls = RGBToHLS(r, g, b);
                const RgbColor back = HLSToRGB(hls.h, hls.s, hls.l);
                ASSERT_LE(std::abs(back.r - r) + std::abs(back.g - g) + std::abs(back.b - b), 1)
                    << r << "," << g << "," << b;
            }
}

TEST(Hls, ChannelsRoundHalfToEvenAndClamp) {
    const std::pair<double, int> cases[] = {{126.5, 126}, {127.5, 128}, {-3, 0},
                                            {300, 255},   {kNaN, 0},    {HUGE_VAL, 255}};
    for (const auto& [value, channel] : cases)
        EXPECT_EQ(toChannel(value), channel) << value;
    EXPECT_EQ(HLSToRGB(0, 0, 2.0), (RgbColor{255, 255, 255}));
    EXPECT_EQ(HLSToRGB(7, 1, -1.0), (RgbColor{0, 0, 0}));
}

TEST(DibSection, ScanLinesArePaddedToFourBytes) {
    const std::pair<int, int> cases[] = {{1, 4}, {3, 12}, {4, 12}, {5, 16}, {8, 24}};
    for (const auto& [width, bytes] : cases) {
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
}

TEST(DibSection, PicturesCopyInAndOut) {
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

TEST(DibSection, FadeScalesChannelsAndClamps) {
    QImage img(1, 1, QImage::Format_RGB32);
    img.setPixel(0, 0, qRgb(255, 1, 200));
    const std::pair<int, RgbColor> cases[] = {
        {128, {128, 0, 100}}, {255, {255, 1, 200}},
        {0, {0, 0, 0}},       {1000, {255, 3, 255}},
        {-40, {0, 0, 0}},     {std::numeric_limits<int>::max(), {255, 255, 255}}};
    for (const auto& [amount, expected] : cases) {
        pcDibSection dib = dibOf(img);
        dib.Fade(amount);
        EXPECT_EQ(pixelOf(dib, 0, 0), expected) << amount;
    }
}

TEST(DibSection, ModifyHlsAndLighten) {
    const QImage src = gradient();
    pcDibSection same = dibOf(src), grey = dibOf(src), bright = dibOf(src), lighter = dibOf(src);
    same.ModifyHLS(1, 1, 1);
    grey.ModifyHLS(1, 1, 0);
    bright.ModifyHLS(1, 2, 1);
    lighter.Lighten(100); // the same doubling
    for (int y = 0; y < src.height(); ++y)
        for (int x = 0; x < src.width(); ++x) {
            const RgbColor o = rgbOf(src.pixel(x, y));
            const HlsColor hls = RGBToHLS(o.r, o.g, o.b);
            const RgbColor s = pixelOf(same, x, y);
            ASSERT_LE(std::abs(s.r - o.r) + std::abs(s.g - o.g) + std::abs(s.b - o.b), 1);
            const int level = toChannel(hls.l * 255.0);
            ASSERT_EQ(pixelOf(grey, x, y), (RgbColor{level, level, level}));
            if (hls.l >= 0.5f) {
                ASSERT_EQ(pixelOf(bright, x, y), (RgbColor{255, 255, 255}));
            }
            ASSERT_EQ(pixelOf(bright, x, y), pixelOf(lighter, x, y));
        }

    // Factors and amounts out of range give black, never wrapped or undefined values.
    pcDibSection negative = dibOf(src), dark = dibOf(src), undefined = dibOf(src);
    negative.ModifyHLS(1, -1, 1);
    dark.Lighten(-300);
    undefined.ModifyHLS(1, kNaN, 1);
    for (const pcDibSection* dib : {&negative, &dark, &undefined})
        for (int y = 0; y < src.height(); ++y)
            for (int x = 0; x < src.width(); ++x)
                ASSERT_EQ(pixelOf(*dib, x, y), (RgbColor{0, 0, 0}));
}

TEST(DibSection, RandomiseBits) {
    pcDibSection colour, again, grey;
    ASSERT_TRUE(colour.Create(16, 16) && again.Create(16, 16) && grey.Create(16, 16));
    colour.RandomiseBits(false, 42);
    again.RandomiseBits(false, 42);
    grey.RandomiseBits(true);
    EXPECT_EQ(*colour.hdc(), *again.hdc());
    int distinct = 0;
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x) {
            EXPECT_EQ(pixelOf(colour, x, y).b, 0);
            distinct += !(pixelOf(colour, x, y) == pixelOf(colour, 0, 0));
            const RgbColor g = pixelOf(grey, x, y);
            EXPECT_TRUE(g.r == g.g && g.g == g.b);
        }
    EXPECT_GT(distinct, 200);
}

TEST(DibSection, CopyToClipboard) {
    FakePlatform fake;
    pcDibSection dib = dibOf(gradient(6, 5));
    QGuiApplication::clipboard()->setText(QStringLiteral("before"));

    EXPECT_FALSE(dib.CopyToClipboard(fake.dialogs, true));
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    const FakeDialogs::Box& box = fake.dialogs.boxes[0];
    EXPECT_EQ(box.text,
              "I don't know how to put a DIB on the clipboard! Copy as bitmap instead!!!");
    EXPECT_EQ(box.title, "lum");
    EXPECT_EQ(box.buttons, MsgButtons::Ok);
    EXPECT_EQ(box.icon, MsgIcon::None);
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "before");

    EXPECT_TRUE(dib.CopyToClipboard(fake.dialogs));
    EXPECT_EQ(QGuiApplication::clipboard()->image().convertToFormat(QImage::Format_RGB32),
              gradient(6, 5));
    EXPECT_FALSE(pcDibSection().CopyToClipboard(fake.dialogs));
}

TEST(MemDC, GrowsOnlyWhenARequestDoesNotFit) {
    pcMemDC mem;
    EXPECT_EQ(mem.hdc(0, 0), nullptr);
    mem.hdc(100, 20)->setPixel(99, 19, qRgb(1, 2, 3));
    struct Step {
        int w, h, expectW, expectH;
    };
    // Fits: the same surface, content kept; otherwise anew at exactly the request.
    const Step steps[] = {{80, 20, 100, 20}, {120, 20, 120, 20}, {100, 30, 100, 30}};
    for (const Step& s : steps) {
        QImage* surface = mem.hdc(s.w, s.h);
        ASSERT_NE(surface, nullptr);
        EXPECT_EQ(surface->size(), QSize(s.expectW, s.expectH)) << s.w << "x" << s.h;
        EXPECT_EQ(mem.Width(), s.expectW);
        if (s.w == 80) {
            EXPECT_EQ(surface->pixel(99, 19), qRgb(1, 2, 3));
        }
    }
}

TEST(MemDC, DrawCopiesOneRectangle) {
    pcMemDC mem;
    QImage* surface = mem.hdc(10, 10);
    surface->fill(qRgb(0, 0, 255));
    surface->setPixel(2, 3, qRgb(255, 0, 0));
    QImage target(20, 20, QImage::Format_RGB32);
    target.fill(Qt::white);
    QPainter p(&target);
    mem.Draw(p, 2, 3, 4, 4, 15, 15); // a part, at an offset
    mem.Draw(p);                     // 0 sizes: all of it
    p.end();
    EXPECT_EQ(target.pixel(15, 15), qRgb(255, 0, 0));
    EXPECT_EQ(target.pixel(18, 18), qRgb(0, 0, 255));
    EXPECT_EQ(target.pixel(19, 19), qRgb(255, 255, 255));
    EXPECT_EQ(target.pixel(9, 9), qRgb(0, 0, 255));
    EXPECT_EQ(target.pixel(10, 10), qRgb(255, 255, 255));
}
