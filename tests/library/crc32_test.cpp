#include "library/CCRC32.h"

#include "support/Boxes.h"
#include "support/FakePlatform.h"
#include "support/Unreadable.h"

#include <QFileInfo>

#include <numeric>
#include <random>
#include <tuple>
#include <vector>

#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

// The CRC-32 bit by bit, straight from its definition, as the yardstick.
quint32 referenceCrc(QByteArrayView bytes) {
    quint32 crc = 0xFFFFFFFFu;
    for (const char byte : bytes) {
        crc ^= static_cast<unsigned char>(byte);
        for (int bit = 0; bit < 8; ++bit)
            crc = (crc & 1u) ? (crc >> 1) ^ 0xEDB88320u : crc >> 1;
    }
    return crc ^ 0xFFFFFFFFu;
}

QByteArray randomBytes(std::mt19937& rng, qsizetype size) {
    QByteArray bytes(size, Qt::Uninitialized);
    for (char& b : bytes)
        b = static_cast<char>(rng() & 0xFFu);
    return bytes;
}

// A ROM file in every shape gives, call after call, the CRC of its bytes, read in chunks of
// 32,767 but for a last piece of up to 32,768 (as the progress shows); or, unreadable, 0, no
// progress and one box. A missing file is not created, and a FIFO does not hang the call.
TEST(Crc32, EveryFileGivesTheCrcOfItsBytesOrZeroAndOneBox) {
    FakePlatform fake;
    CCRC32 crc(fake.dialogs);
    std::vector<float> progress;
    QObject::connect(&crc, &CCRC32::Progress, [&](float value) { progress.push_back(value); });
    using Case = std::tuple<QString, quint32, std::vector<qsizetype>, const char*>;
    std::mt19937 rng(1);
    const auto randomFile = [&](const std::vector<qsizetype>& chunks) {
        const QByteArray bytes = randomBytes(rng, std::reduce(chunks.begin(), chunks.end()));
        const QString path = fake.writeFile(QString::number(bytes.size()), bytes);
        return Case{path, referenceCrc(bytes), chunks, nullptr};
    };
    const QString readOnly = fake.writeFile(QStringLiteral("read-only.bin"), "123456789");
    ASSERT_TRUE(QFile::setPermissions(readOnly, QFile::ReadOwner));
    const QString huge = fake.writeFile(QStringLiteral("huge.bin"));
    ASSERT_TRUE(QFile(huge).resize(qint64(64) << 20)); // sparse: 64 MiB of zeros
    std::vector<qsizetype> hugeChunks(2048, 32767);
    hugeChunks.push_back(2048);
    const QString locked = fake.writeFile(QStringLiteral("locked.bin"), "123456789");
    ASSERT_TRUE(QFile::setPermissions(locked, {}));
    const QString fifo = fake.root() + QStringLiteral("/pipe");
    ASSERT_EQ(::mkfifo(QFile::encodeName(fifo).constData(), 0600), 0);
    const QString missing = fake.root() + QStringLiteral("/no such.bin");
    const Case cases[] = {randomFile({}),
                          randomFile({1}),
                          randomFile({32768}),
                          randomFile({32767, 2}),
                          randomFile({32767, 32768}),
                          randomFile({32767, 32767, 2}),
                          {readOnly, 0xCBF43926u, {9}, nullptr}, // the check value
                          {huge, 0xB2EB30EDu, hugeChunks, nullptr},
                          {missing, 0, {}, "Error: 53. File not found"},
                          {QString(), 0, {}, "Error: 53. File not found"},
                          {fake.makeFolder("dir"), 0, {}, "Error: 75. Path/File access error"},
                          {fifo, 0, {}, "Error: 75. Path/File access error"},
                          {locked, 0, {}, "Error: 70. Permission denied"}};
    const NoPermissionOverride asAnyone;
    ASSERT_TRUE(asAnyone.holds());
    for (const auto& [path, value, chunks, error] : cases) {
        SCOPED_TRACE(path.toStdString());
        std::vector<float> expected(error ? 0 : 1, 0.0f);
        qsizetype done = 0;
        for (const qsizetype chunk : chunks)
            expected.push_back(static_cast<float>(
                double(done += chunk) / double(std::reduce(chunks.begin(), chunks.end()))));
        for (int call = 0; call < 2; ++call) {
            fake.dialogs.boxes.clear();
            progress.clear();
            crc.setInputFileName(path);
            EXPECT_EQ(crc.GetCRCFromFile(), static_cast<qint32>(value));
            EXPECT_EQ(progress, expected);
            EXPECT_EQ(boxLines(fake.dialogs),
                      error ? Lines{"GetCRCFromFile | " + std::string(error) + " | Ok | None"}
                            : Lines{});
        }
    }
    EXPECT_FALSE(QFileInfo::exists(missing));

    // A text is checksummed as its UTF-16LE code units.
    const std::pair<QString, QByteArray> texts[] = {
        {QString(), QByteArray()},
        {QStringLiteral("A"), QByteArray("\x41\x00", 2)},
        {QStringLiteral("abc"), QByteArray("a\0b\0c\0", 6)},
        {QStringLiteral("\u00e9\u20ac"), QByteArray("\xe9\x00\xac\x20", 4)},
    };
    for (const auto& [text, bytes] : texts) {
        SCOPED_TRACE(text.toStdString());
        progress.clear();
        EXPECT_EQ(crc.GetCRCFromString(text), static_cast<qint32>(referenceCrc(bytes)));
        ASSERT_FALSE(progress.empty());
        EXPECT_EQ(progress.back(), 1.0f);
    }
}

// Every kernel, started at any alignment, gives the bit-by-bit CRC; a running value carried
// from one piece into the next is fed to them by the files above.
TEST(Crc32Kernels, AgreeWithTheReferenceForEveryLengthAndAlignment) {
    std::mt19937 rng(7);
    const QByteArray data = randomBytes(rng, 4096 + 64);
    const auto* bytes = reinterpret_cast<const unsigned char*>(data.constData());
    std::vector<std::uint32_t (*)(std::uint32_t, const unsigned char*, std::size_t)> kernels = {
        crc32kernels::updatePortable, crc32kernels::update};
    if (crc32kernels::clmulAvailable())
        kernels.push_back(crc32kernels::updateClmul);
    for (std::size_t length = 0; length <= 4096; length += (length < 300 ? 1 : 97)) {
        for (std::size_t offset : {0, 1, 3, 8, 15}) {
            const quint32 expected = referenceCrc(
                data.sliced(static_cast<qsizetype>(offset), static_cast<qsizetype>(length)));
            for (auto kernel : kernels) {
                SCOPED_TRACE(testing::Message() << "length " << length << " offset " << offset);
                ASSERT_EQ(kernel(crc32kernels::kInitial, bytes + offset, length) ^ 0xFFFFFFFFu,
                          expected);
            }
        }
    }
}

} // namespace
