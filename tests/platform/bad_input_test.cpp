#include "support/DiskFull.h"
#include "support/FakePlatform.h"
#include "support/Unreadable.h"

#include "platform/IniSettingsStore.h"
#include "platform/SettingsStore.h"

#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>

#include <cmath>
#include <csignal>
#include <functional>
#include <memory>
#include <optional>

#include <sys/resource.h>
#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

QByteArray contents(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<unreadable>");
}

QStringList folderEntries(const QString& folder) {
    return QDir(folder).entryList(QDir::AllEntries | QDir::System | QDir::Hidden |
                                  QDir::NoDotAndDotDot);
}

// What identifies a file on disk: a replacement (a new file renamed into place) or a
// rewrite changes it.
struct FileIdentity {
    ino_t inode = 0;
    off_t size = 0;
    timespec modified{};
    bool operator==(const FileIdentity& o) const {
        return inode == o.inode && size == o.size && modified.tv_sec == o.modified.tv_sec &&
               modified.tv_nsec == o.modified.tv_nsec;
    }
};

FileIdentity identity(const QString& path) {
    struct stat info {};
    if (::lstat(QFile::encodeName(path).constData(), &info) != 0)
        return {};
    return {info.st_ino, info.st_size, info.st_mtim};
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
    const Case cases[] = {
        {"missing", [](const FakePlatform&) {}, "default"},
        {"empty", [](const FakePlatform& f) { f.writeFile("config/lum/lum.ini"); }, "default"},
        {"truncated in a value",
         [](const FakePlatform& f) {
             f.writeFile("config/lum/lum.ini", "[Settings]\nROMPath=/ro");
         },
         "/ro"},
        {"truncated in a section name",
         [](const FakePlatform& f) { f.writeFile("config/lum/lum.ini", "[Settings]\n[Sett"); },
         "default"},
        {"garbage",
         [](const FakePlatform& f) {
             QByteArray noise(4096, '\0');
             QRandomGenerator random(7);
             for (char& c : noise)
                 c = static_cast<char>(random.bounded(256));
             f.writeFile("config/lum/lum.ini", noise + "\n[Settings]\nROMPath=/after\n");
         },
         "/after"},
        {"UTF-16 with a byte order mark",
         [](const FakePlatform& f) {
             const QString text = QStringLiteral("\uFEFF[Settings]\r\nROMPath=/w\r\n");
             f.writeFile("config/lum/lum.ini",
                         QByteArray(reinterpret_cast<const char*>(text.utf16()), text.size() * 2));
         },
         "default"},
        {"unreadable",
         [](const FakePlatform& f) {
             makeUnreadable(f.iniPath(), "[Settings]\nROMPath=/secret\n");
         },
         "default"},
        {"a folder", [](const FakePlatform& f) { QDir().mkpath(f.iniPath()); }, "default"},
        {"a FIFO", // would block a reader that opened it
         [](const FakePlatform& f) {
             QDir().mkpath(QFileInfo(f.iniPath()).absolutePath());
             ::mkfifo(QFile::encodeName(f.iniPath()).constData(), 0600);
         },
         "default"},
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
        {"   ", dS, dL, true, dC},
        {"garbage", dS, dL, true, dC},
        {"12abc", dS, dL, true, dC},
        {"nan", dS, dL, true, dC},
        {"inf", dS, dL, true, dC},
        {"-inf", dS, dL, true, dC},
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
    const QByteArray before = contents(fake.iniPath());
    const QString folder = QFileInfo(fake.iniPath()).absolutePath();
    const QStringList entriesBefore = folderEntries(folder);
    {
        const DiskFull full(before.size() + 16);
        EXPECT_FALSE(fake.store.SaveSetting("Settings", "BackImg", QString(4096, u'x')));
    }
    EXPECT_EQ(contents(fake.iniPath()), before);
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
    const QByteArray before = contents(fake.iniPath());
    ASSERT_TRUE(QFile::setPermissions(folder, QFile::ReadOwner | QFile::ExeOwner));
    {
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        EXPECT_FALSE(fake.store.SaveSetting("Settings", "Z26Path", "/emu"));
        EXPECT_FALSE(fake.store.DeleteSetting("Settings", "ROMPath"));
    }
    QFile::setPermissions(folder, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    EXPECT_EQ(contents(fake.iniPath()), before);
    EXPECT_EQ(folderEntries(folder), QStringList{"lum.ini"});
    EXPECT_EQ(fake.store.GetSetting("Settings", "Z26Path"), "/emu");
    EXPECT_EQ(fake.store.GetSetting("Settings", "ROMPath", "deleted"), "deleted");
}

TEST(BadInputSettingsWrite, AFolderInPlaceOfTheFileIsLeftAlone) {
    FakePlatform fake;
    QDir().mkpath(fake.iniPath());
    fake.writeFile("config/lum/lum.ini/keep.txt", "mine");
    IniSettingsStore store(fake.iniPath());
    EXPECT_FALSE(store.SaveSetting("Settings", "ROMPath", "/roms"));
    EXPECT_FALSE(store.DeleteSetting("Settings", "ROMPath"));
    EXPECT_TRUE(QFileInfo(fake.iniPath()).isDir());
    EXPECT_EQ(contents(fake.iniPath() + "/keep.txt"), "mine");
    EXPECT_EQ(folderEntries(QFileInfo(fake.iniPath()).absolutePath()), QStringList{"lum.ini"});
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
        {"a FIFO", [](const QString& path) { ::mkfifo(QFile::encodeName(path).constData(), 0600); },
         false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        QDir().mkpath(QFileInfo(fake.iniPath()).absolutePath());
        c.make(fake.iniPath());
        const FileIdentity before = identity(fake.iniPath());
        ASSERT_NE(before.inode, ino_t(0));
        std::unique_ptr<IniSettingsStore> store;
        {
            std::optional<NoPermissionOverride> asAnyone;
            if (c.withoutOverride)
                asAnyone.emplace();
            store = std::make_unique<IniSettingsStore>(fake.iniPath());
        }
        EXPECT_FALSE(store->SaveSetting("Settings", "Z26Path", "/emu"));
        EXPECT_EQ(store->GetSetting("Settings", "Z26Path"), "/emu");
        EXPECT_TRUE(identity(fake.iniPath()) == before);
        EXPECT_EQ(folderEntries(QFileInfo(fake.iniPath()).absolutePath()), QStringList{"lum.ini"});

        ASSERT_TRUE(QFile::remove(fake.iniPath()));
        EXPECT_TRUE(store->SaveSetting("Settings", "ROMPath", "/roms"));
        const auto reread = fake.reopenStore();
        EXPECT_EQ(reread->GetSetting("Settings", "Z26Path"), "/emu");
        EXPECT_EQ(reread->GetSetting("Settings", "ROMPath"), "/roms");
    }
}
