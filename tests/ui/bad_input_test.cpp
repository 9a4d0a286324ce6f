#include "ui/Twips.h"

#include <QGuiApplication>
#include <QScreen>

#include <cmath>
#include <limits>

#include <gtest/gtest.h>

// Stored placements come back through these conversions: values no window can have (from
// a damaged or hand-edited store) are held to the desktop instead of overflowing.
TEST(BadInputTwips, AbsurdValuesStayWithinTheDesktop) {
    const QSize desktop = QGuiApplication::primaryScreen()->virtualSize();
    const int limit = 2 * std::max(desktop.width(), desktop.height());
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        double twips;
        int pixels; // -1: the limit itself, -2: minus the limit
    } cases[] = {
        {1e30, -1}, {3e9, -1}, {-1e30, -2}, {-3e9, -2}, {inf, 0}, {-inf, 0}, {std::nan(""), 0},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.twips);
        const int expected = c.pixels == -1 ? limit : c.pixels == -2 ? -limit : c.pixels;
        EXPECT_EQ(twips::toPixelsX(c.twips), expected);
        EXPECT_EQ(twips::toPixelsY(c.twips), expected);
    }
    // Ordinary values are untouched.
    EXPECT_EQ(twips::toPixelsX(4905), std::lround(4905 / twips::perPixelX()));
    EXPECT_EQ(twips::toPixelsY(-500), std::lround(-500 / twips::perPixelY()));
}
