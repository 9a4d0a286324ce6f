#include "ui/PictureBox.h"
#include "ui/cLogo.h"
#include "ui/cTextBoxXP.h"

#include <QLineEdit>

#include <gtest/gtest.h>

TEST(GradientBands, BandHeightAndCount) {
    const struct {
        int height, band;
        size_t count;
    } cases[] = {{300, 1, 301}, {100, 1, 101}, {600, 2, 301}, {255, 1, 256}, {1, 1, 2}};
    for (const auto& c : cases) {
        const auto bands = gradientBands(c.height, 0, 0, 0, 255, 255, 255);
        ASSERT_EQ(bands.size(), c.count) << c.height;
        EXPECT_EQ(bands.front().bottom, c.height);
        EXPECT_EQ(bands.front().bottom - bands.front().top, c.band);
        EXPECT_LT(bands.back().top, 0) << "the last band reaches above the top edge";
    }
    EXPECT_TRUE(gradientBands(0, 0, 0, 0, 1, 1, 1).empty());
}

TEST(GradientBands, RunsFromTheStartColourAtTheBottomTowardsTheEnd) {
    const auto bands = gradientBands(255, 0, 0, 0, 255, 255, 255);
    // The two bottom rows have the start colour; the top row is (253, 253, 253).
    EXPECT_EQ(bands[0].red, 0);
    EXPECT_EQ(bands[1].red, 0);
    EXPECT_EQ(bands[1].top, 253);
    EXPECT_EQ(bands[254].top, 0);
    EXPECT_EQ(bands[254].red, 253);
    EXPECT_EQ(bands[254].blue, 253);
    // Halves round to even: with d = 6 over 4 rows, 1.5 gives 2 and 4.5 gives 4.
    const auto halves = gradientBands(4, 0, 0, 10, 6, 0, 0);
    ASSERT_EQ(halves.size(), 5u);
    EXPECT_EQ(halves[2].red, 2);  // (4 - 3) * 6 / 4 = 1.5
    EXPECT_EQ(halves[3].red, 3);  // 3.0
    EXPECT_EQ(halves[4].red, 4);  // 4.5
    EXPECT_EQ(halves[3].blue, 5); // 10 + 2 * -10 / 4
}

TEST(cLogo, RedrawsOnlyWhenAColourChanges) {
    PictureBox box;
    box.resize(20, 255);
    cLogo logo;
    logo.setStartColor(0);
    logo.setDrawingObject(&box);
    logo.setCaption("Settings");
    EXPECT_EQ(logo.drawCount(), 0); // neither the object nor the caption redraws
    logo.setStartColor(0);
    EXPECT_EQ(logo.drawCount(), 0);
    logo.setEndColor(0xFFFFFF);
    EXPECT_EQ(logo.drawCount(), 1);
    logo.setEndColor(0xFFFFFF);
    EXPECT_EQ(logo.drawCount(), 1);
    logo.Draw();
    // Pixels: black at the bottom, nearly white at the top.
    const QImage& image = box.image();
    EXPECT_EQ(image.pixelColor(10, 254), QColor(0, 0, 0));
    EXPECT_EQ(image.pixelColor(10, 0), QColor(253, 253, 253));
}

TEST(cLogo, CaptionIsWrittenUpwardsFromNearTheBottom) {
    PictureBox box;
    box.resize(30, 300);
    box.setForeColor(0xFFFFFF);
    cLogo logo;
    logo.setDrawingObject(&box);
    logo.setStartColor(0);
    logo.setEndColor(0);
    logo.setCaption("Paddles / Audio");
    logo.Draw();
    const QImage& image = box.image();
    int lowest = -1, highest = -1;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            if (qGray(image.pixel(x, y)) > 128) {
                if (highest < 0)
                    highest = y;
                lowest = y;
            }
    ASSERT_GE(lowest, 0) << "the caption shows";
    EXPECT_LE(lowest, 300 - 16);
    EXPECT_GT(lowest, 300 - 16 - 8);
    EXPECT_LT(highest, 300 - 16 - 50); // it runs a long way up
}

TEST(cTextBoxXP, ShowsOneTipWithIconTitleAndLines) {
    QLineEdit edit;
    edit.show();
    cTextBoxXP first;
    first.setTextBox(&edit);
    first.setBalloonTipIcon(3);
    first.setBalloonTipTitle("Zero");
    first.setBalloonTipText("one\r\ntwo");
    first.ShowBalloonTip();
    cTextBoxXP second;
    second.setTextBox(&edit);
    second.setBalloonTipIcon(1);
    second.setBalloonTipTitle("Help");
    second.setBalloonTipText("line");
    second.ShowBalloonTip();
    BalloonTip* tip = cTextBoxXP::shownOn(&edit);
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->title(), "Help");
    EXPECT_EQ(tip->icon(), 1);
    second.HideBalloonTip();
    EXPECT_EQ(cTextBoxXP::shownOn(&edit), nullptr);

    second.setCueBanner("search");
    EXPECT_EQ(edit.placeholderText(), "search");
}
