#pragma once

#include <QString>
#include <QtGlobal>

#include <vector>

class PictureBox;

// One band of the logo's gradient: the rows [top, bottom) filled with one colour.
struct GradientBand {
    int top;
    int bottom;
    int red, green, blue;
};

// The bands of a gradient `height` pixels high from the start colour at the bottom edge
// towards the end colour at the top (components 0..255). The last band may reach above
// the top edge (a negative top).
std::vector<GradientBand> gradientBands(int height, int startRed, int startGreen, int startBlue,
                                        int endRed, int endGreen, int endBlue);

// Paints a vertical gradient into a picture box and writes a caption over it, turned to
// read upwards.
class cLogo {
public:
    QString Caption() const { return m_caption; }
    // Does not redraw.
    void setCaption(const QString& caption) { m_caption = caption; }
    // Does not redraw.
    void setDrawingObject(PictureBox* box) { m_box = box; }

    quint32 StartColor() const { return m_startColor; }
    // A new colour is stored and drawn at once when there is something to draw into.
    void setStartColor(quint32 ole);
    quint32 EndColor() const { return m_endColor; }
    void setEndColor(quint32 ole);

    void Draw();

    // How many times Draw painted (for the tests of when it redraws).
    int drawCount() const { return m_drawCount; }

private:
    PictureBox* m_box = nullptr;
    QString m_caption;
    quint32 m_startColor = 0;
    quint32 m_endColor = 0x8000000F;
    int m_drawCount = 0;
};
