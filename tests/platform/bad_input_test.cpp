#include "support/DiskFull.h"
#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include "platform/IniSettingsStore.h"
#include "platform/SettingsStore.h"

#include <QElapsedTimer>
#include <QFileInfo>
#include <QRandomGenerator>

#include <functional>
#include <memory>
#include <optional>
#include <tuple>

#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

// What identifies a file on disk: a replacement (a new file renamed into place) or a
// rewrite changes it.
std::tuple<ino_t, off_t, time_t, long> identity(const QString& path) {
    struct stat info {};
    ::lstat(QFile::encodeName(path).constData(), &info);
    return {info.st_ino, info.st_size, info.st_mtim.tv_sec, info.st_mtim.tv_nsec};
}

void makeFifo(const QString& path) {
    QDir().mkpath(QFileInfo(path).absolutePath());
    ::mkfifo(QFile::encodeName(path).constData(), 0600);
}

} // namespace

// lum.ini in every bad shape: the store never fails to start, reads what can be read and
// falls back to the defaults for the rest.
TEST(BadInputSettingsFile, EveryShapeOpensAndReadsWhatItCan) {
    struct Case {
        const char* name;
        std::function<void(const FakePlatform&)> prepare;
        const char* romPath; // what Settings/ROMPath reads afterwards
    };
    const auto ini = [](const QByteArray& bytes) {
        return [bytes](const FakePlatform& f) { f.writeFile("config/lum/lum.ini", bytes); };
    };
    QByteArray noise(4096, '\0');
    QRandomGenerator random(7);
    for (char& c : noise)
        c = static_cast<char>(random.bounded(256));
    const QString utf16 = QStringLiteral("\uFEFF[Settings]\r\nROMPath=/w\r\n");
    const Case cases[] = {
        {"missing", [](const FakePlatform&) {}, "default"},
        {"empty", ini({}), "default"},
        {"truncated in a value", ini("[Settings]\nROMPath=/ro"), "/ro"},
        {"truncated in a section name", ini("[Settings]\n[Sett"), "default"},
        {"garbage", ini(noise + "\n[Settings]\nROMPath=/after\n"), "/after"},
        {"UTF-16 with a byte order mark",
         ini(QByteArray(reinterpret_cast<const char*>(utf16.utf16()), utf16.size() * 2)),
         "default"},
        {"unreadable",
         [](const FakePlatform& f) { makeUnreadable(f.iniPath(), "[Settings]\nROMPath=/s\n"); },
         "default"},
        {"a folder", [](const FakePlatform& f) { QDir().mkpath(f.iniPath()); }, "default"},
        // A FIFO would block a reader that opened it.
        {"a FIFO", [](const FakePlatform& f) { makeFifo(f.iniPath()); }, "default"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        c.prepare(fake);
        const auto store = fake.reopenStore();
        EXPECT_EQ(store->GetSetting("Settings", "ROMPath", "default"), c.romPath);
        EXPECT_EQ(readSingle(*store, "winpos", "height", 6570), 6570);
    }
}

TEST(BadInputSettingsFile, OversizedFilesAreNotReadAndBigOnesReadQuickly) {
    FakePlatform fake;
    // Bigger than any store lum writes: ignored rather than read into memory.
    fake.writeFile("config/lum/lum.ini",
                   "[Settings]\nROMPath=/big\n" + QByteArray(17 * 1024 * 1024, '#'));
    EXPECT_EQ(fake.reopenStore()->GetSetting("Settings", "ROMPath", "default"), "default");

    // Megabytes of distinct keys: still read, and without a pause the user would notice at
    // start-up (reading must not slow down with every key already read).
    QByteArray many = "[Settings]\n";
    for (int i = 0; many.size() < 4 * 1024 * 1024; ++i)
        many += "k" + QByteArray::number(i) + "=v\n";
    many += "ROMPath=/last\n";
    fake.writeFile("config/lum/lum.ini", many);
    QElapsedTimer timer;
    timer.start();
    const auto store = fake.reopenStore();
    EXPECT_EQ(store->GetSetting("Settings", "ROMPath"), "/last");
    EXPECT_LT(timer.elapsed(), 10000);
}

// The typed readers against values a hand-edited or damaged file may hold: a value that
// does not convert, or that no longer fits its meaning, gives the reader's default.
TEST(BadInputSettingsValues, ReadersFallBackToTheirDefaults) {
    struct Case {
        const char* text;
        double single;
        qint64 number;
        bool flag;
        quint32 colour;
    };
    constexpr double dS = 6570;
    constexpr qint64 dL = 42;
    constexpr quint32 dC = 0xFFFFFF;
    const Case cases[] = {
        {"", dS, dL, true, dC},
        {"garbage", dS, dL, true, dC},
        {"12abc", dS, dL, true, dC},
        {"nan", dS, dL, true, dC},
        {"inf", dS, dL, true, dC},
        {"1e400", dS, dL, true, dC},
        {"3.5e38", dS, dL, true, dC},                         // beyond single precision
        {"99999999999999999999", 1e20, dL, true, dC},         // beyond 64 bits as a whole number
        {"4294967296", 4294967296.0, 4294967296LL, true, dC}, // beyond 32-bit colours
        {"-2147483649", -2147483648.0, -2147483649LL, true, dC},
        {"0x10", dS, dL, true, dC},
        {"1e", dS, dL, true, dC}, // cut short
        {"-", dS, dL, true, dC},
        {"Tru", dS, dL, true, dC},
        {"5 5", dS, dL, true, dC},
        {" 7 ", 7, 7, true, 7},
        {"-1", -1, -1, true, 0xFFFFFFFF},
        {"0", 0, 0, false, 0},
        {"False", dS, dL, false, dC},
        {"True", dS, dL, true, dC},
        {" 1234.5 ", 1234.5, 1234, true, 1234}, // a fraction rounds for the whole numbers
        {"-2147483633", -2147483633.0, -2147483633LL, true, 0x8000000F}, // a system colour
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        FakePlatform fake;
        const QString text = QString::fromUtf8(c.text);
        ASSERT_TRUE(fake.store.SaveSetting("s", "k", text));
        const auto store = fake.reopenStore();
        EXPECT_EQ(readSingle(*store, "s", "k", dS), static_cast<float>(c.single));
        EXPECT_EQ(readLong(*store, "s", "k", dL), c.number);
        EXPECT_EQ(readBool(*store, "s", "k", true), c.flag);
        EXPECT_EQ(readColour(*store, "s", "k", dC), c.colour);
    }
}

// Nothing lost: a write that fails leaves the file on disk exactly as it was, leaves no
// temporary file behind, says so to its caller and keeps the value for this session.
TEST(BadInputSettingsWrite, AFailedWriteKeepsTheOldFileWhole) {
    FakePlatform fake;
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "ROMPath", "/roms"));
    const QByteArray before = fileBytes(fake.iniPath());
    const QString folder = QFileInfo(fake.iniPath()).absolutePath();
    const QStringList entriesBefore = folderEntries(folder);
    {
        const DiskFull full(before.size() + 16);
        EXPECT_FALSE(fake.store.SaveSetting("Settings", "BackImg", QString(4096, u'x')));
    }
    EXPECT_EQ(fileBytes(fake.iniPath()), before);
    EXPECT_EQ(folderEntries(folder), entriesBefore);
    EXPECT_EQ(fake.store.GetSetting("Settings", "BackImg").size(), 4096);
    // The next write that can succeed stores everything the session holds.
    EXPECT_TRUE(fake.store.SaveSetting("Settings", "ROMChecked", "True"));
    EXPECT_EQ(fake.reopenStore()->GetSetting("Settings", "BackImg").size(), 4096);
}

// A settings folder without write permission: every write fails, nothing appears in it, and
// the values stay in memory.
TEST(BadInputSettingsWrite, AReadOnlyFolderTakesNoWrite) {
    FakePlatform fake;
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "ROMPath", "/roms"));
    const QString folder = QFileInfo(fake.iniPath()).absolutePath();
    const QByteArray before = fileBytes(fake.iniPath());
    ASSERT_TRUE(QFile::setPermissions(folder, QFile::ReadOwner | QFile::ExeOwner));
    {
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        EXPECT_FALSE(fake.store.SaveSetting("Settings", "Z26Path", "/emu"));
        EXPECT_FALSE(fake.store.DeleteSetting("Settings", "ROMPath"));
    }
    QFile::setPermissions(folder, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    EXPECT_EQ(fileBytes(fake.iniPath()), before);
    EXPECT_EQ(folderEntries(folder), QStringList{"lum.ini"});
    EXPECT_EQ(fake.store.GetSetting("Settings", "Z26Path"), "/emu");
    EXPECT_EQ(fake.store.GetSetting("Settings", "ROMPath", "deleted"), "deleted");
}

// A folder where lum.ini belongs, or a file where its folder belongs: writes fail, what
// stands there is left alone, and the values stay in memory.
TEST(BadInputSettingsWrite, SomethingElseInPlaceOfTheFileOrItsFolderIsLeftAlone) {
    for (const bool folderAtFile : {true, false}) {
        SCOPED_TRACE(folderAtFile);
        FakePlatform fake;
        const QString kept = fake.writeFile(folderAtFile ? "cfg/lum.ini/keep.txt" : "cfg", "mine");
        IniSettingsStore store(fake.root() + "/cfg/lum.ini");
        EXPECT_FALSE(store.SaveSetting("Settings", "ROMPath", "/roms"));
        EXPECT_EQ(store.GetSetting("Settings", "ROMPath"), "/roms");
        EXPECT_FALSE(store.DeleteSetting("Settings", "ROMPath"));
        EXPECT_EQ(fileBytes(kept), "mine");
        if (folderAtFile) {
            EXPECT_EQ(folderEntries(fake.root() + "/cfg"), QStringList{"lum.ini"});
        }
    }
}

// A file that is there but could not be read is never replaced by a write: that would put
// this session's few values in place of every setting it holds. The writes fail, the values
// stay in memory, and once the file is gone they are written.
TEST(BadInputSettingsWrite, AFileThatCouldNotBeReadIsNotWrittenOver) {
    const struct {
        const char* name;
        std::function<void(const QString& path)> make;
        bool withoutOverride; // opened as a user without root's override of permissions
    } cases[] = {
        {"oversized",
         [](const QString& path) {
             QFile file(path);
             file.open(QIODevice::WriteOnly);
             file.write("[Settings]\nROMPath=/mine\n" + QByteArray(17 * 1024 * 1024, '#'));
         },
         false},
        {"unreadable", [](const QString& path) { makeUnreadable(path, "[Settings]\n"); }, false},
        {"writable but not readable",
         [](const QString& path) {
             QFile file(path);
             file.open(QIODevice::WriteOnly);
             file.write("[Settings]\nROMPath=/mine\n");
             file.close();
             QFile::setPermissions(path, QFile::WriteOwner);
         },
         true},
        {"a FIFO", makeFifo, false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        QDir().mkpath(QFileInfo(fake.iniPath()).absolutePath());
        c.make(fake.iniPath());
        const auto before = identity(fake.iniPath());
        ASSERT_NE(std::get<0>(before), ino_t(0));
        std::unique_ptr<IniSettingsStore> store;
        {
            std::optional<NoPermissionOverride> asAnyone;
            if (c.withoutOverride)
                asAnyone.emplace();
            store = std::make_unique<IniSettingsStore>(fake.iniPath());
        }
        EXPECT_FALSE(store->SaveSetting("Settings", "Z26Path", "/emu"));
        EXPECT_EQ(store->GetSetting("Settings", "Z26Path"), "/emu");
        EXPECT_EQ(identity(fake.iniPath()), before);
        EXPECT_EQ(folderEntries(QFileInfo(fake.iniPath()).absolutePath()), QStringList{"lum.ini"});

        ASSERT_TRUE(QFile::remove(fake.iniPath()));
        EXPECT_TRUE(store->SaveSetting("Settings", "ROMPath", "/roms"));
        const auto reread = fake.reopenStore();
        EXPECT_EQ(reread->GetSetting("Settings", "Z26Path"), "/emu");
        EXPECT_EQ(reread->GetSetting("Settings", "ROMPath"), "/roms");
    }
}
