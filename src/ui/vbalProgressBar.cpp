#include "ui/vbalProgressBar.h"

#include "ui/Hls.h"
#include "ui/OleColor.h"
#include "ui/pcDibSection.h"

#include <QEvent>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPalette>
#include <QStyle>
#include <QStyleOptionProgressBar>

#include <algorithm>
#include <cmath>

namespace progressbar {

double fraction(int value, int min, int max) {
    if (max == min)
        return 0.0;
    const double p = (double(value) - min) / (double(max) - min);
    return std::clamp(p, 0.0, 1.0);
}

QRect innerRect(const QRect& client, int borderStyle, int appearance, bool themed) {
    if (borderStyle <= 0)
        return client;
    const int edge = (!themed && appearance == 2) ? 2 : 1;
    return client.adjusted(edge, edge, -edge, -edge);
}

namespace {

int roundHalfEven(double v) {
    return static_cast<int>(std::nearbyint(v));
}

} // namespace

QRect barRect(const QRect& inner, double p, bool horizontal, int step) {
    if (inner.isEmpty())
        return {inner.topLeft(), QSize(0, 0)};
    p = std::clamp(p, 0.0, 1.0);
    if (horizontal) {
        int length = roundHalfEven(inner.width() * p);
        if (step > 0)
            length -= length % step;
        return {inner.left(), inner.top(), length, inner.height()};
    }
    // The top is placed by the empty part, so the bar always reaches the bottom exactly.
    int length = inner.height() - roundHalfEven(inner.height() * (1.0 - p));
    if (step > 0)
        length -= length % step;
    return {inner.left(), inner.top() + inner.height() - length, inner.width(), length};
}

QList<QRect> gapStrips(const QRect& bar, const QRect& inner, bool horizontal, int unit, int gap) {
    QList<QRect> strips;
    const int step = unit + gap;
    if (step <= 0 || gap <= 0 || bar.isEmpty())
        return strips;
    if (horizontal) {
        // Each chunk of unit pixels is followed by its gap, from the bar's left end.
        const int end = bar.left() + bar.width();
        for (int x = bar.left() + unit; x <= end; x += step)
            strips.append(QRect(x, inner.top(), gap, inner.height()));
    } else {
        // The same from the bottom end upwards: a chunk, then the gap above it.
        const int bottom = bar.top() + bar.height();
        for (int y = bottom - step; y >= bar.top(); y -= step)
            strips.append(QRect(inner.left(), y, inner.width(), gap));
    }
    return strips;
}

int valueAt(double x, int left, int width, int min, int max) {
    const double span = width - 1;
    if (span <= 0)
        return x >= left ? max : min;
    const double rel = std::clamp(x - left, 0.0, span);
    return roundHalfEven(min + rel / span * (double(max) - min));
}

} // namespace progressbar

namespace {

Qt::Alignment textAlignment(int alignX, int alignY) {
    Qt::Alignment a = alignX == 1 ? Qt::AlignHCenter : alignX == 2 ? Qt::AlignRight : Qt::AlignLeft;
    a |= alignY == 1 ? Qt::AlignVCenter : alignY == 2 ? Qt::AlignBottom : Qt::AlignTop;
    return a;
}

// Tiles the picture over area, each tile's corner on a multiple of the picture's size
// counted from (0, 0), so neighbouring areas tiled alike join without a seam.
void tile(QPainter& p, const QImage& picture, const QRect& area) {
    if (area.isEmpty())
        return;
    const QPointF origin = p.brushOrigin();
    p.setBrushOrigin(0, 0);
    p.fillRect(area, QBrush(picture));
    p.setBrushOrigin(origin);
}

void stretch(QPainter& p, const QImage& picture, const QRect& area) {
    if (area.isEmpty())
        return;
    p.save();
    p.setRenderHint(QPainter::SmoothPixmapTransform);
    p.drawImage(area, picture);
    p.restore();
}

void drawPicture(QPainter& p, const QImage& surface, int mode, const QRect& tileArea,
                 const QRect& stretchArea) {
    if (mode == 1)
        tile(p, surface, tileArea);
    else
        stretch(p, surface, stretchArea);
}

// Borders on b (right and bottom exclusive), one pixel per ring.
void drawRing(QPainter& p, const QRect& b, const QColor& topLeft, const QColor& bottomRight) {
    if (b.width() <= 0 || b.height() <= 0)
        return;
    // Top and left first; bottom and right take the two far corners.
    p.fillRect(QRect(b.left(), b.top(), b.width() - 1, 1), topLeft);
    p.fillRect(QRect(b.left(), b.top(), 1, b.height() - 1), topLeft);
    p.fillRect(QRect(b.left(), b.top() + b.height() - 1, b.width(), 1), bottomRight);
    p.fillRect(QRect(b.left() + b.width() - 1, b.top(), 1, b.height()), bottomRight);
}

void drawBorder(QPainter& p, const QRect& b, int borderStyle, int appearance,
                const QPalette& palette) {
    if (borderStyle != 1 && borderStyle != 2)
        return;
    const bool inset = borderStyle == 1;
    const int l = b.left();
    const int t = b.top();
    const int w = b.width();
    const int h = b.height();
    if (w <= 0 || h <= 0)
        return;
    switch (appearance) {
    case 0:
        drawRing(p, b, Qt::black, Qt::black);
        break;
    case 1: {
        const QColor shadow = oleToColor(0x80000010);
        const QColor highlight = oleToColor(0x80000014);
        if (inset) {
            p.fillRect(QRect(l, t, 1, h), shadow);
            p.fillRect(QRect(l, t, w, 1), shadow);
            p.fillRect(QRect(l + w - 1, t + 1, 1, h - 1), highlight);
            p.fillRect(QRect(l + 1, t + h - 1, w - 1, 1), highlight);
        } else {
            p.fillRect(QRect(l, t, 1, h - 1), highlight);
            p.fillRect(QRect(l, t, w - 1, 1), highlight);
            p.fillRect(QRect(l + w - 1, t, 1, h), shadow);
            p.fillRect(QRect(l, t + h - 1, w, 1), shadow);
        }
        break;
    }
    case 2: {
        // The classic two-ring sunken or raised edge.
        const QRect inner = b.adjusted(1, 1, -1, -1);
        if (inset) {
            drawRing(p, b, palette.color(QPalette::Dark), palette.color(QPalette::Light));
            drawRing(p, inner, palette.color(QPalette::Shadow), palette.color(QPalette::Midlight));
        } else {
            drawRing(p, b, palette.color(QPalette::Light), palette.color(QPalette::Shadow));
            drawRing(p, inner, palette.color(QPalette::Midlight), palette.color(QPalette::Dark));
        }
        break;
    }
    default:
        break;
    }
}

} // namespace

void vbalProgressBar::PictureHolder::set(const QImage& newPicture) {
    picture = newPicture;
    surface = newPicture.isNull() ? QImage()
                                  : newPicture.convertToFormat(QImage::Format_ARGB32_Premultiplied);
}

void vbalProgressBar::PictureHolder::modify(double fLuminance, double fSaturation) {
    if (!has())
        return;
    pcDibSection dib;
    if (!dib.CreateFromPicture(picture))
        return;
    dib.ModifyHLS(1.0, fLuminance, fSaturation);
    // The new colours with the picture's own transparency.
    const QImage alpha = picture.convertToFormat(QImage::Format_ARGB32);
    QImage result(picture.size(), QImage::Format_ARGB32);
    if (result.isNull())
        return;
    const QImage& colours = *dib.hdc();
    for (int y = 0; y < result.height(); ++y) {
        const uchar* in = colours.constScanLine(y);
        const auto* a = reinterpret_cast<const QRgb*>(alpha.constScanLine(y));
        auto* out = reinterpret_cast<QRgb*>(result.scanLine(y));
        for (int x = 0; x < result.width(); ++x, in += 3)
            out[x] = qRgba(in[2], in[1], in[0], qAlpha(a[x]));
    }
    surface = result.convertToFormat(QImage::Format_ARGB32_Premultiplied);
}

vbalProgressBar::vbalProgressBar(QWidget* parent) : QWidget(parent) {
    // Every pixel is drawn by paintEvent, so Qt need not clear first.
    setAttribute(Qt::WA_OpaquePaintEvent);
    setFocusPolicy(Qt::NoFocus);
}

template <typename T> void vbalProgressBar::assign(T& member, const T& value) {
    if (member == value)
        return;
    member = value;
    redraw();
}

void vbalProgressBar::assignRange(int& member, int value) {
    if (member == value)
        return;
    // Value, Min and Max show only through the bar's extent.
    const QRect before = currentBar();
    member = value;
    if (currentBar() != before)
        redraw();
}

void vbalProgressBar::redraw() {
    // A long operation that never returns to the event loop would otherwise repaint on
    // every visible change; a frame every 16 ms is all the eye sees, the rest is queued.
    constexpr qint64 kFrameMs = 16;
    if (m_lastRepaint.isValid() && m_lastRepaint.elapsed() < kFrameMs) {
        update();
        return;
    }
    repaint();
}

void vbalProgressBar::setSegments(bool on) {
    assign(m_segments, on);
}
void vbalProgressBar::setXpStyle(bool on) {
    assign(m_xpStyle, on);
}
void vbalProgressBar::setTextAlignX(int align) {
    assign(m_textAlignX, align);
}
void vbalProgressBar::setTextAlignY(int align) {
    assign(m_textAlignY, align);
}
void vbalProgressBar::setShowText(bool on) {
    assign(m_showText, on);
}
void vbalProgressBar::setMin(int min) {
    assignRange(m_min, min);
}
void vbalProgressBar::setMax(int max) {
    assignRange(m_max, max);
}
void vbalProgressBar::setValue(int value) {
    assignRange(m_value, value);
}
void vbalProgressBar::setBorderStyle(int style) {
    assign(m_borderStyle, style);
}
void vbalProgressBar::setAppearance(int appearance) {
    assign(m_appearance, appearance);
}
void vbalProgressBar::setBackColor(quint32 ole) {
    assign(m_backColor, ole);
}
void vbalProgressBar::setForeColor(quint32 ole) {
    assign(m_foreColor, ole);
}
void vbalProgressBar::setBarColor(quint32 ole) {
    assign(m_barColor, ole);
}
void vbalProgressBar::setBarForeColor(quint32 ole) {
    assign(m_barForeColor, ole);
}
void vbalProgressBar::setBarPictureMode(int mode) {
    assign(m_barPictureMode, mode);
}
void vbalProgressBar::setBackPictureMode(int mode) {
    assign(m_backPictureMode, mode);
}

void vbalProgressBar::setText(const QString& text) {
    if (m_text == text)
        return;
    m_text = text;
    if (m_showText)
        redraw();
}

void vbalProgressBar::setInteractive(bool on) {
    m_interactive = on;
    // A slider takes the keyboard; a plain progress display never does.
    setFocusPolicy(on ? Qt::StrongFocus : Qt::NoFocus);
}

void vbalProgressBar::setBarPicture(const QImage& picture) {
    if (picture.cacheKey() == m_bar.picture.cacheKey())
        return;
    m_bar.set(picture);
    redraw();
}

void vbalProgressBar::setPicture(const QImage& picture) {
    if (picture.cacheKey() == m_back.picture.cacheKey())
        return;
    m_back.set(picture);
    redraw();
}

void vbalProgressBar::ModifyBarPicture(double fLuminance, double fSaturation) {
    m_bar.modify(fLuminance, fSaturation);
    update();
}

void vbalProgressBar::ModifyPicture(double fLuminance, double fSaturation) {
    m_back.modify(fLuminance, fSaturation);
    update();
}

double vbalProgressBar::Percent() const {
    return PercentAt(m_value);
}

double vbalProgressBar::PercentAt(int value) const {
    return progressbar::fraction(value, m_min, m_max) * 100.0;
}

void vbalProgressBar::initStyleOption(QStyleOptionProgressBar& option) const {
    option.initFrom(this);
    option.rect = QRect(0, 0, width(), height());
    if (horizontal())
        option.state |= QStyle::State_Horizontal;
    else
        option.state &= ~QStyle::State_Horizontal;
    option.text = m_text;
    option.textVisible = m_showText && !m_text.isEmpty();
    option.textAlignment = textAlignment(m_textAlignX, m_textAlignY);
    option.invertedAppearance = false;
    option.bottomToTop = true;
    // A range the bar can always show; the caller fills in the progress.
    option.minimum = 0;
    option.maximum = 1;
    option.progress = 0;
}

QRect vbalProgressBar::track() const {
    if (!themed())
        return progressbar::innerRect(rect(), m_borderStyle, m_appearance, false);
    if (m_themedTrackFor != size()) {
        QStyleOptionProgressBar option;
        initStyleOption(option);
        m_themedTrack = style()->subElementRect(QStyle::SE_ProgressBarContents, &option, this);
        m_themedTrackFor = size();
    }
    return m_themedTrack;
}

int vbalProgressBar::barStep() const {
    // The themed bar is drawn smooth by the style, which splits it into chunks itself.
    return (m_segments && !themed()) ? 10 : 0;
}

QRect vbalProgressBar::currentBar() const {
    return progressbar::barRect(track(), fraction(), horizontal(), barStep());
}

void vbalProgressBar::drawText(QPainter& p, const QRect& r, quint32 ole) const {
    p.setPen(oleToColor(ole));
    p.setFont(font());
    p.drawText(r, int(textAlignment(m_textAlignX, m_textAlignY)) | Qt::TextSingleLine,
               QLatin1Char(' ') + m_text + QLatin1Char(' '));
}

void vbalProgressBar::drawThemed(QPainter& p) {
    const QRect all(0, 0, width(), height());
    QStyleOptionProgressBar option;
    initStyleOption(option);
    const QRect contents = track();
    const QRect bar = currentBar();
    const bool across = horizontal();
    // The style sees the bar's extent in pixels, exactly what the change test compares.
    option.maximum = std::max(1, across ? contents.width() : contents.height());
    option.progress = across ? bar.width() : bar.height();

    // The empty track depends on the size and the look only, and takes the style longer to
    // draw than all the rest; it is drawn once and copied after that.
    const qreal dpr = p.device() != nullptr ? p.device()->devicePixelRatioF() : 1.0;
    const GrooveKey key{size(), dpr, isEnabled(), isActiveWindow()};
    if (m_groove.isNull() || !(m_grooveKey == key)) {
        m_groove = QImage(static_cast<int>(std::ceil(width() * dpr)),
                          static_cast<int>(std::ceil(height() * dpr)),
                          QImage::Format_ARGB32_Premultiplied);
        m_groove.setDevicePixelRatio(dpr);
        QPainter gp(&m_groove);
        gp.fillRect(all, palette().window());
        QStyleOptionProgressBar groove = option;
        groove.rect = style()->subElementRect(QStyle::SE_ProgressBarGroove, &option, this);
        style()->drawControl(QStyle::CE_ProgressBarGroove, &groove, &gp, this);
        m_grooveKey = key;
    }
    p.drawImage(QPointF(0, 0), m_groove);

    QStyleOptionProgressBar part = option;
    if (m_bar.has()) {
        if (!bar.isEmpty()) {
            p.save();
            p.setClipRect(bar);
            drawPicture(p, m_bar.surface, m_barPictureMode, bar, all);
            p.restore();
        }
    } else {
        part.rect = contents;
        style()->drawControl(QStyle::CE_ProgressBarContents, &part, &p, this);
    }
    if (option.textVisible) {
        part.rect = style()->subElementRect(QStyle::SE_ProgressBarLabel, &option, this);
        style()->drawControl(QStyle::CE_ProgressBarLabel, &part, &p, this);
    }
}

void vbalProgressBar::drawPlain(QPainter& p) {
    const QRect all(0, 0, width(), height());
    if (m_back.has())
        drawPicture(p, m_back.surface, m_backPictureMode, all, all);
    else
        p.fillRect(all, oleToColor(m_backColor));

    const QRect inner = track();
    const bool textShown = m_showText && !m_text.isEmpty();
    if (textShown)
        drawText(p, inner, m_foreColor);

    const QRect bar = currentBar();
    if (!bar.isEmpty()) {
        p.save();
        p.setClipRect(bar);
        if (m_bar.has()) {
            // Tiled from the bar's own left edge, so the picture covers all of it.
            drawPicture(p, m_bar.surface, m_barPictureMode, bar, all);
        } else {
            p.fillRect(bar, oleToColor(m_barColor));
        }
        if (m_segments) {
            const QColor gapColour = oleToColor(m_backColor);
            for (const QRect& strip : progressbar::gapStrips(bar, inner, horizontal(), 8, 2))
                p.fillRect(strip, gapColour);
        }
        // The same text again in the bar's text colour, showing only over the bar.
        if (textShown)
            drawText(p, inner, m_barForeColor);
        p.restore();
    }
    drawBorder(p, all, m_borderStyle, m_appearance, palette());
}

void vbalProgressBar::drawControl(QPainter& painter) {
    if (themed())
        drawThemed(painter);
    else
        drawPlain(painter);
}

void vbalProgressBar::paintEvent(QPaintEvent*) {
    m_lastRepaint.start();
    QPainter out(this);
    const qreal dpr = devicePixelRatioF();
    const int w = static_cast<int>(std::ceil(width() * dpr));
    const int h = static_cast<int>(std::ceil(height() * dpr));
    QImage* surface = m_memDC.hdc(w, h);
    if (surface == nullptr) {
        // No off-screen surface: draw straight on, which may flicker but shows the same.
        drawControl(out);
        return;
    }
    surface->setDevicePixelRatio(dpr);
    // Text on the surface is sized as it would be on the screen.
    surface->setDotsPerMeterX(qRound(logicalDpiX() / 0.0254));
    surface->setDotsPerMeterY(qRound(logicalDpiY() / 0.0254));
    {
        QPainter p(surface);
        drawControl(p);
    }
    m_memDC.Draw(out, 0, 0, w, h, 0, 0);
}

void vbalProgressBar::changeEvent(QEvent* event) {
    switch (event->type()) {
    case QEvent::FontChange: // the Font property's setter
        redraw();
        break;
    case QEvent::StyleChange:
    case QEvent::PaletteChange:
        m_themedTrackFor = QSize();
        m_groove = QImage();
        update();
        break;
    default:
        break;
    }
    QWidget::changeEvent(event);
}

void vbalProgressBar::setFromMouse(QMouseEvent* event, bool pressed) {
    if (!m_interactive || event->buttons() != Qt::LeftButton)
        return;
    // The horizontal position counts, for a vertical bar too.
    const QRect r = track();
    const int value =
        progressbar::valueAt(event->position().x(), r.left(), r.width(), m_min, m_max);
    if (!pressed && value == m_value)
        return; // a drag within one value step changes nothing
    setValue(value);
    emit Change();
}

void vbalProgressBar::mousePressEvent(QMouseEvent* event) {
    if (event->button() == Qt::RightButton)
        emit RightClick();
    setFromMouse(event, true);
}

void vbalProgressBar::mouseMoveEvent(QMouseEvent* event) {
    setFromMouse(event, false);
}

void vbalProgressBar::mouseDoubleClickEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton)
        emit DblClick();
    else
        mousePressEvent(event);
}

void vbalProgressBar::keyPressEvent(QKeyEvent* event) {
    const QString text = event->text();
    if (text.size() == 1) {
        emit KeyPress(text.at(0).unicode());
        return;
    }
    QWidget::keyPressEvent(event);
}
