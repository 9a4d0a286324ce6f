#include "ui/pcMemDC.h"

#include <QPainter>

QImage* pcMemDC::hdc(int Width, int Height) {
    if (!m_surface.isNull() && Width <= m_surface.width() && Height <= m_surface.height())
        return &m_surface;
    release();
    if (Width <= 0 || Height <= 0)
        return nullptr;
    // RGB32 is what the raster engine paints and copies fastest; the control is opaque.
    m_surface = QImage(Width, Height, QImage::Format_RGB32);
    return m_surface.isNull() ? nullptr : &m_surface;
}

void pcMemDC::Draw(QPainter& dst, int xSrc, int ySrc, int WidthSrc, int HeightSrc, int xDst,
                   int yDst) const {
    if (m_surface.isNull())
        return;
    const int w = WidthSrc > 0 ? WidthSrc : m_surface.width();
    const int h = HeightSrc > 0 ? HeightSrc : m_surface.height();
    const QPainter::CompositionMode mode = dst.compositionMode();
    dst.setCompositionMode(QPainter::CompositionMode_Source);
    // The source rectangle is in surface pixels, so a surface made for a high-density
    // screen lands at its logical size.
    dst.drawImage(QPointF(xDst, yDst), m_surface, QRectF(xSrc, ySrc, w, h));
    dst.setCompositionMode(mode);
}
