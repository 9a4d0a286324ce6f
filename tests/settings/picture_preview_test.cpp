#include "support/FakePlatform.h"

#include "QtPrinters.h"

#include "platform/SettingsStore.h"
#include "settings/frmPicPreview.h"
#include "ui/Twips.h"

#include <QApplication>
#include <QImage>
#include <QLabel>
#include <QPointer>
#include <QTest>

#include <gtest/gtest.h>

namespace {

const QString kPicpos = QStringLiteral("picpos");

class PicturePreview : public ::testing::Test {
protected:
    void TearDown() override {
        if (m_preview)
            m_preview->close();
        delete m_preview;
    }

    // A picture file of the given size in the program folder.
    QString writePicture(const QString& name, int width, int height) {
        const QString path = fake.programFolder() + "/" + name;
        QImage image(width, height, QImage::Format_RGB32);
        image.fill(Qt::darkCyan);
        EXPECT_TRUE(image.save(path, "JPG"));
        return path;
    }

    frmPicPreview* open(QWidget* owner = nullptr) {
        m_preview = new frmPicPreview(fake.platform, owner);
        return m_preview;
    }

    // Sets the window's inner size and lets the window system deliver it.
    static void resizeTo(frmPicPreview* preview, int width, int height) {
        preview->resize(width, height);
        QCoreApplication::processEvents();
    }

    FakePlatform fake;
    QPointer<frmPicPreview> m_preview;
};

} // namespace

TEST_F(PicturePreview, FirstOpenedAtItsDefaultPlaceAndSize) {
    frmPicPreview* preview = open();
    EXPECT_EQ(preview->objectName(), "frmPicPreview");
    EXPECT_EQ(preview->pos(), QPoint(twips::toPixelsX(300), twips::toPixelsY(300)));
    EXPECT_EQ(preview->size(), QSize(twips::toPixelsX(11115), twips::toPixelsY(5655)));
}

TEST_F(PicturePreview, ClosingStoresThePlaceAndTheNextOneOpensThere) {
    const QString pic = writePicture("lum Paddles.jpg", 64, 32);
    frmPicPreview* preview = open();
    ASSERT_TRUE(preview->showPicture(pic, "Paddle Control Layout"));
    preview->move(twips::toPixelsX(900), twips::toPixelsY(600));
    resizeTo(preview, twips::toPixelsX(6000), twips::toPixelsY(4500));
    const QRect placed(preview->pos(), preview->size());
    preview->close();
    QCoreApplication::processEvents();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(m_preview.isNull()) << "a closed preview is gone until the next click";

    auto store = fake.reopenStore();
    EXPECT_DOUBLE_EQ(readSingle(*store, kPicpos, "left", -1), twips::fromPixelsX(placed.x()));
    EXPECT_DOUBLE_EQ(readSingle(*store, kPicpos, "top", -1), twips::fromPixelsY(placed.y()));
    EXPECT_DOUBLE_EQ(readSingle(*store, kPicpos, "width", -1), twips::fromPixelsX(placed.width()));
    EXPECT_DOUBLE_EQ(readSingle(*store, kPicpos, "height", -1),
                     twips::fromPixelsY(placed.height()));

    frmPicPreview* again = open();
    EXPECT_EQ(QRect(again->pos(), again->size()), placed);
}

TEST_F(PicturePreview, PictureFillsOneAxisAndIsCentredOnTheOther) {
    const struct {
        const char* what;
        int pictureWidth, pictureHeight;
        QRect image;
    } cases[] = {
        {"wider", 400, 100, QRect(0, 100, 400, 100)},
        {"taller", 100, 500, QRect(170, 0, 60, 300)},
        {"same proportions", 800, 600, QRect(0, 0, 400, 300)},
    };
    frmPicPreview* preview = open();
    resizeTo(preview, 400, 300);
    for (const auto& c : cases) {
        const QString pic =
            writePicture(QString::fromLatin1(c.what) + ".jpg", c.pictureWidth, c.pictureHeight);
        ASSERT_TRUE(preview->showPicture(pic, c.what)) << c.what;
        QCoreApplication::processEvents();
        ASSERT_EQ(preview->size(), QSize(400, 300)) << c.what;
        EXPECT_EQ(preview->windowTitle(), QLatin1String(c.what));
        EXPECT_EQ(preview->picturePath(), pic);
        EXPECT_EQ(preview->PPPic->size(), QSize(c.pictureWidth, c.pictureHeight)) << c.what;
        EXPECT_FALSE(preview->PPPic->isVisible());
        EXPECT_TRUE(preview->PPImg->isVisible()) << c.what;
        EXPECT_EQ(preview->PPImg->geometry(), c.image) << c.what;
    }
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(PicturePreview, ResizingRefitsAtOnceButNotWhileMinimized) {
    const QString pic = writePicture("lum Standard.jpg", 200, 100);
    frmPicPreview* preview = open();
    ASSERT_TRUE(preview->showPicture(pic, "Standard Control Layout"));
    resizeTo(preview, 300, 300);
    EXPECT_EQ(preview->PPImg->geometry(), QRect(0, 75, 300, 150));
    resizeTo(preview, 600, 200);
    EXPECT_EQ(preview->PPImg->geometry(), QRect(100, 0, 400, 200));

    preview->setWindowState(Qt::WindowMinimized);
    QCoreApplication::processEvents();
    preview->refit();
    EXPECT_EQ(preview->PPImg->geometry(), QRect(100, 0, 400, 200));
}

TEST_F(PicturePreview, APictureThatCannotBeLoadedSaysSoAndChangesNothing) {
    const QString notAPicture = fake.writeFile("program/lum Keyboard.jpg", "not a JPEG");
    const QString good = writePicture("lum Driving.jpg", 300, 100);
    const QString cases[] = {
        fake.programFolder() + "/lum Missing.jpg",
        notAPicture,
        // A caption that names no picture leaves only the folder to try.
        fake.programFolder() + "/",
    };
    for (const QString& path : cases) {
        FakePlatform local;
        frmPicPreview* preview = new frmPicPreview(local.platform);
        EXPECT_FALSE(preview->showPicture(path, "Keyboard Control Layout"));
        ASSERT_EQ(local.dialogs.boxes.size(), 1u) << qPrintable(path);
        EXPECT_EQ(local.dialogs.boxes[0].title, "Error");
        EXPECT_EQ(local.dialogs.boxes[0].text, "Error loading pic");
        EXPECT_EQ(local.dialogs.boxes[0].icon, MsgIcon::Exclamation);
        EXPECT_EQ(local.dialogs.boxes[0].buttons, MsgButtons::Ok);
        EXPECT_FALSE(preview->isVisible());
        delete preview;
    }

    // An open window keeps its picture and caption.
    frmPicPreview* preview = open();
    ASSERT_TRUE(preview->showPicture(good, "Driving Control Layout"));
    const QRect shown = preview->PPImg->geometry();
    EXPECT_FALSE(preview->showPicture(notAPicture, "Keyboard Control Layout"));
    EXPECT_EQ(preview->windowTitle(), "Driving Control Layout");
    EXPECT_EQ(preview->picturePath(), good);
    EXPECT_TRUE(preview->isVisible());
    EXPECT_EQ(preview->PPImg->geometry(), shown);
    EXPECT_FALSE(preview->PPImg->pixmap().isNull());
}

TEST_F(PicturePreview, ChangingThePathRefitsAndABadOneKeepsThePicture) {
    const QString wide = writePicture("wide.jpg", 400, 100);
    const QString tall = writePicture("tall.jpg", 100, 400);
    frmPicPreview* preview = open();
    resizeTo(preview, 200, 200);
    preview->setPicturePath(wide);
    EXPECT_EQ(preview->PPImg->geometry(), QRect(0, 75, 200, 50));
    preview->setPicturePath(tall);
    EXPECT_EQ(preview->PPImg->geometry(), QRect(75, 0, 50, 200));
    preview->setPicturePath(fake.programFolder() + "/gone.jpg");
    EXPECT_EQ(preview->picturePath(), fake.programFolder() + "/gone.jpg");
    EXPECT_EQ(preview->PPPic->size(), QSize(100, 400));
    EXPECT_EQ(preview->PPImg->geometry(), QRect(75, 0, 50, 200));
    EXPECT_TRUE(fake.dialogs.boxes.empty()) << "only a click reports a missing picture";
}

TEST_F(PicturePreview, TakesItsOwnersIcon) {
    QWidget owner;
    QPixmap pixmap(16, 16);
    pixmap.fill(Qt::red);
    const QIcon icon(pixmap);
    owner.setWindowIcon(icon);
    frmPicPreview* preview = open(&owner);
    EXPECT_EQ(preview->windowIcon().cacheKey(), icon.cacheKey());
    EXPECT_TRUE(preview->isWindow());
    preview->close();
}
