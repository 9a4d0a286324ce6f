#include "support/FakePlatform.h"

#include "QtPrinters.h"

#include "platform/SettingsStore.h"
#include "settings/DefaultPaths.h"

#include <gtest/gtest.h>

namespace {

const QString kSettings = QStringLiteral("Settings");
const QString kMissing = QStringLiteral("<missing>");

void storeEntry(SettingsStore& store, int n, const QString& path, const QString& flag) {
    store.SaveSetting(kSettings, romPathKey(n), path);
    store.SaveSetting(kSettings, romCheckedKey(n), flag);
}

} // namespace

TEST(RomFolderStore, KeysNumberEntriesFromOneWithoutANumberForTheFirst) {
    const struct {
        int n;
        const char* path;
        const char* checked;
    } cases[] = {
        {1, "ROMPath", "ROMChecked"},
        {2, "ROM2Path", "ROM2Checked"},
        {10, "ROM10Path", "ROM10Checked"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(romPathKey(c.n), QLatin1String(c.path));
        EXPECT_EQ(romCheckedKey(c.n), QLatin1String(c.checked));
    }
}

TEST(RomFolderStore, ReadingStopsAtTheFirstGapAndASaveKeepsTheGap) {
    FakePlatform fake;
    storeEntry(fake.store, 1, "/roms/a", "True");
    storeEntry(fake.store, 3, "/roms/c", "True");

    const std::vector<RomFolder> folders = readRomFolders(fake.store);
    ASSERT_EQ(folders.size(), 1u);
    EXPECT_EQ(folders[0], (RomFolder{"/roms/a", true}));

    writeRomFolders(fake.store, folders);
    auto reopened = fake.reopenStore();
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM2Path", kMissing), "");
    // The third entry stays behind the gap, out of every reader's reach.
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM3Path"), "/roms/c");
    EXPECT_EQ(readRomFolders(*reopened).size(), 1u);
}

TEST(RomFolderStore, ASaveBlanksTheEntryAfterTheLastAndLeavesItsFlag) {
    FakePlatform fake;
    storeEntry(fake.store, 1, "/roms/a", "True");
    storeEntry(fake.store, 2, "/roms/b", "True");
    storeEntry(fake.store, 3, "/roms/c", "True");

    writeRomFolders(fake.store, {{"/roms/x", false}});
    auto reopened = fake.reopenStore();
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROMPath"), "/roms/x");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROMChecked"), "False");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM2Path", kMissing), "");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM2Checked"), "True");
    EXPECT_EQ(readRomFolders(*reopened), (std::vector<RomFolder>{{"/roms/x", false}}));

    // Saving no folders at all leaves the first entry empty: no ROM path.
    writeRomFolders(fake.store, {});
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROMPath", kMissing), "");
}

TEST(RomFolderStore, FlagsSurviveAWriteAndARead) {
    FakePlatform fake;
    const std::vector<RomFolder> folders = {{"/a", true}, {"/b", false}, {"/c d", true}};
    writeRomFolders(fake.store, folders);
    EXPECT_EQ(readRomFolders(*fake.reopenStore()), folders);

    // A flag that was never written reads as disabled.
    FakePlatform bare;
    bare.store.SaveSetting(kSettings, "ROMPath", "/a");
    EXPECT_EQ(readRomFolders(bare.store), (std::vector<RomFolder>{{"/a", false}}));
}

TEST(RomFolderStore, AVanishedFolderIsDroppedWithoutHidingTheFoldersAfterIt) {
    FakePlatform fake;
    const QString b = fake.makeFolder("b");
    const QString c = fake.makeFolder("c");
    storeEntry(fake.store, 1, fake.root() + "/gone", "True");
    storeEntry(fake.store, 2, b, "False");
    storeEntry(fake.store, 3, c, "True");

    const std::vector<RomFolder> expected = {{b, false}, {c, true}};
    EXPECT_EQ(loadExistingRomFolders(fake.store), expected);
    // The store was closed up at once, so the main list still reaches b and c.
    auto reopened = fake.reopenStore();
    EXPECT_EQ(readRomFolders(*reopened), expected);
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM3Path", kMissing), "");
}

TEST(RomFolderStore, NothingIsWrittenWhenEveryFolderExists) {
    FakePlatform fake;
    storeEntry(fake.store, 1, fake.makeFolder("a"), "True");
    EXPECT_EQ(loadExistingRomFolders(fake.store).size(), 1u);
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROM2Path", kMissing), kMissing);
}

TEST(ArchiveName, OnlyNamesLongerThanFourCharactersEndingInRarAreArchives) {
    const struct {
        const char* item;
        bool archive;
    } cases[] = {
        {"x.rar", true},      {"X.RAR", true},      {"/roms/Games.Rar", true},
        {".rar", false},      {".RAR", false},      {"xrar", false},
        {"", false},          {"x.rar.zip", false}, {"/roms/x.rarx", false},
        {"/roms/rar", false},
    };
    for (const auto& c : cases)
        EXPECT_EQ(isArchiveName(QString::fromUtf8(c.item)), c.archive) << c.item;
}

TEST(Z26Path, AFolderIsCompletedAndTheExecutableInAnyCaseIsKept) {
    FakePlatform fake;
    const QString emu = fake.makeFolder("emu");
    const QString named = fake.makeFolder("z26");
    EXPECT_EQ(z26FileName(), "z26");

    const struct {
        QString path;
        QString expected;
    } cases[] = {
        {emu, emu + "/z26"},
        {emu + "/", emu + "/z26"},
        {emu + "/z26", emu + "/z26"},
        {emu + "/Z26", emu + "/Z26"},
        {"/usr/games/z26", "/usr/games/z26"},
        {"/opt/z26.exe", "/opt/z26.exe/z26"},
        {"/opt/xz26", "/opt/xz26/z26"},
        // A folder called z26 holds the executable; it is no executable itself.
        {named, named + "/z26"},
        {"/", "/z26"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(completeZ26Path(c.path), c.expected) << qPrintable(c.path);
}

TEST(Z26Path, TheBoxShowsTheTrimmedStoredPathCompleted) {
    const struct {
        const char* stored;
        const char* shown;
    } cases[] = {
        {"  /opt/lum  ", "/opt/lum/z26"},
        {"/opt/lum/Z26", "/opt/lum/Z26"},
        {"/x", "/x"},
        {"", ""},
        {"   ", ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(z26PathForDisplay(QString::fromUtf8(c.stored)), QString::fromUtf8(c.shown))
            << c.stored;
}
