#include "support/DiskFull.h"
#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include "platform/IniSettingsStore.h"
#include "platform/ReportingSettingsStore.h"
#include "platform/SettingsStore.h"

#include <QDirIterator>
#include <QElapsedTimer>

#include <map>
#include <memory>
#include <optional>
#include <tuple>
#include <vector>

#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

using Identities = std::map<QString, std::tuple<ino_t, off_t, time_t, long>>;

// Everything under a folder with what identifies it on disk, so that an entry replaced,
// rewritten or left beside the others shows.
Identities tree(const QString& folder) {
    Identities entries;
    QDirIterator it(folder, QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        struct stat s {};
        ::lstat(QFile::encodeName(path).constData(), &s);
        entries[path] = {s.st_ino, s.st_size, s.st_mtim.tv_sec, s.st_mtim.tv_nsec};
    }
    return entries;
}

// lum.ini and its folder in every shape: the store reads what it can. Where it cannot write
// (a file it could not read is never written over), a change fails, stays in memory, leaves
// the disk exactly as it was and is told once per run of failures. Once the way is clear, the
// next change stores the whole session: names that differ only in case are one name, values
// keep blanks, separators and line breaks, numbers their single precision.
TEST(SettingsStore, EveryShapeOfTheFileReadsWhatItCanAndLosesNothing) {
    enum Twist { None, Unreadable, WriteOnly, Fifo, ReadOnlyFolder, FullDisk };
    const char* const ini = "config/lum/lum.ini";
    const QByteArray roms = "[Settings]\nROMPath=/roms\n";
    QByteArray keys = "[Settings]\n";
    for (int i = 0; keys.size() < 4 * 1024 * 1024; ++i)
        keys += "k" + QByteArray::number(i) + "=v\n";
    // Each shape: a file written with its bytes, a twist, what ROMPath reads, whether it writes.
    const std::tuple<const char*, const char*, QByteArray, Twist, const char*, bool> cases[] = {
        {"missing", nullptr, {}, None, "default", true},
        {"empty", ini, {}, None, "default", true},
        {"cut short in a value", ini, "[Settings]\nROMPath=/ro", None, "/ro", true},
        // A line without "=" is no key, a section cut short no section.
        {"garbage", ini,
         QByteArray("\xff\xfe=\n[\n=x\n\x80") + '\0' +
             "\xc3(=\n[Settings]\nROMPath=/after\n=\nROMPath\n[Sett",
         None, "/after", true},
        {"megabytes of keys, read in linear time", ini, keys + "ROMPath=/last", None, "/last",
         true},
        {"over 16 MiB", ini, roms + QByteArray(17 << 20, '#'), None, "default", false},
        {"unreadable", ini, roms, Unreadable, "default", false},
        {"writable but not readable", ini, roms, WriteOnly, "default", false},
        {"a folder", "config/lum/lum.ini/keep.txt", "mine", None, "default", false},
        {"a FIFO", nullptr, {}, Fifo, "default", false},
        {"a file where its folder belongs", "config/lum", "mine", None, "default", false},
        {"in a read-only folder", ini, roms, ReadOnlyFolder, "/roms", false},
        {"on a full disk", ini, roms, FullDisk, "/roms", false},
    };
    const QString odd = QStringLiteral("  C:\\roms = [x];#y\nsecond line\\n ");
    for (const auto& [name, file, bytes, twist, read, writes] : cases) {
        SCOPED_TRACE(name);
        FakePlatform fake;
        const QString config = fake.root() + QStringLiteral("/config");
        if (file)
            fake.writeFile(file, bytes);
        if (twist == Unreadable)
            makeUnreadable(fake.iniPath(), bytes);
        if (twist == WriteOnly)
            QFile::setPermissions(fake.iniPath(), QFile::WriteOwner);
        if (twist == Fifo)
            ::mkfifo(QFile::encodeName(fake.makeFolder("config/lum") + "/lum.ini"), 0600);
        if (twist == ReadOnlyFolder)
            QFile::setPermissions(config + "/lum", QFile::ReadOwner | QFile::ExeOwner);
        std::unique_ptr<IniSettingsStore> opened;
        std::optional<ReportingSettingsStore> store;
        {
            std::optional<DiskFull> full;
            if (twist == FullDisk)
                full.emplace(16);
            const NoPermissionOverride asAnyone;
            ASSERT_TRUE(asAnyone.holds());
            QElapsedTimer timer;
            timer.start();
            opened = std::make_unique<IniSettingsStore>(fake.iniPath());
            EXPECT_LT(timer.elapsed(), 10000);
            store.emplace(*opened, fake.dialogs, fake.iniPath());
            EXPECT_EQ(store->GetSetting("Settings", "ROMPath", "default"), read);
            const Identities before = tree(config);
            EXPECT_EQ(store->SaveSetting("Settings", "z26path", "/emu"), writes);
            EXPECT_EQ(store->SaveSetting("SETTINGS", "Z26Path", odd), writes);
            EXPECT_EQ(store->SaveSetting("Settings", "ROMPath", "/new"), writes);
            EXPECT_EQ(store->DeleteSetting("settings", "ROMPATH"), writes);
            if (!writes) {
                EXPECT_EQ(tree(config), before);
            }
        }
        if (!writes) {
            QFile::setPermissions(config + "/lum",
                                  QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
            ASSERT_TRUE(QDir(config).removeRecursively());
        }
        EXPECT_TRUE(store->SaveSetting("winpos", "height", singleText(6570.0 / 7)));
        const auto reread = fake.reopenStore();
        EXPECT_EQ(reread->GetSetting("settings", "z26PATH"), odd);
        EXPECT_EQ(fileBytes(fake.iniPath()).toLower().count("z26path"), 1);
        EXPECT_EQ(reread->GetSetting("Settings", "ROMPath", "gone"), "gone");
        EXPECT_EQ(readSingle(*reread, "winpos", "height", 0), static_cast<float>(6570.0 / 7));
        // After a write that worked, the next failure is told again.
        {
            const DiskFull full(16);
            EXPECT_FALSE(store->SaveSetting("winpos", "width", "4905"));
        }
        EXPECT_EQ(fake.dialogs.boxes.size(), writes ? 1u : 2u);
        for (const FakeDialogs::Box& box : fake.dialogs.boxes) {
            EXPECT_EQ(box.title, "lum");
            EXPECT_TRUE(box.text.contains(fake.iniPath()));
            EXPECT_EQ(box.icon, MsgIcon::Exclamation);
        }
    }
}

// Stored texts a hand-edited or damaged file may hold: what does not convert, or no longer
// fits, gives the reader's default. Window places are read as singles, colours as colours.
TEST(SettingsStore, ReadersFallBackToTheirDefaults) {
    constexpr double dS = 6570;
    constexpr qint64 dL = 42;
    constexpr quint32 dC = 0xFFFFFF;
    std::vector<std::tuple<const char*, double, qint64, bool, quint32>> cases = {
        {"99999999999999999999", 1e20, dL, true, dC},         // beyond 64 bits as a whole number
        {"4294967296", 4294967296.0, 4294967296LL, true, dC}, // beyond 32-bit colours
        {"-2147483649", -2147483648.0, -2147483649LL, true, dC},
        {"-3e9", -3e9, -3000000000LL, true, dC},
        {" 7 ", 7, 7, true, 7},
        {"-1", -1, -1, true, 0xFFFFFFFF},
        {"0", 0, 0, false, 0},
        {"False", dS, dL, false, dC},
        {"True", dS, dL, true, dC},
        {" 1234.5 ", 1234.5, 1234, true, 1234}, // a fraction rounds for the whole numbers
        {"-2147483633", -2147483633.0, -2147483633LL, true, 0x8000000F}, // a system colour
    };
    // No number, one cut short, one beyond double and one beyond single precision.
    for (const char* text :
         {"", "tall", "12abc", "nan", "inf", "0x10", "5 5", "1e", "-", "Tru", "1e400", "3.5e38"})
        cases.emplace_back(text, dS, dL, true, dC);
    FakePlatform fake;
    for (const auto& [text, single, number, flag, colour] : cases) {
        SCOPED_TRACE(text);
        ASSERT_TRUE(fake.store.SaveSetting("s", "k", QString::fromUtf8(text)));
        EXPECT_EQ(readSingle(fake.store, "s", "k", dS), static_cast<float>(single));
        EXPECT_EQ(readLong(fake.store, "s", "k", dL), number);
        EXPECT_EQ(readBool(fake.store, "s", "k", true), flag);
        EXPECT_EQ(readColour(fake.store, "s", "k", dC), colour);
    }
    // The writers' forms: the shortest text that reads back as the same single, and the flags.
    EXPECT_EQ(singleText(500), "500");
    EXPECT_EQ(boolText(true), "True");
    EXPECT_EQ(boolText(false), "False");
}

} // namespace
