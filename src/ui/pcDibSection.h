#pragma once

#include <QImage>
#include <QPainter>
#include <QtGlobal>

class Dialogs;

// A 24-bit picture with direct access to its bytes: blue, green, red per pixel, each scan
// line padded to a multiple of 4 bytes. Used to copy a picture in, adjust it pixel by pixel
// and copy it back out. Pixel operations work in place on the bytes; on an empty picture
// they do nothing.
class pcDibSection {
public:
    // Copies this picture to the clipboard as a bitmap. As a DIB it is not supported: that
    // request shows a message and returns false. False too when there is no picture.
    bool CopyToClipboard(Dialogs& dialogs, bool bAsDIB = false);

    // Makes a picture of picThis's size and copies picThis's colours into it (any
    // transparency is dropped). False when no picture could be made.
    bool CreateFromPicture(const QImage& picThis);

    // Drops any picture and makes a black one of lWidth x lHeight. False, leaving nothing,
    // when the size is empty or there is no memory for it.
    bool Create(int lWidth, int lHeight);

    int BytesPerScanLine() const { return bytesPerScanLine(Width()); }
    int Width() const { return m_dib.width(); }
    int Height() const { return m_dib.height(); }

    // Copies from src at (lSrcLeft, lSrcTop) into this picture at (0, 0). A negative width
    // or height means this picture's own.
    void LoadPictureBlt(const QImage& src, int lSrcLeft = 0, int lSrcTop = 0, int lSrcWidth = -1,
                        int lSrcHeight = -1,
                        QPainter::CompositionMode eRop = QPainter::CompositionMode_Source);

    // Copies this picture from (lSrcLeft, lSrcTop) to dst at (lDestLeft, lDestTop), without
    // scaling. A negative width or height means this picture's own.
    void PaintPicture(QPainter& dst, int lDestLeft = 0, int lDestTop = 0, int lDestWidth = -1,
                      int lDestHeight = -1, int lSrcLeft = 0, int lSrcTop = 0,
                      QPainter::CompositionMode eRop = QPainter::CompositionMode_Source) const;

    // The picture itself (null when there is none) and the address of its first byte.
    QImage* hdc() { return m_dib.isNull() ? nullptr : &m_dib; }
    const QImage* hdc() const { return m_dib.isNull() ? nullptr : &m_dib; }
    uchar* DIBSectionBitsPtr() { return m_dib.isNull() ? nullptr : m_dib.bits(); }

    // Random pixels: without bGray blue is 0 and green and red are random; with bGray each
    // pixel is one random grey. The first form seeds from the clock.
    void RandomiseBits(bool bGray);
    void RandomiseBits(bool bGray, quint32 seed);

    void ClearUp() { m_dib = QImage(); }

    // Every channel c becomes c * lAmount / 255, fraction dropped: 255 keeps the picture,
    // 0 makes it black. Results are kept within 0..255.
    void Fade(int lAmount);

    // Scales hue, luminance and saturation of every pixel; luminance and saturation stop
    // at 1 and every channel is kept within 0..255.
    void ModifyHLS(double fHue, double fLuminance, double fSaturation);

    // Raises (or, negative, lowers) the luminance of every pixel by lAmount percent.
    void Lighten(int lAmount);

    static int bytesPerScanLine(int width) { return (width * 3 + 3) & ~3; }

private:
    template <typename Fn> void forEachPixel(Fn&& fn);

    QImage m_dib; // Format_BGR888: its scan lines are 4-byte aligned, the layout above
};
