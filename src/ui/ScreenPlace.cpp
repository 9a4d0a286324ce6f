#include "ui/ScreenPlace.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWidget>

#include <algorithm>

namespace {

// About the height of a title bar: enough of it on a screen to grab it with the mouse.
constexpr int kTitleBand = 24;
constexpr int kGrabWidth = 48;

bool titleBarOn(const QRect& place, const QRect& area) {
    const QRect band(place.left(), place.top(), place.width(), kTitleBand);
    const QRect seen = band.intersected(area);
    return place.top() >= area.top() && place.top() + kTitleBand <= area.bottom() + 1 &&
           seen.width() >= std::min(kGrabWidth, place.width());
}

QRect within(const QRect& place, const QRect& area) {
    const QSize size = place.size().boundedTo(area.size());
    const int left = std::clamp(place.left(), area.left(), area.right() + 1 - size.width());
    const int top = std::clamp(place.top(), area.top(), area.bottom() + 1 - size.height());
    return {QPoint(left, top), size};
}

} // namespace

ScreenFit fitOnScreens(const QRect& wanted, const QList<QRect>& available) {
    if (available.isEmpty())
        return {wanted, false};
    for (const QRect& area : available) {
        if (!titleBarOn(wanted, area))
            continue;
        const QSize size = wanted.size().boundedTo(area.size());
        if (size == wanted.size())
            return {wanted, false};
        return {within(QRect(wanted.topLeft(), size), area), true};
    }
    return {within(wanted, available.front()), true};
}

ScreenFit placeOnScreen(QWidget& window, const QRect& wanted) {
    QList<QRect> areas;
    if (const QScreen* primary = QGuiApplication::primaryScreen())
        areas << primary->availableGeometry();
    for (const QScreen* screen : QGuiApplication::screens())
        if (screen != QGuiApplication::primaryScreen())
            areas << screen->availableGeometry();
    const ScreenFit fit = fitOnScreens(wanted, areas);
    window.resize(fit.place.size());
    window.move(fit.place.topLeft());
    return fit;
}

bool placeChangedByUser(const QWidget& window, const ScreenFit& fit) {
    return !fit.bMoved || QRect(window.pos(), window.size()) != fit.place;
}
