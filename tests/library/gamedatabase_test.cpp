#include "library/CCRC32.h"
#include "library/GameDatabase.h"

#include "support/DiskFull.h"
#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include <QFileInfo>
#include <QProcess>

#include <functional>
#include <tuple>

#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

// The CRC looked up; its top bit is set, so it must match as the negative number it is.
constexpr qint32 kKey = static_cast<qint32>(0xCBF43926u);

QByteArray record(qint16 id, qint32 crc) {
    return GameRecord{id, QStringLiteral("A game"), crc}.encode();
}

// Top bits set in both numbers, so that a sign carried into another byte shows.
TEST(GameRecord, HasTheFixedLittleEndianLayout) {
    const GameRecord record{static_cast<qint16>(0x80FE), QStringLiteral("Caf\u00e9"),
                            static_cast<qint32>(0xCBF43926u)};
    const QByteArray bytes = QByteArray("\xFE\x80") + QByteArray("Caf\xE9").leftJustified(50) +
                             QByteArray("\x26\x39\xF4\xCB");
    EXPECT_EQ(record.encode(), bytes);
    const auto decoded = GameRecord::decode(bytes + "more");
    ASSERT_TRUE(decoded);
    EXPECT_EQ(decoded->SoftwareID, record.SoftwareID);
    EXPECT_EQ(decoded->Title, record.Title.leftJustified(50));
    EXPECT_EQ(decoded->CRC, record.CRC);
    EXPECT_FALSE(GameRecord::decode(QByteArrayView(bytes).first(55)));
}

// CRCID.dat in every shape: whole records are read to the end, 1,024 at a time, and the
// first match wins; a lookup never fails, hangs, creates or changes the file, and whatever
// cannot be read identifies nothing (0).
TEST(GameDatabase, EveryShapeGivesTheFirstWholeMatchAndTheFileIsLeftAsItWas) {
    const auto holding = [](const QByteArray& bytes) {
        return [bytes](const QString& path) { ASSERT_TRUE(putFile(path, bytes)); };
    };
    std::vector<std::tuple<std::string, std::function<void(const QString&)>, qint16>> cases = {
        {"missing", [](const QString&) {}, 0},
        {"empty", holding({}), 0},
        {"garbage before the match", holding(QByteArray(56 * 500, '\xA5') + record(7, kKey)), 7},
        {"a duplicate, after the key's lower 31 bits",
         holding(record(5, kKey & 0x7FFFFFFF) + record(7, kKey) + record(9, kKey)), 7},
        {"the first match has the ID 0", holding(record(0, kKey) + record(9, kKey)), 0},
        {"unreadable", [](const QString& path) { makeUnreadable(path, record(7, kKey)); }, 0},
        {"a folder", [](const QString& path) { QDir().mkpath(path); }, 0},
        {"a FIFO", [](const QString& path) { ::mkfifo(QFile::encodeName(path), 0600); }, 0},
        {"a link to itself", [](const QString& path) { QFile::link(path, path); }, 0},
        {"256 MiB of other records (sparse), then the match",
         [](const QString& path) {
             constexpr qint64 others = qint64(56) * 4'793'490;
             QFile file(path);
             ASSERT_TRUE(file.open(QIODevice::WriteOnly) && file.resize(others));
             ASSERT_TRUE(file.seek(others) && file.write(record(7, kKey)) == 56);
         },
         7},
    };
    // The match as the last of 1, 1024, 1025, 2048 and 3000 records.
    for (const int before : {0, 1023, 1024, 2047, 2999}) {
        QByteArray whole;
        for (int i = 1; i <= before; ++i)
            whole += record(static_cast<qint16>(i), kKey ^ i);
        whole += record(7, kKey);
        const std::string name = std::to_string(before + 1) + " records";
        cases.push_back({name, holding(whole), 7});
        cases.push_back({name + " and a piece", holding(whole + QByteArray(55, '\0')), 7});
        cases.push_back({name + ", the last cut short", holding(whole.chopped(1)), 0});
    }
    for (const auto& [name, prepare, id] : cases) {
        SCOPED_TRACE(name);
        FakePlatform fake;
        const QString path = fake.programFolder() + QStringLiteral("/CRCID.dat");
        prepare(path);
        const QFileInfo before(path);
        EXPECT_EQ(findSoftwareID(path, kKey), id);
        const QFileInfo after(path);
        EXPECT_EQ(after.exists(), before.exists());
        EXPECT_EQ(after.size(), before.size());
    }
}

// The list the database is built from: entries, comments and blank lines; a bad line stops
// the parse, named by its number, with each complaint here given for the lines that earn it.
TEST(GameList, ReadsEntriesAndNamesABadLine) {
    const GameListParse parsed = parseGameList("\xEF\xBB\xBF# comment\r\n"
                                               "\r\n"
                                               "57, Pitfall!, 0x1A2B3C4D\r\n"
                                               "  12 ,Adventure, Part 2 , cbf43926\n"
                                               "   # indented comment\n"
                                               "32767, Caf\xC3\xA9, ff\n"
                                               "1,x,0");
    ASSERT_FALSE(parsed.error) << parsed.error->message.toStdString();
    EXPECT_EQ(encodeGameDatabase(parsed.records),
              encodeGameDatabase({{57, "Pitfall!", 0x1A2B3C4D},
                                  {12, "Adventure, Part 2", static_cast<qint32>(0xCBF43926u)},
                                  {32767, "Caf\u00e9", 0xFF},
                                  {1, "x", 0}}));
    const std::pair<const char*, std::vector<QByteArray>> cases[] = {
        {"expected", {"2 Missing commas 2", "2, no crc"}},
        {"software ID",
         {"x, Title, 1234", "0, Title, 1234", "-3, Title, 1234", "32768, Title, 1234",
          ", Title, 1234"}},
        {"CRC-32", {"2, Title, 123456789", "2, Title, 12G4", "2, Title, 0x", "2, Title,"}},
        {"title is empty", {"2, , 1234"}},
        {"51 characters", {"2, " + QByteArray(51, 'T') + ", 1234"}},
        {"Latin-1", {"2, \xE2\x82\xAC uro, 1234"}},
        {"UTF-8", {"2, Bad \xFF UTF-8, 1234"}},
        {"already listed on line 2", {"2, Same CRC, 0x00000001"}},
    };
    for (const auto& [complaint, lines] : cases) {
        for (const QByteArray& line : lines) {
            SCOPED_TRACE(line.toStdString());
            const GameListParse bad =
                parseGameList("# header\n1, Good, 00000001\n" + line + "\n4, Later, 4444\n");
            ASSERT_TRUE(bad.error);
            EXPECT_EQ(bad.error->line, 3);
            EXPECT_TRUE(bad.error->message.contains(QLatin1String(complaint)))
                << bad.error->message.toStdString();
        }
    }
}

#if defined(LUM_CRCID_TOOL) && defined(LUM_CRCID_DAT) && defined(LUM_CRCID_SOURCE_DIR)

// The tool writes the whole database or fails (a bad line, a full disk) and keeps the earlier
// one. From the program's list it builds the one beside the program, which identifies our test
// cartridges; one that is gone is reported by the engine and identifies nothing.
TEST(CrcIdTool, BuildsTheDatabaseThatIdentifiesTheTestCartridges) {
    FakePlatform fake;
    const QString games = QStringLiteral(LUM_CRCID_SOURCE_DIR "/CRCID.txt");
    const QString output = fake.root() + QStringLiteral("/CRCID.dat");
    QString errors;
    const auto run = [&](const QString& list) {
        QProcess tool;
        tool.start(QStringLiteral(LUM_CRCID_TOOL), {list, output});
        EXPECT_TRUE(tool.waitForFinished(30000));
        errors = QString::fromLocal8Bit(tool.readAllStandardError());
        return tool.exitCode();
    };
    const QString bad =
        fake.writeFile(QStringLiteral("bad.txt"), "# games\n1, One, 1\n2; Two; 2\n");
    EXPECT_NE(run(bad), 0);
    EXPECT_TRUE(errors.startsWith(bad + QStringLiteral(":3: error: "))) << errors.toStdString();
    EXPECT_FALSE(QFileInfo::exists(output));
    EXPECT_EQ(run(games), 0);
    const QByteArray database = fileBytes(output);
    EXPECT_EQ(database, fileBytes(QStringLiteral(LUM_CRCID_DAT)));
    {
        const DiskFull full(100);
        EXPECT_EQ(run(games), 1);
    }
    EXPECT_EQ(fileBytes(output), database);

    CCRC32 crc(fake.dialogs);
    const std::pair<const char*, qint16> roms[] = {
        {"rising-bars.a26", 32001}, {"falling-bars.a26", 32002}, {"flashing-screen.a26", 32003}};
    for (const auto& [name, id] : roms)
        EXPECT_EQ(LookupSoftwareID(crc, output, LUM_CRCID_SOURCE_DIR "/testroms/" + QString(name)),
                  id)
            << name;
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_EQ(LookupSoftwareID(crc, output, fake.root() + QStringLiteral("/gone.bin")), 0);
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].title, QStringLiteral("GetCRCFromFile"));
}

#endif

} // namespace
