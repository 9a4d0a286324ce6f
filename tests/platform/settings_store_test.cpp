#include "support/FakePlatform.h"
#include "support/Files.h"

#include "platform/IniSettingsStore.h"
#include "platform/SettingsStore.h"

#include <gtest/gtest.h>

// Values that do not convert are checked with the other bad input; here, what the program
// itself writes and reads back.
TEST(SettingsStore, KeysAndSectionsIgnoreCaseAndSurviveARestart) {
    FakePlatform fake;
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "z26Path", "/opt/z26"));
    EXPECT_EQ(fake.store.GetSetting("settings", "Z26PATH"), "/opt/z26");
    // A second spelling overwrites the first instead of adding a twin.
    ASSERT_TRUE(fake.store.SaveSetting("SETTINGS", "Z26Path", "/usr/games"));
    EXPECT_EQ(fake.reopenStore()->GetSetting("Settings", "z26path"), "/usr/games");
    EXPECT_EQ(fileBytes(fake.iniPath()).count("26Path"), 1);
}

TEST(SettingsStore, WrittenNumbersAndFlagsReadBack) {
    EXPECT_EQ(parseSingle(singleText(6570.0 / 7), 0), static_cast<float>(6570.0 / 7));
    EXPECT_EQ(singleText(500), "500");
    EXPECT_TRUE(parseBool(boolText(true), false));
    EXPECT_FALSE(parseBool(boolText(false), true));
}

TEST(SettingsStore, ValuesKeepBlanksSeparatorsAndLineBreaks) {
    FakePlatform fake;
    const QString odd = QStringLiteral("  C:\\roms = [x];#y\nsecond line\\n ");
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "ROMPath", odd));
    EXPECT_EQ(fake.reopenStore()->GetSetting("Settings", "ROMPath"), odd);
}

TEST(SettingsStore, GarbageFilesReadAsAnEmptyStoreAndTakeWrites) {
    FakePlatform fake;
    const QString path =
        fake.writeFile("garbage.ini", QByteArray("\xff\xfe=\n[\n=x\n[a]\n=\nk\n", 17));
    IniSettingsStore store(path);
    EXPECT_EQ(store.GetSetting("a", "k", "d"), "d");
    EXPECT_TRUE(store.SaveSetting("a", "k", "v"));
    EXPECT_EQ(IniSettingsStore(path).GetSetting("A", "K"), "v");
}
