#include "support/FakePlatform.h"

#include "platform/FileSystem.h"
#include "platform/QtDialogs.h"

#include <QApplication>
#include <QMessageBox>
#include <QTimer>

#include <gtest/gtest.h>

// A name's bytes come back whole from its text, valid UTF-8 or not; it reads as Latin-1 where
// it is not UTF-8.
TEST(FileSystem, EveryNameKeepsItsBytes) {
    const std::pair<QByteArray, QString> cases[] = {
        {"Pitfall!.bin", "Pitfall!.bin"},
        {"Caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80", "Café € 😀"},
        {"Caf\xE9.bin", "Café.bin"},                                  // Latin-1
        {"\xC3", "\u00C3"},                                           // cut short
        {"\xC0\xAF \xE0\x80\xAF", "\u00C0\u00AF \u00E0\u0080\u00AF"}, // overlong
        {"\xED\xA0\x80", "\u00ED\u00A0\u0080"},                       // a surrogate
        {"\xF4\x90\x80\x80 \xFF", "\u00F4\u0090\u0080\u0080 \u00FF"}, // above U+10FFFF
    };
    for (const auto& [bytes, readable] : cases) {
        const QString name = nameFromFileSystem(bytes);
        EXPECT_EQ(nameToFileSystem(name), bytes);
        EXPECT_EQ(readableName(name), readable) << bytes.toHex().constData();
    }
}

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

// Each entry shows its patterns once, in Qt's form, whether or not its label showed them.
TEST(FileFilter, WindowsFiltersBecomeQtFilters) {
    const std::pair<const char*, const char*> rows[] = {
        {"lum configurations (*.lum)|*.lum", "lum configurations (*.lum)"},
        {"z26 executable (z26)|z26", "z26 executable (z26)"},
        {"Pictures (*.jpg,*.png)|*.jpg; *.png|All Files (*.*)|*.*",
         "Pictures (*.jpg *.png);;All Files (*)"},
        {"lum Settings|*.lum", "lum Settings (*.lum)"},
        {"Notes (old)|*.txt", "Notes (old) (*.txt)"},
    };
    for (const auto& [filter, qt] : rows)
        EXPECT_EQ(qtFileFilter(filter), qt) << filter;
    EXPECT_EQ(qtSelectedFilter(rows[2].first, 2) + qtSelectedFilter(rows[2].first, 3),
              "All Files (*)");
}

// A message box shows its text as given, markup and all.
TEST(MessageBox, ShowsPlainText) {
    QTimer::singleShot(0, [] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_TRUE(box);
        EXPECT_EQ(box->textFormat(), Qt::PlainText);
        box->accept();
    });
    QtDialogs().MsgBox(nullptr, "<b>a.bin</b>", MsgButtons::Ok, MsgIcon::None, "lum");
}
