#include "library/CCRC32.h"

#include "support/Boxes.h"
#include "support/Files.h"

#include <numeric>
#include <random>

#include <sys/stat.h>

#include <gtest/gtest.h>

// The CRC-32 bit by bit, as the yardstick: each bit of a byte, lowest first, meets the running
// value's lowest bit, which decides whether the polynomial goes in.
static quint32 referenceCrc(QByteArrayView bytes) {
    quint32 crc = ~0u;
    for (const char byte : bytes)
        for (int bit = 0; bit < 8; ++bit)
            crc = ((crc ^ (quint8(byte) >> bit)) & 1u) ? (crc >> 1) ^ 0xEDB88320u : crc >> 1;
    return ~crc;
}

static QByteArray randomBytes(qsizetype size) {
    static std::mt19937 rng(1);
    QByteArray bytes(size, Qt::Uninitialized);
    std::generate(bytes.begin(), bytes.end(), [] { return char(rng()); });
    return bytes;
}

// Call after call, a file's CRC, read in chunks of 32,767 but for a last piece of up to 32,768
// (as the progress shows); or, unreadable (not created, not waited for), 0 and one box.
TEST(Crc32, EveryFileGivesTheCrcOfItsBytesOrZeroAndOneBox) {
    FakePlatform fake;
    CCRC32 crc(fake.dialogs);
    std::vector<float> progress;
    QObject::connect(&crc, &CCRC32::Progress, [&](float value) { progress.push_back(value); });
    const QString readOnly = fake.writeFile("read-only.bin", "123456789");
    const QString locked = fake.writeFile("locked.bin"), fifo = fake.root() + "/pipe";
    const NoPermissionOverride asAnyone;
    ASSERT_TRUE(asAnyone.holds() && QFile::setPermissions(readOnly, QFile::ReadOwner) &&
                QFile::setPermissions(locked, {}) && ::mkfifo(QFile::encodeName(fifo), 0600) == 0);
    std::vector<std::tuple<QString, quint32, std::vector<qsizetype>, const char*>> cases = {
        {readOnly, 0xCBF43926u, {9}, nullptr}, // the check value
        {fake.root() + "/no such.bin", 0, {}, "Error: 53. File not found"},
        {QString(), 0, {}, "Error: 53. File not found"},
        {fake.makeFolder("dir"), 0, {}, "Error: 75. Path/File access error"},
        {fifo, 0, {}, "Error: 75. Path/File access error"},
        {locked, 0, {}, "Error: 70. Permission denied"}};
    for (const auto& chunks : {std::vector<qsizetype>{}, {32768}, {32767, 2}, {32767, 32767, 2}}) {
        const QByteArray bytes = randomBytes(std::reduce(chunks.begin(), chunks.end()));
        cases.emplace_back(fake.writeFile(QString::number(bytes.size()), bytes),
                           referenceCrc(bytes), chunks, nullptr);
    }
    for (const auto& [path, value, chunks, error] : cases) {
        SCOPED_TRACE(path.toStdString());
        const double size = double(std::reduce(chunks.begin(), chunks.end()));
        std::vector<float> expected(error ? 0 : 1, 0.0f);
        for (qsizetype done = 0; const qsizetype chunk : chunks)
            expected.push_back(float(double(done += chunk) / size));
        const Lines box =
            error ? Lines{"GetCRCFromFile | " + std::string(error) + " | Ok | None"} : Lines{};
        crc.setInputFileName(path);
        // A braced list is evaluated in order: the progress and boxes are those of this call.
        for (int call = 0; call < 2; ++call, fake.dialogs.boxes.clear())
            EXPECT_EQ((std::tuple{crc.GetCRCFromFile(), std::exchange(progress, {}),
                                  boxLines(fake.dialogs)}),
                      std::tuple(qint32(value), expected, box));
    }
    EXPECT_FALSE(QFile::exists(fake.root() + "/no such.bin"));
}

// Every kernel at any alignment gives the bit-by-bit CRC (the files above carry running values).
TEST(Crc32Kernels, AgreeWithTheReferenceForEveryLengthAndAlignment) {
    const QByteArray data = randomBytes(4096 + 64);
    const auto* bytes = reinterpret_cast<const unsigned char*>(data.constData());
    using namespace crc32kernels;
    const auto clmul = clmulAvailable() ? updateClmul : update; // only callable where available
    for (std::size_t length = 0; length <= 4096; length += (length < 300 ? 1 : 97))
        for (const qsizetype offset : {0, 1, 3, 8, 15})
            for (const auto kernel : {updatePortable, update, clmul})
                ASSERT_EQ(~kernel(kInitial, bytes + offset, length),
                          referenceCrc(data.sliced(offset, qsizetype(length))))
                    << "length " << length << " offset " << offset;
}
