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

// Fits a picture of natural size `picture` into a box `height` high and `width` wide. A
// picture that is relatively wider than the box takes the box's width and is centred
// vertically; otherwise it takes the box's height and is centred horizontally. Empty for a
// picture without a size; a box with no room gives an empty target at its corner.
std::optional<PictureFit> FitPictureToBox(QSizeF picture, float height, float width);
