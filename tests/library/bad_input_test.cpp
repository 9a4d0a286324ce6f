#include "library/CCRC32.h"
#include "library/FileLister.h"
#include "library/GameDatabase.h"

#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QRandomGenerator>

#include <csignal>
#include <functional>

#include <sys/resource.h>
#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

GameRecord record(qint16 id, qint32 crc) {
    GameRecord r;
    r.SoftwareID = id;
    r.CRC = crc;
    r.Title = QStringLiteral("A game");
    return r;
}

constexpr qint32 kKey = 0x1A2B3C4D;

} // namespace

// CRCID.dat in every bad shape: a lookup never fails, never hangs, never creates or
// changes the file; whatever cannot be read identifies nothing (0).
TEST(BadInputGameDatabase, EveryShapeGivesAnAnswerAndTheFileIsLeftAsItWas) {
    struct Case {
        const char* name;
        std::function<void(const QString& path)> prepare;
        qint16 id;
    };
    const auto holding = [](const QByteArray& bytes) {
        return [bytes](const QString& p) { putFile(p, bytes); };
    };
    const QByteArray match = record(57, kKey).encode();
    QByteArray noise(56 * 500, '\0');
    QRandomGenerator random(11);
    for (char& c : noise)
        c = static_cast<char>(random.bounded(256));
    // The noise must not hold the key itself at a record's CRC place.
    for (qsizetype at = GameRecord::kCRCOffset; at < noise.size(); at += 56)
        noise[at] = 0;
    const Case cases[] = {
        {"missing", [](const QString&) {}, 0},
        {"empty", holding({}), 0},
        {"truncated in the matching record", holding(record(1, 5).encode() + match.left(55)), 0},
        {"truncated after the matching record",
         holding(record(1, 5).encode() + match + match.left(30)), 57},
        {"garbage before the match", holding(noise + match), 57},
        {"unreadable", [&](const QString& p) { makeUnreadable(p, match); }, 0},
        {"a folder", [](const QString& p) { QDir().mkpath(p); }, 0},
        {"a FIFO",
         [](const QString& p) { ASSERT_EQ(::mkfifo(QFile::encodeName(p).constData(), 0600), 0); },
         0},
        {"a link to itself", [](const QString& p) { QFile::link(p, p); }, 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        const QString path = fake.programFolder() + QStringLiteral("/CRCID.dat");
        c.prepare(path);
        const QFileInfo before(path);
        EXPECT_EQ(findSoftwareID(path, kKey), c.id);
        const QFileInfo after(path);
        EXPECT_EQ(after.exists(), before.exists());
        EXPECT_EQ(after.size(), before.size());
    }
}

TEST(BadInputGameDatabase, AnOversizedFileIsScannedToItsEnd) {
    FakePlatform fake;
    const QString path = fake.programFolder() + QStringLiteral("/CRCID.dat");
    // 256 MiB of zero records without disk use (a sparse file), then the match.
    constexpr qint64 zeros = qint64(56) * 4'793'490;
    {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        ASSERT_TRUE(file.resize(zeros));
        ASSERT_TRUE(file.seek(zeros));
        file.write(record(99, kKey).encode());
    }
    QElapsedTimer timer;
    timer.start();
    EXPECT_EQ(findSoftwareID(path, kKey), 99);
    EXPECT_LT(timer.elapsed(), 30000);
    EXPECT_EQ(findSoftwareID(path, 0), 0); // the zero records' ID is 0 as well
}

// A ROM folder in bad shapes lists what it can and never stops the program.
TEST(BadInputRomFolders, OnlyReadableRegularFilesAreListed) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    fake.writeFile("roms/good.bin", "x");
    fake.makeFolder("roms/sub.bin");
    ASSERT_EQ(::mkfifo(QFile::encodeName(folder + "/pipe.bin").constData(), 0600), 0);
    QFile::link(folder + "/nowhere", folder + "/dangling.bin");
    QFile::link(folder + "/loop.bin", folder + "/loop.bin");
    QFile::link(folder + "/good.bin", folder + "/link.bin");
    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(), QStringList({"good.bin", "link.bin"}));

    // A file, an empty folder, a missing one, no path at all.
    for (const QString& path : {fake.writeFile("file.bin", "x"), fake.makeFolder("empty"),
                                fake.root() + "/gone", QString()}) {
        lister.setPath(path);
        EXPECT_EQ(lister.ListCount(), 0) << path.toStdString();
    }
}

TEST(BadInputRomFolders, AnUnreadableFolderListsNothing) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("locked");
    fake.writeFile("locked/a.bin", "x");
    ASSERT_TRUE(QFile::setPermissions(folder, {}));
    FileLister lister;
    lister.setPattern("*.*");
    {
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        lister.setPath(folder);
    }
    EXPECT_EQ(lister.ListCount(), 0);
    // The same folder once it can be read again: the listing above was refused, not empty.
    QFile::setPermissions(folder, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    lister.setPath(folder);
    EXPECT_EQ(lister.ListCount(), 1);
}

// A folder far bigger than a collection: every file is listed, sorted, without a pause the
// user would take for a hang.
TEST(BadInputRomFolders, AnOversizedFolderIsListedWhole) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    constexpr int kFiles = 10000;
    for (int i = kFiles; i > 0; --i) {
        QFile file(folder + QStringLiteral("/Game %1.bin").arg(i, 5, 10, QLatin1Char('0')));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    }
    QElapsedTimer timer;
    timer.start();
    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_LT(timer.elapsed(), 10000); // a hang guard only
    ASSERT_EQ(lister.ListCount(), kFiles);
    EXPECT_EQ(lister.List(0), "Game 00001.bin");
    EXPECT_EQ(lister.List(kFiles - 1), "Game 10000.bin");
}

// Names holding the pattern's own wildcard characters are listed like any other.
TEST(BadInputRomFolders, NamesWithWildcardCharactersAreListed) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    for (const char* name : {"*game.bin", "x*.bin", "?.bin", "*", "a.bin"})
        fake.writeFile(QStringLiteral("roms/") + QLatin1String(name), "x");
    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(),
              QStringList({"*game.bin", "?.bin", "a.bin", "x*.bin"}));
    lister.setPattern("*");
    lister.setPath(folder);
    EXPECT_EQ(lister.ListCount(), 5);
    lister.setPattern("*g*");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(), QStringList{"*game.bin"});
}

// A name that is not valid UTF-8 (a file copied from an old Latin-1 disk) is still listed;
// the engine then cannot reopen it by that name and says so instead of guessing.
TEST(BadInputRomFolders, NamesThatAreNotUtf8AreListedAndReportedWhenOpened) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    const QByteArray raw = QFile::encodeName(folder) + "/Pitfall\xe9.bin";
    FILE* f = std::fopen(raw.constData(), "w");
    ASSERT_NE(f, nullptr);
    std::fputs("ROM", f);
    std::fclose(f);

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    ASSERT_EQ(lister.ListCount(), 1);
    EXPECT_TRUE(lister.List(0).startsWith("Pitfall"));

    CCRC32 crc(fake.dialogs);
    crc.setInputFileName(folder + u'/' + lister.List(0));
    EXPECT_EQ(crc.GetCRCFromFile(), 0);
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text, "Error: 53. File not found");
}

// An image far bigger than any cartridge (64 MiB, here sparse) is read to its end, with
// the progress reaching the whole.
TEST(BadInputRomFiles, AnOversizedImageIsReadToItsEnd) {
    FakePlatform fake;
    const QString path = fake.root() + "/huge.bin";
    {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        ASSERT_TRUE(file.resize(qint64(64) << 20));
    }
    CCRC32 crc(fake.dialogs);
    float last = -1;
    QObject::connect(&crc, &CCRC32::Progress, [&](float value) { last = value; });
    crc.setInputFileName(path);
    QElapsedTimer timer;
    timer.start();
    EXPECT_EQ(crc.GetCRCFromFile(), static_cast<qint32>(0xB2EB30EDu)); // CRC-32 of 64 MiB of 0
    EXPECT_LT(timer.elapsed(), 30000);                                 // a hang guard only
    EXPECT_EQ(last, 1.0f);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

#if defined(LUM_CRCID_TOOL)

// The database tool on a full disk: it fails and leaves the earlier database whole, rather
// than putting a cut-off one in place.
TEST(BadInputGameDatabase, TheToolKeepsTheOldDatabaseWhenTheDiskIsFull) {
    FakePlatform fake;
    QByteArray list;
    for (int i = 1; i <= 200; ++i)
        list += QByteArray::number(i) + ", Game " + QByteArray::number(i) + ", " +
                QByteArray::number(i, 16) + "\n";
    const QString listPath = fake.writeFile("list.txt", list);
    const QString output = fake.writeFile("CRCID.dat", record(7, 7).encode());
    QProcess tool;
    tool.setChildProcessModifier([] {
        // Files may not grow past 1000 bytes in the tool, as on a nearly full disk.
        std::signal(SIGXFSZ, SIG_IGN);
        rlimit limit{1000, RLIM_INFINITY};
        setrlimit(RLIMIT_FSIZE, &limit);
    });
    tool.start(QStringLiteral(LUM_CRCID_TOOL), {listPath, output});
    ASSERT_TRUE(tool.waitForFinished(30000));
    EXPECT_EQ(tool.exitCode(), 1);
    QFile database(output);
    ASSERT_TRUE(database.open(QIODevice::ReadOnly));
    EXPECT_EQ(database.readAll(), record(7, 7).encode());
}

#endif
