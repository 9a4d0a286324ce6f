#pragma once

#include "ui/pcMemDC.h"

#include <QElapsedTimer>
#include <QImage>
#include <QRect>
#include <QString>
#include <QWidget>

class QPainter;
class QStyleOptionProgressBar;

// The bar's layout rules, free of any widget.
namespace progressbar {

// Where Value lies between Min and Max, 0..1. Outside the range it is held at the near end;
// an empty range (Max = Min) gives 0, an empty bar.
double fraction(int value, int min, int max);

// The client rectangle less the border: 2 pixels on each side for the full 3D look
// (unthemed), otherwise 1; the whole client rectangle without a border.
QRect innerRect(const QRect& client, int borderStyle, int appearance, bool themed);

// The part of inner that the bar covers at fraction p: from the left when horizontal, from
// the bottom otherwise. With a step (segment plus gap) above 0 the length is cut to a whole
// number of steps.
QRect barRect(const QRect& inner, double p, bool horizontal, int step = 0);

// The gaps between segments of unit pixels separated by gap pixels, counted from the bar's
// start (its left end, or its bottom end when vertical). Each strip runs across the whole
// of inner; the caller clips them to the bar.
QList<QRect> gapStrips(const QRect& bar, const QRect& inner, bool horizontal, int unit, int gap);

// The value for a press at x across a bar that starts at left and is width pixels long:
// the first pixel column is Min, the last Max; beyond either end it is held there.
int valueAt(double x, int left, int width, int min, int max);

} // namespace progressbar

// A progress bar that draws itself: background colour or picture, a bar of colour or
// picture with optional segments, text in two colours (one over the background, one over
// the bar) and one of three border looks; or the current style's progress bar. It is wider
// than high for a horizontal bar growing to the right, otherwise vertical, growing upwards.
// In interactive mode the user sets Value by dragging with the left button.
//
// Every property set that changes the drawn picture repaints at once (at most once a
// frame), so a long operation that never returns to the event loop still shows its
// progress; a set that leaves every pixel as it was does not repaint.
// Colours are OLE colour numbers (ui/OleColor.h).
class vbalProgressBar : public QWidget {
    Q_OBJECT
public:
    explicit vbalProgressBar(QWidget* parent = nullptr);

    bool Segments() const { return m_segments; }
    void setSegments(bool on);
    bool XpStyle() const { return m_xpStyle; }
    void setXpStyle(bool on);
    QString Text() const { return m_text; }
    void setText(const QString& text);
    int TextAlignX() const { return m_textAlignX; } // 0 left, 1 centre, 2 right
    void setTextAlignX(int align);
    int TextAlignY() const { return m_textAlignY; } // 0 top, 1 centre, 2 bottom
    void setTextAlignY(int align);
    bool ShowText() const { return m_showText; }
    void setShowText(bool on);
    double Percent() const;
    // What Percent would be with Value at `value`.
    double PercentAt(int value) const;
    int Min() const { return m_min; }
    void setMin(int min);
    int Max() const { return m_max; }
    void setMax(int max);
    // Value is stored as set, also outside Min..Max; the drawing and Percent clamp it.
    int Value() const { return m_value; }
    void setValue(int value);
    int BorderStyle() const { return m_borderStyle; } // 0 none, 1 inset, 2 raised
    void setBorderStyle(int style);
    int Appearance() const { return m_appearance; } // 0 flat, 1 thin 3D, 2 full 3D
    void setAppearance(int appearance);
    bool Interactive() const { return m_interactive; }
    void setInteractive(bool on);
    quint32 BackColor() const { return m_backColor; }
    void setBackColor(quint32 ole);
    quint32 ForeColor() const { return m_foreColor; }
    void setForeColor(quint32 ole);
    // The widget's own font; QWidget::setFont sets it and repaints.
    QFont Font() const { return font(); }
    quint32 BarColor() const { return m_barColor; }
    void setBarColor(quint32 ole);
    quint32 BarForeColor() const { return m_barForeColor; }
    void setBarForeColor(quint32 ole);
    // A null image means no picture.
    QImage BarPicture() const { return m_bar.picture; }
    void setBarPicture(const QImage& picture);
    int BarPictureMode() const { return m_barPictureMode; } // 1 tile, else stretch
    void setBarPictureMode(int mode);
    int BackPictureMode() const { return m_backPictureMode; } // 1 tile, else stretch
    void setBackPictureMode(int mode);
    QImage Picture() const { return m_back.picture; }
    void setPicture(const QImage& picture);

    // Scale the luminance and saturation of the bar or background picture as drawn (the
    // picture itself is kept, and each call starts from it). Shows at the next redraw.
    void ModifyBarPicture(double fLuminance = 1.0, double fSaturation = 1.0);
    void ModifyPicture(double fLuminance = 1.0, double fSaturation = 1.0);

    // What the control draws, over the rectangle (0, 0, width, height) of painter.
    void drawControl(QPainter& painter);

signals:
    // Value was set with the mouse: once for every press of the left button, and once for
    // every drag step that moves it.
    void Change();
    void DblClick();
    void KeyPress(int KeyAscii);
    void RightClick();

protected:
    void paintEvent(QPaintEvent* event) override;
    void changeEvent(QEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    QSize sizeHint() const override { return {150, 20}; }

private:
    // A picture and the copy of it that is drawn (which the Modify operations change).
    struct PictureHolder {
        QImage picture;
        QImage surface; // ARGB32_Premultiplied

        bool has() const { return !surface.isNull(); }
        void set(const QImage& newPicture);
        void modify(double fLuminance, double fSaturation);
    };

    bool horizontal() const { return width() > height(); }
    bool themed() const { return m_xpStyle && !m_back.has(); }
    int barStep() const;
    double fraction() const { return progressbar::fraction(m_value, m_min, m_max); }
    // The bar's rectangle as it would be drawn now.
    QRect currentBar() const;
    // The rectangle the bar grows in: inside the border, or the style's contents area.
    QRect track() const;
    void initStyleOption(QStyleOptionProgressBar& option) const;
    void drawThemed(QPainter& p);
    void drawPlain(QPainter& p);
    void drawText(QPainter& p, const QRect& r, quint32 ole) const;
    void setFromMouse(QMouseEvent* event, bool pressed);
    // Repaints now; a set that cannot change the picture returns before this.
    void redraw();
    template <typename T> void assign(T& member, const T& value);
    void assignRange(int& member, int value);

    bool m_segments = false;
    bool m_xpStyle = false;
    QString m_text;
    int m_textAlignX = 1;
    int m_textAlignY = 1;
    bool m_showText = false;
    int m_min = 0;
    int m_max = 100;
    int m_value = 0;
    int m_borderStyle = 1;
    int m_appearance = 1;
    bool m_interactive = false;
    quint32 m_backColor = 0x8000000F; // the button face
    quint32 m_foreColor = 0;
    quint32 m_barColor = 0x800000;
    quint32 m_barForeColor = 0xFFFFFF;
    int m_barPictureMode = 1;
    int m_backPictureMode = 1;
    PictureHolder m_back;
    PictureHolder m_bar;
    pcMemDC m_memDC;
    QElapsedTimer m_lastRepaint;
    // The style's contents area is asked for once per size and style, not once per Value.
    mutable QRect m_themedTrack;
    mutable QSize m_themedTrackFor;
    // The style's empty track as last drawn, and what it was drawn for.
    struct GrooveKey {
        QSize size;
        qreal dpr = 0;
        bool enabled = false;
        bool active = false;
        bool operator==(const GrooveKey&) const = default;
    };
    QImage m_groove;
    GrooveKey m_grooveKey;
};
