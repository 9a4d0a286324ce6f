// GetCRCFromFile on a 64 MiB file against zlib's crc32 on the same bytes in memory.

#include "BenchReport.h"
#include "SilentDialogs.h"

#include "library/CCRC32.h"

#include <QCoreApplication>
#include <QFile>
#include <QTemporaryDir>

#include <random>

#include <zlib.h>

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    constexpr qsizetype kSize = qsizetype(64) << 20;
    constexpr int kRepetitions = 15;

    QByteArray bytes(kSize, Qt::Uninitialized);
    std::mt19937_64 rng(42);
    for (qsizetype i = 0; i < kSize; i += 8) {
        const std::uint64_t v = rng();
        std::memcpy(bytes.data() + i, &v, 8);
    }
    QTemporaryDir dir;
    const QString path = dir.path() + QStringLiteral("/big.bin");
    {
        QFile file(path);
        if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != kSize) {
            std::fprintf(stderr, "cannot write %s\n", qPrintable(path));
            return 1;
        }
    }

    bench::SilentDialogs dialogs;
    CCRC32 engine(dialogs);
    engine.setInputFileName(path);
    const auto* data = reinterpret_cast<const unsigned char*>(bytes.constData());

    qint32 ours = 0;
    uLong theirs = 0;
    std::uint32_t kernelCrc = 0;
    auto zlibCrc = [&] { theirs = crc32(crc32(0L, Z_NULL, 0), data, static_cast<uInt>(kSize)); };
    const auto [file, zlib] = bench::measurePair(
        kRepetitions, [&] { ours = engine.GetCRCFromFile(); }, zlibCrc);
    const auto [kernel, zlib2] = bench::measurePair(
        kRepetitions,
        [&] {
            kernelCrc =
                crc32kernels::update(crc32kernels::kInitial, data, static_cast<std::size_t>(kSize));
        },
        zlibCrc);
    const bench::Samples portable = bench::measure(kRepetitions, [&] {
        kernelCrc ^= crc32kernels::updatePortable(crc32kernels::kInitial, data,
                                                  static_cast<std::size_t>(kSize));
    });
    if (static_cast<quint32>(ours) != static_cast<quint32>(theirs) || dialogs.boxes) {
        std::fprintf(stderr, "CRC mismatch: ours %08x, zlib %08lx\n", static_cast<quint32>(ours),
                     theirs);
        return 1;
    }

    auto gbps = [](const bench::Samples& s) { return double(kSize) / (s.median() * 1e6); };
    std::printf("64 MiB: GetCRCFromFile %.2f GB/s, in-memory kernel %.2f GB/s (%s), portable "
                "kernel %.2f GB/s, zlib crc32 %.2f GB/s\n",
                gbps(file), gbps(kernel), crc32kernels::clmulAvailable() ? "pclmulqdq" : "portable",
                gbps(portable), gbps(zlib));
    bench::report("GetCRCFromFile 64 MiB (from file)", file, "zlib crc32 (memory)", zlib, 1.0);
    bench::report("CRC kernel alone 64 MiB (memory)", kernel, "zlib crc32 (memory)", zlib2, 1.0);
    return 0;
}
