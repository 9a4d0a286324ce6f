#pragma once

// Window geometry is stored in twips (1440 per inch). These convert with the primary
// screen's logical DPI, so that a stored value keeps its meaning on any screen. Pixel
// results stay within twice the desktop's extent, whatever the store held.
namespace twips {

double perPixelX();
double perPixelY();
int toPixelsX(double twips);
int toPixelsY(double twips);
double fromPixelsX(int pixels);
double fromPixelsY(int pixels);

} // namespace twips
