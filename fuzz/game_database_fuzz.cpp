// The game database: any bytes as CRCID.dat (record decoder and the lookup scan) and as the
// text list the database is built from.
#include "FuzzSupport.h"

#include "library/GameDatabase.h"

#include <cstring>

#include <sys/mman.h>
#include <unistd.h>

namespace {

// An in-memory file with a path, so that the scan reads it through the file system as it
// reads CRCID.dat, without touching the disk.
class MemoryFile {
public:
    MemoryFile() : m_fd(::memfd_create("CRCID.dat", MFD_CLOEXEC)) {
        if (m_fd < 0)
            FUZZ_CHECK(!"memfd_create failed");
        m_path = QStringLiteral("/proc/self/fd/%1").arg(m_fd);
    }
    ~MemoryFile() { ::close(m_fd); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    const QString& hold(const QByteArray& content) {
        FUZZ_CHECK(::ftruncate(m_fd, 0) == 0);
        FUZZ_CHECK(::pwrite(m_fd, content.constData(), size_t(content.size()), 0) ==
                   ssize_t(content.size()));
        return m_path;
    }

private:
    int m_fd;
    QString m_path;
};

qint32 le32(const char* p) {
    quint32 v = 0;
    std::memcpy(&v, p, 4);
    return static_cast<qint32>(v); // x86-64 is little-endian, as the file is
}

qint16 le16(const char* p) {
    quint16 v = 0;
    std::memcpy(&v, p, 2);
    return static_cast<qint16>(v);
}

// The ID a plain walk over whole records gives: the model the scan must agree with.
qint16 expectedID(const QByteArray& file, qint32 key) {
    for (qsizetype at = 0; at + GameRecord::kSize <= file.size(); at += GameRecord::kSize) {
        if (le32(file.constData() + at + GameRecord::kCRCOffset) == key)
            return le16(file.constData() + at);
    }
    return 0;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static MemoryFile database;
    const QByteArray input = fuzz::bytes(data, size);

    // The decoder: fewer than 56 bytes are no record; otherwise the record encodes back to
    // the very bytes it came from.
    const std::optional<GameRecord> record = GameRecord::decode(input);
    FUZZ_CHECK(record.has_value() == (input.size() >= GameRecord::kSize));
    if (record) {
        FUZZ_CHECK(record->Title.size() == GameRecord::kTitleSize);
        FUZZ_CHECK(record->encode() == input.left(GameRecord::kSize));
    }

    // The scan, keyed by the first record's CRC (so that it often matches) and by a CRC
    // taken from the input's first bytes.
    const QString& path = database.hold(input);
    if (record)
        FUZZ_CHECK(findSoftwareID(path, record->CRC) == expectedID(input, record->CRC));
    if (input.size() >= 4) {
        const qint32 key = le32(input.constData());
        FUZZ_CHECK(findSoftwareID(path, key) == expectedID(input, key));

        // The same records behind up to 192 KiB of zeros, so that they straddle the scan's
        // reads: the padding's length comes from the input too.
        const qsizetype padding = qsizetype(quint16(le16(input.constData()))) * 3;
        const QByteArray padded = QByteArray(padding, '\0') + input;
        const QString& paddedPath = database.hold(padded);
        FUZZ_CHECK(findSoftwareID(paddedPath, key) == expectedID(padded, key));
    }

    // The text list: whatever it yields is a database in which every entry is found.
    const GameListParse list = parseGameList(input);
    if (!list.records.empty()) {
        const QByteArray built = encodeGameDatabase(list.records);
        FUZZ_CHECK(built.size() == qsizetype(list.records.size()) * GameRecord::kSize);
        const QString& builtPath = database.hold(built);
        for (const GameRecord& entry : list.records) {
            FUZZ_CHECK(entry.SoftwareID >= 1);
            FUZZ_CHECK(entry.Title.size() == GameRecord::kTitleSize);
            FUZZ_CHECK(findSoftwareID(builtPath, entry.CRC) == entry.SoftwareID);
        }
    }
    return 0;
}
