#include "ui/PictureBox.h"
#include "ui/cLogo.h"
#include "ui/cTextBoxXP.h"

#include <QLineEdit>

#include <gtest/gtest.h>

TEST(GradientBands, RunFromTheStartColourAtTheBottomPastTheTopEdge) {
    // {strip height, band height, bands}: the band is height / 255, at least 1.
    for (const auto& [height, band, count] :
         {std::tuple{300, 1, 301}, {100, 1, 101}, {600, 2, 301}, {1, 1, 2}}) {
        const auto bands = gradientBands(height, 0, 0, 0, 255, 255, 255);
        ASSERT_EQ(int(bands.size()), count) << height;
        EXPECT_EQ(std::tuple(bands.front().bottom, bands.front().top, bands.back().top < 0),
                  std::tuple(height, height - band, true)); // the last above the top edge
    }
    EXPECT_TRUE(gradientBands(0, 0, 0, 0, 1, 1, 1).empty());
    // Halves round to even: with d = 6 over 4 rows, 1.5 gives 2 and 4.5 gives 4; the first
    // two bands both have the start colour.
    std::string redBlue;
    for (const GradientBand& b : gradientBands(4, 0, 0, 10, 6, 0, 0))
        redBlue += std::to_string(b.red) + "," + std::to_string(b.blue) + " ";
    EXPECT_EQ(redBlue, "0,10 0,10 2,8 3,5 4,2 ");
}

TEST(cLogo, RedrawsOnlyWhenAColourChangesAndWritesTheCaptionUpwards) {
    PictureBox box;
    box.resize(30, 255);
    box.setForeColor(0xFFFFFF);
    cLogo logo;
    logo.setDrawingObject(&box);
    logo.setCaption("Paddles / Audio");
    logo.setStartColor(0);
    EXPECT_EQ(logo.drawCount(), 0); // neither the object, the caption nor the same colour
    logo.setEndColor(0xFFFFFF);
    logo.setEndColor(0xFFFFFF);
    // Drawn once: black at the bottom, nearly white at the top.
    EXPECT_EQ(std::tuple(logo.drawCount(), box.image().pixel(29, 254), box.image().pixel(29, 0)),
              std::tuple(1, qRgb(0, 0, 0), qRgb(253, 253, 253)));

    // On black, the caption starts 16 pixels above the bottom edge and runs a long way up.
    logo.setEndColor(0);
    std::vector<int> lit; // the rows the caption reaches, from the top
    for (int y = 0; y < 255; ++y)
        for (int x = 0; x < 30; ++x)
            if (qGray(box.image().pixel(x, y)) > 128)
                lit.push_back(y);
    EXPECT_TRUE(!lit.empty() && lit.back() <= 255 - 16 && lit.back() > 255 - 16 - 8 &&
                lit.front() < 255 - 16 - 50);
}

// A tip shown on a control replaces the one already there.
TEST(cTextBoxXP, ShowsOneTipAtATime) {
    QLineEdit edit;
    edit.show();
    for (const auto& [icon, title] : {std::pair{3, "Zero"}, {1, "Help"}}) {
        cTextBoxXP tip;
        tip.setTextBox(&edit);
        tip.setBalloonTipIcon(icon);
        tip.setBalloonTipTitle(title);
        tip.ShowBalloonTip();
    }
    const BalloonTip* tip = cTextBoxXP::shownOn(&edit);
    EXPECT_EQ(tip ? tip->title() + QString::number(tip->icon()) : "no tip", "Help1");
}
