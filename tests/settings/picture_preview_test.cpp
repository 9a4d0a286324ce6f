#include "SettingsFixture.h"
#include "support/Files.h"

#include "settings/frmPicPreview.h"
#include "ui/Twips.h"

#include <QPointer>

namespace {

class PicturePreview : public SettingsFixture {
protected:
    // A JPEG of that size in the program folder.
    QString picture(const QString& name, int width, int height) {
        return fake.writeFile("program/" + name, encodedPicture(width, height, "JPG"));
    }
    static QRect place(const QWidget* w) { return QRect(w->pos(), w->size()); }
    static std::string shown(const frmPicPreview* w) {
        return (w->windowTitle() + " " + w->picturePath()).toStdString();
    }
    const std::string kError = "Error | Error loading pic | Ok | Exclamation";
};

} // namespace

TEST_F(PicturePreview, FitsThePictureKeepsItWhenANewOneCannotBeLoadedAndReopensInPlace) {
    // (Every shape of a file that is no picture is read by the picture loader's own test.)
    const QString bad = fake.writeFile("program/empty.jpg");
    QPointer<frmPicPreview> preview = new frmPicPreview(fake.platform);
    EXPECT_EQ(place(preview), QRect(twips::toPixelsX(300), twips::toPixelsY(300),
                                    twips::toPixelsX(11115), twips::toPixelsY(5655)));
    EXPECT_FALSE(preview->showPicture(bad, "Paddle Control Layout"));
    EXPECT_EQ(boxLines(fake.dialogs), Lines{kError});
    EXPECT_FALSE(preview->isVisible());

    preview->resize(400, 300);
    const std::pair<QSize, QRect> cases[] = {
        {{400, 100}, {0, 100, 400, 100}}, // wider: the whole width
        {{100, 500}, {170, 0, 60, 300}},  // taller: the whole height
        {{800, 600}, {0, 0, 400, 300}}};
    for (const auto& [size, image] : cases) {
        const QString path = picture("a.jpg", size.width(), size.height());
        ASSERT_TRUE(preview->showPicture(path, "Paddle Control Layout"));
        EXPECT_EQ(preview->PPImg->geometry(), image);
    }
    EXPECT_TRUE(preview->PPImg->isVisible() && !preview->PPPic->isVisible());
    preview->resize(600, 300);
    QCoreApplication::processEvents();
    EXPECT_EQ(preview->PPImg->geometry(), QRect(100, 0, 400, 300));

    // A bad picture leaves the open window as it was, and says so.
    EXPECT_FALSE(preview->showPicture(bad, "Keyboard Control Layout"));
    EXPECT_EQ(shown(preview),
              "Paddle Control Layout " + fake.programFolder().toStdString() + "/a.jpg");
    EXPECT_EQ(preview->PPPic->size(), QSize(800, 600));
    EXPECT_EQ(fake.dialogs.boxes.size(), 2u);

    preview->move(twips::toPixelsX(900), twips::toPixelsY(600));
    QCoreApplication::processEvents();
    const QRect placed = place(preview);
    preview->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(preview.isNull()) << "a closed preview is gone until the next click";
    const frmPicPreview again(fake.platform);
    EXPECT_EQ(place(&again), placed);

    // A place off every screen opens on one, and stays stored until the user moves it.
    fake.store.SaveSetting("picpos", "top", "-90000");
    frmPicPreview off(fake.platform);
    EXPECT_TRUE(off.screen()->availableGeometry().contains(place(&off)));
    off.close();
    EXPECT_EQ(fake.reopenStore()->GetSetting("picpos", "top", ""), "-90000");
}

TEST_F(PicturePreview, EachPortButtonShowsTheLayoutOfItsController) {
    // A later word of the list wins, wherever it stands in the caption.
    const std::pair<const char*, const char*> names[] = {
        {"Standard Control Layout", "/lum Standard.jpg"},
        {"DRIVING or paddle", "/lum Driving.jpg"},
        {"keyboard standard", "/lum Keyboard.jpg"},
        {"Joystick", ""}};
    for (const auto& [caption, name] : names)
        EXPECT_EQ(frmSettings::GetPicName(caption), name) << caption;

    auto w = open();
    auto* left = control<QPushButton>(*w, "cmdLeftControlPic");
    auto* right = control<QPushButton>(*w, "cmdRightControlPic");
    picture("lum Paddles.jpg", 40, 20);
    picture("lum Driving.jpg", 40, 20);
    control<QComboBox>(*w, "comboLeftController")->setCurrentIndex(2);  // Paddle Controller
    control<QComboBox>(*w, "comboRightController")->setCurrentIndex(4); // Driving Controller
    const std::string folder = fake.programFolder().toStdString();
    QTest::mouseClick(left, Qt::LeftButton);
    const QPointer<frmPicPreview> preview = w->findChild<frmPicPreview*>();
    ASSERT_TRUE(preview && preview->isVisible() && preview->isWindow());
    EXPECT_EQ(shown(preview), "Paddle Control Layout " + folder + "/lum Paddles.jpg");
    // A click while it is open shows the other picture in the same window.
    QTest::mouseClick(right, Qt::LeftButton);
    EXPECT_EQ(w->findChildren<frmPicPreview*>(), QList<frmPicPreview*>{preview});
    EXPECT_EQ(shown(preview), "Driving Control Layout " + folder + "/lum Driving.jpg");
    // Once closed, the next click opens a new one.
    preview->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QTest::mouseClick(left, Qt::LeftButton);
    const frmPicPreview* next = w->findChild<frmPicPreview*>();
    EXPECT_TRUE(next && next->isVisible());
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}
