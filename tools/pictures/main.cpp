// lum_pictures OUTPUT_FOLDER
// Draws the pictures that lie beside the program: the four controller-layout pictures,
// a few background pictures in Backgrounds/, and the main window's backdrop. Everything
// is drawn here from shapes and text, so the pictures can be changed by editing this file.

#include <QDir>
#include <QGuiApplication>
#include <QImage>
#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>
#include <QRandomGenerator>

#include <cmath>
#include <cstdio>
#include <vector>

namespace {

constexpr int kWidth = 1100;
constexpr int kHeight = 560;

const QColor kInk(235, 240, 250);
const QColor kMuted(160, 175, 205);
const QColor kFire(222, 60, 48);
const QString kFamily = QStringLiteral("DejaVu Sans");

QFont font(int pixels, bool bold = false) {
    QFont f(kFamily);
    f.setPixelSize(pixels);
    f.setBold(bold);
    return f;
}

// ---- common parts ---------------------------------------------------------------------

void drawBackdrop(QPainter& p, const QString& title, const QString& subtitle) {
    QLinearGradient sky(0, 0, 0, kHeight);
    sky.setColorAt(0, QColor(34, 52, 92));
    sky.setColorAt(1, QColor(12, 20, 40));
    p.fillRect(0, 0, kWidth, kHeight, sky);
    p.setPen(kInk);
    p.setFont(font(30, true));
    p.drawText(QRect(0, 14, kWidth, 40), Qt::AlignHCenter | Qt::AlignVCenter, title);
    p.setPen(kMuted);
    p.setFont(font(16));
    p.drawText(QRect(0, 54, kWidth, 24), Qt::AlignHCenter | Qt::AlignVCenter, subtitle);
    p.setFont(font(13));
    p.drawText(QRect(0, kHeight - 26, kWidth - 16, 20), Qt::AlignRight | Qt::AlignVCenter,
               QStringLiteral("z26's default keys"));
}

void drawPanel(QPainter& p, const QRect& r, const QString& heading) {
    p.setPen(QPen(QColor(255, 255, 255, 70), 2));
    p.setBrush(QColor(255, 255, 255, 18));
    p.drawRoundedRect(r, 14, 14);
    p.setPen(kInk);
    p.setFont(font(20, true));
    p.drawText(QRect(r.left(), r.top() + 10, r.width(), 28), Qt::AlignHCenter, heading);
}

// A key cap with its legend; `accent` marks a fire key.
void drawKey(QPainter& p, const QRectF& r, const QString& legend, bool accent = false,
             int pixels = 22) {
    QLinearGradient face(r.topLeft(), r.bottomLeft());
    face.setColorAt(0, accent ? QColor(255, 214, 208) : QColor(250, 250, 252));
    face.setColorAt(1, accent ? QColor(235, 160, 150) : QColor(196, 202, 214));
    p.setPen(QPen(QColor(40, 44, 56), 2));
    p.setBrush(QColor(70, 76, 92));
    p.drawRoundedRect(r, 8, 8);
    p.setBrush(face);
    p.setPen(Qt::NoPen);
    p.drawRoundedRect(r.adjusted(4, 3, -4, -7), 6, 6);
    p.setPen(QColor(30, 34, 44));
    p.setFont(font(pixels, true));
    p.drawText(r.adjusted(4, 3, -4, -7), Qt::AlignCenter, legend);
}

void drawLabel(QPainter& p, const QRectF& r, const QString& text, const QColor& colour = kInk,
               int pixels = 16, int align = Qt::AlignCenter) {
    p.setPen(colour);
    p.setFont(font(pixels, true));
    p.drawText(r, align, text);
}

// Four keys as an inverted T (up on top; left, down, right below), each with what it does.
void drawDirectionKeys(QPainter& p, QPointF topCentre, const QString& up, const QString& left,
                       const QString& down, const QString& right) {
    const qreal k = 56;
    const qreal gap = 6;
    const QRectF upKey(topCentre.x() - k / 2, topCentre.y(), k, k);
    const QRectF downKey(upKey.left(), upKey.bottom() + gap, k, k);
    const QRectF leftKey(downKey.left() - k - gap, downKey.top(), k, k);
    const QRectF rightKey(downKey.right() + gap, downKey.top(), k, k);
    drawKey(p, upKey, up);
    drawKey(p, leftKey, left);
    drawKey(p, downKey, down);
    drawKey(p, rightKey, right);
    drawLabel(p, QRectF(upKey.left() - 70, upKey.top(), 64, k), QStringLiteral("up"), kMuted, 14,
              Qt::AlignRight | Qt::AlignVCenter);
    const qreal below = downKey.bottom() + 2;
    drawLabel(p, QRectF(leftKey.left(), below, k, 20), QStringLiteral("left"), kMuted, 14);
    drawLabel(p, QRectF(downKey.left(), below, k, 20), QStringLiteral("down"), kMuted, 14);
    drawLabel(p, QRectF(rightKey.left(), below, k, 20), QStringLiteral("right"), kMuted, 14);
}

// Two keys side by side for turning left and right.
void drawTurnKeys(QPainter& p, QPointF centre, const QString& left, const QString& right) {
    const qreal k = 56;
    const QRectF leftKey(centre.x() - k - 20, centre.y() - k / 2, k, k);
    const QRectF rightKey(centre.x() + 20, centre.y() - k / 2, k, k);
    drawKey(p, leftKey, left);
    drawKey(p, rightKey, right);
    drawLabel(p, QRectF(leftKey.left() - 10, leftKey.bottom() + 2, k + 20, 20),
              QStringLiteral("turn left"), kMuted, 14);
    drawLabel(p, QRectF(rightKey.left() - 10, rightKey.bottom() + 2, k + 20, 20),
              QStringLiteral("turn right"), kMuted, 14);
}

void drawFireKey(QPainter& p, QPointF centre, const QString& legend) {
    const qreal w = legend.size() > 2 ? 130 : 56;
    const QRectF key(centre.x() - w / 2, centre.y() - 28, w, 56);
    drawKey(p, key, legend, true, legend.size() > 2 ? 18 : 22);
    drawLabel(p, QRectF(key.left() - 20, key.bottom() + 2, w + 40, 20), QStringLiteral("fire"),
              kFire.lighter(130), 14);
}

// ---- controllers ----------------------------------------------------------------------

void drawJoystick(QPainter& p, QPointF centre) {
    const QRectF base(centre.x() - 70, centre.y() - 50, 140, 110);
    p.setPen(QPen(QColor(20, 20, 24), 2));
    QLinearGradient body(base.topLeft(), base.bottomLeft());
    body.setColorAt(0, QColor(64, 64, 70));
    body.setColorAt(1, QColor(22, 22, 26));
    p.setBrush(body);
    p.drawRoundedRect(base, 14, 14);
    // Fire button in the top left corner, as on the classic stick.
    p.setBrush(kFire);
    p.drawEllipse(QPointF(base.left() + 26, base.top() + 24), 14, 14);
    // Shaft and grip.
    p.setBrush(QColor(30, 30, 34));
    p.drawEllipse(QPointF(centre.x() + 6, centre.y() + 10), 24, 16);
    p.setBrush(QColor(16, 16, 18));
    p.drawRoundedRect(QRectF(centre.x() - 3, centre.y() - 80, 18, 92), 8, 8);
    p.setBrush(QColor(48, 48, 54));
    p.drawEllipse(QPointF(centre.x() + 6, centre.y() - 82), 14, 10);
}

void drawPaddle(QPainter& p, QPointF centre, const QString& name) {
    const QRectF body(centre.x() - 46, centre.y() - 34, 92, 78);
    p.setPen(QPen(QColor(20, 20, 24), 2));
    QLinearGradient wood(body.topLeft(), body.bottomLeft());
    wood.setColorAt(0, QColor(70, 70, 76));
    wood.setColorAt(1, QColor(26, 26, 30));
    p.setBrush(wood);
    p.drawRoundedRect(body, 12, 12);
    // The knob with its grip ridges, and the fire button on the side.
    QRadialGradient knob(centre + QPointF(-6, -6), 34);
    knob.setColorAt(0, QColor(90, 90, 96));
    knob.setColorAt(1, QColor(18, 18, 20));
    p.setBrush(knob);
    const QPointF k = centre + QPointF(0, 4);
    p.drawEllipse(k, 28, 28);
    p.setPen(QPen(QColor(120, 120, 128), 2));
    for (int i = 0; i < 12; ++i) {
        const double a = i * M_PI / 6;
        p.drawLine(k + QPointF(22 * std::cos(a), 22 * std::sin(a)),
                   k + QPointF(27 * std::cos(a), 27 * std::sin(a)));
    }
    p.setPen(QPen(QColor(20, 20, 24), 2));
    p.setBrush(kFire);
    p.drawRoundedRect(QRectF(body.left() - 12, centre.y() - 8, 14, 24), 4, 4);
    drawLabel(p, QRectF(centre.x() - 60, body.bottom() + 4, 120, 22), name, kInk, 16);
}

void drawWheel(QPainter& p, QPointF centre) {
    const QRectF base(centre.x() - 90, centre.y() - 70, 180, 140);
    p.setPen(QPen(QColor(20, 20, 24), 2));
    QLinearGradient body(base.topLeft(), base.bottomLeft());
    body.setColorAt(0, QColor(64, 64, 70));
    body.setColorAt(1, QColor(22, 22, 26));
    p.setBrush(body);
    p.drawRoundedRect(base, 14, 14);
    p.setBrush(kFire);
    p.drawEllipse(QPointF(base.left() + 22, base.bottom() - 22), 12, 12);
    // The wheel knob turns endlessly both ways.
    const QPointF c = centre + QPointF(14, 0);
    p.setBrush(QColor(30, 30, 34));
    p.drawEllipse(c, 40, 40);
    p.setPen(QPen(QColor(140, 140, 150), 5, Qt::SolidLine, Qt::RoundCap));
    for (int i = 0; i < 3; ++i) {
        const double a = -M_PI / 2 + i * 2 * M_PI / 3;
        p.drawLine(c, c + QPointF(34 * std::cos(a), 34 * std::sin(a)));
    }
    p.setPen(QPen(QColor(200, 200, 210), 3));
    p.setBrush(Qt::NoBrush);
    p.drawArc(QRectF(c.x() - 54, c.y() - 54, 108, 108), 30 * 16, 120 * 16);
    p.drawArc(QRectF(c.x() - 54, c.y() - 54, 108, 108), 210 * 16, 120 * 16);
    // Arrow heads on the two arcs: clockwise and anticlockwise.
    p.setBrush(QColor(200, 200, 210));
    p.setPen(Qt::NoPen);
    auto head = [&](double degrees, double dir) {
        const double a = -degrees * M_PI / 180;
        const QPointF tip = c + QPointF(54 * std::cos(a), 54 * std::sin(a));
        const QPointF along(-std::sin(a) * dir, std::cos(a) * dir);
        const QPointF out(std::cos(a), std::sin(a));
        QPolygonF tri;
        tri << tip + along * 10 << tip - along * 2 + out * 7 << tip - along * 2 - out * 7;
        p.drawPolygon(tri);
    };
    head(30, 1);
    head(210, 1);
}

void drawMouse(QPainter& p, QPointF centre) {
    const QRectF body(centre.x() - 36, centre.y() - 56, 72, 112);
    p.setPen(QPen(QColor(20, 20, 24), 2));
    p.setBrush(QColor(214, 218, 226));
    p.drawRoundedRect(body, 34, 34);
    QPainterPath left;
    left.moveTo(body.center().x(), body.top());
    left.lineTo(body.center().x(), body.top() + 44);
    left.lineTo(body.left() + 1, body.top() + 44);
    left.arcTo(QRectF(body.left(), body.top(), 68, 68), 180, -90);
    left.closeSubpath();
    p.setBrush(kFire);
    p.drawPath(left);
    p.drawLine(QPointF(body.left(), body.top() + 44), QPointF(body.right(), body.top() + 44));
    // Left and right movement.
    p.setPen(QPen(kInk, 3, Qt::SolidLine, Qt::RoundCap));
    p.drawLine(QPointF(body.left() - 50, centre.y()), QPointF(body.left() - 12, centre.y()));
    p.drawLine(QPointF(body.right() + 12, centre.y()), QPointF(body.right() + 50, centre.y()));
    p.drawLine(QPointF(body.left() - 50, centre.y()), QPointF(body.left() - 40, centre.y() - 8));
    p.drawLine(QPointF(body.left() - 50, centre.y()), QPointF(body.left() - 40, centre.y() + 8));
    p.drawLine(QPointF(body.right() + 50, centre.y()), QPointF(body.right() + 40, centre.y() - 8));
    p.drawLine(QPointF(body.right() + 50, centre.y()), QPointF(body.right() + 40, centre.y() + 8));
}

// ---- the four pictures ------------------------------------------------------------------

struct PlayerKeys {
    QString heading;
    QString up, left, down, right, fire;
};

const PlayerKeys kPlayers[2] = {
    {QStringLiteral("Left controller (player 0)"), QStringLiteral("\u2191"),
     QStringLiteral("\u2190"), QStringLiteral("\u2193"), QStringLiteral("\u2192"),
     QStringLiteral("Right Ctrl")},
    {QStringLiteral("Right controller (player 1)"), QStringLiteral("E"), QStringLiteral("S"),
     QStringLiteral("D"), QStringLiteral("F"), QStringLiteral("N")},
};

QRect panelRect(int i) {
    return QRect(30 + i * 530, 96, 510, 430);
}

QImage standardPicture() {
    QImage img(kWidth, kHeight, QImage::Format_RGB32);
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    drawBackdrop(p, QStringLiteral("Standard Control Layout"),
                 QStringLiteral("Joysticks, and every controller without a layout of its own"));
    for (int i = 0; i < 2; ++i) {
        const QRect r = panelRect(i);
        const PlayerKeys& k = kPlayers[i];
        drawPanel(p, r, k.heading);
        drawJoystick(p, QPointF(r.left() + 130, r.top() + 190));
        drawDirectionKeys(p, QPointF(r.left() + 360, r.top() + 80), k.up, k.left, k.down, k.right);
        drawFireKey(p, QPointF(r.left() + 360, r.top() + 290), k.fire);
        drawLabel(p, QRectF(r.left() + 20, r.top() + 350, r.width() - 40, 60),
                  QStringLiteral("Push the stick with the four keys, press the button with the "
                                 "fire key."),
                  kMuted, 15, Qt::AlignCenter | Qt::TextWordWrap);
    }
    return img;
}

QImage paddlePicture() {
    QImage img(kWidth, kHeight, QImage::Format_RGB32);
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    drawBackdrop(p, QStringLiteral("Paddle Control Layout"),
                 QStringLiteral("Two paddles on each port: 0 and 1 on the left, 2 and 3 on the "
                                "right"));
    const QRect mouseCard = panelRect(0);
    drawPanel(p, mouseCard, QStringLiteral("With the mouse"));
    drawMouse(p, QPointF(mouseCard.left() + 150, mouseCard.top() + 150));
    drawPaddle(p, QPointF(mouseCard.left() + 390, mouseCard.top() + 140), QStringLiteral("Paddle"));
    drawLabel(p, QRectF(mouseCard.left() + 20, mouseCard.top() + 260, mouseCard.width() - 40, 150),
              QStringLiteral("Move the mouse left and right to turn the paddle; the left mouse "
                             "button fires. Settings: \"Paddles to Emulate with Mouse\" picks "
                             "the paddles the mouse drives."),
              kInk, 16, Qt::AlignCenter | Qt::TextWordWrap);

    const QRect keyCard = panelRect(1);
    drawPanel(p, keyCard, QStringLiteral("With the keyboard"));
    drawTurnKeys(p, QPointF(keyCard.left() + 150, keyCard.top() + 110), QStringLiteral("\u2190"),
                 QStringLiteral("\u2192"));
    drawFireKey(p, QPointF(keyCard.left() + 150, keyCard.top() + 215),
                QStringLiteral("Right Ctrl"));
    drawPaddle(p, QPointF(keyCard.left() + 390, keyCard.top() + 140), QStringLiteral("Paddle"));
    drawLabel(p, QRectF(keyCard.left() + 20, keyCard.top() + 260, keyCard.width() - 40, 150),
              QStringLiteral("Hold \u2190 or \u2192 to turn the paddle; Right Ctrl fires. "
                             "Settings: \"Keyboard Paddle Sensitivity\" sets how fast it turns."),
              kInk, 16, Qt::AlignCenter | Qt::TextWordWrap);
    return img;
}

QImage keyboardPicture() {
    QImage img(kWidth, kHeight, QImage::Format_RGB32);
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    drawBackdrop(p, QStringLiteral("Keyboard Control Layout"),
                 QStringLiteral("Keypads: each key of the pad is the PC key shown in its corner"));
    const char* pad[12] = {"1", "2", "3", "4", "5", "6", "7", "8", "9", "*", "0", "#"};
    const char* keys[2][12] = {
        {"1", "2", "3", "Q", "W", "E", "A", "S", "D", "Z", "X", "C"},
        {"8", "9", "0", "I", "O", "P", "K", "L", ";", ",", ".", "/"},
    };
    for (int i = 0; i < 2; ++i) {
        const QRect r = panelRect(i);
        drawPanel(p, r, kPlayers[i].heading);
        // The keypad's case.
        const QRectF padCase(r.center().x() - 150, r.top() + 52, 300, 362);
        p.setPen(QPen(QColor(20, 20, 24), 2));
        p.setBrush(QColor(40, 40, 46));
        p.drawRoundedRect(padCase, 16, 16);
        for (int n = 0; n < 12; ++n) {
            const int row = n / 3;
            const int col = n % 3;
            const QRectF cell(padCase.left() + 22 + col * 88, padCase.top() + 20 + row * 84, 80,
                              74);
            p.setPen(QPen(QColor(15, 15, 18), 2));
            p.setBrush(QColor(222, 196, 140));
            p.drawRoundedRect(cell, 8, 8);
            p.setPen(QColor(40, 30, 20));
            p.setFont(font(30, true));
            p.drawText(cell.adjusted(0, 0, -18, 0), Qt::AlignCenter, QString::fromLatin1(pad[n]));
            drawKey(p, QRectF(cell.right() - 34, cell.top() + 4, 30, 30),
                    QString::fromLatin1(keys[i][n]), false, 14);
        }
    }
    return img;
}

QImage drivingPicture() {
    QImage img(kWidth, kHeight, QImage::Format_RGB32);
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    drawBackdrop(p, QStringLiteral("Driving Control Layout"),
                 QStringLiteral("Driving controllers: a wheel that turns without end, and a "
                                "button"));
    for (int i = 0; i < 2; ++i) {
        const QRect r = panelRect(i);
        const PlayerKeys& k = kPlayers[i];
        drawPanel(p, r, k.heading);
        drawWheel(p, QPointF(r.left() + 140, r.top() + 180));
        drawTurnKeys(p, QPointF(r.left() + 370, r.top() + 110), k.left, k.right);
        drawFireKey(p, QPointF(r.left() + 370, r.top() + 240), k.fire);
        drawLabel(p, QRectF(r.left() + 20, r.top() + 340, r.width() - 40, 70),
                  QStringLiteral("Hold a turn key to keep the wheel turning that way; the fire "
                                 "key presses the button."),
                  kMuted, 15, Qt::AlignCenter | Qt::TextWordWrap);
    }
    return img;
}

// ---- backgrounds --------------------------------------------------------------------------

constexpr int kBackWidth = 800;
constexpr int kBackHeight = 600;

// Pale colours throughout, so that the list's black text stays easy to read on top.
QImage paleSky() {
    QImage img(kBackWidth, kBackHeight, QImage::Format_RGB32);
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    QLinearGradient sky(0, 0, 0, kBackHeight);
    sky.setColorAt(0, QColor(196, 222, 246));
    sky.setColorAt(1, QColor(244, 249, 255));
    p.fillRect(img.rect(), sky);
    QRandomGenerator rng(2600);
    p.setPen(Qt::NoPen);
    for (int cloud = 0; cloud < 9; ++cloud) {
        const QPointF c(rng.bounded(kBackWidth), rng.bounded(kBackHeight * 2 / 3));
        for (int puff = 0; puff < 7; ++puff) {
            const QPointF at = c + QPointF(rng.bounded(160) - 80, rng.bounded(40) - 20);
            const qreal radius = 30 + rng.bounded(40);
            QRadialGradient g(at, radius);
            g.setColorAt(0, QColor(255, 255, 255, 150));
            g.setColorAt(1, QColor(255, 255, 255, 0));
            p.setBrush(g);
            p.drawEllipse(at, radius, radius);
        }
    }
    return img;
}

QImage rainbowStripes() {
    QImage img(kBackWidth, kBackHeight, QImage::Format_RGB32);
    img.fill(QColor(250, 248, 244));
    QPainter p(&img);
    p.setRenderHint(QPainter::Antialiasing);
    // Soft stripes sweeping up from the bottom right corner.
    const QColor stripes[] = {QColor(250, 214, 200), QColor(252, 230, 196), QColor(250, 242, 200),
                              QColor(214, 238, 210), QColor(206, 226, 246), QColor(226, 214, 244)};
    p.setPen(Qt::NoPen);
    const qreal band = 34;
    for (int i = 0; i < 6; ++i) {
        const qreal outer = 520 - i * band;
        p.setBrush(stripes[i]);
        p.drawEllipse(QPointF(kBackWidth + 40, kBackHeight + 40), outer, outer);
    }
    p.setBrush(QColor(250, 248, 244));
    p.drawEllipse(QPointF(kBackWidth + 40, kBackHeight + 40), 520 - 6 * band, 520 - 6 * band);
    return img;
}

QImage graphPaper() {
    QImage img(kBackWidth, kBackHeight, QImage::Format_RGB32);
    img.fill(QColor(252, 252, 246));
    QPainter p(&img);
    for (int x = 0; x <= kBackWidth; x += 20) {
        p.setPen(QPen(x % 100 == 0 ? QColor(178, 206, 224) : QColor(220, 232, 240), 1));
        p.drawLine(x, 0, x, kBackHeight);
    }
    for (int y = 0; y <= kBackHeight; y += 20) {
        p.setPen(QPen(y % 100 == 0 ? QColor(178, 206, 224) : QColor(220, 232, 240), 1));
        p.drawLine(0, y, kBackWidth, y);
    }
    return img;
}

QImage dusk() {
    QImage img(kBackWidth, kBackHeight, QImage::Format_RGB32);
    QPainter p(&img);
    QLinearGradient g(0, 0, kBackWidth, kBackHeight);
    g.setColorAt(0, QColor(255, 236, 214));
    g.setColorAt(0.55, QColor(246, 214, 226));
    g.setColorAt(1, QColor(214, 212, 242));
    p.fillRect(img.rect(), g);
    return img;
}

// The main window's backdrop: the progress bar's background, tiled, so it repeats
// seamlessly across.
QImage backdrop() {
    constexpr int w = 96;
    constexpr int h = 48;
    QImage img(w, h, QImage::Format_RGB32);
    QPainter p(&img);
    QLinearGradient g(0, 0, 0, h);
    g.setColorAt(0, QColor(250, 251, 253));
    g.setColorAt(0.5, QColor(232, 237, 245));
    g.setColorAt(1, QColor(214, 221, 234));
    p.fillRect(img.rect(), g);
    // Diagonal lines 8 apart; the width is a multiple of 8, so tiles join without a seam.
    p.setPen(QColor(255, 255, 255, 110));
    for (int x = -h; x < w; x += 8)
        p.drawLine(x, 0, x + h, h);
    return img;
}

bool save(const QImage& image, const QString& path, const char* format, int quality) {
    if (!image.save(path, format, quality)) {
        std::fprintf(stderr, "%s: error: cannot write the picture\n", qPrintable(path));
        return false;
    }
    return true;
}

} // namespace

int main(int argc, char** argv) {
    QGuiApplication app(argc, argv);
    if (argc != 2) {
        std::fprintf(stderr, "usage: lum_pictures OUTPUT_FOLDER\n");
        return 2;
    }
    const QDir out(QFile::decodeName(argv[1]));
    if (!out.mkpath(QStringLiteral("Backgrounds"))) {
        std::fprintf(stderr, "%s: error: cannot make the folder\n", argv[1]);
        return 1;
    }
    bool ok = true;
    ok &= save(standardPicture(), out.filePath("lum Standard.jpg"), "JPG", 90);
    ok &= save(paddlePicture(), out.filePath("lum Paddles.jpg"), "JPG", 90);
    ok &= save(keyboardPicture(), out.filePath("lum Keyboard.jpg"), "JPG", 90);
    ok &= save(drivingPicture(), out.filePath("lum Driving.jpg"), "JPG", 90);
    ok &= save(paleSky(), out.filePath("Backgrounds/Pale Sky.jpg"), "JPG", 85);
    ok &= save(rainbowStripes(), out.filePath("Backgrounds/Rainbow.jpg"), "JPG", 85);
    ok &= save(graphPaper(), out.filePath("Backgrounds/Graph Paper.png"), "PNG", -1);
    ok &= save(dusk(), out.filePath("Backgrounds/Dusk.jpg"), "JPG", 85);
    ok &= save(backdrop(), out.filePath("backdrop.png"), "PNG", -1);
    return ok ? 0 : 1;
}
