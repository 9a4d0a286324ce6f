#include "library/CCRC32.h"
#include "library/GameDatabase.h"

#include "support/FakePlatform.h"
#include "support/Files.h"

#include <QFileInfo>
#include <QProcess>

#include <gtest/gtest.h>

namespace {

GameRecord record(qint16 id, qint32 crc, const QString& title = QStringLiteral("A game")) {
    GameRecord r;
    r.SoftwareID = id;
    r.CRC = crc;
    r.Title = title;
    return r;
}

TEST(GameRecord, EncodesTheFixedLittleEndianLayout) {
    const QByteArray bytes = record(0x0102, static_cast<qint32>(0xCBF43926u), "Pac").encode();
    ASSERT_EQ(bytes.size(), 56);
    EXPECT_EQ(bytes.left(2), QByteArray("\x02\x01", 2));
    EXPECT_EQ(bytes.mid(2, 50), QByteArray("Pac").leftJustified(50, ' '));
    EXPECT_EQ(bytes.mid(52), QByteArray("\x26\x39\xF4\xCB", 4));
}

TEST(GameRecord, DecodesWhatItEncodesAndNeedsAWholeRecord) {
    const std::vector<GameRecord> cases = {
        record(0, 0),
        record(1, -1, QString(50, u'x')),
        record(32767, static_cast<qint32>(0x80000000u), QStringLiteral("Caf\u00e9, Deluxe")),
        record(-32768, 0x7FFFFFFF),
    };
    for (const GameRecord& original : cases) {
        QByteArray bytes = original.encode() + QByteArray("trailing");
        const auto decoded = GameRecord::decode(bytes);
        ASSERT_TRUE(decoded);
        EXPECT_EQ(decoded->SoftwareID, original.SoftwareID);
        EXPECT_EQ(decoded->CRC, original.CRC);
        EXPECT_EQ(decoded->Title, original.Title.leftJustified(50, u' '));
        EXPECT_FALSE(GameRecord::decode(QByteArrayView(bytes).first(55)));
    }
    EXPECT_FALSE(GameRecord::decode(QByteArrayView()));
}

class GameDatabaseTest : public ::testing::Test {
protected:
    QString database(const QByteArray& bytes) {
        return m_fake.writeFile(QStringLiteral("program/CRCID.dat"), bytes);
    }
    QString databasePath() const { return m_fake.programFolder() + QStringLiteral("/CRCID.dat"); }
    // A ROM image and its CRC as the engine computes it.
    QString rom(const QByteArray& content, qint32* crc) {
        const QString path = m_fake.writeFile(QStringLiteral("roms/game.bin"), content);
        m_crc.setInputFileName(path);
        *crc = m_crc.GetCRCFromFile();
        return path;
    }
    qint16 lookup(const QString& romPath) {
        return LookupSoftwareID(m_crc, databasePath(), romPath);
    }

    FakePlatform m_fake;
    CCRC32 m_crc{m_fake.dialogs};
};

TEST_F(GameDatabaseTest, ScansEveryWholeRecordAndIgnoresATrailingPiece) {
    qint32 key = 0;
    const QString romPath = rom("a small ROM image", &key);
    // Enough records to cross the scan's read size, with the match placed at the edges.
    for (const int count : {1, 2, 1023, 1024, 1025, 2048, 3000}) {
        SCOPED_TRACE(count);
        std::vector<GameRecord> records;
        for (int i = 0; i < count; ++i)
            records.push_back(record(static_cast<qint16>(i + 1), key ^ (i + 1)));
        records.back().CRC = key;
        const QByteArray whole = encodeGameDatabase(records);
        ASSERT_EQ(whole.size(), count * 56);

        database(whole);
        EXPECT_EQ(lookup(romPath), count);
        // Whatever trails the last whole record is not a record.
        database(whole + QByteArray(17, '\0'));
        EXPECT_EQ(lookup(romPath), count);
        // A last record cut short matches nothing, even with its CRC almost whole.
        database(whole.chopped(1));
        EXPECT_EQ(lookup(romPath), 0);
    }
    EXPECT_TRUE(m_fake.dialogs.boxes.empty());
}

// "123456789" has the CRC 0xCBF43926, negative as a signed number: it matches as that
// number, not as its lower 31 bits.
TEST_F(GameDatabaseTest, TheFirstMatchWinsEvenWhenItsIdIsZero) {
    qint32 key = 0;
    const QString romPath = rom("123456789", &key);
    ASSERT_EQ(key, static_cast<qint32>(0xCBF43926u));
    database(encodeGameDatabase({record(5, 0x4BF43926), record(7, key), record(9, key)}));
    EXPECT_EQ(lookup(romPath), 7);
    database(encodeGameDatabase({record(0, key), record(9, key)}));
    EXPECT_EQ(lookup(romPath), 0);
}

TEST_F(GameDatabaseTest, AMissingRomIsReportedByTheEngineAndIdentifiesNothing) {
    // The engine reports the missing image and gives 0, which no record here carries.
    database(encodeGameDatabase({record(3, 12345)}));
    EXPECT_EQ(lookup(m_fake.root() + QStringLiteral("/roms/gone.bin")), 0);
    ASSERT_EQ(m_fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(m_fake.dialogs.boxes[0].title, QStringLiteral("GetCRCFromFile"));
}

TEST(GameList, ReadsEntriesCommentsAndBlankLines) {
    const QByteArray text = "\xEF\xBB\xBF# comment\r\n"
                            "\r\n"
                            "57, Pitfall!, 0x1A2B3C4D\r\n"
                            "  12 ,Adventure, Part 2 , cbf43926\n"
                            "   # indented comment\n"
                            "32767, Caf\xC3\xA9, ff\n"
                            "1,x,0";
    const GameListParse parsed = parseGameList(text);
    ASSERT_FALSE(parsed.error) << parsed.error->message.toStdString();
    ASSERT_EQ(parsed.records.size(), 4u);
    EXPECT_EQ(parsed.records[0].SoftwareID, 57);
    EXPECT_EQ(parsed.records[0].CRC, 0x1A2B3C4D);
    EXPECT_EQ(parsed.records[0].Title, QStringLiteral("Pitfall!").leftJustified(50));
    EXPECT_EQ(parsed.records[1].SoftwareID, 12);
    EXPECT_EQ(parsed.records[1].Title.trimmed(), QStringLiteral("Adventure, Part 2"));
    EXPECT_EQ(parsed.records[1].CRC, static_cast<qint32>(0xCBF43926u));
    EXPECT_EQ(parsed.records[2].Title.trimmed(), QStringLiteral("Caf\u00e9"));
    EXPECT_EQ(parsed.records[2].CRC, 0xFF);
    EXPECT_EQ(parsed.records[3].CRC, 0);
    EXPECT_EQ(encodeGameDatabase(parsed.records).mid(2 * 56 + 2, 5), QByteArray("Caf\xE9 "));
}

TEST(GameList, ABadLineIsNamedByNumber) {
    struct Case {
        QByteArray line;
        const char* complaint;
    };
    const QByteArray good = "# header\n1, Good, 00000001\n";
    const std::vector<Case> cases = {
        {"2 Missing commas 2", "expected"},
        {"2, no crc", "expected"},
        {"x, Title, 1234", "software ID"},
        {"0, Title, 1234", "software ID"},
        {"-3, Title, 1234", "software ID"},
        {"32768, Title, 1234", "software ID"},
        {", Title, 1234", "software ID"},
        {"2, Title, 123456789", "CRC-32"},
        {"2, Title, 12G4", "CRC-32"},
        {"2, Title, 0x", "CRC-32"},
        {"2, Title,", "CRC-32"},
        {"2, , 1234", "title is empty"},
        {"2, " + QByteArray(51, 'T') + ", 1234", "51 characters"},
        {"2, \xE2\x82\xAC uro, 1234", "Latin-1"},
        {"2, Bad \xFF UTF-8, 1234", "UTF-8"},
        {"2, Same CRC, 0x00000001", "already listed on line 2"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.line.toStdString());
        const GameListParse parsed = parseGameList(good + c.line + "\n4, Later, 4444\n");
        ASSERT_TRUE(parsed.error);
        EXPECT_EQ(parsed.error->line, 3);
        EXPECT_TRUE(parsed.error->message.contains(QLatin1String(c.complaint)))
            << parsed.error->message.toStdString();
    }
}

#if defined(LUM_CRCID_TOOL) && defined(LUM_CRCID_DAT) && defined(LUM_CRCID_SOURCE_DIR)

TEST(CrcIdTool, RejectsABadLineAndWritesNothing) {
    FakePlatform fake;
    const QString list =
        fake.writeFile(QStringLiteral("bad.txt"), "# games\n1, One, 1\n2; Two; 2\n");
    const QString output = fake.root() + QStringLiteral("/CRCID.dat");
    QProcess tool;
    tool.start(QStringLiteral(LUM_CRCID_TOOL), {list, output});
    ASSERT_TRUE(tool.waitForFinished(30000));
    EXPECT_NE(tool.exitCode(), 0);
    const QString errors = QString::fromLocal8Bit(tool.readAllStandardError());
    EXPECT_TRUE(errors.startsWith(list + QStringLiteral(":3: error: "))) << errors.toStdString();
    EXPECT_FALSE(QFileInfo::exists(output));

    fake.writeFile(QStringLiteral("bad.txt"), "# games\n1, One, 1\n2, Two, 2\n");
    tool.start(QStringLiteral(LUM_CRCID_TOOL), {list, output});
    ASSERT_TRUE(tool.waitForFinished(30000));
    EXPECT_EQ(tool.exitCode(), 0);
    EXPECT_EQ(fileBytes(output), encodeGameDatabase({record(1, 1, "One"), record(2, 2, "Two")}));
}

// The database built beside the program is the list's, and identifies our test cartridges.
TEST(CrcIdTool, TheBuiltDatabaseIdentifiesTheTestCartridges) {
    const QString source = QStringLiteral(LUM_CRCID_SOURCE_DIR);
    const QString built = QStringLiteral(LUM_CRCID_DAT);
    const GameListParse parsed = parseGameList(fileBytes(source + QStringLiteral("/CRCID.txt")));
    ASSERT_FALSE(parsed.error);
    EXPECT_EQ(fileBytes(built), encodeGameDatabase(parsed.records));

    FakePlatform fake;
    CCRC32 crc(fake.dialogs);
    const std::vector<std::pair<QString, qint16>> roms = {
        {QStringLiteral("rising-bars.a26"), 32001},
        {QStringLiteral("falling-bars.a26"), 32002},
        {QStringLiteral("flashing-screen.a26"), 32003},
    };
    for (const auto& [name, id] : roms) {
        SCOPED_TRACE(name.toStdString());
        EXPECT_EQ(LookupSoftwareID(crc, built, source + QStringLiteral("/testroms/") + name), id);
    }
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

#endif

} // namespace
