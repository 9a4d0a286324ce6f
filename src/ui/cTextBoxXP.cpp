#include "ui/cTextBoxXP.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QScreen>
#include <QStyle>
#include <QTimer>
#include <QToolTip>
#include <QVBoxLayout>

#include <algorithm>

namespace {

constexpr int kShownMilliseconds = 8000;

QIcon standardIcon(int icon) {
    switch (icon) {
    case 1:
        return QApplication::style()->standardIcon(QStyle::SP_MessageBoxInformation);
    case 2:
        return QApplication::style()->standardIcon(QStyle::SP_MessageBoxWarning);
    case 3:
        return QApplication::style()->standardIcon(QStyle::SP_MessageBoxCritical);
    default:
        return QIcon();
    }
}

} // namespace

BalloonTip::BalloonTip(QWidget* anchor, int icon, const QString& title, const QString& text)
    : QFrame(anchor, Qt::ToolTip | Qt::FramelessWindowHint), m_title(title), m_text(text),
      m_icon(icon) {
    setObjectName(QStringLiteral("balloonTip"));
    setAttribute(Qt::WA_DeleteOnClose);
    setFrameShape(QFrame::Box);
    setAutoFillBackground(true);
    setPalette(QToolTip::palette());

    auto* outer = new QHBoxLayout(this);
    outer->setContentsMargins(8, 6, 10, 8);
    outer->setSpacing(8);
    if (const QIcon i = standardIcon(icon); !i.isNull()) {
        auto* iconLabel = new QLabel(this);
        iconLabel->setObjectName(QStringLiteral("balloonIcon"));
        iconLabel->setPixmap(i.pixmap(24, 24));
        outer->addWidget(iconLabel, 0, Qt::AlignTop);
    }
    auto* column = new QVBoxLayout;
    auto* titleLabel = new QLabel(title, this);
    titleLabel->setObjectName(QStringLiteral("balloonTitle"));
    QFont bold = titleLabel->font();
    bold.setBold(true);
    titleLabel->setFont(bold);
    titleLabel->setTextFormat(Qt::PlainText);
    auto* textLabel =
        new QLabel(QString(text).replace(QLatin1String("\r\n"), QLatin1String("\n")), this);
    textLabel->setObjectName(QStringLiteral("balloonText"));
    textLabel->setTextFormat(Qt::PlainText);
    column->addWidget(titleLabel);
    column->addWidget(textLabel);
    outer->addLayout(column);

    adjustSize();
    // Under the control, starting a little in from its left edge; above it where the screen
    // ends below, and always whole on the screen's free area.
    QPoint at = anchor->mapToGlobal(QPoint(std::min(16, anchor->width() / 2), anchor->height()));
    const QRect area = anchor->screen()->availableGeometry();
    if (at.y() + height() > area.bottom() + 1)
        at.setY(anchor->mapToGlobal(QPoint()).y() - height());
    at.setX(std::clamp(at.x(), area.left(), std::max(area.left(), area.right() + 1 - width())));
    at.setY(std::clamp(at.y(), area.top(), std::max(area.top(), area.bottom() + 1 - height())));
    move(at);
    QTimer::singleShot(kShownMilliseconds, this, &QWidget::close);
}

void BalloonTip::mousePressEvent(QMouseEvent*) {
    close();
}

void cTextBoxXP::setCueBanner(const QString& text) {
    m_cueBanner = text;
    if (auto* edit = qobject_cast<QLineEdit*>(m_box.data()))
        edit->setPlaceholderText(text);
}

BalloonTip* cTextBoxXP::shownOn(QWidget* box) {
    if (box == nullptr)
        return nullptr;
    for (BalloonTip* tip : box->findChildren<BalloonTip*>(QString(), Qt::FindDirectChildrenOnly))
        if (tip->isVisible())
            return tip;
    return nullptr;
}

void cTextBoxXP::ShowBalloonTip() {
    if (m_box == nullptr)
        return;
    HideBalloonTip();
    auto* tip = new BalloonTip(m_box, m_icon, m_title, m_text);
    tip->show();
}

void cTextBoxXP::HideBalloonTip() {
    if (m_box == nullptr)
        return;
    for (BalloonTip* tip :
         m_box->findChildren<BalloonTip*>(QString(), Qt::FindDirectChildrenOnly)) {
        tip->hide();
        tip->deleteLater();
    }
}
