#include "support/FakePlatform.h"
#include "support/Files.h"

#include "platform/ReportingSettingsStore.h"
#include "platform/StoredSettings.h"

#include <QProcess>

#include <sys/stat.h>

#include <gtest/gtest.h>

namespace {

// Everything under a folder as it is on disk: an entry replaced, rewritten or added shows.
QByteArray tree(const QString& folder) {
    QProcess find;
    find.start("find", {folder, "-mindepth", "1", "-printf", "%p %y %i %s %T@\n"});
    EXPECT_TRUE(find.waitForFinished()) << "find did not run";
    return find.readAllStandardOutput();
}

// lum.ini in every shape, read as far as it can be. Where the store cannot write (nor over a file
// it could not read) a change fails, leaves the disk alone and is told once per run of failures;
// the next change that can be written stores the whole session.
TEST(SettingsStore, EveryShapeOfTheFileReadsWhatItCanAndLosesNothing) {
    enum Twist { None, Unreadable, Fifo, ReadOnlyFolder, FullDisk };
    const char* const ini = "config/lum/lum.ini";
    const QByteArray roms = "[Settings]\nROMPath=/roms\n";
    // A line without "=" is no key, a section cut short no section.
    const QByteArray garbage(
        "\xff=\n[\n=x\n\x80\0\xc3(=\n[Settings]\nROMPath=/after\nROMPath\n[Sett", 53);
    // Each shape: a file and its bytes, a twist, what ROMPath reads, whether a change is written
    // and what the box blames.
    const char* const disk = "disk is not full";
    const std::tuple<const char*, const char*, QByteArray, Twist, const char*, bool, const char*>
        cases[] = {
            {"missing", nullptr, {}, None, "default", true, disk},
            {"empty", ini, {}, None, "default", true, disk},
            {"cut short in a value", ini, "[Settings]\nROMPath=/ro", None, "/ro", true, disk},
            {"garbage", ini, garbage, None, "/after", true, disk},
            {"over 16 MiB", ini, roms + QByteArray(17 << 20, '#'), None, "default", false,
             "larger than 16 MiB"},
            {"unreadable", ini, roms, Unreadable, "default", false, "could not be read ("},
            {"a folder", "config/lum/lum.ini/keep.txt", "mine", None, "default", false,
             "not a regular file"},
            {"a FIFO", nullptr, {}, Fifo, "default", false, "not a regular file"},
            {"a file where its folder belongs", "config/lum", "mine", None, "default", false, disk},
            {"in a read-only folder", ini, roms, ReadOnlyFolder, "/roms", false, disk},
            {"on a full disk", ini, roms, FullDisk, "/roms", false, disk},
        };
    const QString odd = QStringLiteral("  C:\\roms = [x];#y\nsecond line\\n ");
    for (const auto& [name, file, bytes, twist, read, writes, blamed] : cases) {
        SCOPED_TRACE(name);
        FakePlatform fake;
        const QString config = fake.root() + "/config";
        if (file)
            fake.writeFile(file, bytes);
        if (twist == Unreadable)
            makeUnreadable(fake.iniPath(), bytes);
        if (twist == Fifo)
            ::mkfifo(QFile::encodeName(fake.makeFolder("config/lum") + "/lum.ini"), 0600);
        ::chmod(QFile::encodeName(config + "/lum"), twist == ReadOnlyFolder ? 0500 : 0700);
        std::optional<DiskFull> full(std::in_place, twist == FullDisk ? 16 : 1 << 30);
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        IniSettingsStore opened(fake.iniPath());
        ReportingSettingsStore store(opened, fake.dialogs, fake.iniPath());
        EXPECT_EQ(store.GetSetting("Settings", "ROMPath", "default"), read);
        const auto before = tree(config);
        const std::vector<bool> done = {store.SaveSetting("Settings", "z26path", "/emu"),
                                        store.SaveSetting("SETTINGS", "Z26Path", odd),
                                        store.SaveSetting("Settings", "ROMPath", "/new"),
                                        store.DeleteSetting("settings", "ROMPATH")};
        EXPECT_EQ(done, std::vector<bool>(4, writes));
        EXPECT_TRUE(writes || tree(config) == before);
        EXPECT_TRUE(writes || fake.dialogs.boxes.at(0).text.contains(blamed))
            << fake.dialogs.boxes.at(0).text.toStdString();
        full.reset();
        ::chmod(QFile::encodeName(config + "/lum"), 0700);
        ASSERT_TRUE(writes || QDir(config).removeRecursively());
        EXPECT_TRUE(store.SaveSetting("winpos", "top", "1"));
        const auto reread = fake.reopenStore();
        EXPECT_EQ(reread->GetSetting("settings", "z26PATH") +
                      reread->GetSetting("Settings", "ROMPath", "|gone") +
                      QString::number(fileBytes(fake.iniPath()).toLower().count("z26path")),
                  odd + "|gone1"); // one entry for names alike but for case
        full.emplace(16);          // after a write that worked, the next failure is told again
        EXPECT_FALSE(store.SaveSetting("winpos", "width", "4905"));
        EXPECT_EQ(fake.dialogs.boxes.size(), writes ? 1u : 2u);
        for (const FakeDialogs::Box& box : fake.dialogs.boxes)
            EXPECT_TRUE(box.text.contains(fake.iniPath()) && box.icon == MsgIcon::Exclamation);
    }
}

// The enabled ROM folders, then lum.ini, once every setting is read from it and written back.
QByteArray resaved(const QByteArray& ini) {
    FakePlatform fake;
    fake.writeFile("config/lum/lum.ini", ini);
    const auto store = fake.reopenStore();
    const auto resave = [&](const auto&... s) { (write(*store, s, read(*store, s)), ...); };
    resave(stored::z26Path, stored::romFilter, stored::backColor, stored::textColor,
           stored::backImg, stored::backImgEnabled, stored::mainWindowMaximized, stored::mainWindow,
           stored::settingsWindow, stored::pictureWindow);
    writeRomFolders(*store, readRomFolders(*store));
    return enabledRomFolders(*store).join(' ').toUtf8() + '\n' + fileBytes(fake.iniPath());
}

// Each setting's section, key, default and written form; a text that does not convert or fit
// reads as the default. ROM folders (ROMPath, ROMChecked, ROM2Path, ...; no flag: off) end at
// the first empty or missing path; a save writes one empty path after its last.
TEST(StoredSettings, EachKeyHasItsSectionNameAndDefault) {
    const QByteArray defaults =
        "[Settings]\nZ26Path=\nROMFilter=*.bin\nBackColor=16777215\nTextColor=0\nBackImg=\n"
        "BackImgEnabled=True\nROMPath=\n\n[winpos]\nmax=False\ntop=500\nleft=500\nheight=6570\n"
        "width=4905\n\n[setpos]\ntop=250\nleft=250\n\n[picpos]\ntop=300\nleft=300\nheight=5655\n"
        "width=11115\n";
    EXPECT_EQ(resaved({}), "\n" + defaults);
    const QByteArray damaged =
        "[Settings]\nZ26Path=\nROMFilter=*.bin\nBackColor=2147483663\nTextColor=1234.5\nBackImg=\n"
        "BackImgEnabled=Tru\nROMPath=\n\n[winpos]\nmax=tall\ntop=nan\nleft=1e400\nheight=3.5e38\n"
        "width=12abc\n\n[setpos]\ntop=inf\nleft= 7 \n\n[picpos]\ntop=\nleft=-\nheight=1e\n"
        "width=5 5\n";
    EXPECT_EQ(resaved(damaged), "\n" + QByteArray(defaults)
                                           .replace("TextColor=0", "TextColor=1234")
                                           .replace("left=250", "left=7"));
    const QByteArray mine =
        "[Settings]\nz26Path=/emu\nROMFilter=*.a26\nBackColor=1193046\nTextColor=255\n"
        "BackImg=/b.png\nBackImgEnabled=False\nROMPath=/a\nROMChecked=True\nROM2Path=/b\n"
        "ROM3Checked=True\nROM4Path=/d\nROM4Checked=True\n\n[winpos]\nmax=True\ntop=1234.5625\n"
        "left=2\nheight=4\nwidth=3\n\n[setpos]\ntop=5\nleft=6\n\n[picpos]\ntop=7\nleft=8\n"
        "height=10\nwidth=9\n";
    EXPECT_EQ(resaved(mine), "/a\n" + QByteArray(mine).replace(
                                          "ROM4Checked=True\n",
                                          "ROM4Checked=True\nROM2Checked=False\nROM3Path=\n"));
}

// Newest first, each ROM once, ten at most, as the next start reads them; a shorter list
// leaves nothing of a longer one.
TEST(StoredSettings, RecentRomsKeepTheLastTenStartedNewestFirst) {
    FakePlatform fake;
    const std::pair<const char*, const char*> rows[] = {{"a", "a"},
                                                        {"b", "b a"},
                                                        {"a", "a b"},
                                                        {"cdefghijkl", "l k j i h g f e d c"},
                                                        {"c", "c l k j i h g f e d"}};
    for (const auto& [started, expected] : rows) {
        for (const char rom : QByteArray(started))
            writeRecentRoms(fake.store, withRecentRom(readRecentRoms(fake.store), QString(rom)));
        EXPECT_EQ(readRecentRoms(*fake.reopenStore()).join(' '), expected) << started;
    }
    writeRecentRoms(fake.store, {"/roms/z.bin"});
    EXPECT_EQ(fileBytes(fake.iniPath()), "[Recent]\nROM1=/roms/z.bin\n");
}

} // namespace
