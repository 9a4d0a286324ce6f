#include "support/Files.h"
#include "support/Unreadable.h"

#include "emulator/OptionFile.h"

#include <QElapsedTimer>
#include <QFile>
#include <QRandomGenerator>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <sys/stat.h>

namespace {

const ConfigLimits kLimits{9, 13, 14};

} // namespace

// Option sets of random bytes: each is either a valid set or stops at a field the window
// rejects, with every field before that one acceptable; none is read out of bounds.
TEST(BadInputOptionFile, GarbageIsEitherAValidSetOrStopsAtTheFirstBadField) {
    QTemporaryDir dir;
    const QString path = dir.filePath("garbage.lum");
    QRandomGenerator random(2600);
    int valid = 0;
    for (int n = 0; n < 300; ++n) {
        QByteArray bytes(ConfigRecord::kSize, '\0');
        for (char& c : bytes)
            c = static_cast<char>(random.bounded(256));
        // Small values in the int16 fields now and then, so that loads get further.
        for (const ConfigFieldInfo& info : configFields()) {
            const bool small =
                info.kind == ConfigFieldKind::Check || info.kind == ConfigFieldKind::ListIndex;
            if (small && random.bounded(4) != 0) {
                bytes[info.offset] = static_cast<char>(random.bounded(3));
                bytes[info.offset + 1] = 0;
            }
        }
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(bytes);
        file.close();

        const ConfigDecode read = readOptionFile(path, kLimits);
        ASSERT_NE(read.status, ConfigStatus::Short);
        ASSERT_NE(read.status, ConfigStatus::Unreadable);
        for (int i = 0; i < read.applicableCount(); ++i)
            EXPECT_TRUE(configFieldAcceptable(read.record, ConfigField(i), kLimits)) << n;
        if (read.ok())
            ++valid;
        else
            EXPECT_FALSE(configFieldAcceptable(read.record, *read.firstBad, kLimits)) << n;
    }
    EXPECT_LT(valid, 300); // random singles are rarely all whole slider values
}

// Files that hold no whole record, or cannot be read, are reported and nothing of them is
// applied.
TEST(BadInputOptionFile, UnusableSourcesAreReportedNotApplied) {
    QTemporaryDir dir;
    const QString shortFile = dir.filePath("short.lum");
    ASSERT_TRUE(putFile(shortFile, ConfigRecord().encode().left(171)));
    const QString empty = dir.filePath("empty.lum");
    ASSERT_TRUE(putFile(empty, {}));
    const QString fifo = dir.filePath("pipe.lum");
    ASSERT_EQ(mkfifo(QFile::encodeName(fifo).constData(), 0600), 0);
    const QString locked = makeUnreadable(dir.filePath("locked.lum"), ConfigRecord().encode());
    ASSERT_FALSE(locked.isEmpty());

    const struct {
        QString path;
        ConfigStatus status;
    } cases[] = {
        {shortFile, ConfigStatus::Short},
        {empty, ConfigStatus::Short},
        {dir.filePath("absent.lum"), ConfigStatus::Unreadable},
        {locked, ConfigStatus::Unreadable},
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

// An oversized file (a gigabyte, here sparse) is read for its first record only.
TEST(BadInputOptionFile, AnOversizedFileIsReadForItsFirstRecordOnly) {
    QTemporaryDir dir;
    const QString path = dir.filePath("huge.lum");
    ConfigRecord record;
    record.BarColorSoundQueue = 4608;
    {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(record.encode());
        ASSERT_TRUE(file.resize(qint64(1) << 30));
    }
    QElapsedTimer timer;
    timer.start();
    const ConfigDecode read = readOptionFile(path, kLimits);
    EXPECT_LT(timer.elapsed(), 10000); // a hang guard only
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.record, record);
}

// Whatever sound-queue value the window takes from a file, its own save gives back: the
// slider holds a whole number, down to a single digit. (Found by fuzzing the load into the
// window.)
TEST(BadInputOptionFile, ASoundQueueTakenFromAFileSavesAsAValueThatLoadsAgain) {
    QRandomGenerator random(4608);
    for (int n = 0; n < 100000; ++n) {
        const float stored = n < 4000 ? static_cast<float>(n - 2000) / 16
                                      : static_cast<float>(random.generateDouble() * 40 - 20);
        const std::optional<SoundQueueScale> scale = soundQueueScaleFor(stored);
        if (!scale)
            continue;
        const std::optional<SoundQueueScale> saved =
            soundQueueScaleFor(static_cast<float>(scale->value));
        ASSERT_TRUE(saved) << stored;
        EXPECT_EQ(saved->value, scale->value) << stored;
    }
}
