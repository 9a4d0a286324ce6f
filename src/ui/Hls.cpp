#include "ui/Hls.h"

#include <algorithm>
#include <cmath>

HlsColor RGBToHLS(int r, int g, int b) {
    const float R = static_cast<float>(r) / 255.0f;
    const float G = static_cast<float>(g) / 255.0f;
    const float B = static_cast<float>(b) / 255.0f;
    const float max = std::max({R, G, B});
    const float min = std::min({R, G, B});

    HlsColor hls;
    hls.l = (max + min) / 2.0f;
    if (max == min)
        return hls;

    const float d = max - min;
    hls.s = hls.l <= 0.5f ? d / (max + min) : d / (2.0f - max - min);
    if (R == max)
        hls.h = (G - B) / d;
    else if (G == max)
        hls.h = 2.0f + (B - R) / d;
    else
        hls.h = 4.0f + (R - G) / d;
    return hls;
}

int toChannel(double value) {
    if (!(value > 0.0)) // also catches NaN
        return 0;
    if (value >= 255.0)
        return 255;
    return static_cast<int>(std::nearbyint(value)); // the default mode rounds half to even
}

RgbColor HLSToRGB(double h, double s, double l) {
    double R = l;
    double G = l;
    double B = l;
    if (s != 0.0) {
        const double min = l <= 0.5 ? l * (1.0 - s) : l - (1.0 - l) * s;
        const double max = 2.0 * l - min;
        const double d = max - min;
        if (h < 1.0) {
            R = max;
            if (h < 0.0) {
                G = min;
                B = min - h * d;
            } else {
                B = min;
                G = min + h * d;
            }
        } else if (h < 3.0) {
            G = max;
            if (h < 2.0) {
                B = min;
                R = min - (h - 2.0) * d;
            } else {
                R = min;
                B = min + (h - 2.0) * d;
            }
        } else {
            B = max;
            if (h < 4.0) {
                R = min;
                G = min - (h - 4.0) * d;
            } else {
                G = min;
                R = min + (h - 4.0) * d;
            }
        }
    }
    return {toChannel(R * 255.0), toChannel(G * 255.0), toChannel(B * 255.0)};
}
