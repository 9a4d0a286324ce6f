#include "support/Boxes.h"

#include "platform/SettingsStore.h"
#include "settings/PictureFit.h"
#include "settings/frmPicPreview.h"
#include "settings/frmSettings.h"
#include "ui/Twips.h"

#include <QComboBox>
#include <QCoreApplication>
#include <QImage>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QTest>

#include <gtest/gtest.h>

static void PrintTo(const PictureFit& f, std::ostream* out) {
    *out << "{top " << f.top << ", left " << f.left << ", " << f.width << " x " << f.height << "}";
}

namespace {

class PicturePreview : public ::testing::Test {
protected:
    void TearDown() override { delete m_preview.data(); }

    // A picture file of the given size in the program folder.
    QString writePicture(const QString& name, int width, int height) {
        const QString path = fake.programFolder() + "/" + name;
        QImage image(width, height, QImage::Format_RGB32);
        image.fill(Qt::darkCyan);
        EXPECT_TRUE(image.save(path, "JPG"));
        return path;
    }

    // A new preview window, the given inner size when one is given.
    frmPicPreview* open(QSize size = {}, QWidget* owner = nullptr) {
        delete m_preview.data();
        m_preview = new frmPicPreview(fake.platform, owner);
        if (size.isValid()) {
            m_preview->resize(size);
            QCoreApplication::processEvents();
        }
        return m_preview;
    }

    FakePlatform fake;
    QPointer<frmPicPreview> m_preview;
};

} // namespace

TEST_F(PicturePreview, OpensWhereTheLastOneWasClosedOrAtItsDefaultPlace) {
    frmPicPreview* preview = open();
    EXPECT_EQ(preview->objectName(), "frmPicPreview");
    EXPECT_EQ(QRect(preview->pos(), preview->size()),
              QRect(twips::toPixelsX(300), twips::toPixelsY(300), twips::toPixelsX(11115),
                    twips::toPixelsY(5655)));

    ASSERT_TRUE(preview->showPicture(writePicture("a.jpg", 64, 32), "Paddle Control Layout"));
    preview->move(twips::toPixelsX(900), twips::toPixelsY(600));
    preview->resize(twips::toPixelsX(6000), twips::toPixelsY(4500));
    QCoreApplication::processEvents();
    const QRect placed(preview->pos(), preview->size());
    preview->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(m_preview.isNull()) << "a closed preview is gone until the next click";

    auto store = fake.reopenStore();
    EXPECT_DOUBLE_EQ(readSingle(*store, "picpos", "left", -1), twips::fromPixelsX(placed.x()));
    EXPECT_DOUBLE_EQ(readSingle(*store, "picpos", "height", -1),
                     twips::fromPixelsY(placed.height()));
    preview = open();
    EXPECT_EQ(QRect(preview->pos(), preview->size()), placed);
}

TEST_F(PicturePreview, PictureFillsOneAxisAndIsCentredOnTheOther) {
    const struct {
        const char* what;
        QSize picture;
        QRect image;
    } cases[] = {
        {"wider", {400, 100}, {0, 100, 400, 100}},
        {"taller", {100, 500}, {170, 0, 60, 300}},
        {"same proportions", {800, 600}, {0, 0, 400, 300}},
    };
    frmPicPreview* preview = open({400, 300});
    for (const auto& c : cases) {
        const QString pic = writePicture(QString::fromLatin1(c.what) + ".jpg", c.picture.width(),
                                         c.picture.height());
        ASSERT_TRUE(preview->showPicture(pic, c.what)) << c.what;
        QCoreApplication::processEvents();
        ASSERT_EQ(preview->size(), QSize(400, 300)) << c.what;
        EXPECT_EQ(preview->windowTitle(), QLatin1String(c.what));
        EXPECT_EQ(preview->picturePath(), pic);
        EXPECT_EQ(preview->PPPic->size(), c.picture) << c.what;
        EXPECT_FALSE(preview->PPPic->isVisible());
        EXPECT_TRUE(preview->PPImg->isVisible());
        EXPECT_EQ(preview->PPImg->geometry(), c.image) << c.what;
    }
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(PicturePreview, ResizesAndNewPathsRefitButNotWhileMinimized) {
    frmPicPreview* preview = open({200, 200});
    preview->show();
    preview->setPicturePath(writePicture("wide.jpg", 400, 100));
    EXPECT_EQ(preview->PPImg->geometry(), QRect(0, 75, 200, 50));
    preview->setPicturePath(writePicture("tall.jpg", 100, 400));
    EXPECT_EQ(preview->PPImg->geometry(), QRect(75, 0, 50, 200));
    // A path that cannot be loaded keeps the picture, and only a click reports it.
    preview->setPicturePath(fake.programFolder() + "/gone.jpg");
    EXPECT_EQ(preview->picturePath(), fake.programFolder() + "/gone.jpg");
    EXPECT_EQ(preview->PPPic->size(), QSize(100, 400));
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    preview->resize(600, 200);
    QCoreApplication::processEvents();
    EXPECT_EQ(preview->PPImg->geometry(), QRect(275, 0, 50, 200));
    preview->setWindowState(Qt::WindowMinimized);
    QCoreApplication::processEvents();
    preview->refit();
    EXPECT_EQ(preview->PPImg->geometry(), QRect(275, 0, 50, 200));
}

TEST_F(PicturePreview, APictureThatCannotBeLoadedSaysSoAndChangesNothing) {
    // A caption that names no picture leaves only the folder to try.
    for (const QString& path :
         {fake.programFolder() + "/lum Missing.jpg",
          fake.writeFile("program/lum Keyboard.jpg", "not a JPEG"), fake.programFolder() + "/"}) {
        fake.dialogs.boxes.clear();
        EXPECT_FALSE(open()->showPicture(path, "Keyboard Control Layout"));
        EXPECT_EQ(fake.dialogs.boxes.size(), 1u) << qPrintable(path);
        EXPECT_FALSE(m_preview->isVisible());
    }

    // An open window keeps its picture and caption.
    const QString good = writePicture("lum Driving.jpg", 300, 100);
    frmPicPreview* preview = open();
    ASSERT_TRUE(preview->showPicture(good, "Driving Control Layout"));
    const QRect shown = preview->PPImg->geometry();
    EXPECT_FALSE(preview->showPicture(fake.programFolder() + "/", "Keyboard Control Layout"));
    EXPECT_EQ(preview->windowTitle(), "Driving Control Layout");
    EXPECT_EQ(preview->picturePath(), good);
    EXPECT_TRUE(preview->isVisible());
    EXPECT_EQ(preview->PPImg->geometry(), shown);
    EXPECT_FALSE(preview->PPImg->pixmap().isNull());
}

TEST_F(PicturePreview, TakesItsOwnersIcon) {
    QWidget owner;
    QPixmap pixmap(16, 16);
    pixmap.fill(Qt::red);
    owner.setWindowIcon(QIcon(pixmap));
    frmPicPreview* preview = open({}, &owner);
    EXPECT_EQ(preview->windowIcon().cacheKey(), owner.windowIcon().cacheKey());
    EXPECT_TRUE(preview->isWindow());
}

TEST(FitPictureToBox, FillsOneAxisAndCentresOnTheOther) {
    const struct {
        const char* what;
        QSizeF picture; // width x height
        float height, width;
        bool frame;
        float top, left;
        PictureFit fit;
    } cases[] = {
        {"wider than the box", {200, 100}, 1000, 1000, false, 0, 0, {250, 0, 1000, 500}},
        {"taller than the box", {100, 200}, 1000, 1000, false, 0, 0, {0, 250, 500, 1000}},
        {"same proportions", {300, 150}, 300, 600, false, 0, 0, {0, 0, 600, 300}},
        // The preview window's first size, less its frame: 10990 x 5130 twips.
        {"outer size with frame", {640, 480}, 5655, 11115, true, 0, 0, {0, 2075, 6840, 5130}},
        {"frame, wide picture", {1000, 100}, 1525, 1125, true, 0, 0, {450, 0, 1000, 100}},
        // The caller's start is added on the axis that is centred and kept on the other.
        {"start offsets, wider", {200, 100}, 1000, 1000, false, 10, 20, {260, 20, 1000, 500}},
        {"start offsets, taller", {100, 200}, 1000, 1000, false, 10, 20, {10, 270, 500, 1000}},
    };
    for (const auto& c : cases) {
        const std::optional<PictureFit> fit =
            FitPictureToBox(c.picture, c.height, c.width, c.frame, c.top, c.left);
        ASSERT_TRUE(fit) << c.what;
        EXPECT_EQ(*fit, c.fit) << c.what;
    }
}

TEST(FitPictureToBox, NothingToFitOrNoRoomLeft) {
    EXPECT_FALSE(FitPictureToBox({0, 100}, 500, 500, false));
    EXPECT_FALSE(FitPictureToBox({100, 0}, 500, 500, false));
    EXPECT_FALSE(FitPictureToBox({}, 500, 500, false));
    // A window smaller than its frame: an empty target at the start, no division by 0.
    EXPECT_EQ(FitPictureToBox({100, 100}, 400, 2000, true), (PictureFit{0, 0, 0, 0}));
    EXPECT_EQ(FitPictureToBox({100, 100}, 2000, 125, true, 5, 6), (PictureFit{5, 6, 0, 0}));
    EXPECT_EQ(FitPictureToBox({100, 100}, 0, 0, false), (PictureFit{0, 0, 0, 0}));
}

TEST(ControlPictures, PictureNameFollowsTheLastLayoutWordInTheCaption) {
    FakePlatform fake;
    frmSettings w(fake.platform);
    const std::pair<const char*, const char*> cases[] = {
        {"Standard Control Layout", "/lum Standard.jpg"},
        {"Paddle Control Layout", "/lum Paddles.jpg"},
        {"Keyboard Control Layout", "/lum Keyboard.jpg"},
        {"DRIVING", "/lum Driving.jpg"},
        {"driving or paddle", "/lum Driving.jpg"},
        {"keyboard standard", "/lum Keyboard.jpg"},
        {"Joystick", ""},
    };
    for (const auto& [caption, name] : cases)
        EXPECT_EQ(w.GetPicName(caption), name) << caption;
}

TEST(ControlPictures, EachPortButtonShowsItsControllersPicture) {
    FakePlatform fake;
    frmSettings w(fake.platform);
    w.cmdLeftControlPic_Click(); // no picture file yet
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"Error | Error loading pic | Ok | Exclamation"});
    EXPECT_TRUE(w.findChild<frmPicPreview*>() == nullptr ||
                !w.findChild<frmPicPreview*>()->isVisible());

    for (const char* name : {"lum Paddles.jpg", "lum Driving.jpg"}) {
        QImage image(40, 20, QImage::Format_RGB32);
        image.fill(Qt::darkGreen);
        ASSERT_TRUE(image.save(fake.programFolder() + "/" + name, "JPG"));
    }
    w.comboLeftController->setCurrentIndex(2);  // Paddle Controller
    w.comboRightController->setCurrentIndex(4); // Driving Controller
    ASSERT_EQ(w.cmdLeftControlPic->text(), "Paddle Control Layout");
    QTest::mouseClick(w.cmdLeftControlPic, Qt::LeftButton);
    const QPointer<frmPicPreview> first = w.findChild<frmPicPreview*>();
    ASSERT_NE(first, nullptr);
    EXPECT_TRUE(first->isVisible());
    EXPECT_EQ(first->windowTitle(), "Paddle Control Layout");
    EXPECT_EQ(first->picturePath(), fake.programFolder() + "/lum Paddles.jpg");

    // A click while it is open replaces picture and caption in the same window.
    QTest::mouseClick(w.cmdRightControlPic, Qt::LeftButton);
    EXPECT_EQ(w.findChild<frmPicPreview*>(), first.data());
    EXPECT_EQ(first->windowTitle(), "Driving Control Layout");
    EXPECT_EQ(first->picturePath(), fake.programFolder() + "/lum Driving.jpg");

    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);
}
