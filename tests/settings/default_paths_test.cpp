#include "support/FakePlatform.h"

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

TEST(RomFolderStore, EntriesRunFromOneToTheFirstGapAndASaveEndsTheList) {
    EXPECT_EQ(QStringList({romPathKey(1), romCheckedKey(1), romPathKey(10), romCheckedKey(10)}),
              QStringList({"ROMPath", "ROMChecked", "ROM10Path", "ROM10Checked"}));
    FakePlatform fake;
    storeEntry(fake.store, 1, "/roms/a", "True");
    fake.store.SaveSetting(kSettings, "ROM2Path", "/roms/b"); // a flag never written is off
    storeEntry(fake.store, 3, "", "True");
    storeEntry(fake.store, 4, "/roms/d", "True");
    const std::vector<RomFolder> folders = readRomFolders(fake.store);
    EXPECT_EQ(folders, (std::vector<RomFolder>{{"/roms/a", true}, {"/roms/b", false}}));

    // Entry k + 1 gets an empty path and keeps its flag; what lies behind stays unreachable.
    writeRomFolders(fake.store, {{"/roms/x", false}, {"/r o/y", true}});
    auto reopened = fake.reopenStore();
    EXPECT_EQ(readRomFolders(*reopened),
              (std::vector<RomFolder>{{"/roms/x", false}, {"/r o/y", true}}));
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM3Path", kMissing), "");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM3Checked"), "True");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM4Path"), "/roms/d");

    // Saving no folders at all leaves the first entry empty: no ROM path.
    writeRomFolders(fake.store, {});
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROMPath", kMissing), "");
}

TEST(RomFolderStore, AVanishedFolderIsDroppedWithoutHidingTheFoldersAfterIt) {
    FakePlatform fake;
    const QString b = fake.makeFolder("b");
    const QString c = fake.makeFolder("c");
    storeEntry(fake.store, 1, b, "True");
    EXPECT_EQ(loadExistingRomFolders(fake.store).size(), 1u);
    // Nothing is written while every folder exists.
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROM2Path", kMissing), kMissing);

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

TEST(ArchiveName, OnlyNamesLongerThanFourCharactersEndingInRarAreArchives) {
    for (const char* archive : {"x.rar", "X.RAR", "/roms/Games.Rar"})
        EXPECT_TRUE(isArchiveName(QString::fromUtf8(archive))) << archive;
    for (const char* other : {".rar", "xrar", "", "x.rar.zip", "/roms/rar"})
        EXPECT_FALSE(isArchiveName(QString::fromUtf8(other))) << other;
}

TEST(Z26Path, FoldersAreCompletedAndTheExecutableInAnyCaseIsKept) {
    FakePlatform fake;
    const QString emu = fake.makeFolder("emu");
    const QString named = fake.makeFolder("z26");
    EXPECT_EQ(z26FileName(), "z26");
    const std::pair<QString, QString> cases[] = {
        {emu, emu + "/z26"},
        {emu + "/", emu + "/z26"},
        {emu + "/Z26", emu + "/Z26"},
        {"/opt/z26.exe", "/opt/z26.exe/z26"},
        {"/opt/xz26", "/opt/xz26/z26"},
        {"/", "/z26"},
        // A folder called z26 holds the executable; it is no executable itself.
        {named, named + "/z26"}};
    for (const auto& [path, expected] : cases)
        EXPECT_EQ(completeZ26Path(path), expected) << qPrintable(path);

    // The box shows the stored path trimmed, and completed once it is long enough.
    const std::pair<const char*, const char*> shown[] = {{"  /opt/lum  ", "/opt/lum/z26"},
                                                         {"/opt/lum/Z26", "/opt/lum/Z26"},
                                                         {"/x", "/x"},
                                                         {"   ", ""}};
    for (const auto& [stored, text] : shown)
        EXPECT_EQ(z26PathForDisplay(QString::fromUtf8(stored)), QString::fromUtf8(text)) << stored;
}
