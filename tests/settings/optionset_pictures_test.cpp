#include "support/FakePlatform.h"

#include "QtPrinters.h"

#include "settings/frmPicPreview.h"
#include "settings/frmSettings.h"

#include <QComboBox>
#include <QImage>
#include <QPointer>
#include <QPushButton>
#include <QTest>

#include <gtest/gtest.h>

namespace {

class ControlPictures : public ::testing::Test {
protected:
    void writePicture(const QString& name) {
        QImage image(40, 20, QImage::Format_RGB32);
        image.fill(Qt::darkGreen);
        ASSERT_TRUE(image.save(fake.programFolder() + "/" + name, "JPG"));
    }
    frmPicPreview* preview() const { return w.findChild<frmPicPreview*>(); }

    FakePlatform fake;
    frmSettings w{fake.platform};
};

} // namespace

TEST_F(ControlPictures, PictureNameFollowsTheLastLayoutWordInTheCaption) {
    const struct {
        const char* caption;
        const char* name;
    } cases[] = {
        {"Standard Control Layout", "/lum Standard.jpg"},
        {"Paddle Control Layout", "/lum Paddles.jpg"},
        {"Keyboard Control Layout", "/lum Keyboard.jpg"},
        {"Driving Control Layout", "/lum Driving.jpg"},
        {"DRIVING", "/lum Driving.jpg"},
        {"paddle or driving", "/lum Driving.jpg"},
        {"driving or paddle", "/lum Driving.jpg"},
        {"keyboard standard", "/lum Keyboard.jpg"},
        {"Joystick", ""},
        {"", ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(w.GetPicName(c.caption), c.name) << c.caption;
}

TEST_F(ControlPictures, EachPortButtonShowsItsControllersPicture) {
    writePicture("lum Paddles.jpg");
    writePicture("lum Driving.jpg");
    w.comboLeftController->setCurrentIndex(2);  // Paddle Controller
    w.comboRightController->setCurrentIndex(4); // Driving Controller
    ASSERT_EQ(w.cmdLeftControlPic->text(), "Paddle Control Layout");
    ASSERT_EQ(w.cmdRightControlPic->text(), "Driving Control Layout");

    QTest::mouseClick(w.cmdLeftControlPic, Qt::LeftButton);
    const QPointer<frmPicPreview> first = preview();
    ASSERT_NE(first, nullptr);
    EXPECT_TRUE(first->isVisible());
    EXPECT_EQ(first->windowTitle(), "Paddle Control Layout");
    EXPECT_EQ(first->picturePath(), fake.programFolder() + "/lum Paddles.jpg");

    // A click while it is open replaces picture and caption in the same window.
    QTest::mouseClick(w.cmdRightControlPic, Qt::LeftButton);
    EXPECT_EQ(preview(), first.data());
    EXPECT_EQ(first->windowTitle(), "Driving Control Layout");
    EXPECT_EQ(first->picturePath(), fake.programFolder() + "/lum Driving.jpg");

    // Closed, it is gone; the next click opens a new one.
    first->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(first.isNull());
    w.cmdLeftControlPic_Click();
    ASSERT_NE(preview(), nullptr);
    EXPECT_EQ(preview()->windowTitle(), "Paddle Control Layout");
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(ControlPictures, MissingPictureSaysSo) {
    w.cmdLeftControlPic_Click();
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text, "Error loading pic");
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Error");
    EXPECT_EQ(fake.dialogs.boxes[0].icon, MsgIcon::Exclamation);
    EXPECT_TRUE(preview() == nullptr || !preview()->isVisible());
}
