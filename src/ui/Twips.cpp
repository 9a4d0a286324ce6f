#include "ui/Twips.h"

#include <QGuiApplication>
#include <QScreen>

#include <cmath>

namespace {

double logicalDpi(bool horizontal) {
    const QScreen* screen = QGuiApplication::primaryScreen();
    if (screen == nullptr)
        return 96.0;
    const double dpi = horizontal ? screen->logicalDotsPerInchX() : screen->logicalDotsPerInchY();
    return dpi > 0 ? dpi : 96.0;
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
    return static_cast<int>(std::lround(t / perPixelX()));
}

int toPixelsY(double t) {
    return static_cast<int>(std::lround(t / perPixelY()));
}

double fromPixelsX(int pixels) {
    return pixels * perPixelX();
}

double fromPixelsY(int pixels) {
    return pixels * perPixelY();
}

} // namespace twips
