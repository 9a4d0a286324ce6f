#include "support/FakePlatform.h"

#include "platform/IniSettingsStore.h"
#include "platform/SettingsStore.h"

#include <QFile>
#include <QFileInfo>

#include <gtest/gtest.h>

TEST(SettingsStore, KeysAndSectionsIgnoreCaseAndSurviveARestart) {
    FakePlatform fake;
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "z26Path", "/opt/z26"));
    EXPECT_EQ(fake.store.GetSetting("settings", "Z26PATH"), "/opt/z26");
    // A second spelling overwrites the first instead of adding a twin.
    ASSERT_TRUE(fake.store.SaveSetting("SETTINGS", "Z26Path", "/usr/games"));
    auto reopened = fake.reopenStore();
    EXPECT_EQ(reopened->GetSetting("Settings", "z26path"), "/usr/games");
    QFile file(fake.iniPath());
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll().count("26Path"), 1);
}

TEST(SettingsStore, MissingKeysGiveTheDefault) {
    FakePlatform fake;
    EXPECT_EQ(fake.store.GetSetting("Settings", "ROMFilter", "*.*"), "*.*");
    EXPECT_EQ(readSingle(fake.store, "winpos", "height", 6570), 6570);
    EXPECT_TRUE(readBool(fake.store, "Settings", "BackImgEnabled", true));
    EXPECT_EQ(readColour(fake.store, "Settings", "BackColor", 0xFFFFFF), 0xFFFFFFu);
}

TEST(SettingsStore, ValuesThatDoNotConvertGiveTheDefault) {
    FakePlatform fake;
    fake.store.SaveSetting("winpos", "height", "tall");
    fake.store.SaveSetting("winpos", "width", "1e400");
    fake.store.SaveSetting("winpos", "max", "maybe");
    fake.store.SaveSetting("Settings", "BackColor", "blue");
    fake.store.SaveSetting("Settings", "TextColor", "99999999999");
    EXPECT_EQ(readSingle(fake.store, "winpos", "height", 6570), 6570);
    EXPECT_EQ(readSingle(fake.store, "winpos", "width", 4905), 4905);
    EXPECT_FALSE(readBool(fake.store, "winpos", "max", false));
    EXPECT_EQ(readColour(fake.store, "Settings", "BackColor", 0xFFFFFF), 0xFFFFFFu);
    EXPECT_EQ(readColour(fake.store, "Settings", "TextColor", 0), 0u);
}

TEST(SettingsStore, ReadersAcceptTheFormsTheProgramWrites) {
    EXPECT_EQ(parseSingle(" 1234.5 ", 0), 1234.5);
    EXPECT_EQ(parseSingle(singleText(6570.0 / 7), 0), static_cast<float>(6570.0 / 7));
    EXPECT_TRUE(parseBool("True", false));
    EXPECT_FALSE(parseBool("false", true));
    EXPECT_TRUE(parseBool("-1", false));
    EXPECT_EQ(parseLong("16777215", 0), 16777215);
    EXPECT_EQ(parseLong("-2147483633", 0), -2147483633LL);
    EXPECT_EQ(boolText(true), "True");
    EXPECT_EQ(singleText(500), "500");
}

TEST(SettingsStore, ValuesKeepBlanksSeparatorsAndLineBreaks) {
    FakePlatform fake;
    const QString odd = QStringLiteral("  C:\\roms = [x];#y\nsecond line\\n ");
    ASSERT_TRUE(fake.store.SaveSetting("Settings", "ROMPath", odd));
    EXPECT_EQ(fake.reopenStore()->GetSetting("Settings", "ROMPath"), odd);
}

TEST(SettingsStore, AnUnwritableFolderReportsTheFailureAndKeepsTheValueInMemory) {
    FakePlatform fake;
    const QString blocker = fake.writeFile("blocked", "not a folder");
    IniSettingsStore store(blocker + "/lum/lum.ini");
    EXPECT_FALSE(store.SaveSetting("Settings", "ROMPath", "/roms"));
    EXPECT_EQ(store.GetSetting("Settings", "ROMPath"), "/roms");
}

TEST(SettingsStore, GarbageFilesReadAsAnEmptyStoreWithoutCrashing) {
    FakePlatform fake;
    const QString path =
        fake.writeFile("garbage.ini", QByteArray("\xff\xfe=\n[\n=x\n[a]\n=\nk\n", 17));
    IniSettingsStore store(path);
    EXPECT_EQ(store.GetSetting("a", "k", "d"), "d");
    EXPECT_TRUE(store.SaveSetting("a", "k", "v"));
    EXPECT_EQ(IniSettingsStore(path).GetSetting("A", "K"), "v");
}
