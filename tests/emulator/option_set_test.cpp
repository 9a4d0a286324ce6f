#include "support/Files.h"
#include "support/SampleOptions.h"

#include "emulator/OptionFile.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QtEndian>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include <sys/stat.h>

namespace {

using O = EmulatorOptions;

// The set of sampleOptions(), written out by hand: offset and little-endian bytes. Singles
// as IEEE bits: 1.5 = 3FC00000, -2.5 = C0200000, 5000 = 459C4000, 11 = 41300000,
// 60 = 42700000, 40 = 42200000, 262 = 43830000, 30 = 41F00000, 0.25 = 3E800000.
// clang-format off
const std::vector<std::pair<int, std::vector<unsigned char>>> kKnownBytes = {
    {0, {3, 0}}, {2, {0, 0}}, {4, {0xFF, 0xFF}}, {6, {0, 0}}, {8, {0, 0}},
    {10, {0, 0}}, {12, {0xFF, 0xFF}}, {14, {1, 0}}, {16, {2, 0}}, {18, {0, 0}},
    {20, {0, 0}}, {22, {0xFF, 0xFF}}, {42, {1, 0}}, {44, {0, 0, 0xC0, 0x3F}},
    {48, {0, 0, 0x20, 0xC0}}, {52, {1, 0}}, {54, {0, 0x40, 0x9C, 0x45}},
    {60, {0, 0, 0x30, 0x41}}, {68, {0, 0}}, {70, {0xFF, 0xFF}}, {72, {0, 0}},
    {74, {0, 0}}, {76, {0xFF, 0xFF}}, {78, {0, 0}}, {80, {0, 0}}, {82, {0, 0}},
    {84, {0, 0}}, {86, {0, 0}}, {88, {0, 0}}, {90, {0xFF, 0xFF}}, {92, {1, 0}},
    {94, {2, 0}}, {96, {0, 0}}, {98, {0, 0}}, {100, {0xFF, 0xFF}},
    {102, {0, 0, 0x70, 0x42}}, {106, {0, 0}}, {108, {0, 0}}, {110, {0xFF, 0xFF}},
    {112, {0, 0}}, {114, {0, 0}}, {116, {0, 0}}, {118, {0xFF, 0xFF}},
    {120, {0, 0, 0x20, 0x42}}, {124, {1, 0}}, {126, {0, 0, 0x83, 0x43}},
    {130, {0, 0}}, {132, {2, 0}}, {134, {1, 0}}, {136, {2, 0}}, {138, {1, 0}},
    {140, {2, 0}}, {142, {13, 0}}, {144, {1, 0}}, {146, {0, 0, 0xF0, 0x41}},
    {150, {1, 0}}, {152, {2, 0}}, {154, {0xFF, 0xFF}}, {156, {1, 0}}, {158, {2, 0}},
    {160, {1, 0}}, {162, {2, 0}}, {164, {1, 0}}, {166, {1, 0}},
    {168, {0, 0, 0x80, 0x3E}},
};
// clang-format on

bool unused(int offset) {
    return (offset >= 24 && offset < 42) || (offset >= 58 && offset < 60) ||
           (offset >= 64 && offset < 68);
}

} // namespace

// Every option at its offset, the unused bytes zero on the way out and ignored on the way
// in, like the bytes after the record.
TEST(OptionSet, EveryOptionLandsAtItsOffsetAndReadsBack) {
    QByteArray data = encodeOptions(sampleOptions());
    ASSERT_EQ(data.size(), 172);
    std::vector<int> described(172, 0);
    for (const auto& [offset, bytes] : kKnownBytes)
        for (std::size_t i = 0; i < bytes.size(); ++i) {
            EXPECT_EQ(static_cast<unsigned char>(data[offset + int(i)]), bytes[i])
                << "byte " << offset + int(i);
            ++described[static_cast<std::size_t>(offset) + i];
        }
    for (int at = 0; at < 172; ++at) {
        EXPECT_EQ(described[std::size_t(at)] == 0, unused(at)) << "byte " << at;
        EXPECT_TRUE(!unused(at) || data[at] == '\0') << "byte " << at;
        if (unused(at))
            data[at] = char(0xA5);
    }
    const OptionSetRead read = decodeOptions(data + QByteArray(10, '\x7F'), EmulatorOptions());
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.options, sampleOptions());
}

TEST(OptionSet, FlagsSelectTheLastSetButtonOrTheGroupsStart) {
    QByteArray data = encodeOptions(EmulatorOptions());
    qToLittleEndian<qint16>(1, data.data() + 2); // "Default" video start, any non-zero value
    qToLittleEndian<qint16>(qint16(0x8000), data.data() + 4); // and "Fullscreen" after it
    qToLittleEndian<qint16>(7, data.data() + 70);             // keyboard paddle 1
    qToLittleEndian<qint16>(0, data.data() + 96);             // no frame rate button at all
    for (int offset = 76; offset < 84; offset += 2)
        qToLittleEndian<qint16>(0, data.data() + offset); // no paddle for the first mouse: "None"
    EmulatorOptions base;
    base.frameRate = FrameRate::Monitor;
    base.mousePaddle1 = Paddle::P2;
    const OptionSetRead read = decodeOptions(data, base);
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.options.videoStart, VideoStart::Fullscreen);
    EXPECT_EQ(read.options.keyboardPaddle, Paddle::P1);
    EXPECT_EQ(read.options.frameRate, FrameRate::Default);
    EXPECT_EQ(read.options.mousePaddle1, Paddle::None);
}

// A value the window cannot show ends the load there: every option before it, in the order
// a load applies them, comes from the file; the rest keep the base's values.
TEST(OptionSet, TheFirstBadValueEndsTheLoad) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    // A check box of 3 and of -1; the last video mode, none, one past the list; an entry
    // below -1 and past the controllers and game types; a number not a number; a slider
    // beyond 32 bits; a sound queue its hundreds do not frame. Offset, a single or not, the
    // value: the first bad option in load order, -1 for a good set.
    const std::tuple<int, bool, float, int> cases[] = {
        {14, false, 3, 3},    {140, false, -1, 40}, {0, false, 8, -1},    {0, false, -1, -1},
        {0, false, 9, 0},     {152, false, -2, 7},  {154, false, 13, 8},  {142, false, 14, 41},
        {102, true, nan, 29}, {60, true, 3e9f, 13}, {54, true, 12.5f, 19}};
    EmulatorOptions base;
    base.player0Hard = base.player1Hard = Check::Grayed;
    for (const auto& [offset, bSingle, value, firstBad] : cases) {
        QByteArray data = encodeOptions(sampleOptions());
        if (bSingle)
            qToLittleEndian<float>(value, data.data() + offset);
        else
            qToLittleEndian<qint16>(static_cast<qint16>(value), data.data() + offset);
        const OptionSetRead read = decodeOptions(data, base);
        EXPECT_EQ(read.firstBad, firstBad) << offset;
        EXPECT_EQ(read.status,
                  firstBad < 0 ? OptionSetRead::Status::Ok : OptionSetRead::Status::Invalid)
            << offset;
        if (offset == 14) {
            EXPECT_EQ(read.options.dsp, sampleOptions().dsp);
            EXPECT_EQ(read.options.player1Hard, Check::Grayed);
        }
    }
    // A slider takes the nearest whole number, halves to the even one.
    for (const auto& [stored, shown] : {std::pair{8.5f, 8}, {7.5f, 8}, {-0.4f, 0}}) {
        QByteArray data = encodeOptions(sampleOptions());
        qToLittleEndian<float>(stored, data.data() + 120);
        EXPECT_EQ(decodeOptions(data, base).options.phosphor, shown) << stored;
    }
}

TEST(OptionSet, SoundQueueRangeIsCentredOnTheStoredHundreds) {
    const std::pair<float, std::optional<SliderScale>> cases[] = {
        {4608, SliderScale{4500, 4700, 4608}},
        // Re-centred off the scale: the end window the keys reach, the value held in it.
        {50, SliderScale{1, 201, 50}},
        {-0.75f, SliderScale{1, 201, 1}},
        {5, SliderScale{1, 201, 5}}, // one digit: what a save of the lowest window gives
        {65599, SliderScale{65339, 65536, 65536}},
        // A fraction: the hundreds do not frame the value (12 lies outside 1100 to 1300).
        {12.5f, std::nullopt},
        {3839.625f, std::nullopt},
        // Hundreds that are no number ("-", "1e+") or beyond the bar's range.
        {-50, std::nullopt},
        {1e20f, std::nullopt},
        {1e12f, std::nullopt},
        {std::numeric_limits<float>::quiet_NaN(), std::nullopt},
    };
    for (const auto& [stored, scale] : cases)
        EXPECT_EQ(soundQueueScaleFor(stored), scale) << stored;
}

TEST(OptionFile, SourcesWithoutAWholeSetApplyNothing) {
    QTemporaryDir dir;
    const QByteArray good = encodeOptions(sampleOptions());
    const QString shortFile = dir.filePath("short.lum");
    ASSERT_TRUE(putFile(shortFile, good.left(171)));
    const QString fifo = dir.filePath("pipe.lum");
    ASSERT_EQ(mkfifo(QFile::encodeName(fifo).constData(), 0600), 0);
    const QString locked = makeUnreadable(dir.filePath("locked.lum"), good);
    ASSERT_FALSE(locked.isEmpty());
    const QString huge = dir.filePath("huge.lum"); // sparse: read for its first set only
    ASSERT_TRUE(putFile(huge, good) && QFile::resize(huge, qint64(1) << 30));
    using S = OptionSetRead::Status;
    const std::pair<QString, S> cases[] = {
        {shortFile, S::Short},   {dir.filePath("absent.lum"), S::Unreadable},
        {locked, S::Unreadable}, {dir.path(), S::Unreadable},
        {fifo, S::Unreadable}, // a pipe would block a reader: refused unopened
        {huge, S::Ok},
    };
    for (const auto& [path, status] : cases) {
        const OptionSetRead read = readOptionFile(path, EmulatorOptions());
        EXPECT_EQ(read.status, status) << qPrintable(path);
        EXPECT_EQ(read.options, status == S::Ok ? sampleOptions() : EmulatorOptions())
            << qPrintable(path);
    }
}

TEST(OptionFile, AWriteReplacesTheFileWholeOrLeavesItAsItWas) {
    QTemporaryDir dir;
    const QString path = dir.filePath("set.lum");
    // An older, longer file with junk everywhere, unused bytes included.
    ASSERT_TRUE(putFile(path, QByteArray(300, '\x5A')));
    ASSERT_TRUE(writeOptionFile(path, sampleOptions()));
    EXPECT_EQ(fileBytes(path), encodeOptions(sampleOptions()));
    {
        const DiskFull limit(100);
        EXPECT_FALSE(writeOptionFile(path, EmulatorOptions()));
    }
    EXPECT_EQ(fileBytes(path), encodeOptions(sampleOptions()));
    // No temporary file stays behind.
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), QStringList{"set.lum"});

    const QString plain = dir.filePath("plain");
    ASSERT_TRUE(putFile(plain, "x"));
    QDir(dir.path()).mkdir("taken.lum");
    for (const QString& target :
         {dir.filePath("missing/set.lum"), plain + "/set.lum", dir.filePath("taken.lum")})
        EXPECT_FALSE(writeOptionFile(target, sampleOptions())) << qPrintable(target);
}
