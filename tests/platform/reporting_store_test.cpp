#include "support/DiskFull.h"
#include "support/FakePlatform.h"

#include "platform/ReportingSettingsStore.h"

#include <gtest/gtest.h>

// A write that fails is said once, however many follow; after one that works, the next
// failure is said again. Nothing the session holds is lost meanwhile.
TEST(ReportingSettingsStore, SaysOnceForARunOfFailedWrites) {
    FakePlatform fake;
    ReportingSettingsStore store(fake.store, fake.dialogs, fake.iniPath());
    ASSERT_TRUE(store.SaveSetting("Settings", "ROMPath", "/roms"));
    {
        const DiskFull full(16);
        EXPECT_FALSE(store.SaveSetting("winpos", "top", "500"));
        EXPECT_FALSE(store.SaveSetting("winpos", "left", "600"));
        EXPECT_FALSE(store.DeleteSetting("Settings", "ROMPath"));
    }
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    const FakeDialogs::Box& box = fake.dialogs.boxes[0];
    EXPECT_EQ(box.title, "lum");
    EXPECT_TRUE(box.text.contains(fake.iniPath()));
    EXPECT_EQ(box.icon, MsgIcon::Exclamation);
    EXPECT_EQ(store.GetSetting("winpos", "left"), "600");

    EXPECT_TRUE(store.SaveSetting("winpos", "width", "4905"));
    const auto saved = fake.reopenStore();
    EXPECT_EQ(saved->GetSetting("winpos", "top"), "500");
    EXPECT_EQ(saved->GetSetting("Settings", "ROMPath"), "");

    {
        const DiskFull full(16);
        EXPECT_FALSE(store.SaveSetting("winpos", "height", "6570"));
    }
    EXPECT_EQ(fake.dialogs.boxes.size(), 2u);
}
