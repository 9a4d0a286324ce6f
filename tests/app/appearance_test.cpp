#include "AppFixture.h"

#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/vbalProgressBar.h"

#include <QImage>

#include <gtest/gtest.h>

namespace {

QString writePicture(FakePlatform& fake, const QString& name, QColor colour) {
    QImage image(8, 8, QImage::Format_RGB32);
    image.fill(colour);
    const QString path = fake.root() + "/" + name;
    image.save(path);
    return path;
}

} // namespace

TEST(Appearance, BackgroundColourInvertsTheTextAndSwitchesThePictureOff) {
    const struct {
        quint32 background, text;
    } cases[] = {{0xFFFFFF, 0x000000}, {0x00FF00, 0xFF00FF}, {0x123456, 0xEDCBA9}};
    for (const auto& c : cases) {
        AppFixture app;
        app.fake.store.SaveSetting("Settings", "BackImg", writePicture(app.fake, "p.png", Qt::red));
        frmMain& w = app.load();
        ASSERT_TRUE(w.vbalListViewCtl1->hasPicture());
        app.fake.dialogs.colours.push_back(c.background);
        w.mnuBackColorChange->trigger();
        EXPECT_EQ(w.vbalListViewCtl1->BackColor(), c.background);
        EXPECT_EQ(w.vbalListViewCtl1->ForeColor(), c.text);
        for (vbalProgressBar* bar :
             {w.vbalProgressBar1, w.settingsWindow().BarColorPaddle,
              w.settingsWindow().BarColorSoundQueue, w.settingsWindow().BarColorPhos}) {
            EXPECT_EQ(bar->BarColor(), c.background) << bar->objectName().toStdString();
            EXPECT_EQ(bar->BarForeColor(), c.text) << bar->objectName().toStdString();
        }
        EXPECT_FALSE(w.mnuBackImgEnabled->isChecked());
        EXPECT_FALSE(w.vbalListViewCtl1->hasPicture());
        EXPECT_TRUE(w.vbalProgressBar1->BarPicture().isNull());
        auto stored = app.fake.reopenStore();
        EXPECT_EQ(stored->GetSetting("Settings", "BackColor").toUInt(), c.background);
        EXPECT_EQ(stored->GetSetting("Settings", "TextColor").toUInt(), c.text);
        EXPECT_EQ(stored->GetSetting("Settings", "BackImgEnabled"), "False");
        EXPECT_EQ(app.fake.dialogs.colourTitles.value(0), "Choose a Color");
        EXPECT_EQ(app.fake.dialogs.colourInitials.at(0), 0xFFFFFFu); // the list's colour
    }
}

// A cancelled chooser changes nothing; a text colour leaves the background and picture.
TEST(Appearance, TextColourLeavesTheBackgroundAndPicture) {
    AppFixture app;
    app.fake.store.SaveSetting("Settings", "BackImg", writePicture(app.fake, "p.png", Qt::blue));
    app.fake.store.SaveSetting("Settings", "BackColor", "255");
    frmMain& w = app.load();
    w.mnuBackColorChange->trigger();
    w.mnuTextColor->trigger();
    EXPECT_EQ(w.vbalListViewCtl1->ForeColor(), 0u);
    EXPECT_EQ(app.fake.reopenStore()->GetSetting("Settings", "TextColor"), QString());

    app.fake.dialogs.colours.push_back(0x0000FF);
    w.mnuTextColor->trigger();
    EXPECT_EQ(w.vbalListViewCtl1->ForeColor(), 0x0000FFu);
    EXPECT_EQ(w.vbalProgressBar1->BarForeColor(), 0x0000FFu);
    EXPECT_EQ(w.vbalListViewCtl1->BackColor(), 255u);
    EXPECT_TRUE(w.mnuBackImgEnabled->isChecked());
    EXPECT_TRUE(w.vbalListViewCtl1->hasPicture());
    EXPECT_FALSE(w.vbalProgressBar1->BarPicture().isNull());
}

TEST(Appearance, PictureOffAndOnRestoresTheStoredPicture) {
    AppFixture app;
    const QString picture = writePicture(app.fake, "p.png", Qt::green);
    app.fake.store.SaveSetting("Settings", "BackImg", picture);
    frmMain& w = app.load();
    w.mnuBackImgEnabled->trigger();
    EXPECT_FALSE(w.vbalListViewCtl1->hasPicture());
    EXPECT_TRUE(w.vbalProgressBar1->BarPicture().isNull());
    EXPECT_EQ(app.fake.reopenStore()->GetSetting("Settings", "BackImgEnabled"), "False");
    w.mnuBackImgEnabled->trigger();
    EXPECT_EQ(w.vbalListViewCtl1->Picture(), picture);
    EXPECT_TRUE(w.vbalListViewCtl1->hasPicture());
    EXPECT_EQ(w.vbalProgressBar1->BarPicture().pixelColor(0, 0), QColor(Qt::green));
    EXPECT_EQ(w.settingsWindow().BarColorPhos->BarPicture().pixelColor(0, 0), QColor(Qt::green));
    EXPECT_EQ(app.fake.reopenStore()->GetSetting("Settings", "BackImgEnabled"), "True");

    // A start with the picture switched off shows none.
    AppFixture off;
    off.fake.store.SaveSetting("Settings", "BackImg", picture);
    off.fake.store.SaveSetting("Settings", "BackImgEnabled", "False");
    frmMain& o = off.load();
    EXPECT_FALSE(o.mnuBackImgEnabled->isChecked());
    EXPECT_FALSE(o.vbalListViewCtl1->hasPicture());
}

TEST(Appearance, ChoosingAPictureStoresItAndCancelKeepsTheOldOne) {
    AppFixture app;
    const QString first = writePicture(app.fake, "first.png", Qt::red);
    const QString second = writePicture(app.fake, "second.png", Qt::blue);
    app.fake.store.SaveSetting("Settings", "BackImg", first);
    app.fake.store.SaveSetting("Settings", "BackImgEnabled", "False");
    frmMain& w = app.load();
    w.mnuBackImgChange->trigger(); // cancelled: the stored picture is switched on
    EXPECT_TRUE(w.mnuBackImgEnabled->isChecked());
    EXPECT_EQ(w.vbalListViewCtl1->Picture(), first);
    const FakeDialogs::FileRequest& request = app.fake.dialogs.fileRequests.at(0);
    EXPECT_EQ(request.request.title, "Choose Image File");
    EXPECT_EQ(request.request.initialFolder, app.fake.programFolder() + "/Backgrounds");
    EXPECT_EQ(request.request.flags, 0x1800u);
    EXPECT_EQ(request.request.filter,
              "Image Files (*.jpg,*.bmp,*gif,*png)|*.jpg;*.bmp;*.gif;*.png|All Files (*.*)|*.*");
    app.fake.dialogs.paths.push_back(second);
    w.mnuBackImgChange->trigger();
    EXPECT_EQ(w.vbalListViewCtl1->Picture(), second);
    EXPECT_EQ(app.fake.reopenStore()->GetSetting("Settings", "BackImg"), second);
}

TEST(Appearance, StoredColoursApplyAtStart) {
    AppFixture app;
    app.fake.store.SaveSetting("Settings", "BackColor", "8421504");
    app.fake.store.SaveSetting("Settings", "TextColor", "65535");
    frmMain& w = app.load();
    EXPECT_EQ(w.vbalListViewCtl1->BackColor(), 8421504u);
    EXPECT_EQ(w.vbalListViewCtl1->ForeColor(), 65535u);
    EXPECT_EQ(w.vbalProgressBar1->BarColor(), 8421504u);
    EXPECT_EQ(w.vbalProgressBar1->BarForeColor(), 65535u);
    EXPECT_EQ(w.vbalProgressBar1->ForeColor(), 0u);
    EXPECT_EQ(w.settingsWindow().BarColorPaddle->BarColor(), 8421504u);
    EXPECT_EQ(w.settingsWindow().BarColorPaddle->ForeColor(), 0u);
    EXPECT_EQ(w.vbalListViewCtl1->palette().color(QPalette::Text), QColor(255, 255, 0));
}
