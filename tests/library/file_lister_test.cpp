#include "support/FakePlatform.h"
#include "support/Unreadable.h"

#include "library/Ascii.h"
#include "library/FileLister.h"

#include <QFile>
#include <QFileInfo>

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

// Each name goes through the general match and, where pattern and name are plain ASCII,
// through the quicker byte-wise one that folders are matched with.
TEST(FilePattern, WildcardListsMatchWholeNamesWithoutCase) {
    const struct {
        const char* pattern;
        std::vector<const char*> matching, others;
    } cases[] = {
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
        // A star in the name is no wildcard of its own: the pattern's star still spans it.
        {"*.bin", {"*game.bin"}, {}},
        {"*.b?n", {"*game.bin"}, {}},
        {"*g*", {}, {"x*.bin"}},
        // Letters beyond ASCII fold too, in the pattern and in the name.
        {"*ÄPFEL*", {"äpfel.bin"}, {}},
        {"*.bin", {"Émulé.BIN"}, {}},
    };
    for (const auto& c : cases) {
        const FilePattern pattern{QString::fromUtf8(c.pattern)};
        for (const bool matches : {true, false}) {
            for (const char* n : matches ? c.matching : c.others) {
                const QString name = QString::fromUtf8(n);
                EXPECT_EQ(pattern.matches(name), matches) << c.pattern << " on " << n;
                if (pattern.asciiOnly() && isAscii(name)) {
                    EXPECT_EQ(pattern.matchesFoldedAscii(name.toLower().toStdString()), matches)
                        << c.pattern << " on " << n << " (ASCII)";
                }
            }
        }
    }
}

// A folder lists its regular, visible, matching files (links to them too), sorted without
// regard to case, then by their bytes, as one list though a large one is matched in batches
// on another thread; anything else in it, or a path that is no readable folder, lists nothing.
TEST(FileLister, ListsReadableRegularFilesSortedAsOneList) {
    FakePlatform fake;
    const QString folder = fake.makeFolder("roms");
    QStringList expected;
    // Names that share their first twenty characters, differ only in case, or are not
    // ASCII, in an order the folder does not keep.
    for (int i = 0; i < 10000; ++i) {
        const int n = (i * 7919) % 10000;
        const QString name = n % 3 == 0 ? QStringLiteral("Activision Collection - %1.bin").arg(n)
                             : n % 3 == 1
                                 ? QStringLiteral("activision collection - %1.BIN").arg(n - 1)
                                 : QStringLiteral("Émulé %1.bin").arg(n);
        ASSERT_TRUE(QFile(folder + u'/' + name).open(QIODevice::WriteOnly));
        expected.push_back(name);
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
    expected << "link.bin" << QFileInfo(QFile::decodeName(latin1)).fileName();
    const auto key = [](const QString& name) {
        return std::pair(name.toCaseFolded().toUtf8(), name.toUtf8());
    };
    std::sort(expected.begin(), expected.end(),
              [&](const QString& a, const QString& b) { return key(a) < key(b); });

    FileLister lister;
    lister.setPattern("*.bin");
    lister.setPath(folder);
    EXPECT_EQ(lister.names().toStringList(), expected);
    EXPECT_EQ(lister.List(-1), QString());
    EXPECT_EQ(lister.List(lister.ListCount()), QString());
    // Paths that are no readable folder, one of them a folder that cannot be read.
    const QString locked = fake.makeFolder("locked");
    fake.writeFile("locked/a.bin");
    ASSERT_TRUE(QFile::setPermissions(locked, {}));
    const NoPermissionOverride asAnyone;
    ASSERT_TRUE(asAnyone.holds());
    for (const QString& path : {fake.writeFile("file.bin"), fake.makeFolder("empty"), locked,
                                fake.root() + "/gone", QString()}) {
        lister.setPath(path);
        EXPECT_EQ(lister.ListCount(), 0) << path.toStdString();
    }
    QFile::setPermissions(locked, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    ::unlink(latin1.constData()); // the temporary folder cannot remove it by its decoded name
}
