#include "emulator/OptionFile.h"
#include "support/DiskFull.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <csignal>
#include <sys/resource.h>
#include <sys/stat.h>

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

QByteArray readAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray("<unreadable>");
}

void writeBytes(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    ASSERT_EQ(f.write(bytes), bytes.size());
}

} // namespace

TEST(OptionFile, WrittenFileReadsBackAndReplacesAnOlderOneWhole) {
    QTemporaryDir dir;
    const QString path = dir.filePath("set.lum");
    // An older, longer file with junk everywhere, reserved areas included.
    writeBytes(path, QByteArray(300, '\x5A'));

    ASSERT_TRUE(writeOptionFile(path, sampleRecord()));
    const QByteArray bytes = readAll(path);
    ASSERT_EQ(bytes.size(), 172);
    EXPECT_EQ(bytes.mid(24, 18), QByteArray(18, '\0'));
    EXPECT_EQ(bytes.mid(58, 2), QByteArray(2, '\0'));
    EXPECT_EQ(bytes.mid(64, 4), QByteArray(4, '\0'));

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
    writeBytes(path, older);

    ConfigRecord changed = sampleRecord();
    changed.comboVideoMode = 1;
    {
        const DiskFull limit(100);
        EXPECT_FALSE(writeOptionFile(path, changed));
    }
    EXPECT_EQ(readAll(path), older);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), QStringList{"old.lum"});
}

TEST(OptionFile, TargetsThatCannotBeWrittenReportFailure) {
    QTemporaryDir dir;
    const QString notAFolder = dir.filePath("plain");
    writeBytes(notAFolder, "x");
    QDir(dir.path()).mkdir("taken.lum");

    for (const QString& path :
         {dir.filePath("missing/set.lum"), notAFolder + "/set.lum", dir.filePath("taken.lum")})
        EXPECT_FALSE(writeOptionFile(path, sampleRecord())) << qPrintable(path);
    // Something still exists under the last name; that alone is no success.
    EXPECT_TRUE(QFileInfo(dir.filePath("taken.lum")).isDir());
}

TEST(OptionFile, ShortMissingAndNonFileSourcesAreReportedNotApplied) {
    QTemporaryDir dir;
    const QString shortFile = dir.filePath("short.lum");
    writeBytes(shortFile, sampleRecord().encode().left(171));
    const QString empty = dir.filePath("empty.lum");
    writeBytes(empty, {});
    const QString fifo = dir.filePath("pipe.lum");
    ASSERT_EQ(mkfifo(QFile::encodeName(fifo).constData(), 0600), 0);

    const struct {
        QString path;
        ConfigStatus status;
    } cases[] = {
        {shortFile, ConfigStatus::Short},
        {empty, ConfigStatus::Short},
        {dir.filePath("absent.lum"), ConfigStatus::Unreadable},
        {dir.path(), ConfigStatus::Unreadable},
        // A pipe would block a reader; it is refused without being opened.
        {fifo, ConfigStatus::Unreadable},
    };
    for (const auto& c : cases) {
        const ConfigDecode read = readOptionFile(c.path, kLimits);
        EXPECT_EQ(read.status, c.status) << qPrintable(c.path);
        EXPECT_EQ(read.applicableCount(), 0) << qPrintable(c.path);
    }
}

TEST(OptionFile, ALongerFileIsReadForItsFirstRecordOnly) {
    QTemporaryDir dir;
    const QString path = dir.filePath("long.lum");
    writeBytes(path, sampleRecord().encode() + QByteArray(1000, '\x01'));
    const ConfigDecode read = readOptionFile(path, kLimits);
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.record, sampleRecord());
}
