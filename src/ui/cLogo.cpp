#include "ui/cLogo.h"

#include "ui/OleColor.h"
#include "ui/PictureBox.h"

#include <QPainter>

#include <cmath>

std::vector<GradientBand> gradientBands(int height, int startRed, int startGreen, int startBlue,
                                        int endRed, int endGreen, int endBlue) {
    std::vector<GradientBand> bands;
    if (height <= 0)
        return bands;
    const int band = std::max(height / 255, 1);
    const int dr = endRed - startRed, dg = endGreen - startGreen, db = endBlue - startBlue;
    // Halves round to even, as the default floating-point rounding does.
    const auto step = [height](int start, int diff, int i) {
        return start +
               static_cast<int>(std::nearbyint(static_cast<double>(height - i) * diff / height));
    };
    int r = startRed, g = startGreen, b = startBlue;
    int bottom = height;
    bands.reserve(static_cast<size_t>(height / band + 1));
    for (int i = height; i >= 0; i -= band) {
        const int top = bottom - band;
        bands.push_back({top, bottom, r, g, b});
        bottom = top;
        r = step(startRed, dr, i);
        g = step(startGreen, dg, i);
        b = step(startBlue, db, i);
    }
    return bands;
}

void cLogo::setStartColor(quint32 ole) {
    if (ole == m_startColor)
        return;
    m_startColor = ole;
    if (m_box != nullptr)
        Draw();
}

void cLogo::setEndColor(quint32 ole) {
    if (ole == m_endColor)
        return;
    m_endColor = ole;
    if (m_box != nullptr)
        Draw();
}

void cLogo::Draw() {
    if (m_box == nullptr)
        return;
    ++m_drawCount;
    QImage& image = m_box->image();
    const int h = image.height();
    const int w = image.width();
    const QColor start = oleToColor(m_startColor);
    const QColor end = oleToColor(m_endColor);

    QPainter painter(&image);
    for (const GradientBand& band : gradientBands(h, start.red(), start.green(), start.blue(),
                                                  end.red(), end.green(), end.blue()))
        painter.fillRect(QRect(0, band.top, w, band.bottom - band.top),
                         QColor(band.red, band.green, band.blue));

    // The caption: the box's font at its whole point size, antialiased, running upwards
    // with its first character 16 pixels above the bottom edge.
    QFont font = m_box->font();
    const int points = static_cast<int>(std::lround(font.pointSizeF()));
    const int dpi = m_box->logicalDpiY();
    const int pixels = static_cast<int>(std::lround(static_cast<double>(points) * dpi / 72.0));
    if (pixels > 0) {
        font.setPixelSize(pixels);
        font.setStyleStrategy(QFont::PreferAntialias);
        painter.setFont(font);
        painter.setPen(oleToColor(m_box->ForeColor()));
        painter.setRenderHint(QPainter::TextAntialiasing);
        painter.translate(0, h - 16);
        painter.rotate(-90);
        painter.drawText(0, painter.fontMetrics().ascent(), m_caption);
    }
    painter.end();
    m_box->refresh();
}
