#include "settings/PictureFit.h"

#include <cmath>

std::optional<PictureFit> FitPictureToBox(QSizeF picture, float height, float width) {
    const float pictureHeight = static_cast<float>(picture.height());
    const float pictureWidth = static_cast<float>(picture.width());
    if (!(pictureHeight > 0) || !(pictureWidth > 0) || !std::isfinite(pictureHeight) ||
        !std::isfinite(pictureWidth))
        return std::nullopt;

    const float h = height;
    const float w = width;
    PictureFit fit;
    if (!(h > 0) || !(w > 0))
        return fit;

    const float rp = pictureHeight / pictureWidth;
    const float rb = h / w;
    if (rp <= rb) {
        fit.width = w;
        fit.height = fit.width * rp;
        fit.top = h / 2 - fit.height / 2;
    } else {
        fit.height = h;
        fit.width = fit.height / rp;
        fit.left = w / 2 - fit.width / 2;
    }
    return fit;
}
