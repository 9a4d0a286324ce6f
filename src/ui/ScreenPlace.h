#pragma once

#include <QList>
#include <QRect>

class QWidget;

// Where a window with a stored place opens: its title bar on an available screen area and
// no larger than that area. A place that breaks this is moved onto the primary screen.
struct ScreenFit {
    // The window's frame position and its size.
    QRect place;
    // True when the stored place had to be changed to fit.
    bool bMoved = false;
};

// `wanted` holds the frame's top-left and the window's size; `available` the screens'
// available areas, the primary first.
ScreenFit fitOnScreens(const QRect& wanted, const QList<QRect>& available);

// Moves and sizes `window` to the stored place fitted to the application's screens.
// Returns the fit, so that a window can leave a corrected place unsaved until the user
// moves or resizes it (see placeChangedByUser).
ScreenFit placeOnScreen(QWidget& window, const QRect& wanted);
bool placeChangedByUser(const QWidget& window, const ScreenFit& fit);
