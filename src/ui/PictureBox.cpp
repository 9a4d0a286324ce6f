#include "ui/PictureBox.h"

#include "ui/OleColor.h"

#include <QPainter>

PictureBox::PictureBox(QWidget* parent) : QWidget(parent) {
    setAttribute(Qt::WA_OpaquePaintEvent);
}

QImage& PictureBox::image() {
    const QSize wanted = size().expandedTo(QSize(1, 1));
    if (m_image.size() != wanted) {
        m_image = QImage(wanted, QImage::Format_RGB32);
        m_image.fill(oleToColor(m_backColor));
    }
    return m_image;
}

void PictureBox::setBackColor(quint32 ole) {
    m_backColor = ole;
    if (!m_image.isNull())
        m_image.fill(oleToColor(m_backColor));
    update();
}

void PictureBox::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    if (m_image.isNull())
        painter.fillRect(rect(), oleToColor(m_backColor));
    else
        painter.drawImage(0, 0, m_image);
}
