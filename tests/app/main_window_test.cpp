#include "AppFixture.h"

#include "emulator/OptionFile.h"
#include "support/SampleOptions.h"

// Without both paths the first one missing is asked for; Default.lum's options as read at
// start wait for the settings window, built when first needed.
TEST_F(MainWindow, StartsFromTheStoredPathsAndDefaultLum) {
    storePaths({"a.bin", "b.bin"});
    // Folders of the emulator and the ROMs, Default.lum (at first none) and its folder, the
    // outcome; the user's Default.lum before the program's.
    const std::tuple<const char*, const char*, QByteArray, const char*, const char*> starts[] = {
        {"", "roms", QByteArray(), "program",
         "lum 0\nChoose z26 Path | You need to select you z26 path before you continue. | Ok | "
         "None\npage DefaultPaths\nDefault.lum couldn't be loaded / Default.lum need's to be in "
         "the same folder as lum\ngame type 0"},
        {"emu", "", encodeOptions(sampleOptions()).left(100), "program",
         "lum 0\nlum | .lum file is corrupt\r\nPlease verify settings and re-save to correct "
         "this problem | Ok | None\nChoose ROM's Path | You need to select you ROM's path before "
         "you continue. | Ok | None\npage DefaultPaths\nDefault.lum is corrupt.  Please verify "
         "settings and re-save to correct the problem. / \ngame type 0"},
        {"emu", "roms", encodeOptions(sampleOptions()), "program",
         "lum - 2 ROM's Found 2\n\nDefault.lum was succesfully loaded / \ngame type 13"},
        {"", "roms", encodeOptions(sampleOptions()), "config/lum",
         "lum - 2 ROM's Found 2\n\nDefault.lum was succesfully loaded / \ngame type 13"}};
    // Last, a z26 on PATH is found when none is stored.
    const QString onPath = fake.writeFile("bin/z26");
    QFile::setPermissions(onPath, QFile::permissions(onPath) | QFile::ExeOwner);
    const QByteArray path = qgetenv("PATH");
    for (const auto& [z26, roms, lum, folder, expected] : starts) {
        if (QString(folder) == "config/lum")
            qputenv("PATH", QFile::encodeName(fake.root() + "/bin"));
        set("Z26Path", *z26 ? fake.root() + "/" + z26 : "");
        storeFolder(1, roms);
        if (!lum.isEmpty())
            fake.writeFile(QString(folder) + "/Default.lum", lum);
        frmMain& w = reload();
        QString outcome = w.windowTitle() + ' ' + QString::number(w.listModel().columnCount()) +
                          '\n' + happened();
        fake.writeFile("program/Default.lum", encodeOptions(EmulatorOptions())); // not read
        const auto* status = control<QLabel>(settings(), "lblConfig");
        outcome += '\n' + status->text() + " / " + status->toolTip() + "\ngame type " +
                   QString::number(settings().options().gameType);
        EXPECT_EQ(outcome, expected);
    }
    qputenv("PATH", path);
    EXPECT_EQ(stored("Z26Path"), onPath);
    emit control<QMenu>(*window, "mnuFile")->aboutToShow(); // the icons come with a menu
    expectGolden("frmMain", dumpWidgetTree(*window));
}

// In twips, 15 a pixel at 96 dpi; closed maximised or minimised, the normal place stays.
// The documents come from the emulator's folder, whether the stored path names the folder
// or the program; Exit closes every window, the settings window storing its place.
TEST_F(MainWindow, KeepsItsPlaceAndItsMenusReachDocumentsPagesOptionSetsAndWindows) {
    storePaths();
    for (const char* file : {"README.TXT", "copying.txt", "Z26"}) // lower case as often unpacked
        fake.writeFile(QString("emu/") + file);
    for (const auto& [key, value] :
         {std::pair{"height", "7200"}, {"width", "6000"}, {"top", "900"}, {"left", "1500"}})
        fake.store.SaveSetting("winpos", key, value);
    frmMain& w = load();
    EXPECT_EQ(QRect(w.pos(), w.size()), QRect(100, 60, 400, 480));
    w.resize(40, 10);
    EXPECT_EQ(w.size(), QSize(180, 180));
    w.resize(320, 530);
    const auto* search = control<QLineEdit>(w, "txtSearch");
    EXPECT_EQ(control<vbalProgressBar>(w, "vbalProgressBar1")->geometry(), search->geometry());
    const QHeaderView* header = list()->header(); // the name takes what the path leaves
    EXPECT_EQ(header->sectionSize(0) + header->sectionSize(1), list()->viewport()->width());
    const auto* frame = control<QGroupBox>(w, "fraSearch"); // margins of 8 pixels, no band
    const QRect inside = frame->parentWidget()->rect();
    EXPECT_EQ(QPoint(inside.right() - frame->geometry().right(),
                     inside.bottom() - frame->geometry().bottom()),
              QPoint(8, 8));

    const auto closed = [this] {
        window->close();
        QStringList values;
        for (const char* key : {"max", "top", "left", "height", "width"})
            values << stored(key, "winpos");
        return values.join(' ');
    };
    EXPECT_EQ(closed(), "False 900 1500 7950 4800");
    EXPECT_EQ(stored("top", "setpos"), "<missing>"); // the settings window was never built
    reload().showMaximized();
    QCoreApplication::processEvents(); // the window takes the screen's size
    EXPECT_EQ(closed(), "True 900 1500 7950 4800");
    EXPECT_TRUE(reload().isMaximized()); // as it was left
    window->showNormal();
    window->resize(600, 600);
    window->showMinimized();
    EXPECT_EQ(closed(), "True 900 1500 7950 4800");
    // A place off every screen opens on the main one and stays stored until the user moves.
    fake.store.SaveSetting("winpos", "max", "False");
    fake.store.SaveSetting("winpos", "left", "450000");
    EXPECT_TRUE(QGuiApplication::primaryScreen()->availableGeometry().contains(reload().pos()));
    EXPECT_EQ(closed(), "False 900 450000 7950 4800");

    reload();
    const char* const cases[][3] = {
        {"", "mnuAboutz26Readme", "Error | Error loading README.TXT | Ok | Exclamation"},
        {"emu/Z26", "mnuAboutz26Readme", "open ~/emu/README.TXT"},
        {"emu", "mnuAboutz26Readme", "open ~/emu/README.TXT"},
        {"emu", "mnuAboutCopying", "open ~/emu/copying.txt"}};
    for (const auto& [z26, item, outcome] : cases) {
        set("Z26Path", *z26 ? fake.root() + "/" + z26 : "");
        action(item)->trigger();
        EXPECT_EQ(happened(), outcome) << z26 << ' ' << item;
    }
    fake.shell.succeed = false; // the editor could not be started
    action("mnuAboutCopying")->trigger();
    EXPECT_EQ(happened(),
              "open ~/emu/copying.txt\nError | Error loading COPYING.TXT | Ok | Exclamation");
    for (const char* item : {"mnuAboutz26HomePage", "mnuAboutlumHomePage", "mnuFileSaveSettings",
                             "mnuFileLoadSettings", "mnuSettingsConfiguration", "mnuAboutlumAbout",
                             "mnuAboutlumAbout"}) // one About window, brought to the front
        action(item)->trigger();
    const QStringList seen = happened().split('\n');
    EXPECT_TRUE(seen.size() == 4 && seen[0] != seen[1] && seen.filter("open https://").size() == 2)
        << seen.join(' ').toStdString();
    EXPECT_EQ(seen.mid(2), QStringList({"about", "page Settings"}));
    const auto& asked = fake.dialogs.fileRequests; // Save's, then Load's: both cancelled
    EXPECT_TRUE(asked.size() == 2 && asked[0].save && !asked[1].save);
    settings().move(200, 80);
    action("mnuFileExit")->trigger();
    EXPECT_EQ(happened() + (window->isVisible() ? "main" : ""), "");
    EXPECT_EQ(stored("left", "setpos") + ' ' + stored("top", "setpos"), "3000 1200");
}
