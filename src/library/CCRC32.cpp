#include "library/CCRC32.h"
#include "library/ReadFully.h"

#include "platform/Dialogs.h"
#include "platform/FileSystem.h"

#include <QFile>
#include <QSysInfo>

#include <array>
#include <cerrno>
#include <memory>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#if defined(__x86_64__) || defined(__i386__)
#include <immintrin.h>
#define LUM_CRC32_HAVE_CLMUL 1
#else
#define LUM_CRC32_HAVE_CLMUL 0
#endif

namespace crc32kernels {
namespace {

// Slicing tables: row 0 is the classic byte-at-a-time table; row k advances a byte that
// lies k positions further back, so eight bytes are folded in one step.
using Tables = std::array<std::array<std::uint32_t, 256>, 8>;

constexpr Tables makeTables() {
    Tables t{};
    for (std::uint32_t n = 0; n < 256; ++n) {
        std::uint32_t c = n;
        for (int bit = 0; bit < 8; ++bit)
            c = (c & 1u) ? (c >> 1) ^ kPolynomial : c >> 1;
        t[0][n] = c;
    }
    for (std::size_t k = 1; k < t.size(); ++k)
        for (std::size_t n = 0; n < 256; ++n)
            t[k][n] = (t[k - 1][n] >> 8) ^ t[0][t[k - 1][n] & 0xFFu];
    return t;
}

constexpr Tables kTables = makeTables();

std::uint32_t loadLe32(const unsigned char* p) {
    return std::uint32_t(p[0]) | std::uint32_t(p[1]) << 8 | std::uint32_t(p[2]) << 16 |
           std::uint32_t(p[3]) << 24;
}

std::uint32_t updateBytes(std::uint32_t crc, const unsigned char* data, std::size_t size) {
    for (std::size_t i = 0; i < size; ++i)
        crc = (crc >> 8) ^ kTables[0][(crc ^ data[i]) & 0xFFu];
    return crc;
}

#if LUM_CRC32_HAVE_CLMUL

// Folding with carry-less multiplication (Gopal et al., "Fast CRC Computation for Generic
// Polynomials Using PCLMULQDQ Instruction", Intel 2009), constants for the reflected
// CRC-32 polynomial. Four 128-bit lanes are folded 64 bytes at a time, then folded into
// one lane, then reduced to 32 bits with Barrett's method. size is a multiple of 16, >= 64.
#define LUM_CLMUL_TARGET __attribute__((target("pclmul,sse4.1")))

LUM_CLMUL_TARGET inline __m128i load(const unsigned char* p) {
    return _mm_loadu_si128(reinterpret_cast<const __m128i*>(p));
}

// x times the folding constants (both halves), added to the next 128 bits.
LUM_CLMUL_TARGET inline __m128i fold(__m128i x, __m128i k, __m128i next) {
    const __m128i lo = _mm_clmulepi64_si128(x, k, 0x00);
    const __m128i hi = _mm_clmulepi64_si128(x, k, 0x11);
    return _mm_xor_si128(_mm_xor_si128(hi, lo), next);
}

LUM_CLMUL_TARGET std::uint32_t foldClmul(std::uint32_t crc, const unsigned char* buf,
                                         std::size_t size) {
    const __m128i k1k2 = _mm_set_epi64x(0x01c6e41596, 0x0154442bd4);
    const __m128i k3k4 = _mm_set_epi64x(0x00ccaa009e, 0x01751997d0);
    const __m128i k5k0 = _mm_set_epi64x(0, 0x0163cd6124);
    const __m128i poly = _mm_set_epi64x(0x01f7011641, 0x01db710641);
    const __m128i low32 = _mm_setr_epi32(~0, 0, ~0, 0);

    __m128i x1 = _mm_xor_si128(load(buf), _mm_cvtsi32_si128(static_cast<int>(crc)));
    __m128i x2 = load(buf + 16);
    __m128i x3 = load(buf + 32);
    __m128i x4 = load(buf + 48);
    buf += 64;
    size -= 64;

    while (size >= 64) {
        x1 = fold(x1, k1k2, load(buf));
        x2 = fold(x2, k1k2, load(buf + 16));
        x3 = fold(x3, k1k2, load(buf + 32));
        x4 = fold(x4, k1k2, load(buf + 48));
        buf += 64;
        size -= 64;
    }

    x1 = fold(x1, k3k4, x2);
    x1 = fold(x1, k3k4, x3);
    x1 = fold(x1, k3k4, x4);
    while (size >= 16) {
        x1 = fold(x1, k3k4, load(buf));
        buf += 16;
        size -= 16;
    }

    // 128 bits to 64.
    __m128i x2r = _mm_clmulepi64_si128(x1, k3k4, 0x10);
    x1 = _mm_xor_si128(_mm_srli_si128(x1, 8), x2r);
    // 64 bits to 32 (plus 32 to carry).
    x2r = _mm_srli_si128(x1, 4);
    x1 = _mm_and_si128(x1, low32);
    x1 = _mm_xor_si128(_mm_clmulepi64_si128(x1, k5k0, 0x00), x2r);
    // Barrett reduction.
    __m128i t = _mm_and_si128(x1, low32);
    t = _mm_clmulepi64_si128(t, poly, 0x10);
    t = _mm_and_si128(t, low32);
    t = _mm_clmulepi64_si128(t, poly, 0x00);
    x1 = _mm_xor_si128(x1, t);
    return static_cast<std::uint32_t>(_mm_extract_epi32(x1, 1));
}

bool detectClmul() {
    __builtin_cpu_init();
    return __builtin_cpu_supports("pclmul") && __builtin_cpu_supports("sse4.1");
}

#endif

} // namespace

std::uint32_t updatePortable(std::uint32_t crc, const unsigned char* data, std::size_t size) {
    while (size >= 8) {
        const std::uint32_t one = loadLe32(data) ^ crc;
        const std::uint32_t two = loadLe32(data + 4);
        crc = kTables[7][one & 0xFFu] ^ kTables[6][(one >> 8) & 0xFFu] ^
              kTables[5][(one >> 16) & 0xFFu] ^ kTables[4][one >> 24] ^ kTables[3][two & 0xFFu] ^
              kTables[2][(two >> 8) & 0xFFu] ^ kTables[1][(two >> 16) & 0xFFu] ^
              kTables[0][two >> 24];
        data += 8;
        size -= 8;
    }
    return updateBytes(crc, data, size);
}

bool clmulAvailable() {
#if LUM_CRC32_HAVE_CLMUL
    // The answer never changes while the program runs.
    static const bool available = detectClmul();
    return available;
#else
    return false;
#endif
}

std::uint32_t updateClmul(std::uint32_t crc, const unsigned char* data, std::size_t size) {
#if LUM_CRC32_HAVE_CLMUL
    if (size >= 64) {
        const std::size_t folded = size & ~std::size_t(15);
        crc = foldClmul(crc, data, folded);
        data += folded;
        size -= folded;
    }
#endif
    return updatePortable(crc, data, size);
}

std::uint32_t update(std::uint32_t crc, const unsigned char* data, std::size_t size) {
    return clmulAvailable() ? updateClmul(crc, data, size) : updatePortable(crc, data, size);
}

} // namespace crc32kernels

namespace {

// Error numbers and texts in the form the program has always shown them.
struct FileError {
    int number;
    const char* description;
};

FileError openError(int err) {
    switch (err) {
    case ENOENT:
    case ENOTDIR:
        return {53, "File not found"};
    case EACCES:
    case EPERM:
        return {70, "Permission denied"};
    default:
        return {75, "Path/File access error"};
    }
}

constexpr FileError kNotAFile{75, "Path/File access error"};
constexpr FileError kReadError{57, "Device I/O error"};

// Closes the descriptor when the computation ends, whichever way it ends.
class FileHandle {
public:
    explicit FileHandle(int fd) : m_fd(fd) {}
    ~FileHandle() {
        if (m_fd >= 0)
            ::close(m_fd);
    }
    FileHandle(const FileHandle&) = delete;
    FileHandle& operator=(const FileHandle&) = delete;
    int fd() const { return m_fd; }

private:
    int m_fd;
};

qint32 asSigned(std::uint32_t crc) {
    return static_cast<qint32>(crc);
}

} // namespace

CCRC32::CCRC32(Dialogs& dialogs, QObject* parent) : QObject(parent), m_dialogs(dialogs) {}

std::uint32_t CCRC32::UpdateCRC32(std::uint32_t crc, unsigned char b) {
    return crc32kernels::updatePortable(crc, &b, 1);
}

void CCRC32::showError(const QString& operation, int number, const QString& description) {
    m_dialogs.MsgBox(nullptr,
                     QStringLiteral("Error: %1. %2").arg(QString::number(number), description),
                     MsgButtons::Ok, MsgIcon::None, operation);
}

qint32 CCRC32::GetCRCFromFile() {
    const QString operation = QStringLiteral("GetCRCFromFile");
    const QByteArray path = nameToFileSystem(m_inputFileName);
    // Non-blocking so that a FIFO or a device named by mistake cannot hang the window;
    // anything that is not a regular file is refused below.
    int fd = -1;
    int err = ENOENT;
    if (!path.isEmpty()) {
        fd = ::open(path.constData(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK);
        err = errno;
    }
    if (fd < 0) {
        const FileError e = openError(err);
        showError(operation, e.number, QString::fromLatin1(e.description));
        return 0;
    }
    const FileHandle file(fd);
    struct stat info {};
    if (::fstat(fd, &info) != 0 || !S_ISREG(info.st_mode)) {
        showError(operation, kNotAFile.number, QString::fromLatin1(kNotAFile.description));
        return 0;
    }
    ::posix_fadvise(fd, 0, 0, POSIX_FADV_SEQUENTIAL);

    // The length is taken once: bytes appended while we read are not part of the result.
    const qint64 length = info.st_size;
    const auto buffer = std::make_unique_for_overwrite<unsigned char[]>(kChunkSize + 1);
    std::uint32_t crc = crc32kernels::kInitial;
    qint64 done = 0;
    emit Progress(0.0f);
    for (;;) {
        const qint64 remaining = length - done;
        if (remaining <= 0)
            break;
        // A remainder of up to one byte over the chunk size is read whole.
        const qint64 want = remaining > kChunkSize + 1 ? kChunkSize : remaining;
        const qint64 got = readFully(fd, buffer.get(), want);
        if (got < 0) {
            // The chunk counts as empty: the result covers the bytes before it.
            showError(QStringLiteral("ReadFile"), kReadError.number,
                      QString::fromLatin1(kReadError.description));
            break;
        }
        if (got == 0)
            break; // the file shrank while we read it
        crc = crc32kernels::update(crc, buffer.get(), static_cast<std::size_t>(got));
        done += got;
        emit Progress(static_cast<float>(double(done) / double(length)));
    }
    return asSigned(crc ^ 0xFFFFFFFFu);
}

qint32 CCRC32::GetCRCFromString(const QString& text) {
    emit Progress(0.0f);
    std::uint32_t crc = crc32kernels::kInitial;
    if constexpr (QSysInfo::ByteOrder == QSysInfo::LittleEndian) {
        crc = crc32kernels::update(crc, reinterpret_cast<const unsigned char*>(text.utf16()),
                                   static_cast<std::size_t>(text.size()) * 2);
    } else {
        for (const QChar c : text) {
            const unsigned char bytes[2] = {static_cast<unsigned char>(c.unicode() & 0xFFu),
                                            static_cast<unsigned char>(c.unicode() >> 8)};
            crc = crc32kernels::update(crc, bytes, 2);
        }
    }
    emit Progress(1.0f);
    return asSigned(crc ^ 0xFFFFFFFFu);
}
