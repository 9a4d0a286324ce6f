#include "support/FakePlatform.h"

#include "library/Ascii.h"
#include "library/FileLister.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

// A pattern, names it matches, names it does not: by the general match and, for plain ASCII,
// by the byte-wise one folders are listed with.
TEST(FilePattern, WildcardListsMatchWholeNamesWithoutCase) {
    const std::tuple<const char*, QStringList, QStringList> cases[] = {
        {"*.bin;*.A26", {"Pitfall.BIN", "combat.a26", ".bin"}, {"readme.txt", "x.bin.bak", "bin"}},
        {" *.bin ; ", {"a.bin"}, {}},
        {"", {}, {"a.bin"}},
        {"**.bin", {"a.bin"}, {}},
        {"*.*", {"NoExtension"}, {}},
        {"*.", {"a."}, {"noext"}},
        {"*", {"b"}, {}},
        {"pitfall.bin", {"PITFALL.bin"}, {"pitfall.bi"}},
        {"p?t*.bin", {"Pitfall.bin"}, {"Pt.bin"}},
        {"*pit*", {"spit.txt"}, {}},
        // A star in a name is a plain character; letters beyond ASCII fold, in pattern and name.
        {"*.bin", {"*game.bin", "Émulé.BIN"}, {}},
        {"*.b?n", {"*game.bin"}, {}},
        {"*g*", {}, {"x*.bin"}},
        {"*ÄPFEL*", {"äpfel.bin"}, {}},
    };
    for (const auto& [text, matching, others] : cases) {
        const FilePattern pattern{QString::fromUtf8(text)};
        for (const QString& name : matching + others) {
            SCOPED_TRACE(text + (" on " + name.toStdString()));
            const bool expected = matching.contains(name);
            EXPECT_EQ(pattern.matches(name), expected);
            EXPECT_TRUE(!pattern.asciiOnly() || !isAscii(name) ||
                        pattern.matchesFoldedAscii(name.toLower().toStdString()) == expected);
        }
    }
}

// Regular, visible, matching files (links to them too), sorted without case, then by bytes,
// as one list though a large folder is matched in batches on another thread; anything else in
// it, or a path that is no folder, lists nothing.
TEST(FileLister, ListsReadableRegularFilesSortedAsOneList) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    // Names alike in their first twenty characters, or but for case, or not ASCII.
    QStringList expected;
    for (int n = 0; n < 10000; ++n) {
        const char* const kinds[] = {"Activision Collection - %1.bin",
                                     "activision collection - %1.BIN", "Émulé %1.bin"};
        expected << QString(kinds[n % 3]).arg(n % 3 == 1 ? n - 1 : n);
        ASSERT_TRUE(QFile(folder + u'/' + expected.back()).open(QIODevice::WriteOnly));
    }
    fake.writeFile("roms/notes.txt");
    fake.writeFile("roms/.hidden.bin");
    fake.makeFolder("roms/sub.bin");
    ASSERT_EQ(::mkfifo(QFile::encodeName(folder + "/pipe.bin").constData(), 0600), 0);
    QFile::link(folder + "/nowhere", folder + "/dangling.bin");
    QFile::link(folder + "/loop.bin", folder + "/loop.bin");
    QFile::link(folder + u'/' + expected[0], folder + "/link.bin");
    // A name that is not UTF-8, as on a file copied from an old Latin-1 disk.
    const QByteArray latin1 = QFile::encodeName(folder) + "/Pitfall\xe9.bin";
    ASSERT_EQ(::close(::creat(latin1.constData(), 0600)), 0);
    expected << "link.bin"
             << "Pitfall" + QString(QChar(0xDCE9)) + ".bin"; // the byte kept
    std::ranges::sort(expected, {}, [](const QString& name) {
        return std::pair(name.toCaseFolded().toUtf8(), name.toUtf8());
    });

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(), expected);
    for (const QString& path : {QString(), fake.writeFile("file.bin"), fake.root() + "/gone"})
        EXPECT_EQ((lister.setPath(path), lister.ListCount()), 0) << path.toStdString();
    ::unlink(latin1.constData()); // the temporary folder cannot remove it by its decoded name
}
