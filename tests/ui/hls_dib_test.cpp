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

// A picture whose pixels run through many colours, so the pixel operations meet reds,
// greys, darks and lights alike.
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

pcDibSection dibOf(const QImage& img) {
    pcDibSection dib;
    EXPECT_TRUE(dib.CreateFromPicture(img));
    return dib;
}

} // namespace

TEST(Hls, PrimaryAndGreyColoursConvert) {
    struct Case {
        int r, g, b;
        float h, l, s;
    };
    const Case cases[] = {
        {255, 0, 0, 0.0f, 0.5f, 1.0f},     {0, 255, 0, 2.0f, 0.5f, 1.0f},
        {0, 0, 255, 4.0f, 0.5f, 1.0f},     {255, 0, 255, -1.0f, 0.5f, 1.0f}, // hue below 0
        {255, 255, 255, 0.0f, 1.0f, 0.0f}, {0, 0, 0, 0.0f, 0.0f, 0.0f},
        {51, 51, 51, 0.0f, 0.2f, 0.0f},    {255, 128, 128, 0.0f, 0.75098f, 1.0f},
    };
    for (const Case& c : cases) {
        const HlsColor hls = RGBToHLS(c.r, c.g, c.b);
        EXPECT_NEAR(hls.h, c.h, 1e-4) << c.r << "," << c.g << "," << c.b;
        EXPECT_NEAR(hls.l, c.l, 1e-4) << c.r << "," << c.g << "," << c.b;
        EXPECT_NEAR(hls.s, c.s, 1e-4) << c.r << "," << c.g << "," << c.b;
    }
    EXPECT_EQ(HLSToRGB(0.0, 1.0, 0.5), (RgbColor{255, 0, 0}));
}

TEST(Hls, RoundTripKeepsEveryColourOfAGrid) {
    for (int r = 0; r < 256; r += 15)
        for (int g = 0; g < 256; g += 15)
            for (int b = 0; b < 256; b += 15) {
                const HlsColor hls = RGBToHLS(r, g, b);
                const RgbColor back = HLSToRGB(hls.h, hls.s, hls.l);
                ASSERT_LE(std::abs(back.r - r), 1) << r << "," << g << "," << b;
                ASSERT_LE(std::abs(back.g - g), 1) << r << "," << g << "," << b;
                ASSERT_LE(std::abs(back.b - b), 1) << r << "," << g << "," << b;
            }
}

TEST(Hls, ChannelsRoundHalfToEvenAndStayInRange) {
    EXPECT_EQ(toChannel(126.5), 126);
    EXPECT_EQ(toChannel(127.5), 128);
    EXPECT_EQ(toChannel(0.49), 0);
    EXPECT_EQ(toChannel(-3.0), 0);
    EXPECT_EQ(toChannel(300.0), 255);
    EXPECT_EQ(toChannel(std::numeric_limits<double>::quiet_NaN()), 0);
    EXPECT_EQ(toChannel(std::numeric_limits<double>::infinity()), 255);
    // Scaled colours out of range come back clamped, not wrapped.
    EXPECT_EQ(HLSToRGB(0.0, 0.0, 2.0), (RgbColor{255, 255, 255}));
    EXPECT_EQ(HLSToRGB(0.0, 0.0, -0.5), (RgbColor{0, 0, 0}));
    EXPECT_EQ(HLSToRGB(7.0, 1.0, -1.0), (RgbColor{0, 0, 0}));
}

TEST(DibSection, ScanLinesArePaddedToFourBytes) {
    const std::pair<int, int> cases[] = {{1, 4}, {2, 8}, {3, 12}, {4, 12}, {5, 16}, {8, 24}};
    for (const auto& [width, bytes] : cases) {
        pcDibSection dib;
        ASSERT_TRUE(dib.Create(width, 3));
        EXPECT_EQ(dib.BytesPerScanLine(), bytes) << width;
        // The bytes really lie that way in memory.
        EXPECT_EQ(dib.hdc()->bytesPerLine(), bytes) << width;
        EXPECT_EQ(dib.hdc()->constScanLine(1) - dib.hdc()->constScanLine(0), bytes);
    }
}

TEST(DibSection, CreateFailsCleanlyAndClearUpEmpties) {
    pcDibSection dib;
    EXPECT_FALSE(dib.Create(0, 10));
    EXPECT_FALSE(dib.Create(10, -1));
    EXPECT_EQ(dib.DIBSectionBitsPtr(), nullptr);
    EXPECT_EQ(dib.Width(), 0);

    ASSERT_TRUE(dib.Create(4, 2));
    EXPECT_NE(dib.DIBSectionBitsPtr(), nullptr);
    EXPECT_EQ(pixelOf(dib, 3, 1), (RgbColor{0, 0, 0})); // starts black
    dib.ClearUp();
    EXPECT_EQ(dib.hdc(), nullptr);
    EXPECT_EQ(dib.Height(), 0);
    dib.Fade(10); // no picture: nothing to do, and no crash
    dib.ModifyHLS(1, 1, 1);
}

TEST(DibSection, PicturesCopyInAndOut) {
    const QImage src = gradient();
    pcDibSection dib = dibOf(src);
    EXPECT_EQ(dib.Width(), src.width());
    EXPECT_EQ(pixelOf(dib, 5, 7), (RgbColor{35, 77, 145}));

    QImage out(src.size(), QImage::Format_RGB32);
    out.fill(Qt::white);
    QPainter p(&out);
    dib.PaintPicture(p);
    p.end();
    EXPECT_EQ(out, src);

    // From an offset, into a part of the picture.
    pcDibSection part;
    ASSERT_TRUE(part.Create(4, 4));
    part.LoadPictureBlt(src, 10, 3);
    EXPECT_EQ(pixelOf(part, 0, 0), (RgbColor{qRed(src.pixel(10, 3)), qGreen(src.pixel(10, 3)),
                                             qBlue(src.pixel(10, 3))}));
}

TEST(DibSection, FadeScalesEveryChannelAndClamps) {
    QImage img(4, 1, QImage::Format_RGB32);
    img.setPixel(0, 0, qRgb(255, 1, 0));
    img.setPixel(1, 0, qRgb(128, 200, 2));
    img.setPixel(2, 0, qRgb(254, 255, 100));
    img.setPixel(3, 0, qRgb(3, 60, 90));
    struct Case {
        int amount;
        RgbColor first, second;
    };
    const Case cases[] = {
        {128, {128, 0, 0}, {64, 100, 1}},
        {255, {255, 1, 0}, {128, 200, 2}},
        {0, {0, 0, 0}, {0, 0, 0}},
        {1000, {255, 3, 0}, {255, 255, 7}}, // above 255 brightens, kept within 255
        {-40, {0, 0, 0}, {0, 0, 0}},
        {std::numeric_limits<int>::max(), {255, 255, 0}, {255, 255, 255}},
    };
    for (const Case& c : cases) {
        pcDibSection dib = dibOf(img);
        dib.Fade(c.amount);
        EXPECT_EQ(pixelOf(dib, 0, 0), c.first) << c.amount;
        EXPECT_EQ(pixelOf(dib, 1, 0), c.second) << c.amount;
    }
}

TEST(DibSection, ModifyHlsFactors) {
    const QImage src = gradient();

    pcDibSection same = dibOf(src);
    same.ModifyHLS(1.0, 1.0, 1.0);
    for (int y = 0; y < src.height(); ++y)
        for (int x = 0; x < src.width(); ++x) {
            const RgbColor c = pixelOf(same, x, y);
            const QRgb o = src.pixel(x, y);
            ASSERT_LE(
                std::abs(c.r - qRed(o)) + std::abs(c.g - qGreen(o)) + std::abs(c.b - qBlue(o)), 2);
        }

    pcDibSection grey = dibOf(src);
    grey.ModifyHLS(1.0, 1.0, 0.0);
    for (int y = 0; y < src.height(); ++y)
        for (int x = 0; x < src.width(); ++x) {
            const RgbColor c = pixelOf(grey, x, y);
            const QRgb o = src.pixel(x, y);
            ASSERT_EQ(c.r, c.g);
            ASSERT_EQ(c.g, c.b);
            ASSERT_EQ(c.r, toChannel(RGBToHLS(qRed(o), qGreen(o), qBlue(o)).l * 255.0));
        }

    pcDibSection bright = dibOf(src);
    bright.ModifyHLS(1.0, 2.0, 1.0);
    pcDibSection lighter = dibOf(src);
    lighter.Lighten(100); // the same doubling
    for (int y = 0; y < src.height(); ++y)
        for (int x = 0; x < src.width(); ++x) {
            const QRgb o = src.pixel(x, y);
            if (RGBToHLS(qRed(o), qGreen(o), qBlue(o)).l >= 0.5f) {
                ASSERT_EQ(pixelOf(bright, x, y), (RgbColor{255, 255, 255}));
            }
            ASSERT_EQ(pixelOf(bright, x, y), pixelOf(lighter, x, y));
        }
}

TEST(DibSection, OutOfRangeFactorsGiveBlackNotGarbage) {
    const QImage src = gradient();
    auto allBlack = [](const pcDibSection& dib) {
        for (int y = 0; y < dib.Height(); ++y)
            for (int x = 0; x < dib.Width(); ++x)
                if (!(pixelOf(dib, x, y) == RgbColor{0, 0, 0}))
                    return false;
        return true;
    };
    pcDibSection negative = dibOf(src);
    negative.ModifyHLS(1.0, -1.0, 1.0);
    EXPECT_TRUE(allBlack(negative));
    pcDibSection dark = dibOf(src);
    dark.Lighten(-300);
    EXPECT_TRUE(allBlack(dark));
    pcDibSection nan = dibOf(src);
    nan.ModifyHLS(1.0, std::numeric_limits<double>::quiet_NaN(), 1.0);
    EXPECT_TRUE(allBlack(nan));
}

TEST(DibSection, RandomiseBits) {
    pcDibSection colour;
    ASSERT_TRUE(colour.Create(16, 16));
    colour.RandomiseBits(false, 42);
    pcDibSection again;
    ASSERT_TRUE(again.Create(16, 16));
    again.RandomiseBits(false, 42);
    EXPECT_EQ(*colour.hdc(), *again.hdc());
    bool varied = false;
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x) {
            EXPECT_EQ(pixelOf(colour, x, y).b, 0);
            varied |= !(pixelOf(colour, x, y) == pixelOf(colour, 0, 0));
        }
    EXPECT_TRUE(varied);

    pcDibSection grey;
    ASSERT_TRUE(grey.Create(16, 16));
    grey.RandomiseBits(true);
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x) {
            const RgbColor c = pixelOf(grey, x, y);
            EXPECT_TRUE(c.r == c.g && c.g == c.b);
        }
}

TEST(DibSection, CopyToClipboard) {
    FakePlatform fake;
    pcDibSection dib = dibOf(gradient(6, 5));
    QGuiApplication::clipboard()->setText(QStringLiteral("before"));

    EXPECT_FALSE(dib.CopyToClipboard(fake.dialogs, true));
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text,
              "I don't know how to put a DIB on the clipboard! Copy as bitmap instead!!!");
    EXPECT_EQ(fake.dialogs.boxes[0].title, "lum");
    EXPECT_EQ(fake.dialogs.boxes[0].buttons, MsgButtons::Ok);
    EXPECT_EQ(fake.dialogs.boxes[0].icon, MsgIcon::None);
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "before");

    EXPECT_TRUE(dib.CopyToClipboard(fake.dialogs));
    EXPECT_EQ(QGuiApplication::clipboard()->image().convertToFormat(QImage::Format_RGB32),
              gradient(6, 5));
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);

    pcDibSection empty;
    EXPECT_FALSE(empty.CopyToClipboard(fake.dialogs));
}

TEST(MemDC, GrowsOnlyWhenARequestDoesNotFit) {
    pcMemDC mem;
    EXPECT_EQ(mem.hdc(0, 0), nullptr);
    EXPECT_EQ(mem.Width(), 0);

    QImage* first = mem.hdc(100, 20);
    ASSERT_NE(first, nullptr);
    first->setPixel(99, 19, qRgb(1, 2, 3));

    struct Step {
        int w, h;
        int expectW, expectH;
        bool sameContent;
    };
    const Step steps[] = {
        {80, 20, 100, 20, true},   // fits: the same surface, content kept
        {100, 20, 100, 20, true},  // exactly fits
        {120, 20, 120, 20, false}, // wider: made anew at exactly the request
        {100, 30, 100, 30, false}, // taller: anew, and narrower again
        {0, 0, 100, 30, true},
    };
    for (const Step& s : steps) {
        QImage* surface = mem.hdc(s.w, s.h);
        ASSERT_NE(surface, nullptr);
        EXPECT_EQ(mem.Width(), s.expectW) << s.w << "x" << s.h;
        EXPECT_EQ(mem.Height(), s.expectH) << s.w << "x" << s.h;
        EXPECT_EQ(surface->size(), QSize(s.expectW, s.expectH));
        if (s.sameContent && s.w == 80) {
            EXPECT_EQ(surface->pixel(99, 19), qRgb(1, 2, 3));
        }
    }
}

TEST(MemDC, DrawCopiesOneRectangle) {
    pcMemDC mem;
    QImage* surface = mem.hdc(10, 10);
    ASSERT_NE(surface, nullptr);
    surface->fill(qRgb(0, 0, 255));
    surface->setPixel(2, 3, qRgb(255, 0, 0));

    QImage target(20, 20, QImage::Format_RGB32);
    target.fill(Qt::white);
    QPainter p(&target);
    mem.Draw(p, 2, 3, 4, 4, 15, 15); // a part, at an offset
    mem.Draw(p);                     // all of it at (0, 0)
    p.end();
    EXPECT_EQ(target.pixel(15, 15), qRgb(255, 0, 0));
    EXPECT_EQ(target.pixel(18, 18), qRgb(0, 0, 255));
    EXPECT_EQ(target.pixel(19, 19), qRgb(255, 255, 255));
    EXPECT_EQ(target.pixel(9, 9), qRgb(0, 0, 255));
    EXPECT_EQ(target.pixel(10, 10), qRgb(255, 255, 255));
}
