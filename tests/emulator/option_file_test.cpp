#include "emulator/OptionFile.h"
#include "support/DiskFull.h"
#include "support/Files.h"

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

const ConfigLimits kLimits{9, 13, 14};

ConfigRecord sampleRecord() {
    ConfigRecord r;
    r.comboVideoMode = 4;
    r.optVMWindow = true;
    r.chkQuiet = 1;
    r.BarColorSoundQueue = 4608;
    r.BarColorPaddle = 6;
    r.BarColorPhos = 77;
    r.txtFPScustom = 59.94f;
    r.optPaddleM1 = {false, false, true, false};
    r.comboGT = 2;
    return r;
}

} // namespace

TEST(OptionFile, WrittenFileReadsBackAndReplacesAnOlderOneWhole) {
    QTemporaryDir dir;
    const QString path = dir.filePath("set.lum");
    // An older, longer file with junk everywhere, reserved areas included.
    ASSERT_TRUE(putFile(path, QByteArray(300, '\x5A')));

    ASSERT_TRUE(writeOptionFile(path, sampleRecord()));
    EXPECT_EQ(fileBytes(path), sampleRecord().encode());
    const ConfigDecode read = readOptionFile(path, kLimits);
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.record, sampleRecord());
    // Only the file itself is left in the folder: no temporary stays behind.
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), QStringList{"set.lum"});
}

TEST(OptionFile, AFailedWriteReportsFailureAndKeepsTheOlderFile) {
    QTemporaryDir dir;
    const QString path = dir.filePath("old.lum");
    const QByteArray older = sampleRecord().encode();
    ASSERT_TRUE(putFile(path, older));

    ConfigRecord changed = sampleRecord();
    changed.comboVideoMode = 1;
    {
        const DiskFull limit(100);
        EXPECT_FALSE(writeOptionFile(path, changed));
    }
    EXPECT_EQ(fileBytes(path), older);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), QStringList{"old.lum"});
}

TEST(OptionFile, TargetsThatCannotBeWrittenReportFailure) {
    QTemporaryDir dir;
    const QString notAFolder = dir.filePath("plain");
    ASSERT_TRUE(putFile(notAFolder, "x"));
    QDir(dir.path()).mkdir("taken.lum");

    for (const QString& path :
         {dir.filePath("missing/set.lum"), notAFolder + "/set.lum", dir.filePath("taken.lum")})
        EXPECT_FALSE(writeOptionFile(path, sampleRecord())) << qPrintable(path);
    // Something still exists under the last name; that alone is no success.
    EXPECT_TRUE(QFileInfo(dir.filePath("taken.lum")).isDir());
}
