// data/Default.lum is the option set of the settings window as it starts, written by the
// program's own save. When the window's start state or the record changes, this test
// fails; run it once with LUM_UPDATE_DEFAULT_LUM=1 to write the new file, then commit it.

#include "support/FakePlatform.h"

#include "settings/SliderRules.h"
#include "settings/frmSettings.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QImageReader>
#include <QRadioButton>

#include <gtest/gtest.h>

namespace {

QString dataFolder() {
    const QByteArray source = qgetenv("LUM_SOURCE_DIR");
    if (!source.isEmpty())
        return QString::fromLocal8Bit(source) + "/data";
    // Run by hand: the tree this file lies in.
    return QDir::cleanPath(QFileInfo(QStringLiteral(__FILE__)).absolutePath() + "/../../data");
}

QByteArray readAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

} // namespace

TEST(DefaultLum, IsTheStartStateOfTheSettingsWindow) {
    FakePlatform fake;
    frmSettings w(fake.platform);
    const QString path = fake.root() + "/start.lum";
    fake.dialogs.paths.push_back(path);
    w.cmdSaveDat_Click();
    const QByteArray produced = readAll(path);
    ASSERT_EQ(produced.size(), 172);
    const QString committed = dataFolder() + "/Default.lum";
    if (!qgetenv("LUM_UPDATE_DEFAULT_LUM").isEmpty()) {
        QFile out(committed);
        ASSERT_TRUE(out.open(QIODevice::WriteOnly | QIODevice::Truncate));
        ASSERT_EQ(out.write(produced), produced.size());
    }
    EXPECT_EQ(readAll(committed).toHex(' '), produced.toHex(' '))
        << "data/Default.lum is out of date: run this test with LUM_UPDATE_DEFAULT_LUM=1";

    // And it loads back: every option as the window starts.
    w.chkQuiet->setChecked(true);
    w.optCPPAL->setChecked(true);
    w.BarColorPaddle->setValue(3);
    w.BarColorPhos->setValue(10);
    ASSERT_TRUE(w.LoadSettings(committed));
    EXPECT_FALSE(w.chkQuiet->isChecked());
    EXPECT_TRUE(w.optCPDefault->isChecked());
    EXPECT_EQ(w.BarColorPaddle->Value(), sliders::kPaddleStart);
    EXPECT_EQ(w.BarColorPhos->Value(), sliders::kPhosDefault);
    EXPECT_EQ(w.BarColorSoundQueue->Value(), sliders::kSoundQueueDefault);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST(DefaultLum, ControllerPicturesLieBesideItUnderTheNamesTheButtonsUse) {
    FakePlatform fake;
    frmSettings w(fake.platform);
    for (const char* caption : {"Standard Control Layout", "Paddle Control Layout",
                                "Keyboard Control Layout", "Driving Control Layout"}) {
        QImageReader reader(dataFolder() + w.GetPicName(caption));
        EXPECT_TRUE(reader.canRead()) << caption;
        EXPECT_EQ(reader.format(), "jpeg") << caption;
    }
}
