#include "support/FakePlatform.h"

#include "platform/Dialogs.h"
#include "platform/FileSystem.h"

#include <gtest/gtest.h>

// FileExist finds files, folders and wildcard matches of the last element; GetShortPath gives
// the absolute path of a file or folder that exists, and the empty text for anything else.
TEST(FileSystem, FileExistAndGetShortPath) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("my roms");
    const QString file = fake.writeFile("my roms/Pitfall.bin", "x");
    const struct {
        QString path;
        bool exists;
        QString shortPath;
    } cases[] = {
        {file, true, file},
        {folder + "/../my roms", true, folder},
        {folder + "/*.bin", true, QString()},
        {folder + "/Pit?all.*", true, QString()},
        {folder + "/*.a26", false, QString()},
        {folder + "/missing.bin", false, QString()},
        {fake.root() + "/nowhere/*.bin", false, QString()},
        {QString(), false, QString()},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(FileExist(c.path), c.exists) << c.path.toStdString();
        EXPECT_EQ(GetShortPath(c.path), c.shortPath) << c.path.toStdString();
    }
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
