// LookupSoftwareID on a 100,000-record database (the CRC of a small ROM included) against
// reading the database in large chunks into a reused buffer and comparing the CRC field.

#include "BenchReport.h"
#include "SilentDialogs.h"

#include "library/CCRC32.h"
#include "library/GameDatabase.h"

#include <QCoreApplication>
#include <QFile>
#include <QTemporaryDir>

#include <cstring>
#include <random>

#include <fcntl.h>
#include <unistd.h>

namespace {

bool writeFile(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    return file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size();
}

// The baseline: 1 MiB-ish reads into one buffer kept across runs, a plain compare per record.
qint16 chunkedScan(const QByteArray& path, std::vector<unsigned char>& buffer, qint32 key) {
    const int fd = ::open(path.constData(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return 0;
    qint16 id = 0;
    ssize_t got;
    while (id == 0 && (got = ::read(fd, buffer.data(), buffer.size())) > 0) {
        for (ssize_t at = 0; at + 56 <= got; at += 56) {
            qint32 crc;
            std::memcpy(&crc, buffer.data() + at + 52, 4);
            if (crc == key) {
                std::memcpy(&id, buffer.data() + at, 2);
                break;
            }
        }
    }
    ::close(fd);
    return id;
}

} // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    constexpr int kRecords = 100000;
    constexpr int kRepetitions = 41;

    QTemporaryDir dir;
    const QString romPath = dir.path() + QStringLiteral("/game.bin");
    const QString dbPath = dir.path() + QStringLiteral("/CRCID.dat");

    std::mt19937 rng(3);
    QByteArray rom(4096, Qt::Uninitialized);
    for (char& b : rom)
        b = static_cast<char>(rng());
    bench::SilentDialogs dialogs;
    CCRC32 engine(dialogs);
    if (!writeFile(romPath, rom)) {
        std::fprintf(stderr, "cannot write the test files\n");
        return 1;
    }
    engine.setInputFileName(romPath);
    const qint32 romCrc = engine.GetCRCFromFile();

    // The ROM's record is the very last, so both sides scan the whole file.
    std::vector<GameRecord> records(kRecords);
    for (int i = 0; i < kRecords; ++i) {
        records[std::size_t(i)].SoftwareID = static_cast<qint16>(1 + i % 32000);
        records[std::size_t(i)].Title = QStringLiteral("Game %1").arg(i);
        qint32 crc;
        do
            crc = static_cast<qint32>(rng());
        while (crc == romCrc);
        records[std::size_t(i)].CRC = crc;
    }
    records.back().CRC = romCrc;
    records.back().SoftwareID = 4242;
    if (!writeFile(dbPath, encodeGameDatabase(records))) {
        std::fprintf(stderr, "cannot write the test files\n");
        return 1;
    }

    qint16 ours = 0;
    qint16 theirs = 0;
    const QByteArray dbName = QFile::encodeName(dbPath);
    std::vector<unsigned char> buffer(56 * 16384);
    const auto [lookup, chunked] = bench::measurePair(
        kRepetitions, [&] { ours = LookupSoftwareID(engine, dbPath, romPath); },
        [&] { theirs = chunkedScan(dbName, buffer, romCrc); });
    if (ours != 4242 || theirs != 4242 || dialogs.boxes) {
        std::fprintf(stderr, "wrong result: ours %d, baseline %d\n", ours, theirs);
        return 1;
    }
    bench::report("LookupSoftwareID 100,000 records", lookup, "chunked read", chunked, 2.0);
    return 0;
}
