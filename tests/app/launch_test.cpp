#include "AppFixture.h"

#include "app/CommandLine.h"
#include "emulator/OptionFile.h"
#include "library/GameDatabase.h"
#include "platform/QtShell.h"
#include "platform/WebAddresses.h"
#include "support/Archives.h"

#include <QMimeData>

#include <fcntl.h>
#include <unistd.h>

// A path leading nowhere is said, and so is a z26 that cannot start; no selection is not. z26
// runs in its own folder.
TEST_F(MainWindow, ChecksThePathsAndTheOptionsThenStartsTheEmulator) {
    storePaths({"River Raid.bin", "Space Invaders.bin"});
    fake.makeFolder("named/z26");
    load().LoadROM(); // nothing selected yet
    EXPECT_EQ(happened(), "");
    list()->setCurrentIndex(window->listModel().index(1, 0));
    const QString run = "~/emu/z26 ~/roms/Space Invaders.bin";
    const QString failed = "\nLaunch Failed | z26 could not be started:\n\n~/";
    const std::pair<const char*, QString> paths[] = {
        {"", "Invalid z26 Path | z26 path isn't valid.\n\nTry removing the z26 path and "
             "re-adding it to correct the problem. | Ok | Exclamation"},
        {"/named", failed.mid(1) + "named/z26\n\nThere is no program file there. | Ok | Critical"},
        {"/emu",
         run + " -p8 -M1 in ~/emu" + failed + "emu/z26\n\nPermission denied | Ok | Critical"}};
    for (const auto& [path, outcome] : paths) {
        set("Z26Path", *path ? fake.root() + path : "");
        fake.shell.succeed = false;
        QTest::keyClick(list(), Qt::Key_Return);
        EXPECT_EQ(happened(), outcome) << path;
    }

    // No controller, then a zero: only Yes goes on; a stop shows where to mend.
    EmulatorOptions o;
    o.leftController = o.rightController = 12;
    o.lowerSensitivity = Check::On;
    const QString question = "There Are No Active Controllers | It's going to be difficult "
                             "playing the game\nwith all the available Controllers inactive\n\n"
                             "Do you still want to load the ROM? | YesNoCancel | Information";
    const QString noControllers =
        question + "\npage Controls\ntip txtIPC4Balloon 1 | There Are No Active Controllers | "
                   "Allowing at least one controller to be\r\nactive will make gameplay much "
                   "easier.";
    using enum MsgResult;
    const std::tuple<MsgResult, const char*, QString> answers[] = {
        {No, "0", noControllers},
        {Cancel, "0", noControllers},
        {Yes, "0",
         question + "\npage PaddlesAudio\ntip txtLowerSens 3 | Zero Value | Number Cannot Be Zero"},
        {Yes, "2", run + " -)NC -(NC -P2 -M1 in ~/emu\n" + question}};
    for (const auto& [answer, sensitivity, outcome] : answers) {
        o.lowerSensitivityBy = sensitivity;
        settings().setOptions(o);
        settings().hide();
        settings().selectPage("Settings");
        fake.dialogs.answers = {answer};
        window->LoadROM();
        EXPECT_EQ(happened(), outcome) << sensitivity;
    }

    // "Edit Switches": Enter starts with the text as edited, the paths checked again.
    control<QCheckBox>(settings(), "chkDOSSwitch")->click();
    auto* edit = control<QLineEdit>(settings(), "txtDOSOutput");
    window->LoadROM();
    EXPECT_EQ(happened() + " |" + edit->text(), question + "\npage Debug | -)NC -(NC -P2 -M1");
    EXPECT_EQ(settings().focusWidget(), edit);
    edit->setText("  -c2  -v13");
    QTest::keyClick(edit, Qt::Key_Enter);
    EXPECT_EQ(happened(), run + " -c2 -v13 in ~/emu\n" + question + "\npage Debug");
    ASSERT_TRUE(QFile::remove(fake.root() + "/roms/Space Invaders.bin"));
    QTest::keyClick(edit, Qt::Key_Return);
    EXPECT_EQ(happened(),
              "Invalid ROM Path | ROM path isn't valid.\n\nTry removing the ROM paths "
              "and re-adding them to correct the problem. | Ok | Exclamation\npage Debug");

    // The whole way, by a real shell; written aside first, never read half written.
    const QString z26 = fake.writeFile(
        "emu/z26", "#!/bin/sh\nprintf '%s\\n' \"$@\" > \"$0.tmp\" && mv \"$0.tmp\" \"$0.txt\"\n");
    // A name that is not UTF-8 (listed first) is shown readably and given to z26 as it is, as
    // one argument whatever it holds.
    const QByteArray name = "Caf\xE9 (it's \"good\") $HOME.bin";
    ::close(::creat(QFile::encodeName(fake.root()) + "/roms/" + name, 0644));
    QtShell os;
    Platform real = fake.with(os);
    window = std::make_unique<frmMain>(real);
    const QPoint at = list()->visualRect(load().listModel().index(0, 0)).center();
    QTest::mouseClick(list()->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(list()->viewport(), Qt::LeftButton, {}, at); // not yet a program
    EXPECT_TRUE(happened().contains(failed.mid(1) + "emu/z26\n\n")) << happened().toStdString();
    ASSERT_TRUE(QFile::setPermissions(z26, QFile::permissions(z26) | QFile::ExeOwner));
    QTest::mouseDClick(list()->viewport(), Qt::LeftButton, {}, at);
    EXPECT_TRUE(QTest::qWaitFor([&] { return QFile::exists(z26 + ".txt"); }, 10000)); // it ran
    EXPECT_EQ(fileBytes(z26 + ".txt"), (fake.root() + "/roms/").toUtf8() + name + "\n-p8\n-M1\n");
    EXPECT_EQ(window->listModel().index(0, 0).data(), "Café (it's \"good\") $HOME.bin");
    window.reset(); // before the shell and platform it uses, even when a check failed
}

// What each command line asks for: a ROM file by its absolute path, a file that cannot be
// opened named with the reason.
TEST(CommandLine, TellsWhatToDoAndWhyNot) {
    FakePlatform fake;
    const QString rom = fake.writeFile("River Raid.a26");
    const QString was = QDir::currentPath();
    QDir::setCurrent(fake.root());
    using enum CommandLine::Mode;
    const std::tuple<QStringList, CommandLine::Mode, QString> cases[] = {
        {{}, Window, ""},
        {{"--version"}, Print, "lum 1.1.12\n"},
        {{"--help"}, Print, "Usage: lum [options] [FILE]\nA front end for the z26"},
        {{"River Raid.a26"}, Launch, "~/River Raid.a26"},
        {{"gone.bin"},
         Refuse,
         "The ROM file cannot be opened:\n\n~/gone.bin\n\nThere is no such "
         "file."},
        {{"."}, Refuse, "The ROM file cannot be opened:\n\n~\n\nIt is a folder, not a file."},
        {{"-x", rom}, Fail, "lum: Unknown option 'x'.\nUsage: lum [options] [FILE]\n"}};
    for (const auto& [arguments, mode, text] : cases) {
        const CommandLine command = parseCommandLine(QStringList("lum") + arguments);
        const QString said = QString(command.text + command.romPath).replace(fake.root(), "~");
        EXPECT_EQ(std::tuple(command.mode, command.exitStatus, said.left(text.size())),
                  std::tuple(mode, mode == Refuse || mode == Fail ? 1 : 0, text))
            << arguments.join(' ').toStdString();
    }
    QDir::setCurrent(was);
}

// A ROM named on the command line, dropped on the list or chosen from Recent ROMs starts as a
// double-click does, and goes on top of Recent ROMs. The command line shows no main window, and
// says in a box what a double-click would show on the settings window.
TEST_F(MainWindow, StartsCommandLineDroppedAndRecentRoms) {
    storePaths({"a.bin", "b.bin"});
    EmulatorOptions o;
    o.lowerSensitivity = Check::On;
    o.lowerSensitivityBy = "2";
    fake.writeFile("config/lum/Default.lum", encodeOptions(o));
    const auto commandLine = [&](const QString& file) {
        window = std::make_unique<frmMain>(fake.platform);
        const auto status = window->startFromCommandLine(parseCommandLine({"lum", file}));
        return QString::number(status.value_or(-1)) + (window->isVisible() ? " shown\n" : "\n") +
               happened();
    };
    EXPECT_EQ(commandLine(fake.root() + "/roms/b.bin"),
              "0\n~/emu/z26 ~/roms/b.bin -p8 -P2 -M1 in ~/emu");
    EXPECT_EQ(commandLine(fake.root() + "/gone.bin"),
              "1\nlum | The ROM file cannot be opened:\n\n~/gone.bin\n\nThere is no such file. | "
              "Ok | Exclamation");
    o.lowerSensitivityBy = "0";
    fake.writeFile("config/lum/Default.lum", encodeOptions(o));
    EXPECT_EQ(
        commandLine(fake.root() + "/roms/a.bin"),
        "1\nZero Value | The ROM was not started:\n\n~/roms/a.bin\n\nNumber Cannot Be Zero\n\n"
        "Mend it on the page \"Paddles / Audio\" of lum's Settings, Configuration, and save "
        "the options as Default.lum. | Ok | Exclamation");

    const auto recent = [this] {
        QStringList items;
        for (QAction* item : control<QMenu>(*window, "mnuFileRecent")->actions())
            items << item->text() + (item->isEnabled() ? "" : " off") + ' ' + item->statusTip();
        return items.join(" | ").replace(QDir::toNativeSeparators(fake.root()), "~");
    };
    fake.writeFile("config/lum/Default.lum", encodeOptions(EmulatorOptions()));
    reload();
    QMimeData data; // the first file, the folder passed over
    data.setUrls({QUrl::fromLocalFile(fake.root() + "/roms"),
                  QUrl::fromLocalFile(fake.root() + "/roms/a.bin"),
                  QUrl::fromLocalFile(fake.root() + "/roms/b.bin")});
    QDropEvent drop(QPointF(5, 5), Qt::CopyAction, &data, Qt::LeftButton, {});
    QDragEnterEvent enter(QPoint(5, 5), Qt::CopyAction, &data, Qt::LeftButton, {});
    QApplication::sendEvent(list()->viewport(), &enter);
    QApplication::sendEvent(list()->viewport(), &drop);
    EXPECT_EQ(happened(), "~/emu/z26 ~/roms/a.bin -p8 -M1 in ~/emu");
    EXPECT_EQ(recent(), "a.bin ~/roms | b.bin ~/roms |   | &Clear List ");
    ASSERT_TRUE(QFile::remove(fake.root() + "/roms/a.bin"));
    emit control<QMenu>(*window, "mnuFileRecent")->aboutToShow();
    action("mnuFileRecentROM2")->trigger();
    EXPECT_EQ(happened(), "~/emu/z26 ~/roms/b.bin -p8 -M1 in ~/emu");
    EXPECT_EQ(recent(), "b.bin ~/roms | a.bin off ~/roms |   | &Clear List ");
    action("mnuFileRecentClear")->trigger();
    EXPECT_EQ(recent() + stored("ROM1", "Recent"), "  | &Clear List off <missing>");
}

// A listed archive starts z26 on its first file, extracted into a private folder that goes with
// the window; Game Info knows that file (57: its CRC-32). An archive that gives no ROM says why.
TEST_F(MainWindow, StartsAndIdentifiesTheFirstFileOfAnArchive) {
    set("ROMFilter", "*.bin;*.zip");
    storePaths({"a.bin", "bad.zip", "good.zip"});
    writeArchive(fake.root() + "/roms/good.zip", "zip", {{"../Known.bin", "123456789"}});
    fake.writeFile("program/CRCID.dat", encodeGameDatabase({{57, {}, qint32(0xCBF43926u)}}));
    load();
    list()->setCurrentIndex(window->listModel().index(2, 0));
    window->LoadROM();
    action("mnuMainGameInfo")->trigger();
    const QString folder = folderEntries(fake.platform.runtimeFolder).join(' ');
    EXPECT_EQ(happened(), "~/emu/z26 ~/run/lum/" + folder + "/Known.bin -p8 -M1 in ~/emu\nopen " +
                              web::kGameInfoSite + "/software_page.html?SoftwareID=57");
    EXPECT_EQ((QFile::permissions(fake.platform.runtimeFolder) & 0x77).toInt(), 0); // group, other
    window->launchRom(fake.root() + "/roms/bad.zip", false);                        // an empty file
    EXPECT_EQ(happened(), "Archive Not Usable | No ROM could be taken from the archive:\n\n"
                          "~/roms/bad.zip\n\nIt is damaged or is not a zip, 7z or gzip file "
                          "(Unrecognized archive format). | Ok | Exclamation");
    window.reset();
    EXPECT_EQ(folderEntries(fake.platform.runtimeFolder).join(' '), "");
}
