#pragma once

#include <QSizeF>

#include <optional>

// Where the preview's image control goes so that a picture fills the box on one axis,
// keeps its proportions, and is centred on the other axis.
struct PictureFit {
    float top = 0;
    float left = 0;
    float width = 0;
    float height = 0;
    bool operator==(const PictureFit&) const = default;
};

// The frame of the preview window (title bar and borders), in twips, that a caller
// passing the window's outer size asks to have subtracted.
inline constexpr float kPreviewFrameHeight = 525;
inline constexpr float kPreviewFrameWidth = 125;

// Fits a picture of natural size `picture` into a box `height` high and `width` wide
// whose target starts at (`top`, `left`). With `subtractFrame` the box is the window's
// outer size in twips and the frame is taken off first. A picture that is relatively
// wider than the box takes the box's width and is centred vertically; otherwise it takes
// the box's height and is centred horizontally. Empty for a picture without a size; a box
// with no room left gives an empty target at its start.
std::optional<PictureFit> FitPictureToBox(QSizeF picture, float height, float width,
                                          bool subtractFrame, float top = 0, float left = 0);
