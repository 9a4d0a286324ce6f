#include "ui/Twips.h"

#include <QGuiApplication>
#include <QScreen>

#include <cmath>

#include <gtest/gtest.h>

// Stored placements come back through these conversions: values no window can have (from
// a damaged or hand-edited store) are held to twice the desktop instead of overflowing.
TEST(BadInputTwips, AbsurdValuesStayWithinTheDesktop) {
    const QScreen* screen = QGuiApplication::primaryScreen();
    const int limit = 2 * std::max(screen->virtualSize().width(), screen->virtualSize().height());
    const std::pair<double, int> cases[] = {{1e30, limit},  {3e9, limit},  {-1e30, -limit},
                                            {-3e9, -limit}, {HUGE_VAL, 0}, {-HUGE_VAL, 0},
                                            {NAN, 0}};
    for (const auto& [value, pixels] : cases) {
        EXPECT_EQ(twips::toPixelsX(value), pixels) << value;
        EXPECT_EQ(twips::toPixelsY(value), pixels) << value;
    }
    // Ordinary values are untouched: 1440 twips to the inch.
    EXPECT_EQ(twips::toPixelsX(4905), std::lround(4905 * screen->logicalDotsPerInchX() / 1440));
    EXPECT_EQ(twips::toPixelsY(-500), std::lround(-500 * screen->logicalDotsPerInchY() / 1440));
}
