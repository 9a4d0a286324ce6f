#include "library/GameDatabase.h"

#include "library/CCRC32.h"
#include "library/ReadFully.h"
#include "platform/FileSystem.h"

#include <QFile>
#include <QHash>
#include <QStringDecoder>

#include <cerrno>
#include <cstdint>
#include <memory>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

std::uint16_t loadLe16(const unsigned char* p) {
    return static_cast<std::uint16_t>(p[0] | p[1] << 8);
}

std::uint32_t loadLe32(const unsigned char* p) {
    return std::uint32_t(p[0]) | std::uint32_t(p[1]) << 8 | std::uint32_t(p[2]) << 16 |
           std::uint32_t(p[3]) << 24;
}

void storeLe(char* p, std::uint32_t value, int bytes) {
    for (int i = 0; i < bytes; ++i)
        p[i] = static_cast<char>((value >> (8 * i)) & 0xFFu);
}

// Whole records per read; a multiple of the record size keeps records whole in the buffer.
constexpr qint64 kRecordsPerRead = 1024;
constexpr qint64 kReadSize = kRecordsPerRead * GameRecord::kSize;

} // namespace

QByteArray GameRecord::encode() const {
    QByteArray out(kSize, ' ');
    storeLe(out.data(), static_cast<std::uint16_t>(SoftwareID), 2);
    const QByteArray title = Title.left(kTitleSize).toLatin1();
    std::copy(title.begin(), title.end(), out.begin() + 2);
    storeLe(out.data() + kCRCOffset, static_cast<std::uint32_t>(CRC), 4);
    return out;
}

std::optional<GameRecord> GameRecord::decode(QByteArrayView bytes) {
    if (bytes.size() < kSize)
        return std::nullopt;
    const auto* p = reinterpret_cast<const unsigned char*>(bytes.data());
    GameRecord record;
    record.SoftwareID = static_cast<qint16>(loadLe16(p));
    record.Title = QString::fromLatin1(bytes.data() + 2, kTitleSize);
    record.CRC = static_cast<qint32>(loadLe32(p + kCRCOffset));
    return record;
}

qint16 findSoftwareID(const QString& databasePath, qint32 key) {
    const QByteArray path = QFile::encodeName(databasePath);
    if (path.isEmpty())
        return 0;
    // Read-only and non-blocking: a missing database is not created, and something that
    // is not a regular file cannot hang the caller.
    const int fd = ::open(path.constData(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK);
    if (fd < 0)
        return 0;
    struct stat info {};
    if (::fstat(fd, &info) != 0 || !S_ISREG(info.st_mode)) {
        ::close(fd);
        return 0;
    }
    ::posix_fadvise(fd, 0, 0, POSIX_FADV_SEQUENTIAL);

    const auto wanted = static_cast<std::uint32_t>(key);
    const auto buffer = std::make_unique_for_overwrite<unsigned char[]>(kReadSize);
    qint16 id = 0;
    for (bool found = false; !found;) {
        const qint64 got = readFully(fd, buffer.get(), kReadSize);
        if (got <= 0)
            break;
        // A trailing piece shorter than a record is not a record.
        const qint64 records = got / GameRecord::kSize;
        const unsigned char* record = buffer.get();
        for (qint64 i = 0; i < records; ++i, record += GameRecord::kSize) {
            if (loadLe32(record + GameRecord::kCRCOffset) == wanted) {
                id = static_cast<qint16>(loadLe16(record));
                found = true;
                break;
            }
        }
        if (got < kReadSize)
            break;
    }
    ::close(fd);
    return id;
}

qint16 LookupSoftwareID(CCRC32& crc, const QString& databasePath, const QString& romPath) {
    // No cartridge image comes near this size; reading a film by mistake would take long.
    constexpr qint64 kLargestRom = 16 * 1024 * 1024;
    struct stat status {};
    if (::stat(nameToFileSystem(romPath).constData(), &status) == 0 && status.st_size > kLargestRom)
        return 0;
    crc.setInputFileName(GetShortPath(romPath));
    const qint32 key = crc.GetCRCFromFile();
    return findSoftwareID(databasePath, key);
}

namespace {

bool parseSoftwareID(QStringView text, qint16& id) {
    if (text.isEmpty() || text.size() > 5)
        return false;
    int value = 0;
    for (const QChar c : text) {
        if (c < u'0' || c > u'9')
            return false;
        value = value * 10 + (c.unicode() - u'0');
    }
    if (value < 1 || value > 32767)
        return false;
    id = static_cast<qint16>(value);
    return true;
}

bool parseCRC(QStringView text, qint32& crc) {
    if (text.startsWith(u"0x", Qt::CaseInsensitive))
        text = text.mid(2);
    if (text.isEmpty() || text.size() > 8)
        return false;
    std::uint32_t value = 0;
    for (const QChar c : text) {
        const char16_t u = c.unicode();
        const int digit = (u >= u'0' && u <= u'9')   ? u - u'0'
                          : (u >= u'a' && u <= u'f') ? u - u'a' + 10
                          : (u >= u'A' && u <= u'F') ? u - u'A' + 10
                                                     : -1;
        if (digit < 0)
            return false;
        value = value << 4 | static_cast<std::uint32_t>(digit);
    }
    crc = static_cast<qint32>(value);
    return true;
}

} // namespace

GameListParse parseGameList(QByteArrayView text) {
    GameListParse result;
    QHash<qint32, int> seen; // CRC -> line that listed it
    auto fail = [&result](int line, const QString& message) {
        result.error = GameListError{line, message};
        return result;
    };

    int lineNumber = 0;
    qsizetype pos = 0;
    if (text.startsWith("\xEF\xBB\xBF"))
        pos = 3;
    while (pos < text.size()) {
        qsizetype end = text.indexOf('\n', pos);
        if (end < 0)
            end = text.size();
        const QByteArrayView raw = text.sliced(pos, end - pos);
        pos = end + 1;
        ++lineNumber;

        QStringDecoder utf8(QStringDecoder::Utf8);
        const QString decoded = utf8(raw);
        if (utf8.hasError())
            return fail(lineNumber, QStringLiteral("the line is not valid UTF-8"));
        const QString line = decoded.trimmed();
        if (line.isEmpty() || line.startsWith(u'#'))
            continue;

        const qsizetype firstComma = line.indexOf(u',');
        const qsizetype lastComma = line.lastIndexOf(u',');
        if (firstComma < 0 || firstComma == lastComma)
            return fail(lineNumber,
                        QStringLiteral("expected \"software ID, title, CRC-32 in hex\""));

        GameRecord record;
        const QStringView idText = QStringView(line).left(firstComma).trimmed();
        if (!parseSoftwareID(idText, record.SoftwareID))
            return fail(lineNumber, QStringLiteral("software ID \"%1\" is not a whole number "
                                                   "from 1 to 32767")
                                        .arg(idText));

        const QStringView crcText = QStringView(line).mid(lastComma + 1).trimmed();
        if (!parseCRC(crcText, record.CRC))
            return fail(lineNumber,
                        QStringLiteral("CRC-32 \"%1\" is not 1 to 8 hex digits").arg(crcText));

        const QString title = QStringView(line)
                                  .sliced(firstComma + 1, lastComma - firstComma - 1)
                                  .trimmed()
                                  .toString();
        if (title.isEmpty())
            return fail(lineNumber, QStringLiteral("the title is empty"));
        if (title.size() > GameRecord::kTitleSize)
            return fail(lineNumber, QStringLiteral("the title is %1 characters long; at most "
                                                   "%2 fit")
                                        .arg(title.size())
                                        .arg(GameRecord::kTitleSize));
        for (const QChar c : title) {
            if (c.unicode() > 0xFF || c.unicode() < 0x20)
                return fail(lineNumber, QStringLiteral("the title holds \"%1\", which is not a "
                                                       "Latin-1 character")
                                            .arg(c));
        }
        record.Title = title.leftJustified(GameRecord::kTitleSize, u' ');

        const auto previous = seen.constFind(record.CRC);
        if (previous != seen.constEnd())
            return fail(lineNumber,
                        QStringLiteral("CRC-32 %1 is already listed on line %2; only the first "
                                       "entry could ever be found")
                            .arg(QString::number(static_cast<quint32>(record.CRC), 16)
                                     .rightJustified(8, u'0')
                                     .toUpper())
                            .arg(*previous));
        seen.insert(record.CRC, lineNumber);
        result.records.push_back(std::move(record));
    }
    return result;
}

QByteArray encodeGameDatabase(const std::vector<GameRecord>& records) {
    QByteArray out;
    out.reserve(static_cast<qsizetype>(records.size()) * GameRecord::kSize);
    for (const GameRecord& record : records)
        out += record.encode();
    return out;
}
