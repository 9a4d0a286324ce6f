#include "ui/pcDibSection.h"

#include "platform/Dialogs.h"
#include "ui/Hls.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QRandomGenerator>
#include <QTime>

#include <algorithm>
#include <cmath>

template <typename Fn> void pcDibSection::forEachPixel(Fn&& fn) {
    const int w = m_dib.width();
    const int h = m_dib.height();
    // Row by row: each pixel is handled on its own, so the order only matters for speed.
    for (int y = 0; y < h; ++y) {
        uchar* px = m_dib.scanLine(y);
        for (int x = 0; x < w; ++x, px += 3)
            fn(px); // px[0] blue, px[1] green, px[2] red
    }
}

bool pcDibSection::Create(int lWidth, int lHeight) {
    ClearUp();
    if (lWidth <= 0 || lHeight <= 0)
        return false;
    QImage dib(lWidth, lHeight, QImage::Format_BGR888);
    if (dib.isNull())
        return false;
    dib.fill(Qt::black);
    m_dib = std::move(dib);
    return true;
}

bool pcDibSection::CreateFromPicture(const QImage& picThis) {
    if (!Create(picThis.width(), picThis.height()))
        return false;
    // The colours as they are, whatever the alpha: a caller that keeps transparency puts
    // the alpha back itself.
    const QImage src = picThis.convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; y < src.height(); ++y) {
        const auto* in = reinterpret_cast<const QRgb*>(src.constScanLine(y));
        uchar* out = m_dib.scanLine(y);
        for (int x = 0; x < src.width(); ++x, out += 3) {
            out[0] = static_cast<uchar>(qBlue(in[x]));
            out[1] = static_cast<uchar>(qGreen(in[x]));
            out[2] = static_cast<uchar>(qRed(in[x]));
        }
    }
    return true;
}

void pcDibSection::LoadPictureBlt(const QImage& src, int lSrcLeft, int lSrcTop, int lSrcWidth,
                                  int lSrcHeight, QPainter::CompositionMode eRop) {
    if (m_dib.isNull() || src.isNull())
        return;
    const int w = lSrcWidth < 0 ? m_dib.width() : lSrcWidth;
    const int h = lSrcHeight < 0 ? m_dib.height() : lSrcHeight;
    QPainter p(&m_dib);
    p.setCompositionMode(eRop);
    p.drawImage(QPoint(0, 0), src, QRect(lSrcLeft, lSrcTop, w, h));
}

void pcDibSection::PaintPicture(QPainter& dst, int lDestLeft, int lDestTop, int lDestWidth,
                                int lDestHeight, int lSrcLeft, int lSrcTop,
                                QPainter::CompositionMode eRop) const {
    if (m_dib.isNull())
        return;
    const int w = lDestWidth < 0 ? m_dib.width() : lDestWidth;
    const int h = lDestHeight < 0 ? m_dib.height() : lDestHeight;
    const QPainter::CompositionMode mode = dst.compositionMode();
    dst.setCompositionMode(eRop);
    dst.drawImage(QPoint(lDestLeft, lDestTop), m_dib, QRect(lSrcLeft, lSrcTop, w, h));
    dst.setCompositionMode(mode);
}

void pcDibSection::RandomiseBits(bool bGray) {
    RandomiseBits(bGray, static_cast<quint32>(QTime::currentTime().msecsSinceStartOfDay()));
}

void pcDibSection::RandomiseBits(bool bGray, quint32 seed) {
    QRandomGenerator random(seed);
    auto next = [&random] { return toChannel(random.generateDouble() * 255.0); };
    forEachPixel([&](uchar* px) {
        if (bGray) {
            px[0] = px[1] = px[2] = static_cast<uchar>(next());
        } else {
            px[0] = 0;
            px[1] = static_cast<uchar>(next());
            px[2] = static_cast<uchar>(next());
        }
    });
}

void pcDibSection::Fade(int lAmount) {
    forEachPixel([lAmount](uchar* px) {
        for (int i = 0; i < 3; ++i) {
            // 64 bits: 255 times any 32-bit amount fits.
            const qint64 c = qint64(px[i]) * lAmount / 255;
            px[i] = static_cast<uchar>(std::clamp<qint64>(c, 0, 255));
        }
    });
}

namespace {

void storeRgb(uchar* px, const RgbColor& rgb) {
    px[0] = static_cast<uchar>(rgb.b);
    px[1] = static_cast<uchar>(rgb.g);
    px[2] = static_cast<uchar>(rgb.r);
}

} // namespace

void pcDibSection::ModifyHLS(double fHue, double fLuminance, double fSaturation) {
    forEachPixel([=](uchar* px) {
        const HlsColor hls = RGBToHLS(px[2], px[1], px[0]);
        const double h = hls.h * fHue;
        const double l = std::min(hls.l * fLuminance, 1.0);
        const double s = std::min(hls.s * fSaturation, 1.0);
        storeRgb(px, HLSToRGB(h, s, l));
    });
}

void pcDibSection::Lighten(int lAmount) {
    const double factor = 1.0 + lAmount / 100.0;
    forEachPixel([=](uchar* px) {
        const HlsColor hls = RGBToHLS(px[2], px[1], px[0]);
        storeRgb(px, HLSToRGB(hls.h, hls.s, std::min(hls.l * factor, 1.0)));
    });
}

bool pcDibSection::CopyToClipboard(Dialogs& dialogs, bool bAsDIB) {
    if (m_dib.isNull())
        return false;
    if (bAsDIB) {
        dialogs.MsgBox(nullptr,
                       QStringLiteral("I don't know how to put a DIB on the clipboard! Copy as "
                                      "bitmap instead!!!"),
                       MsgButtons::Ok, MsgIcon::None);
        return false;
    }
    QClipboard* clipboard = QGuiApplication::clipboard();
    if (clipboard == nullptr)
        return false;
    clipboard->setImage(m_dib.convertToFormat(QImage::Format_RGB32));
    return true;
}
