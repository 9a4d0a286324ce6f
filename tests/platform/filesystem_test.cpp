#include "support/FakePlatform.h"

#include "platform/Dialogs.h"
#include "platform/FileSystem.h"

#include <QDir>

#include <gtest/gtest.h>

TEST(FileExist, FindsFilesFoldersAndWildcards) {
    FakePlatform fake;
    const QString file = fake.writeFile("roms/Pitfall.bin", "x");
    const QString folder = fake.makeFolder("roms");
    EXPECT_TRUE(FileExist(file));
    EXPECT_TRUE(FileExist(folder));
    EXPECT_TRUE(FileExist(folder + "/*.bin"));
    EXPECT_TRUE(FileExist(folder + "/Pit?all.*"));
    EXPECT_FALSE(FileExist(folder + "/*.a26"));
    EXPECT_FALSE(FileExist(folder + "/missing.bin"));
    EXPECT_FALSE(FileExist(fake.root() + "/nowhere/*.bin"));
    EXPECT_FALSE(FileExist(QString()));
}

TEST(GetShortPath, GivesTheAbsolutePathOfWhatExists) {
    FakePlatform fake;
    const QString file = fake.writeFile("my roms/Space Invaders.bin", "x");
    EXPECT_EQ(GetShortPath(file), QDir::cleanPath(file));
    EXPECT_EQ(GetShortPath(fake.root() + "/my roms/../my roms"), fake.root() + "/my roms");
    EXPECT_EQ(GetShortPath(fake.root() + "/my roms/absent.bin"), QString());
    EXPECT_EQ(GetShortPath(QString()), QString());
}

TEST(FileFilter, WindowsFiltersBecomeQtFilters) {
    const QString filter =
        "Image Files (*.jpg,*.bmp,*gif,*png)|*.jpg;*.bmp;*.gif;*.png|All Files (*.*)|*.*";
    EXPECT_EQ(qtFileFilter(filter),
              "Image Files (*.jpg,*.bmp,*gif,*png) (*.jpg *.bmp *.gif *.png);;All Files (*.*) (*)");
    EXPECT_EQ(qtSelectedFilter(filter, 2), "All Files (*.*) (*)");
    EXPECT_EQ(qtSelectedFilter(filter, 3), QString());
    EXPECT_EQ(qtFileFilter("lum Settings|*.lum"), "lum Settings (*.lum)");
}
