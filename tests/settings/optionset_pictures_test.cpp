#include "support/Boxes.h"

#include "settings/frmPicPreview.h"
#include "settings/frmSettings.h"

#include <QComboBox>
#include <QImage>
#include <QPointer>
#include <QPushButton>
#include <QTest>

#include <gtest/gtest.h>

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

    // Closed, it is gone; the next click opens a new one.
    first->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(first.isNull());
    w.cmdLeftControlPic_Click();
    ASSERT_NE(w.findChild<frmPicPreview*>(), nullptr);
    EXPECT_EQ(w.findChild<frmPicPreview*>()->windowTitle(), "Paddle Control Layout");
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);
}
