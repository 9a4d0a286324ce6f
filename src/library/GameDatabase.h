#pragma once

#include <QByteArray>
#include <QByteArrayView>
#include <QString>

#include <optional>
#include <vector>

class CCRC32;

// One entry of the game database CRCID.dat: 56 bytes on disk, little-endian, no header and
// no padding between records.
//   offset 0   int16     SoftwareID
//   offset 2   50 bytes  Title (single-byte characters, padded with spaces; never read)
//   offset 52  int32     CRC (the CRC-32 of the ROM image as CCRC32 returns it)
struct GameRecord {
    static constexpr int kSize = 56;
    static constexpr int kTitleSize = 50;
    static constexpr int kCRCOffset = 52;

    qint16 SoftwareID = 0;
    QString Title; // as stored: kTitleSize characters, space-padded
    qint32 CRC = 0;

    // The record's 56 bytes. The title is written as Latin-1, cut or space-padded to 50.
    QByteArray encode() const;
    // The record held by the first 56 bytes, or nothing when fewer are given.
    static std::optional<GameRecord> decode(QByteArrayView bytes);
};

// The software ID of the ROM image at romPath: the ID of the first record of the database
// whose CRC equals the image's CRC-32, or 0 when none does. The database is only read: a
// missing one identifies nothing and is not created. Nothing is kept between lookups. A file
// over 16 MiB is not read and identifies nothing.
qint16 LookupSoftwareID(CCRC32& crc, const QString& databasePath, const QString& romPath);

// The scan alone: the ID of the first record whose CRC is `key`, or 0.
qint16 findSoftwareID(const QString& databasePath, qint32 key);

// The text list the database is built from, one game a line:
//     software ID, title, CRC-32 in hex
// e.g. "57, Pitfall!, 0x1A2B3C4D". The ID is the text before the first comma and the CRC
// the text after the last, so a title may hold commas. Blank lines and lines starting
// with '#' are skipped.
struct GameListError {
    int line = 0; // 1-based
    QString message;
};

struct GameListParse {
    std::vector<GameRecord> records;
    std::optional<GameListError> error; // the first bad line; records are then incomplete
};

// Reads the list (UTF-8). A line that is not a valid entry stops the parse with an error
// naming it; so does a CRC already listed, which the lookup could never reach.
GameListParse parseGameList(QByteArrayView text);

// The database file's bytes for the records, in order.
QByteArray encodeGameDatabase(const std::vector<GameRecord>& records);
