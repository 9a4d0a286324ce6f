#include "library/CCRC32.h"
#include "library/GameDatabase.h"

#include "support/FakePlatform.h"
#include "support/Files.h"

#include <QFileInfo>
#include <QProcess>

#include <sys/stat.h>

#include <gtest/gtest.h>

// The CRC looked up; its top bit is set, so it must match as the negative number it is.
constexpr qint32 kKey = static_cast<qint32>(0xCBF43926u);

// CRCID.dat in every shape (named by its file): the first whole match wins, read 1,024 records
// at a time; the file is not created or changed, and what cannot be read identifies nothing.
TEST(GameDatabase, EveryShapeGivesTheFirstWholeMatchAndTheFileIsLeftAsItWas) {
    FakePlatform fake;
    const auto record = [](qint16 id, qint32 crc) { return GameRecord{id, "A", crc}.encode(); };
    const QString fifo = fake.root() + "/a FIFO", loop = fake.root() + "/a link to itself";
    ASSERT_TRUE(::mkfifo(QFile::encodeName(fifo), 0600) == 0 && QFile::link(loop, loop));
    std::vector<std::pair<QString, qint16>> cases = {
        {fake.root() + "/missing", 0},
        {fake.writeFile("empty"), 0},
        {fake.writeFile("a duplicate, after the key's lower 31 bits",
                        record(5, kKey & 0x7FFFFFFF) + record(7, kKey) + record(9, kKey)),
         7},
        {fake.writeFile("the first match has the ID 0", record(0, kKey) + record(9, kKey)), 0},
        {makeUnreadable(fake.root() + "/unreadable", record(7, kKey)), 0},
        {fake.makeFolder("a folder"), 0},
        {fifo, 0},
        {loop, 0},
    };
    // The match as the last of 1, 1024, 1025, 2048 and 3000 records.
    for (const int before : {0, 1023, 1024, 2047, 2999}) {
        QByteArray whole;
        for (int i = 1; i <= before; ++i)
            whole += record(static_cast<qint16>(i), kKey ^ i);
        whole += record(7, kKey);
        const QString name = QString::number(before + 1) + " records";
        cases.push_back({fake.writeFile(name, whole), 7});
        cases.push_back({fake.writeFile(name + " and a piece", whole + QByteArray(55, '\0')), 7});
        cases.push_back({fake.writeFile(name + ", the last cut short", whole.chopped(1)), 0});
    }
    for (const auto& [path, id] : cases) {
        const auto state = [&p = path] { return QFile::exists(p) ? QFileInfo(p).size() : -1; };
        const qint64 before = state();
        const qint16 found = findSoftwareID(path, kKey);
        EXPECT_EQ(std::pair(found, state()), std::pair(id, before)) << path.toStdString();
    }
}

// The list the database is built from; a bad line stops the parse, named with its complaint.
TEST(GameList, ReadsEntriesAndNamesABadLine) {
    const GameListParse parsed =
        parseGameList("\xEF\xBB\xBF# comment\r\n\r\n57, Pitfall!, 0x1A2B3C4D\r\n"
                      "  12 ,Adventure, Part 2 , cbf43926\n   # indented comment\n"
                      "32767, Caf\xC3\xA9, ff\n1,x,0");
    ASSERT_FALSE(parsed.error) << parsed.error->message.toStdString();
    // Each record little-endian: the ID, the title padded to 50, the CRC.
    const auto entry = [](const char* id, const char* title, const char* crc) {
        return QByteArray(id, 2) + QByteArray(title).leftJustified(50) + QByteArray(crc, 4);
    };
    EXPECT_EQ(encodeGameDatabase(parsed.records),
              entry("\x39\0", "Pitfall!", "\x4D\x3C\x2B\x1A") +
                  entry("\x0C\0", "Adventure, Part 2", "\x26\x39\xF4\xCB") +
                  entry("\xFF\x7F", "Caf\xE9", "\xFF\0\0\0") + entry("\1\0", "x", "\0\0\0\0"));
    const std::pair<const char*, std::vector<QByteArray>> cases[] = {
        {"expected", {"2 Missing commas 2", "2, no crc"}},
        {"software ID", {"x, T, 1234", "0, T, 1234", "-3, T, 1234", "32768, T, 1234", ", T, 1"}},
        {"CRC-32", {"2, Title, 123456789", "2, Title, 12G4", "2, Title, 0x", "2, Title,"}},
        {"title is empty", {"2, , 1234"}},
        {"51 characters", {"2, " + QByteArray(51, 'T') + ", 1234"}},
        {"Latin-1", {"2, \xE2\x82\xAC uro, 1234"}},
        {"UTF-8", {"2, Bad \xFF UTF-8, 1234"}},
        {"already listed on line 2", {"2, Same CRC, 0x00000001"}},
    };
    for (const auto& [complaint, lines] : cases)
        for (const QByteArray& line : lines) {
            const auto bad = parseGameList("# header\n1, Good, 1\n" + line + "\n4, Later, 4444\n");
            EXPECT_TRUE(bad.error && bad.error->line == 3 && bad.error->message.contains(complaint))
                << line.constData() << (bad.error ? ": " + bad.error->message.toStdString() : "");
        }
}

// The tool builds a database from a list that identifies our test cartridges; one over 16 MiB
// is not read. The database that ships holds no invented entries.
TEST(GameDatabase, TheToolsDatabaseIdentifiesTheTestCartridgesButNoHugeFile) {
    FakePlatform fake;
    const QString list = fake.writeFile("CRCID.txt", "1, Rising, AE215F82\n2, Falling, 8145AE72\n"
                                                     "3, Flashing, 555083D5\n4, Huge, 8F77090B\n");
    const QString database = fake.root() + "/CRCID.dat";
    ASSERT_EQ(QProcess::execute(LUM_CRCID_TOOL, {list, database}), 0);
    QFile huge(fake.writeFile("huge.a26")); // 17 MiB of zeros, whose CRC is listed
    ASSERT_TRUE(huge.resize(17 << 20));
    CCRC32 crc(fake.dialogs);
    QString ids;
    for (const QString rom : {"rising-bars", "falling-bars", "flashing-screen"})
        ids += QString::number(
            LookupSoftwareID(crc, database, LUM_CRCID_SOURCE_DIR "/testroms/" + rom + ".a26"));
    EXPECT_EQ(ids + QString::number(LookupSoftwareID(crc, database, huge.fileName())), "1230");
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_EQ(QFileInfo(LUM_CRCID_DAT).size(), 0);
}
