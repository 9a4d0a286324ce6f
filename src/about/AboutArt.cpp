#include "about/AboutArt.h"

#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>

namespace {

// A small fixed-seed generator: the same picture on every start.
class Lcg {
public:
    quint32 next() {
        m_state = m_state * 1664525u + 1013904223u;
        return m_state >> 8;
    }
    int below(int limit) { return int(next() % quint32(limit)); }

private:
    quint32 m_state = 2600;
};

} // namespace

QImage aboutBackgroundTile() {
    constexpr int kWidth = 128;
    constexpr int kHeight = 96; // even, so the scan lines run on across tiles
    QImage tile(kWidth, kHeight, QImage::Format_RGB32);
    Lcg random;
    for (int y = 0; y < kHeight; ++y) {
        auto* row = reinterpret_cast<QRgb*>(tile.scanLine(y));
        const int scan = (y % 2 == 0) ? 0 : 6;
        for (int x = 0; x < kWidth; ++x) {
            const int grain = random.below(7);
            row[x] = qRgb(8 + grain - scan / 2, 10 + grain - scan / 2, 34 + grain - scan);
        }
    }

    QPainter painter(&tile);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    // Stars stay clear of the edges so that no glow is cut where tiles meet.
    for (int i = 0; i < 18; ++i) {
        const QPointF centre(4 + random.below(kWidth - 8), 4 + random.below(kHeight - 8));
        const bool bright = random.below(4) == 0;
        const double radius = bright ? 3.0 : 1.6;
        QRadialGradient glow(centre, radius);
        const QColor colour = bright ? QColor(170, 190, 235) : QColor(100, 110, 160);
        glow.setColorAt(0, colour);
        glow.setColorAt(1, QColor(colour.red(), colour.green(), colour.blue(), 0));
        painter.setBrush(glow);
        painter.drawEllipse(centre, radius, radius);
    }
    return tile;
}

QImage aboutPicture() {
    constexpr int kWidth = 120;
    constexpr int kHeight = 150;
    QImage picture(kWidth, kHeight, QImage::Format_RGB32);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);

    // Sunset sky over a wooden table.
    QLinearGradient sky(0, 0, 0, kHeight);
    sky.setColorAt(0, QColor(40, 20, 90));
    sky.setColorAt(0.55, QColor(220, 90, 60));
    sky.setColorAt(0.72, QColor(250, 180, 80));
    painter.fillRect(picture.rect(), sky);
    const QRectF table(0, 104, kWidth, kHeight - 104);
    QLinearGradient wood(0, table.top(), 0, table.bottom());
    wood.setColorAt(0, QColor(120, 70, 35));
    wood.setColorAt(1, QColor(70, 38, 18));
    painter.fillRect(table, wood);
    painter.setPen(QPen(QColor(60, 32, 14), 1));
    for (int y = 110; y < kHeight; y += 7)
        painter.drawLine(QPointF(0, y), QPointF(kWidth, y + 2));

    // The joystick: base, fire button, stick and knob.
    painter.setPen(QPen(QColor(90, 90, 90), 1.5));
    QLinearGradient body(0, 88, 0, 132);
    body.setColorAt(0, QColor(60, 60, 60));
    body.setColorAt(1, QColor(12, 12, 12));
    painter.setBrush(body);
    painter.drawRoundedRect(QRectF(22, 88, 76, 44), 8, 8);
    painter.setBrush(QColor(200, 30, 30));
    painter.setPen(QPen(QColor(120, 10, 10), 1.5));
    painter.drawEllipse(QRectF(28, 92, 16, 10));
    QLinearGradient stick(56, 0, 66, 0);
    stick.setColorAt(0, QColor(70, 70, 70));
    stick.setColorAt(0.5, QColor(25, 25, 25));
    stick.setColorAt(1, QColor(5, 5, 5));
    painter.setPen(Qt::NoPen);
    painter.setBrush(stick);
    QPainterPath shaft;
    shaft.moveTo(54, 104);
    shaft.lineTo(58, 38);
    shaft.lineTo(66, 38);
    shaft.lineTo(70, 104);
    shaft.closeSubpath();
    painter.drawPath(shaft);
    QRadialGradient knob(QPointF(58, 32), 12);
    knob.setColorAt(0, QColor(90, 90, 90));
    knob.setColorAt(1, QColor(10, 10, 10));
    painter.setBrush(knob);
    painter.drawEllipse(QPointF(62, 36), 10, 8);
    painter.setBrush(QColor(25, 25, 25));
    painter.drawEllipse(QRectF(46, 98, 32, 12));

    painter.setPen(QPen(QColor(255, 220, 120), 2));
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(QRectF(1, 1, kWidth - 2, kHeight - 2));
    return picture;
}
