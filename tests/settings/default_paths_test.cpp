#include "SettingsFixture.h"

#include "platform/StoredSettings.h"
#include "settings/DefaultPaths.h"

#include <QDir>

namespace {

class DefaultPaths : public SettingsFixture {
protected:
    static QTreeWidget* list(const frmSettings& w) {
        return control<QTreeWidget>(w, "vbalListDefPaths");
    }

    // The folder list's rows as "path count on|off".
    static QStringList rows(const frmSettings& w) {
        QStringList texts;
        for (int i = 0; i < list(w)->topLevelItemCount(); ++i) {
            const QTreeWidgetItem* row = list(w)->topLevelItem(i);
            texts << row->text(0) + " " + row->text(1) +
                         (row->checkState(0) == Qt::Checked ? " on" : " off");
        }
        return texts;
    }

    // -1 selects no row.
    static void selectRow(const frmSettings& w, int index) {
        list(w)->setCurrentItem(index < 0 ? nullptr : list(w)->topLevelItem(index));
    }
};

} // namespace

TEST(DefaultPathsRules, ArchiveNamesAndTheEmulatorsPath) {
    for (const char* archive : {"x.rar", "X.RAR", "/roms/Games.Rar"})
        EXPECT_TRUE(isArchiveName(QString::fromUtf8(archive))) << archive;
    for (const char* other : {".rar", "xrar", "", "x.rar.zip", "/roms/rar"})
        EXPECT_FALSE(isArchiveName(QString::fromUtf8(other))) << other;

    FakePlatform fake;
    const QString emu = fake.makeFolder("emu");
    const QString named = fake.makeFolder("z26");
    // A folder called z26 holds the emulator; it is no emulator itself.
    const QString completed[][2] = {{emu, emu + "/z26"},
                                    {emu + "//", emu + "/z26"},
                                    {emu + "/Z26", emu + "/Z26"},
                                    {"/opt/xz26", "/opt/xz26/z26"},
                                    {named, named + "/z26"}};
    for (const auto& [path, expected] : completed)
        EXPECT_EQ(completeZ26Path(path), expected) << qPrintable(path);

    // The box shows the stored path trimmed, and completed once it is as long as "/z26".
    const char* const shown[][2] = {{"  /opt/lum  ", "/opt/lum/z26"},
                                    {"/opt/lum/Z26", "/opt/lum/Z26"},
                                    {"/ab", "/ab"},
                                    {"/abc", "/abc/z26"},
                                    {"   ", ""}};
    for (const auto& [text, expected] : shown)
        EXPECT_EQ(z26PathForDisplay(QString::fromUtf8(text)), QString::fromUtf8(expected)) << text;
}

// Counting lists every folder, so a window still hidden counts when it is shown. A folder
// not found (its disk unplugged, say) shows greyed and keeps its entry and flag.
TEST_F(DefaultPaths, ThePageCountsFoldersKeepsMissingOnesReloadsAndTakesOnlyAnEmulator) {
    fake.store.SaveSetting("Settings", "ROMFilter", "*.a26");
    const QString a = romFolder("a", {"x.a26", "y.a26", "z.bin"});
    const QString b = romFolder("b with blank", {"1.bin"});
    const QString gone = fake.root() + "/gone";
    const QString file = fake.writeFile("file.bin"); // a file where a folder belongs
    for (int n = 1; const QString& path : {a, gone, file, b})
        storeFolder(n++, path, path != a);
    const std::vector<RomFolder> all = readRomFolders(fake.store);
    auto w = std::make_unique<frmSettings>(fake.platform);
    EXPECT_EQ(rows(*w), QStringList({a + "  off", gone + " 0 on", file + " 0 on", b + "  on"}));
    w->show();
    EXPECT_EQ(rows(*w), QStringList({a + " 2 off", gone + " 0 on", file + " 0 on", b + " 0 on"}));
    const QTreeWidgetItem* missing = list(*w)->topLevelItem(1);
    EXPECT_EQ(missing->toolTip(1), "Folder not found");
    EXPECT_EQ(missing->foreground(0).color(),
              w->palette().color(QPalette::Disabled, QPalette::Text));
    auto* filter = control<QLineEdit>(*w, "txtDefPathFilter");

    // A new pattern recounts every row and is stored at once.
    filter->selectAll();
    QTest::keyClicks(filter, "*.bin");
    EXPECT_EQ(rows(*w), QStringList({a + " 1 off", gone + " 0 on", file + " 0 on", b + " 1 on"}));
    EXPECT_EQ(stored("ROMFilter"), "*.bin");
    QTest::keyClick(list(*w), Qt::Key_F5); // saves the list and reads it back
    EXPECT_EQ(readRomFolders(*fake.reopenStore()), all);
    romFolder("a/sub", {"2.bin"}); // counted with its folder once asked for, and stored
    control<QCheckBox>(*w, "chkROMSubfolders")->click();
    EXPECT_EQ(QStringList({rows(*w)[0], stored("ROMSubfolders")}),
              QStringList({a + " 2 off", "True"}));

    // Choosing the page reads the store again, also by a click on the tab already shown.
    QDir(a).removeRecursively();
    w->selectPage("DefaultPaths");
    EXPECT_EQ(rows(*w)[0], a + " 0 off");
    storeFolder(2, romFolder("c", {"1.bin"}), true);
    QTabBar* bar = control<QTabWidget>(*w, "vbalDTabControl1")->tabBar();
    QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(bar->currentIndex()).center());
    EXPECT_EQ(rows(*w)[1], fake.root() + "/c 1 on");

    // The emulator path is completed, checked and stored.
    const QString emu = fake.makeFolder("emu");
    const QString executable = fake.writeFile("emu/z26");
    const QString upper = fake.writeFile("other/Z26");
    for (const QString& program : {executable, upper})
        QFile::setPermissions(program, QFile::ReadOwner | QFile::ExeOwner);
    auto* box = control<QLineEdit>(*w, "txtDefPathz26");
    EXPECT_EQ(box->text(), fake.programFolder() + "/z26"); // until one is chosen

    auto* choose = control<QPushButton>(*w, "cmdAddZ26Path");
    choose->click(); // cancelled
    EXPECT_EQ(requestLines(fake.dialogs),
              Lines{"open | Choose z26 path | z26 executable (z26)|z26|All Files (*.*)|*.* | " +
                    fake.programFolder().toStdString() + " | 1 | 1800"});
    EXPECT_EQ(stored("Z26Path"), "<missing>");

    fake.dialogs.paths = {emu};
    choose->click(); // a folder is completed
    EXPECT_EQ(box->text(), executable);
    EXPECT_EQ(stored("Z26Path"), executable);
    QTest::keyClicks(box, "xyz"); // typing is ignored
    EXPECT_EQ(box->text(), executable);
    drop(box, {QUrl::fromLocalFile(upper), QUrl::fromLocalFile(emu)}); // the emulator, any case
    EXPECT_EQ(box->text(), upper);
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    // What does not lead to a program is refused, and the stored path kept; a file that
    // cannot be run is named. The third is a folder named like the emulator, holding
    // another such folder; the last a z26 without its execute permission.
    const QString refused[] = {fake.root() + "/missing",
                               fake.makeFolder("empty"),
                               fake.makeFolder("trap/z26/z26").chopped(4),
                               fake.writeFile("notes.txt", "hello"),
                               fake.root() + "/bad\nname\x01/z26",
                               fake.writeFile("plain/z26")};
    for (const QString& path : refused)
        drop(box, {QUrl::fromLocalFile(path)});
    const std::string none = "Non-z26 Folder Chosen. | z26 doesn't exist in that path. \nChoose "
                             "another one. | Ok | None";
    const auto noProgram = [](const QString& path) {
        return "Not a Program | " + path.toStdString() +
               " is not a program lum can start.\nChoose the z26 program. | Ok | Exclamation";
    };
    EXPECT_EQ(boxLines(fake.dialogs), (Lines{none, none, noProgram(refused[2] + "/z26"),
                                             noProgram(refused[3]), none, noProgram(refused[5])}));
    EXPECT_EQ(box->text(), upper);
    EXPECT_EQ(stored("Z26Path"), upper);
}

TEST_F(DefaultPaths, FoldersAreAddedByChooserOrDropThenFlippedRefreshedAndRemoved) {
    const QString a = romFolder("a", {"1.bin"});
    const QString b = romFolder("b", {"1.bin", "2.bin"});
    auto w = open();
    QWidget* target = list(*w)->viewport();
    auto* add = control<QAction>(*w, "mnuROMSAdd");
    add->trigger(); // cancelled
    EXPECT_EQ(fake.dialogs.folderTitles, QStringList({"Choose ROMs path"}));
    fake.dialogs.paths = {a};
    add->trigger();
    drop(target, {QUrl::fromLocalFile(b), QUrl::fromLocalFile(a)}); // only the first counts
    EXPECT_EQ(rows(*w), QStringList({a + " 1 on", b + " 2 on"}));
    EXPECT_EQ(stored("ROM2Path"), b);

    // A folder in the list, however written, is not added again; a name ending in .rar is
    // refused as an archive, even when it is a folder.
    w->AddRomFolder(b + "/../a/", false);
    w->AddRomFolder(fake.writeFile("game.bin"), false);
    drop(target, {QUrl::fromLocalFile(fake.root() + "/missing")});
    drop(target, {QUrl::fromLocalFile(romFolder("games.RAR"))});
    const std::string notAFolder = "Add Folders Not Files. | That doesn't appear to be a valid "
                                   "folder.\nChoose another one. | Ok | None";
    EXPECT_EQ(boxLines(fake.dialogs),
              (Lines{"lum | " + a.toStdString() + " is already in the list. | Ok | Information",
                     notAFolder, notAFolder, "lum | .rar files aren't supported yet | Ok | None"}));
    fake.dialogs.boxes.clear();

    QTreeWidget* paths = list(*w);
    // Enter flips the selected folder and stores it at once, for the main list's next refresh.
    selectRow(*w, -1);
    QTest::keyClick(paths, Qt::Key_Return); // no selected row: nothing
    selectRow(*w, 1);
    QTest::keyClick(paths, Qt::Key_Return);
    EXPECT_EQ(stored("ROM2Checked"), "False");
    selectRow(*w, 0);
    QTest::keyClick(paths, Qt::Key_Enter);
    EXPECT_EQ(stored("ROMChecked"), "False");
    EXPECT_EQ(rows(*w), QStringList({a + " 1 off", b + " 2 off"}));

    fake.writeFile("a/2.bin");
    QTest::keyClick(paths, Qt::Key_F5);
    EXPECT_EQ(rows(*w)[0], a + " 2 off");
    fake.writeFile("a/3.bin");
    control<QAction>(*w, "mnuROMSRefresh")->trigger();
    EXPECT_EQ(rows(*w)[0], a + " 3 off");

    // The right button's menu offers Remove only for a selected row.
    auto* menu = control<QMenu>(*w, "mnuROMSPopup");
    auto* remove = control<QAction>(*w, "mnuROMSRemove");
    for (const int row : {0, -1}) {
        selectRow(*w, row);
        emit paths->customContextMenuRequested(QPoint(5, 5));
        EXPECT_TRUE(menu->isVisible());
        EXPECT_EQ(remove->isVisible(), row == 0);
        menu->close();
    }

    // Remove asks first, and only Yes removes.
    QTest::keyClick(paths, Qt::Key_Delete); // no selected row: nothing
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    selectRow(*w, 0);
    fake.dialogs.answers = {MsgResult::No, MsgResult::Cancel, MsgResult::Yes};
    QTest::keyClick(paths, Qt::Key_Delete);
    remove->trigger();
    EXPECT_EQ(rows(*w).size(), 2);
    QTest::keyClick(paths, Qt::Key_Delete);
    EXPECT_EQ(boxLines(fake.dialogs), Lines(3, ("Remove Path? | Are you sure you want to remove " +
                                                a + " from the list? | YesNoCancel | Question")
                                                   .toStdString()));
    EXPECT_EQ(rows(*w), QStringList({b + " 2 off"}));
    EXPECT_EQ(QStringList({stored("ROMPath"), stored("ROMChecked"), stored("ROM2Path")}),
              QStringList({b, "False", ""}));
    // Removing the only folder leaves no ROM path at all.
    selectRow(*w, 0);
    remove->trigger();
    EXPECT_EQ(stored("ROMPath"), "");
}
