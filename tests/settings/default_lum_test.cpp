// data/Default.lum is the option set of the settings window as it starts, written by the
// window's own save. When the start state or the file's layout changes, this test fails;
// run it once with LUM_UPDATE_DEFAULT_LUM=1 to write the new file, then commit it.

#include "SettingsFixture.h"

#include "support/Files.h"

#include <QDir>
#include <QFileInfo>
#include <QImageReader>

namespace {

QString dataFolder() {
    const QByteArray source = qgetenv("LUM_SOURCE_DIR");
    if (!source.isEmpty())
        return QString::fromLocal8Bit(source) + "/data";
    // Run by hand: the tree this file lies in.
    return QDir::cleanPath(QFileInfo(QStringLiteral(__FILE__)).absolutePath() + "/../../data");
}

using DefaultLum = SettingsFixture;

} // namespace

TEST_F(DefaultLum, IsTheStartStateOfTheSettingsWindow) {
    frmSettings w(fake.platform);
    const QString path = fake.root() + "/start.lum";
    fake.dialogs.paths.push_back(path);
    w.cmdSaveDat_Click();
    const QByteArray produced = fileBytes(path);
    ASSERT_EQ(produced.size(), 172);
    const QString committed = dataFolder() + "/Default.lum";
    if (!qgetenv("LUM_UPDATE_DEFAULT_LUM").isEmpty()) {
        ASSERT_TRUE(putFile(committed, produced));
    }
    EXPECT_EQ(fileBytes(committed).toHex(' '), produced.toHex(' '))
        << "data/Default.lum is out of date: run this test with LUM_UPDATE_DEFAULT_LUM=1";

    // And it loads back every option as the window starts.
    EmulatorOptions changed;
    changed.quiet = Check::On;
    changed.palette = Palette::Pal;
    changed.paddleSensitivity = 3;
    w.setOptions(changed);
    ASSERT_TRUE(w.LoadSettings(committed));
    EmulatorOptions start;
    start.customFrameRate = "0"; // a set keeps numbers, so the empty rate comes back as 0
    EXPECT_EQ(w.options(), start);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(DefaultLum, ControllerPicturesLieBesideItUnderTheNamesTheButtonsUse) {
    for (const char* caption : {"Standard Control Layout", "Paddle Control Layout",
                                "Keyboard Control Layout", "Driving Control Layout"}) {
        QImageReader reader(dataFolder() + frmSettings::GetPicName(caption));
        EXPECT_TRUE(reader.canRead()) << caption;
        EXPECT_EQ(reader.format(), "jpeg") << caption;
    }
}
