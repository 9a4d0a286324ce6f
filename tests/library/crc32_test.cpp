#include "library/CCRC32.h"

#include "support/Boxes.h"
#include "support/FakePlatform.h"
#include "support/Unreadable.h"

#include <QFile>
#include <QFileInfo>

#include <random>
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

class Crc32Test : public ::testing::Test {
protected:
    // Checksums a file holding `content`; records the progress values it reported.
    qint32 crcOfFile(const QByteArray& content) {
        m_crc.setInputFileName(m_fake.writeFile(QStringLiteral("rom.bin"), content));
        m_progress.clear();
        return m_crc.GetCRCFromFile();
    }

    FakePlatform m_fake;
    CCRC32 m_crc{m_fake.dialogs};
    std::vector<float> m_progress;

    void SetUp() override {
        QObject::connect(&m_crc, &CCRC32::Progress,
                         [this](float fraction) { m_progress.push_back(fraction); });
    }
};

TEST_F(Crc32Test, CheckValueComesBackAsTheNegativeNumberWithTheSameBits) {
    const qint32 crc = crcOfFile("123456789");
    EXPECT_EQ(crc, static_cast<qint32>(0xCBF43926u));
    // Nothing carries over: the same file again gives the same value.
    EXPECT_EQ(m_crc.GetCRCFromFile(), crc);
    EXPECT_TRUE(m_fake.dialogs.boxes.empty());
}

// Sizes around the chunk boundaries: a remainder of up to 32,768 bytes is read whole, so
// 32,768 is one chunk and 32,769 two (32,767 + 2). The progress values show the chunks.
TEST_F(Crc32Test, FileSizesAroundTheChunkRuleGiveTheWholeFilesCrc) {
    struct Case {
        qsizetype size;
        std::vector<qsizetype> chunks;
    };
    const std::vector<Case> cases = {
        {0, {}},
        {1, {1}},
        {32767, {32767}},
        {32768, {32768}},
        {32769, {32767, 2}},
        {65535, {32767, 32768}},
        {65536, {32767, 32767, 2}},
    };
    std::mt19937 rng(1);
    for (const Case& c : cases) {
        SCOPED_TRACE(c.size);
        const QByteArray content = randomBytes(rng, c.size);
        EXPECT_EQ(crcOfFile(content), static_cast<qint32>(referenceCrc(content)));

        std::vector<float> expected = {0.0f};
        qsizetype done = 0;
        for (const qsizetype chunk : c.chunks) {
            done += chunk;
            expected.push_back(static_cast<float>(double(done) / double(c.size)));
        }
        EXPECT_EQ(m_progress, expected);
    }
    EXPECT_EQ(crcOfFile({}), 0);
    EXPECT_TRUE(m_fake.dialogs.boxes.empty());
}

// Every kernel, started at any alignment and fed in pieces, gives the bit-by-bit CRC.
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
            const quint32 expected = referenceCrc(QByteArrayView(data).sliced(
                static_cast<qsizetype>(offset), static_cast<qsizetype>(length)));
            for (auto kernel : kernels) {
                SCOPED_TRACE(testing::Message() << "length " << length << " offset " << offset);
                ASSERT_EQ(kernel(crc32kernels::kInitial, bytes + offset, length) ^ 0xFFFFFFFFu,
                          expected);
                // Fed in two pieces, the running value carries across.
                const std::size_t split = length / 3;
                const std::uint32_t head = kernel(crc32kernels::kInitial, bytes + offset, split);
                ASSERT_EQ(kernel(head, bytes + offset + split, length - split) ^ 0xFFFFFFFFu,
                          expected);
            }
        }
    }
}

TEST_F(Crc32Test, StringsAreChecksummedAsUtf16LittleEndian) {
    struct Case {
        QString text;
        QByteArray bytes;
    };
    const std::vector<Case> cases = {
        {QString(), QByteArray()},
        {QStringLiteral("A"), QByteArray("\x41\x00", 2)},
        {QStringLiteral("abc"), QByteArray("a\0b\0c\0", 6)},
        {QStringLiteral("\u00e9\u20ac"), QByteArray("\xe9\x00\xac\x20", 4)},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text.toStdString());
        m_progress.clear();
        EXPECT_EQ(m_crc.GetCRCFromString(c.text), static_cast<qint32>(referenceCrc(c.bytes)));
        ASSERT_FALSE(m_progress.empty());
        EXPECT_EQ(m_progress.back(), 1.0f);
    }
}

// What cannot be read gives 0 and one box naming the fault; a missing file is not created
// and a FIFO must not hang the call.
TEST_F(Crc32Test, FilesThatCannotBeReadGiveZeroAndOneBox) {
    const QString missing = m_fake.root() + QStringLiteral("/no such.bin");
    const QString fifo = m_fake.root() + QStringLiteral("/pipe");
    ASSERT_EQ(::mkfifo(QFile::encodeName(fifo).constData(), 0600), 0);
    const QString locked = m_fake.writeFile(QStringLiteral("locked.bin"), "123456789");
    ASSERT_EQ(::chmod(QFile::encodeName(locked).constData(), 0444), 0);
    m_crc.setInputFileName(locked); // read-only is readable
    EXPECT_EQ(m_crc.GetCRCFromFile(), static_cast<qint32>(0xCBF43926u));
    ASSERT_EQ(::chmod(QFile::encodeName(locked).constData(), 0), 0);
    const NoPermissionOverride asAnyone;
    ASSERT_TRUE(asAnyone.holds());

    const std::pair<QString, const char*> cases[] = {
        {missing, "Error: 53. File not found"},
        {QString(), "Error: 53. File not found"},
        {m_fake.makeFolder(QStringLiteral("folder")), "Error: 75. Path/File access error"},
        {fifo, "Error: 75. Path/File access error"},
        {locked, "Error: 70. Permission denied"},
    };
    for (const auto& [path, error] : cases) {
        SCOPED_TRACE(path.toStdString());
        m_fake.dialogs.boxes.clear();
        m_crc.setInputFileName(path);
        EXPECT_EQ(m_crc.GetCRCFromFile(), 0);
        EXPECT_EQ(boxLines(m_fake.dialogs),
                  Lines{"GetCRCFromFile | " + std::string(error) + " | Ok | None"});
    }
    EXPECT_FALSE(QFileInfo::exists(missing));
}

} // namespace
