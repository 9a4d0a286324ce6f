#include "AppFixture.h"

#include "platform/QtShell.h"

#include <QCheckBox>

using Launch = AppFixture;

// A path leading nowhere is said; no program there, no selection, a failed start are not.
TEST_F(Launch, ChecksThePathsAndTheOptionsThenStartsTheEmulator) {
    const QString name = "River Raid (it's \"good\") $HOME.bin"; // one argument, as it is
    storePaths({name, "Space Invaders.bin"});
    fake.writeFile("emu/Z26");
    fake.makeFolder("named/z26");
    load();
    window->LoadROM(); // nothing selected yet
    EXPECT_EQ(happened(), "");
    selectRow(1);
    const QString run = "~/emu/z26 ~/roms/Space Invaders.bin";
    const std::pair<const char*, QString> paths[] = {
        {"/emu/Z26", "~/emu/Z26 ~/roms/Space Invaders.bin -p8 -M1"}, // no z26 added
        {"", "Invalid z26 Path | z26 path isn't valid.\n\nTry removing the z26 path and "
             "re-adding it to correct the problem. | Ok | Exclamation"},
        {"/named", ""}, // a folder whose z26 is a folder
        {"/emu", run + " -p8 -M1"},
    };
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
    o.lowerSensitivityBy = "0";
    settings().setOptions(o);
    const QString question = "There Are No Active Controllers | It's going to be difficult "
                             "playing the game\nwith all the available Controllers inactive\n\n"
                             "Do you still want to load the ROM? | YesNoCancel | Information";
    const QString noControllers =
        question + "\npage Controls\ntip txtIPC4Balloon 1 | There Are No Active Controllers | "
                   "Allowing at least one controller to be\r\nactive will make gameplay much "
                   "easier.";
    const std::pair<MsgResult, QString> answers[] = {
        {MsgResult::No, noControllers},
        {MsgResult::Cancel, noControllers},
        {MsgResult::Yes,
         question + "\npage PaddlesAudio\ntip txtLowerSens 3 | Zero Value | Number Cannot Be Zero"},
    };
    for (const auto& [answer, outcome] : answers) {
        settings().hide();
        settings().selectPage("Settings");
        fake.dialogs.answers = {answer};
        window->LoadROM();
        EXPECT_EQ(happened(), outcome);
    }
    o.lowerSensitivityBy = "2";
    settings().setOptions(o);
    settings().hide();
    window->LoadROM(); // answered Yes
    EXPECT_EQ(happened(), run + " -)NC -(NC -P2 -M1\n" + question);

    // "Edit Switches": Enter starts with the text as edited, the paths checked again.
    control<QCheckBox>(settings(), "chkDOSSwitch")->click();
    auto* edit = control<QLineEdit>(settings(), "txtDOSOutput");
    window->LoadROM();
    EXPECT_EQ(happened() + " |" + edit->text(), question + "\npage Debug | -)NC -(NC -P2 -M1");
    EXPECT_EQ(settings().focusWidget(), edit);
    edit->setText("  -c2  -v13");
    QTest::keyClick(edit, Qt::Key_Enter);
    EXPECT_EQ(happened(), run + " -c2 -v13\n" + question + "\npage Debug");
    ASSERT_TRUE(QFile::remove(fake.root() + "/roms/Space Invaders.bin"));
    QTest::keyClick(edit, Qt::Key_Return);
    EXPECT_EQ(happened(),
              "Invalid ROM Path | ROM path isn't valid.\n\nTry removing the ROM paths "
              "and re-adding them to correct the problem. | Ok | Exclamation\npage Debug");

    // The whole way, by a real shell; written aside first, never read half written.
    const QString script = fake.writeFile(
        "emu/z26", "#!/bin/sh\nprintf '%s\\n' \"$@\" > \"$0.tmp\" && mv \"$0.tmp\" \"$0.txt\"\n");
    ASSERT_TRUE(QFile::setPermissions(script, QFile::permissions(script) | QFile::ExeOwner));
    QtShell shell;
    Platform platform{fake.store,           fake.dialogs, shell,
                      fake.programFolder(), fake.network, fake.registry};
    frmMain w(platform);
    w.Form_Load();
    w.show();
    auto* view = control<ListView>(w, "vbalListViewCtl1");
    const QPoint at = view->visualRect(w.listModel().index(0, 0)).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
    QFile record(script + ".txt");
    for (int waited = 0; waited < 10000 && !record.exists(); waited += 50)
        QTest::qWait(50);
    ASSERT_TRUE(record.open(QIODevice::ReadOnly)) << "the stand-in emulator never ran";
    EXPECT_EQ(QString::fromUtf8(record.readAll()), fake.root() + "/roms/" + name + "\n-p8\n-M1\n");
}
