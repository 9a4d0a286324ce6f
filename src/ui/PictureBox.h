#pragma once

#include <QImage>
#include <QWidget>

// A picture box: a control that keeps a picture of its own size and shows it. Drawing
// code paints into image() and calls refresh().
class PictureBox : public QWidget {
    Q_OBJECT
public:
    explicit PictureBox(QWidget* parent = nullptr);

    // The picture, resized (and cleared to the back colour) when the control's size changed.
    QImage& image();
    void refresh() { update(); }

    quint32 BackColor() const { return m_backColor; }
    void setBackColor(quint32 ole);
    // The colour text is written in.
    quint32 ForeColor() const { return m_foreColor; }
    void setForeColor(quint32 ole) { m_foreColor = ole; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QImage m_image;
    quint32 m_backColor = 0x8000000F;
    quint32 m_foreColor = 0;
};
