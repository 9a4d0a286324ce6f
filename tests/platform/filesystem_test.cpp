#include "support/FakePlatform.h"

#include "platform/FileSystem.h"

#include <gtest/gtest.h>

// FileExist finds files, folders and wildcard matches of the last element; GetShortPath gives
// the clean absolute path of what exists (plain files, missing ones and "" in the launch tests).
TEST(FileSystem, FileExistAndGetShortPath) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("my roms");
    fake.writeFile("my roms/Pitfall.bin", "x");
    const std::tuple<QString, bool, QString> cases[] = {
        {folder + "/../my roms", true, folder},
        {folder + "/*.bin", true, QString()},
        {folder + "/Pit?all.*", true, QString()},
        {folder + "/*.a26", false, QString()},
        {fake.root() + "/nowhere/*.bin", false, QString()},
    };
    for (const auto& [path, exists, shortPath] : cases)
        EXPECT_EQ(std::pair(FileExist(path), GetShortPath(path)), std::pair(exists, shortPath));
}

TEST(FileFilter, WindowsFiltersBecomeQtFilters) {
    const QString filter = "Pictures (*.jpg,*.png)|*.jpg;*.png|All Files (*.*)|*.*";
    EXPECT_EQ(qtFileFilter(filter), "Pictures (*.jpg,*.png) (*.jpg *.png);;All Files (*.*) (*)");
    EXPECT_EQ(qtSelectedFilter(filter, 2) + qtSelectedFilter(filter, 3), "All Files (*.*) (*)");
    EXPECT_EQ(qtFileFilter("lum Settings|*.lum"), "lum Settings (*.lum)");
}
