#include "settings/frmPicPreview.h"

#include "platform/Dialogs.h"
#include "platform/Platform.h"
#include "platform/SettingsStore.h"
#include "settings/PictureFit.h"
#include "ui/Twips.h"

#include <QCloseEvent>
#include <QFileInfo>
#include <QImageReader>
#include <QLabel>
#include <QPixmap>

#include <algorithm>
#include <cmath>

namespace {

const QString kPicpos = QStringLiteral("picpos");

// The picture in the file, or a null pixmap when there is none to be had.
QPixmap loadPicture(const QString& path) {
    // Only regular files: a folder is no picture, and a pipe could block the reader.
    if (!QFileInfo(path).isFile())
        return {};
    QImageReader reader(path);
    reader.setAutoTransform(true);
    return QPixmap::fromImage(reader.read());
}

} // namespace

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
    Label1->hide();

    if (owner)
        setWindowIcon(owner->window()->windowIcon());

    const SettingsStore& store = m_platform.store;
    const double height = readSingle(store, kPicpos, QStringLiteral("height"), 5655);
    const double width = readSingle(store, kPicpos, QStringLiteral("width"), 11115);
    const double top = readSingle(store, kPicpos, QStringLiteral("top"), 300);
    const double left = readSingle(store, kPicpos, QStringLiteral("left"), 300);
    resize(std::max(1, twips::toPixelsX(width)), std::max(1, twips::toPixelsY(height)));
    move(twips::toPixelsX(left), twips::toPixelsY(top));
}

bool frmPicPreview::showPicture(const QString& path, const QString& caption) {
    const QPixmap picture = loadPicture(path);
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

void frmPicPreview::setPicturePath(const QString& path) {
    const QPixmap picture = loadPicture(path);
    if (picture.isNull()) {
        // The path is taken; the picture shown before stays.
        Label1->setText(path);
        refit();
        return;
    }
    takePicture(path, picture);
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
    const std::optional<PictureFit> fit =
        FitPictureToBox(picture.deviceIndependentSize(), static_cast<float>(height()),
                        static_cast<float>(width()), false);
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
    // A minimized window has no place worth keeping.
    if (isMinimized())
        return;
    SettingsStore& store = m_platform.store;
    store.SaveSetting(kPicpos, QStringLiteral("top"), singleText(twips::fromPixelsY(y())));
    store.SaveSetting(kPicpos, QStringLiteral("left"), singleText(twips::fromPixelsX(x())));
    store.SaveSetting(kPicpos, QStringLiteral("height"), singleText(twips::fromPixelsY(height())));
    store.SaveSetting(kPicpos, QStringLiteral("width"), singleText(twips::fromPixelsX(width())));
}
