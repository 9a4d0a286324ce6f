#include "ui/Hls.h"
#include "ui/pcMemDC.h"

#include <QPainter>

#include <cmath>

#include <gtest/gtest.h>

TEST(Hls, ConvertsBothWaysAndKeepsChannelsWithinAByte) {
    // Every colour comes back as it was, from each sixth of the hue circle.
    for (int r = 0; r < 256; r += 15)
        for (int g = 0; g < 256; g += 15)
            for (int b = 0; b < 256; b += 15) {
                const HlsColor hls = RGBToHLS(r, g, b);
                ASSERT_EQ(HLSToRGB(hls.h, hls.s, hls.l), (RgbColor{r, g, b}));
            }
    // Channels round half to even and stay within a byte, whatever comes in.
    for (const auto& [value, channel] :
         {std::pair{126.5, 126}, {127.5, 128}, {-3.0, 0}, {300.0, 255}, {NAN, 0}, {HUGE_VAL, 255}})
        EXPECT_EQ(toChannel(value), channel) << value;
}

// The bar paints through it: a surface that fits is kept, content and all; one that does
// not is made anew at exactly the request.
TEST(MemDC, GrowsOnlyWhenARequestDoesNotFit) {
    pcMemDC mem;
    EXPECT_EQ(mem.hdc(0, 0), nullptr);
    mem.hdc(10, 10)->fill(qRgb(0, 0, 255));
    mem.hdc(8, 10)->setPixel(2, 3, qRgb(255, 0, 0));
    QImage target(12, 12, QImage::Format_RGB32);
    target.fill(Qt::white);
    QPainter p(&target);
    mem.Draw(p);
    p.end();
    EXPECT_EQ(target.pixel(2, 3), qRgb(255, 0, 0));
    EXPECT_EQ(target.pixel(9, 9), qRgb(0, 0, 255)); // the first surface, kept
    EXPECT_EQ(target.pixel(10, 10), qRgb(255, 255, 255));
    for (const QSize size : {QSize(12, 10), QSize(10, 11)})
        EXPECT_EQ(mem.hdc(size.width(), size.height())->size(), size);
}
