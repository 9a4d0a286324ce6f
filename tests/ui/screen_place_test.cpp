#include "ui/ScreenPlace.h"

#include <gtest/gtest.h>

// Two screens side by side, each less a panel at the top: the primary 1280x1024, the other
// 1920x1080 to its right.
TEST(ScreenPlace, AStoredPlaceOpensWithItsTitleBarOnAScreenAndNoLargerThanIt) {
    const QList<QRect> areas = {{0, 30, 1280, 994}, {1280, 30, 1920, 1050}};
    const std::tuple<QRect, QRect, bool> cases[] = {
        {{100, 60, 400, 480}, {100, 60, 400, 480}, false},
        {{2000, 60, 400, 480}, {2000, 60, 400, 480}, false},     // on the second screen
        {{1200, 500, 400, 480}, {1200, 500, 400, 480}, false},   // across both, bar grabbable
        {{30000, 60, 400, 480}, {880, 60, 400, 480}, true},      // far right: back on the first
        {{100, 0, 400, 480}, {100, 30, 400, 480}, true},         // title bar under the panel
        {{100, 1010, 400, 480}, {100, 544, 400, 480}, true},     // title bar below the screen
        {{-390, 60, 400, 480}, {0, 60, 400, 480}, true},         // 10 pixels of bar: too few
        {{-350, 60, 400, 480}, {-350, 60, 400, 480}, false},     // 50 pixels: enough
        {{100, 60, 4000, 3000}, {0, 30, 1280, 994}, true},       // too big: cut to the screen
        {{1300, 100, 4000, 3000}, {1280, 30, 1920, 1050}, true}, // ... the screen it is on
        {{-2147483647, 60, 400, 480}, {0, 60, 400, 480}, true},
    };
    for (const auto& [wanted, place, bMoved] : cases) {
        const ScreenFit fit = fitOnScreens(wanted, areas);
        EXPECT_EQ(fit.place, place) << wanted.x() << ',' << wanted.y();
        EXPECT_EQ(fit.bMoved, bMoved) << wanted.x() << ',' << wanted.y();
    }
}
