#include "settings/PictureFit.h"

#include <gtest/gtest.h>

#include <ostream>

static void PrintTo(const PictureFit& f, std::ostream* out) {
    *out << "{top " << f.top << ", left " << f.left << ", " << f.width << " x " << f.height << "}";
}

TEST(FitPictureToBox, FillsOneAxisAndCentresOnTheOther) {
    const struct {
        const char* what;
        QSizeF picture; // width x height
        float height, width;
        bool frame;
        float top, left;
        PictureFit fit;
    } cases[] = {
        {"wider than the box", {200, 100}, 1000, 1000, false, 0, 0, {250, 0, 1000, 500}},
        {"taller than the box", {100, 200}, 1000, 1000, false, 0, 0, {0, 250, 500, 1000}},
        {"same proportions", {300, 150}, 300, 600, false, 0, 0, {0, 0, 600, 300}},
        {"tiny picture is scaled up", {4, 3}, 600, 400, false, 0, 0, {150, 0, 400, 300}},
        // The preview window's first size, less its frame: 10990 x 5130 twips.
        {"outer size with frame", {640, 480}, 5655, 11115, true, 0, 0, {0, 2075, 6840, 5130}},
        {"frame, wide picture", {1000, 100}, 1525, 1125, true, 0, 0, {450, 0, 1000, 100}},
        // The caller's start is added on the axis that is centred and kept on the other.
        {"start offsets, wider", {200, 100}, 1000, 1000, false, 10, 20, {260, 20, 1000, 500}},
        {"start offsets, taller", {100, 200}, 1000, 1000, false, 10, 20, {10, 270, 500, 1000}},
    };
    for (const auto& c : cases) {
        const std::optional<PictureFit> fit =
            FitPictureToBox(c.picture, c.height, c.width, c.frame, c.top, c.left);
        ASSERT_TRUE(fit) << c.what;
        EXPECT_EQ(*fit, c.fit) << c.what;
    }
}

TEST(FitPictureToBox, NothingToFitOrNoRoomLeft) {
    EXPECT_FALSE(FitPictureToBox({0, 100}, 500, 500, false));
    EXPECT_FALSE(FitPictureToBox({100, 0}, 500, 500, false));
    EXPECT_FALSE(FitPictureToBox({}, 500, 500, false));
    // A window smaller than its frame: an empty target at the start, no division by 0.
    EXPECT_EQ(FitPictureToBox({100, 100}, 400, 2000, true), (PictureFit{0, 0, 0, 0}));
    EXPECT_EQ(FitPictureToBox({100, 100}, 2000, 125, true, 5, 6), (PictureFit{5, 6, 0, 0}));
    EXPECT_EQ(FitPictureToBox({100, 100}, 0, 0, false), (PictureFit{0, 0, 0, 0}));
}
