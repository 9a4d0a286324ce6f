#include "ui/Twips.h"

#include <QGuiApplication>
#include <QScreen>

#include <algorithm>
#include <cmath>

namespace {

double logicalDpi(bool horizontal) {
    const QScreen* screen = QGuiApplication::primaryScreen();
    if (screen == nullptr)
        return 96.0;
    const double dpi = horizontal ? screen->logicalDotsPerInchX() : screen->logicalDotsPerInchY();
    return dpi > 0 ? dpi : 96.0;
}

// Pixels for a number of twips, held within twice the desktop's extent: a damaged store
// (a size of 1e30 twips) must give neither a window too big to draw nor an overflow.
int toPixels(double value, double perPixel) {
    if (!std::isfinite(value))
        return 0;
    const QScreen* screen = QGuiApplication::primaryScreen();
    const QSize desktop = screen != nullptr ? screen->virtualSize() : QSize(16384, 16384);
    const double limit = 2.0 * std::max({desktop.width(), desktop.height(), 1});
    return static_cast<int>(std::lround(std::clamp(value / perPixel, -limit, limit)));
}

} // namespace

namespace twips {

double perPixelX() {
    return 1440.0 / logicalDpi(true);
}

double perPixelY() {
    return 1440.0 / logicalDpi(false);
}

int toPixelsX(double t) {
    return toPixels(t, perPixelX());
}

int toPixelsY(double t) {
    return toPixels(t, perPixelY());
}

double fromPixelsX(int pixels) {
    return pixels * perPixelX();
}

double fromPixelsY(int pixels) {
    return pixels * perPixelY();
}

} // namespace twips
