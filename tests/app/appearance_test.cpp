#include "AppFixture.h"

#include <QFileInfo>

// Each command in turn, from yellow text on red and a teal picture, and at the next start.
TEST_F(MainWindow, ColourAndPictureCommands) {
    storePaths();
    set("BackColor", "255");
    set("TextColor", "65535");
    set("BackImg", fake.writeFile("teal.png", encodedPicture(8, 8, "PNG"))); // Qt::darkCyan
    load();
    EXPECT_EQ(list()->palette().color(QPalette::Text), QColor(Qt::yellow));
    // "back/text picture check | stored", then any bar that does not follow the list.
    const auto look = [this] {
        const QString picture =
            list()->hasPicture() ? QFileInfo(list()->Picture()).completeBaseName() : "-";
        QString out = QString::asprintf("%x/%x %s %s |", list()->BackColor(), list()->ForeColor(),
                                        qPrintable(picture),
                                        action("mnuBackImgEnabled")->isChecked() ? "on" : "off");
        for (const char* key : {"BackColor", "TextColor", "BackImgEnabled", "BackImg"})
            out += ' ' + stored(key).replace(fake.root(), "~");
        for (const vbalProgressBar* bar : window->findChildren<vbalProgressBar*>() +
                                              settings().findChildren<vbalProgressBar*>()) {
            const QImage image = bar->BarPicture();
            if (bar->BarColor() != list()->BackColor() ||
                bar->BarForeColor() != list()->ForeColor() || bar->ForeColor() != 0 ||
                (image.isNull() ? QColor() : image.pixelColor(0, 0)) != QColor(picture))
                out += " | " + bar->objectName() + " does not follow";
        }
        return out;
    };
    fake.dialogs.colours = {std::nullopt, 0xFF0000, std::nullopt, 0x00FF00}; // none cancels
    fake.dialogs.paths = {"", fake.writeFile("junk.png", "not a picture")};
    const char* const steps[][2] = {
        // the menu item, "" to start again
        {"mnuBackColorChange", "ff/ffff teal on | 255 65535 <missing> ~/teal.png"},
        {"mnuTextColor", "ff/ff0000 teal on | 255 16711680 <missing> ~/teal.png"},
        {"mnuBackImgEnabled", "ff/ff0000 - off | 255 16711680 False ~/teal.png"},
        {"", "ff/ff0000 - off | 255 16711680 False ~/teal.png"},
        {"mnuBackImgEnabled", "ff/ff0000 teal on | 255 16711680 True ~/teal.png"},
        {"mnuTextColor", "ff/ff0000 teal on | 255 16711680 True ~/teal.png"},
        {"mnuBackColorChange", "ff00/ff00ff - off | 65280 16711935 False ~/teal.png"},
        {"mnuBackImgChange", "ff00/ff00ff teal on | 65280 16711935 True ~/teal.png"},
        // A picture that cannot be shown shows none, without a word, its name kept.
        {"mnuBackImgChange", "ff00/ff00ff - on | 65280 16711935 True ~/junk.png"},
        {"", "ff00/ff00ff - on | 65280 16711935 True ~/junk.png"}};
    for (const auto& [item, expected] : steps) {
        settings(); // built, so that each command brings its bars along
        if (*item)
            action(item)->trigger();
        else
            reload();
        EXPECT_EQ(look(), expected) << item;
    }
    EXPECT_EQ(happened(), "");
    EXPECT_EQ(fake.dialogs.colourTitles, QStringList(4, "Choose a Color"));
    EXPECT_EQ(fake.dialogs.colourInitials, (std::vector<quint32>{255, 65535, 0xFF0000, 255}));
    EXPECT_EQ(requestLines(fake.dialogs),
              Lines(2, "open | Choose Image File | Image Files "
                       "(*.jpg,*.bmp,*gif,*png)|*.jpg;*.bmp;*.gif;*.png|All Files (*.*)|*.* | " +
                           fake.programFolder().toStdString() + "/Backgrounds | 1 | 1800"));
}
