#pragma once

// Hue, luminance and saturation as the picture operations use them: hue runs from -1 to 5
// (red 0, green 2, blue 4; not degrees), luminance and saturation from 0 to 1.
struct HlsColor {
    float h = 0;
    float l = 0;
    float s = 0;
};

// Channel bytes, each 0..255.
struct RgbColor {
    int r = 0;
    int g = 0;
    int b = 0;

    friend bool operator==(const RgbColor&, const RgbColor&) = default;
};

HlsColor RGBToHLS(int r, int g, int b);

// Values outside the ranges above (from scaled or shifted colours) are accepted: every
// channel is rounded half to even and then kept within 0..255, and a channel that is not
// a number becomes 0.
RgbColor HLSToRGB(double h, double s, double l);

// A channel value 0..255 from any number, rounded half to even; not-a-number gives 0.
int toChannel(double value);
