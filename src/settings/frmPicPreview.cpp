#include "settings/frmPicPreview.h"

#include "platform/Dialogs.h"
#include "platform/Platform.h"
#include "platform/StoredSettings.h"
#include "settings/PictureFit.h"
#include "ui/PictureFile.h"
#include "ui/Twips.h"

#include <QCloseEvent>
#include <QLabel>
#include <QPixmap>

#include <algorithm>
#include <cmath>

frmPicPreview::frmPicPreview(Platform& platform, QWidget* owner)
    : QWidget(owner, Qt::Window), m_platform(platform) {
    setObjectName(QStringLiteral("frmPicPreview"));
    setAttribute(Qt::WA_DeleteOnClose);

    PPPic = new QLabel(this);
    PPPic->setObjectName(QStringLiteral("PPPic"));
    PPPic->hide();

    PPImg = new QLabel(this);
    PPImg->setObjectName(QStringLiteral("PPImg"));
    PPImg->setScaledContents(true);
    PPImg->hide();

    Label1 = new QLabel(this);
    Label1->setObjectName(QStringLiteral("Label1"));
    Label1->setTextFormat(Qt::PlainText);
    Label1->hide();

    if (owner)
        setWindowIcon(owner->window()->windowIcon());

    const WindowPlace place = read(m_platform.store, stored::pictureWindow);
    m_place = placeOnScreen(*this, QRect(twips::toPixelsX(place.left), twips::toPixelsY(place.top),
                                         std::max(1, twips::toPixelsX(place.width)),
                                         std::max(1, twips::toPixelsY(place.height))));
}

bool frmPicPreview::showPicture(const QString& path, const QString& caption) {
    const QPixmap picture = QPixmap::fromImage(loadPictureFile(path));
    if (picture.isNull()) {
        m_platform.dialogs.MsgBox(this, QStringLiteral("Error loading pic"), MsgButtons::Ok,
                                  MsgIcon::Exclamation, QStringLiteral("Error"));
        return false;
    }
    takePicture(path, picture);
    setWindowTitle(caption);
    show();
    raise();
    activateWindow();
    return true;
}

QString frmPicPreview::picturePath() const {
    return Label1->text();
}

void frmPicPreview::takePicture(const QString& path, const QPixmap& picture) {
    PPPic->setPixmap(picture);
    PPPic->resize(picture.deviceIndependentSize().toSize());
    PPImg->setPixmap(picture);
    Label1->setText(path);
    refit();
}

void frmPicPreview::refit() {
    if (isMinimized())
        return;
    PPImg->hide();
    PPImg->move(0, 0);
    const QPixmap picture = PPPic->pixmap();
    if (picture.isNull())
        return;
    // Qt knows the window's inner size exactly, so there is no frame to estimate and take
    // off; the box is the client area in pixels.
    const std::optional<PictureFit> fit = FitPictureToBox(
        picture.deviceIndependentSize(), static_cast<float>(height()), static_cast<float>(width()));
    if (!fit)
        return;
    PPImg->setGeometry(
        static_cast<int>(std::lround(fit->left)), static_cast<int>(std::lround(fit->top)),
        static_cast<int>(std::lround(fit->width)), static_cast<int>(std::lround(fit->height)));
    PPImg->show();
}

void frmPicPreview::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    refit();
}

void frmPicPreview::closeEvent(QCloseEvent* event) {
    saveGeometryToStore();
    event->accept();
}

void frmPicPreview::saveGeometryToStore() {
    // A minimized window has no place worth keeping, and one moved onto a screen here is
    // kept out of the store until the user moves or resizes it.
    if (isMinimized() || !placeChangedByUser(*this, m_place))
        return;
    write(m_platform.store, stored::pictureWindow,
          {twips::fromPixelsY(y()), twips::fromPixelsX(x()), twips::fromPixelsX(width()),
           twips::fromPixelsY(height())});
}
