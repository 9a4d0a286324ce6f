#include "support/FakePlatform.h"

#include "library/FileLister.h"

#include <QDir>
#include <QFile>

#include <gtest/gtest.h>

TEST(FilePattern, WildcardListsIgnoreCase) {
    const FilePattern bins(QStringLiteral("*.bin;*.A26"));
    EXPECT_TRUE(bins.matches(u"Pitfall.BIN"));
    EXPECT_TRUE(bins.matches(u"combat.a26"));
    EXPECT_FALSE(bins.matches(u"readme.txt"));
    EXPECT_FALSE(bins.matches(u"x.bin.bak"));
    EXPECT_TRUE(FilePattern(QStringLiteral("*.*")).matches(u"NoExtension"));
    EXPECT_TRUE(FilePattern(QStringLiteral("p?t*.bin")).matches(u"Pitfall.bin"));
    EXPECT_FALSE(FilePattern(QStringLiteral("p?t*.bin")).matches(u"Pt.bin"));
    EXPECT_TRUE(FilePattern(QStringLiteral(" *.bin ; ")).matches(u"a.bin"));
    EXPECT_FALSE(FilePattern(QString()).matches(u"a.bin"));
    EXPECT_TRUE(FilePattern(QStringLiteral("*ÄPFEL*")).matches(u"äpfel.bin"));
}

TEST(FileLister, ListsMatchingRegularVisibleFilesSortedWithoutCase) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    for (const char* name : {"b.bin", "A.bin", "c.BIN", ".hidden.bin", "notes.txt", "a.bin"})
        fake.writeFile(QStringLiteral("roms/") + name);
    fake.makeFolder("roms/folder.bin");
    QFile::link(folder + "/b.bin", folder + "/link.bin");
    QFile::link(folder + "/gone.bin", folder + "/dangling.bin");

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names(), (QStringList{"A.bin", "a.bin", "b.bin", "c.BIN", "link.bin"}));
    EXPECT_EQ(lister.ListCount(), 5);
    EXPECT_EQ(lister.List(3), "c.BIN");
    EXPECT_EQ(lister.List(5), QString());
    EXPECT_EQ(lister.List(-1), QString());
}

TEST(FileLister, AMissingOrUnreadableFolderListsNothing) {
    FakePlatform fake;
    FileLister lister;
    lister.setPattern("*.*");
    lister.setPath(fake.root() + "/nowhere");
    EXPECT_EQ(lister.ListCount(), 0);
    lister.setPath(fake.writeFile("plain.bin"));
    EXPECT_EQ(lister.ListCount(), 0);
    lister.setPath(QString());
    EXPECT_EQ(lister.ListCount(), 0);
}
