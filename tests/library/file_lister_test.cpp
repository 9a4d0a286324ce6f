#include "support/FakePlatform.h"

#include "library/FileLister.h"

#include <QDir>
#include <QFile>

#include <gtest/gtest.h>

#include <algorithm>

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
    EXPECT_EQ(lister.names().toStringList(), (QStringList{"A.bin", "a.bin", "b.bin", "c.BIN"}));
    EXPECT_EQ(lister.ListCount(), 4);
    EXPECT_EQ(lister.List(3), "c.BIN");
    EXPECT_EQ(lister.List(4), QString());
    EXPECT_EQ(lister.List(-1), QString());
}

// Folders are matched name by name through a quicker path for plain ASCII wildcards; it
// must agree with the general match on every shape of wildcard.
TEST(FilePattern, TheAsciiPathAgreesWithTheGeneralMatch) {
    const char* patterns[] = {"*.bin", "*.bin;*.a26", "pitfall.bin", "*",     "*.*", "p?t*.bin",
                              "*bin",  "bin",         "**.bin",      "*.b?n", "*.",  "*pit*"};
    const char* names[] = {"pitfall.bin", "x.bin.bak", "bin",   ".bin", "a.bin",    "pitfall.bi",
                           "combat.a26",  "pt.bin",    "noext", "a.",   "spit.txt", "b"};
    for (const char* p : patterns) {
        const FilePattern pattern{QString::fromLatin1(p)};
        ASSERT_TRUE(pattern.asciiOnly()) << p;
        for (const char* n : names)
            EXPECT_EQ(pattern.matchesFoldedAscii(n), pattern.matches(QString::fromLatin1(n)))
                << p << " against " << n;
    }
}

// A folder too large to match in one go is matched on another thread while it is read, in
// batches that are merged afterwards: the order must be the one a plain sort gives.
TEST(FileLister, ALargeFolderIsSortedAsOneList) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    QStringList expected;
    // Names that share their first twenty characters, differ only in case, or are not
    // ASCII, in an order the folder does not keep.
    for (int i = 0; i < 9000; ++i) {
        const int n = (i * 7919) % 9000;
        const QString name = n % 3 == 0 ? QStringLiteral("Activision Collection - %1.bin").arg(n)
                             : n % 3 == 1
                                 ? QStringLiteral("activision collection - %1.BIN").arg(n - 1)
                                 : QStringLiteral("Émulé %1.bin").arg(n);
        QFile(folder + u'/' + name).open(QIODevice::WriteOnly);
        expected.push_back(name);
    }
    fake.writeFile(QStringLiteral("roms/notes.txt"));
    const auto key = [](const QString& name) {
        return std::pair(name.toCaseFolded().toUtf8(), name.toUtf8());
    };
    std::sort(expected.begin(), expected.end(),
              [&](const QString& a, const QString& b) { return key(a) < key(b); });

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(), expected);
}
