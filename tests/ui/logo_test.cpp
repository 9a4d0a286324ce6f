#include "ui/PictureBox.h"
#include "ui/cLogo.h"
#include "ui/cTextBoxXP.h"

#include <QLineEdit>

#include <gtest/gtest.h>

TEST(GradientBands, RunFromTheStartColourAtTheBottomPastTheTopEdge) {
    // {strip height, band height, bands}: the band is height / 255, at least 1.
    for (const auto& [height, band, count] :
         {std::tuple{300, 1, 301u}, {100, 1, 101u}, {600, 2, 301u}, {1, 1, 2u}}) {
        const auto bands = gradientBands(height, 0, 0, 0, 255, 255, 255);
        ASSERT_EQ(bands.size(), count) << height;
        EXPECT_EQ(bands.front().bottom, height);
        EXPECT_EQ(bands.front().bottom - bands.front().top, band);
        EXPECT_LT(bands.back().top, 0) << "the last band reaches above the top edge";
    }
    EXPECT_TRUE(gradientBands(0, 0, 0, 0, 1, 1, 1).empty());

    // Halves round to even: with d = 6 over 4 rows, 1.5 gives 2 and 4.5 gives 4; the first
    // two bands both have the start colour.
    const auto bands = gradientBands(4, 0, 0, 10, 6, 0, 0);
    ASSERT_EQ(bands.size(), 5u);
    std::vector<int> reds, blues;
    for (const GradientBand& b : bands) {
        reds.push_back(b.red);
        blues.push_back(b.blue);
    }
    EXPECT_EQ(reds, (std::vector<int>{0, 0, 2, 3, 4}));
    EXPECT_EQ(blues, (std::vector<int>{10, 10, 8, 5, 2}));
}

TEST(cLogo, RedrawsOnlyWhenAColourChangesAndWritesTheCaptionUpwards) {
    PictureBox box;
    box.resize(30, 255);
    box.setForeColor(0xFFFFFF);
    cLogo logo;
    logo.setStartColor(0);
    logo.setDrawingObject(&box);
    logo.setCaption("Paddles / Audio");
    EXPECT_EQ(logo.drawCount(), 0); // neither the object nor the caption redraws
    logo.setStartColor(0);
    EXPECT_EQ(logo.drawCount(), 0);
    logo.setEndColor(0xFFFFFF);
    logo.setEndColor(0xFFFFFF);
    EXPECT_EQ(logo.drawCount(), 1);
    // Black at the bottom, nearly white at the top.
    EXPECT_EQ(box.image().pixelColor(29, 254), QColor(0, 0, 0));
    EXPECT_EQ(box.image().pixelColor(29, 0), QColor(253, 253, 253));

    logo.setEndColor(0);
    const QImage& image = box.image();
    int lowest = -1, highest = -1;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            if (qGray(image.pixel(x, y)) > 128) {
                highest = highest < 0 ? y : highest;
                lowest = y;
            }
    // The caption starts 16 pixels above the bottom edge and runs a long way up.
    ASSERT_GE(lowest, 0) << "the caption shows";
    EXPECT_LE(lowest, 255 - 16);
    EXPECT_GT(lowest, 255 - 16 - 8);
    EXPECT_LT(highest, 255 - 16 - 50);
}

TEST(cTextBoxXP, ShowsOneTipAtATimeAndACueBanner) {
    QLineEdit edit;
    edit.show();
    for (const auto& [icon, title] : {std::pair{3, "Zero"}, {1, "Help"}}) {
        cTextBoxXP tip;
        tip.setTextBox(&edit);
        tip.setBalloonTipIcon(icon);
        tip.setBalloonTipTitle(title);
        tip.setBalloonTipText("one\r\ntwo");
        tip.ShowBalloonTip();
    }
    BalloonTip* tip = cTextBoxXP::shownOn(&edit);
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->title(), "Help");
    EXPECT_EQ(tip->icon(), 1);
    cTextBoxXP other;
    other.setTextBox(&edit);
    other.HideBalloonTip();
    EXPECT_EQ(cTextBoxXP::shownOn(&edit), nullptr);
    other.setCueBanner("search");
    EXPECT_EQ(edit.placeholderText(), "search");
}
