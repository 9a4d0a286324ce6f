#include "AppFixture.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include "ui/vbalProgressBar.h"

#include <QImage>
#include <QtEndian>

namespace {

using Appearance = AppFixture;

// A bar's colours and the colour of its bar picture ("none" without one).
QString barLook(const vbalProgressBar* bar) {
    const QImage picture = bar->BarPicture();
    return QString("%1 on %2, %3, %4")
        .arg(bar->BarForeColor(), 0, 16)
        .arg(bar->BarColor(), 0, 16)
        .arg(bar->ForeColor())
        .arg(picture.isNull() ? "none" : picture.pixelColor(0, 0).name());
}

} // namespace

// Each command of Settings > Text Color and Settings > Background, from a start with yellow
// text on red and lime.png stored; the bars follow the list, and each choice is stored.
TEST_F(Appearance, ColourAndPictureCommands) {
    for (const char* colour : {"lime", "blue"}) {
        QImage image(8, 8, QImage::Format_RGB32);
        image.fill(QColor(colour));
        image.save(fake.root() + "/" + colour + ".png");
    }
    const struct {
        bool bStartEnabled;
        const char* item;
        const char* answer; // the chooser's colour or picture; "" cancels it
        quint32 back, text;
        const char* shown; // the picture shown, or ""
    } cases[] = {
        {true, "mnuBackColorChange", "ffffff", 0xFFFFFF, 0x000000, ""},
        {true, "mnuBackColorChange", "00ff00", 0x00FF00, 0xFF00FF, ""},
        {true, "mnuBackColorChange", "", 255, 65535, "lime"},
        {true, "mnuTextColor", "ff0000", 255, 0xFF0000, "lime"},
        {false, "mnuTextColor", "", 255, 65535, ""},
        {true, "mnuBackImgEnabled", "", 255, 65535, ""},
        {false, "mnuBackImgEnabled", "", 255, 65535, "lime"},
        {false, "mnuBackImgChange", "blue.png", 255, 65535, "blue"},
        {false, "mnuBackImgChange", "", 255, 65535, "lime"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.item) + " " + c.answer);
        const QString lime = fake.root() + "/lime.png";
        for (const auto& [key, value] : {std::pair<QString, QString>{"BackColor", "255"},
                                         {"TextColor", "65535"},
                                         {"BackImg", lime},
                                         {"BackImgEnabled", c.bStartEnabled ? "True" : "False"}})
            fake.store.SaveSetting("Settings", key, value);
        window.reset();
        load();
        EXPECT_EQ(list()->hasPicture(), c.bStartEnabled);
        bool bColour = false;
        if (const uint colour = QString(c.answer).toUInt(&bColour, 16); bColour)
            fake.dialogs.colours.push_back(colour);
        else if (*c.answer)
            fake.dialogs.paths.push_back(fake.root() + "/" + c.answer);
        action(c.item)->trigger();

        const QString shown = *c.shown ? fake.root() + "/" + c.shown + ".png" : QString();
        EXPECT_EQ(list()->BackColor(), c.back);
        EXPECT_EQ(list()->ForeColor(), c.text);
        EXPECT_EQ(list()->Picture(), shown);
        EXPECT_EQ(list()->hasPicture(), *c.shown != 0);
        EXPECT_EQ(action("mnuBackImgEnabled")->isChecked(), *c.shown != 0);
        const QString look = QString("%1 on %2, 0, %3")
                                 .arg(c.text, 0, 16)
                                 .arg(c.back, 0, 16)
                                 .arg(*c.shown ? QColor(c.shown).name() : "none");
        EXPECT_EQ(barLook(control<vbalProgressBar>(*window, "vbalProgressBar1")), look);
        for (const char* bar : {"BarColorPaddle", "BarColorSoundQueue", "BarColorPhos"})
            EXPECT_EQ(barLook(control<vbalProgressBar>(settings(), bar)), look) << bar;
        EXPECT_EQ(QStringList({stored("BackColor"), stored("TextColor"), stored("BackImgEnabled"),
                               stored("BackImg")}),
                  QStringList({QString::number(c.back), QString::number(c.text),
                               *c.shown ? "True" : "False",
                               c.answer == std::string("blue.png") ? shown : lime}));
    }
    EXPECT_EQ(list()->palette().color(QPalette::Text), QColor(Qt::yellow)); // 65535
    // The colour choosers start from the list's own colours.
    EXPECT_EQ(fake.dialogs.colourTitles, QStringList(5, "Choose a Color"));
    EXPECT_EQ(fake.dialogs.colourInitials, (std::vector<quint32>{255, 255, 255, 65535, 65535}));
    const FileDialogRequest& request = fake.dialogs.fileRequests.back().request;
    EXPECT_EQ(QString("%1 | %2 | %3 | %4 | %5")
                  .arg(request.title, request.initialFolder)
                  .arg(request.flags, 0, 16)
                  .arg(request.filter)
                  .arg(request.filterIndex),
              "Choose Image File | " + fake.programFolder() +
                  "/Backgrounds | 1800 | Image Files (*.jpg,*.bmp,*gif,*png)|*.jpg;*.bmp;*.gif;"
                  "*.png|All Files (*.*)|*.* | 1");
}

// A stored picture that cannot be shown: no picture on the list or the bars, no message,
// and the name stays stored for when the file is mended.
TEST_F(Appearance, APictureThatCannotBeShownShowsNone) {
    const QByteArray png = encodedPicture(64, 64, "PNG");
    // A PNG header that claims a picture of that size, with no picture data after it.
    const auto claimed = [&png](quint32 width, quint32 height) {
        QByteArray header = png.left(24);
        qToBigEndian(width, header.data() + 16);
        qToBigEndian(height, header.data() + 20);
        return header;
    };
    storePaths();
    frmMain& w = load();
    for (const QString& path :
         {fake.root() + "/gone.png", fake.writeFile("empty.png"),
          fake.writeFile("cut.png", png.left(60)),
          fake.writeFile("huge.png", claimed(100000, 100000)),
          fake.writeFile("absurd.png", claimed(0xFFFFFFFF, 1)),
          fake.writeFile("junk.png", "not a picture"),
          makeUnreadable(fake.root() + "/locked.png", png), fake.makeFolder("folder.png")}) {
        fake.store.SaveSetting("Settings", "BackImg", path);
        action("mnuBackImgEnabled")->trigger(); // off, and on again with the stored name
        action("mnuBackImgEnabled")->trigger();
        EXPECT_EQ(list()->Picture(), path);
        EXPECT_FALSE(list()->hasPicture()) << path.toStdString();
        EXPECT_TRUE(control<vbalProgressBar>(w, "vbalProgressBar1")->BarPicture().isNull());
        EXPECT_FALSE(w.grab().isNull());
        EXPECT_EQ(stored("BackImg"), path);
    }
    EXPECT_TRUE(boxes().empty());
}
