#pragma once

#include <QImage>

class QPainter;

// An off-screen drawing surface that a control draws on and then copies to the screen in
// one step, so that a redraw never flickers. The surface is kept while later requests fit
// in it and is made anew, at exactly the requested size, when one does not.
class pcMemDC {
public:
    // A surface of at least Width x Height pixels: the current one, content and all, when
    // both sizes fit; otherwise a new one of exactly that size. Null when none can be made
    // (an empty size, or no memory).
    QImage* hdc(int Width, int Height);

    // Copies the surface from (xSrc, ySrc) to (xDst, yDst) on dst, replacing what is there.
    // A width or height of 0 or less means the surface's whole width or height.
    void Draw(QPainter& dst, int xSrc = 0, int ySrc = 0, int WidthSrc = 0, int HeightSrc = 0,
              int xDst = 0, int yDst = 0) const;

    // The surface's size; 0 x 0 while there is none.
    int Width() const { return m_surface.width(); }
    int Height() const { return m_surface.height(); }

    // Drops the surface.
    void release() { m_surface = QImage(); }

private:
    QImage m_surface;
};
