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

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names(), (QStringList{"A.bin", "a.bin", "b.bin", "c.BIN"}));
    EXPECT_EQ(lister.ListCount(), 4);
    EXPECT_EQ(lister.List(3), "c.BIN");
    EXPECT_EQ(lister.List(4), QString());
    EXPECT_EQ(lister.List(-1), QString());
}
