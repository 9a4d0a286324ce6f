#include "AppFixture.h"

#include "platform/QtShell.h"

#include <QCheckBox>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QTest>

namespace {

const QString kRun = "~/emu/z26 ~/roms/Space Invaders.bin";
const QString kStart = kRun + " -p8 -M1"; // the options as the window starts
const QString kInvalidZ26 = "Invalid z26 Path | z26 path isn't valid.\n\nTry removing the z26 "
                            "path and re-adding it to correct the problem. | Ok | Exclamation";
const QString kInvalidRom = "Invalid ROM Path | ROM path isn't valid.\n\nTry removing the ROM "
                            "paths and re-adding them to correct the problem. | Ok | Exclamation";
const QString kNoControllers =
    "There Are No Active Controllers | It's going to be difficult playing the game\nwith all the "
    "available Controllers inactive\n\nDo you still want to load the ROM? | YesNoCancel | "
    "Information\nControls 1 | There Are No Active Controllers | Allowing at least one controller "
    "to be\r\nactive will make gameplay much easier.";

// A window listing two ROMs, the second selected, with the emulator in "emu".
class Launch : public AppFixture {
protected:
    void SetUp() override {
        storePaths({"Pitfall!.bin", "Space Invaders.bin"});
        load();
        selectRow(1);
    }
    // What the launches so far did, the temporary root written "~", one line each: every
    // program started with its arguments (and a working folder, had one been set), every
    // box, and the settings window's page, when it shows, with the balloon tip at `anchor`.
    // Then they are forgotten.
    QString outcome(const char* anchor = nullptr) {
        QStringList seen;
        for (const FakeShell::Start& start : fake.shell.started)
            seen << (QStringList{start.program} + start.arguments).join(' ') + start.workingFolder;
        for (const std::string& box : boxes())
            seen << QString::fromStdString(box);
        if (settings().isVisible())
            seen << settings().selectedPage() +
                        (anchor ? " " + QString::fromStdString(
                                            balloon(control<QLineEdit>(settings(), anchor)))
                                : QString());
        fake.shell.started.clear();
        fake.dialogs.boxes.clear();
        return seen.join('\n').replace(fake.root(), "~");
    }
};

} // namespace

// The stored emulator path names the folder or the program itself; one that leads nowhere
// is said, one that exists without leading to the program ends the launch without a word.
TEST_F(Launch, TheEmulatorPathInEveryShape) {
    fake.writeFile("emu/Z26");
    fake.makeFolder("other");
    fake.makeFolder("named/z26");
    const std::pair<const char*, QString> cases[] = {
        {"~/emu/", kStart},
        {"~/emu/z26", kStart},
        {"~/emu/Z26", "~/emu/Z26 ~/roms/Space Invaders.bin -p8 -M1"},
        {"", kInvalidZ26},
        {"\x01<?>|\n", kInvalidZ26},
        {"~/gone/z26", kInvalidZ26},
        {"~/other", ""}, // a folder without the program
        {"~/named", ""}, // a folder whose z26 is a folder
    };
    for (const auto& [stored, expected] : cases) {
        fake.store.SaveSetting("Settings", "Z26Path", QString(stored).replace("~", fake.root()));
        window->LoadROM();
        EXPECT_EQ(outcome(), expected) << stored;
    }
}

// Enter in the list starts the selected ROM; without a selection, or when the start fails,
// nothing is said; a ROM gone since the refresh is.
TEST_F(Launch, NoSelectionOrAFailedStartIsQuietAndAVanishedRomIsReported) {
    fake.shell.succeed = false;
    QTest::keyClick(list(), Qt::Key_Return);
    EXPECT_EQ(outcome(), kStart);
    fake.shell.succeed = true;
    list()->selectionModel()->clear();
    window->LoadROM();
    EXPECT_EQ(outcome(), "");
    selectRow(1);
    ASSERT_TRUE(QFile::remove(fake.root() + "/roms/Space Invaders.bin"));
    window->LoadROM();
    EXPECT_EQ(outcome(), kInvalidRom);
}

// No controller on either port, then a zero where a number is needed: the question comes
// first and only Yes goes on; each stop shows the page and the field to mend.
TEST_F(Launch, TheGuardsStopTheLaunchOnThePageToMend) {
    EmulatorOptions o;
    o.leftController = o.rightController = 12;
    o.lowerSensitivity = Check::On;
    o.lowerSensitivityBy = "0";
    o.frameRate = FrameRate::Custom; // left empty: zero too
    const QString zero = " 3 | Zero Value | Number Cannot Be Zero";
    const QString question = kNoControllers.section('\n', 0, 3);
    const struct {
        MsgResult answer;
        const char* anchor;
        QString outcome;
    } stops[] = {
        {MsgResult::No, "txtIPC4Balloon", kNoControllers},
        {MsgResult::Cancel, "txtIPC4Balloon", kNoControllers},
        {MsgResult::Yes, "txtLowerSens", question + "\nPaddlesAudio" + zero},
        {MsgResult::Yes, "txtFPScustom", question + "\nVideo" + zero},
    };
    for (const auto& stop : stops) {
        if (stop.anchor == std::string("txtFPScustom"))
            o.lowerSensitivity = Check::Grayed; // not checked
        settings().setOptions(o);
        settings().hide();
        settings().selectPage("Settings");
        fake.dialogs.answers = {stop.answer};
        window->LoadROM();
        EXPECT_EQ(outcome(stop.anchor), stop.outcome);
    }
    o.customFrameRate = "30";
    settings().setOptions(o);
    settings().hide();
    window->LoadROM(); // answered Yes
    EXPECT_EQ(outcome(), kRun + " -)NC -(NC -M1 -r30\n" + question);
}

// "Edit Switches", as the user works it: the launch hands over the switches; Enter in the
// edit box starts with the text as edited, after checking the paths again.
TEST_F(Launch, EditSwitchesHandsTheSwitchesToTheUserFirst) {
    EmulatorOptions options;
    options.quiet = Check::On;
    settings().setOptions(options);
    control<QCheckBox>(settings(), "chkDOSSwitch")->click();
    auto* edit = control<QLineEdit>(settings(), "txtDOSOutput");
    window->LoadROM();
    EXPECT_EQ(outcome(), "Debug");
    EXPECT_EQ(settings().focusWidget(), edit);
    EXPECT_EQ(edit->text(), " -p8 -M1 -q");

    edit->setText("  -c2  -v13");
    QTest::keyClick(edit, Qt::Key_Return);
    edit->clear();
    QTest::keyClick(edit, Qt::Key_Enter);
    EXPECT_EQ(outcome(), kRun + " -c2 -v13\n" + kRun + "\nDebug");
    ASSERT_TRUE(QFile::remove(fake.root() + "/roms/Space Invaders.bin"));
    QTest::keyClick(edit, Qt::Key_Return);
    EXPECT_EQ(outcome(), kInvalidRom + "\nDebug");
}

// The whole way, with the usual example of options: a double-click on a listed ROM starts
// a real program through the real shell, which writes down the arguments it was given.
TEST_F(AppFixture, AStandInEmulatorReceivesExactlyThePreviewedArguments) {
    const QString script = fake.writeFile(
        "z26 emu/z26", "#!/bin/sh\n"
                       "out=\"$(dirname \"$0\")/args.txt\"\n"
                       "for a in \"$@\"; do printf '%s\\n' \"$a\"; done > \"$out.tmp\"\n"
                       "mv \"$out.tmp\" \"$out\"\n");
    ASSERT_TRUE(QFile::setPermissions(script, QFile::permissions(script) | QFile::ExeOwner));
    fake.store.SaveSetting("Settings", "Z26Path", fake.root() + "/z26 emu");
    const QString name = "River Raid (it's \"good\") $HOME.bin";
    storeFolder(1, romFolder("rom folder", {name}));
    QtShell shell;
    Platform platform{fake.store,           fake.dialogs, shell,
                      fake.programFolder(), fake.network, fake.registry};
    frmMain w(platform);
    w.Form_Load();
    w.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&w));
    EmulatorOptions o;
    o.leftController = 1;  // Joystick
    o.rightController = 2; // Paddle Controller
    o.palette = Palette::Pal;
    o.gameType = 2;
    o.soundQueue = 4000;
    o.mouseCapture = Check::Off;
    o.paddleSensitivity = 6;
    w.settingsWindow().setOptions(o);

    auto* list = control<ListView>(w, "vbalListViewCtl1");
    const QPoint at = list->visualRect(w.listModel().index(0, 0)).center();
    QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(list->viewport(), Qt::LeftButton, {}, at);
    QFile record(fake.root() + "/z26 emu/args.txt");
    for (int waited = 0; waited < 10000 && !record.exists(); waited += 50)
        QTest::qWait(50);
    ASSERT_TRUE(record.open(QIODevice::ReadOnly)) << "the stand-in emulator never ran";
    EXPECT_EQ(QString::fromUtf8(record.readAll()).split(u'\n', Qt::SkipEmptyParts),
              QStringList({fake.root() + "/rom folder/" + name, "-)JS", "-(PC", "-c1", "-g2", "-p6",
                           "-M0", "-s4000"}));
    const QLabel* preview = control<QLabel>(w.settingsWindow(), "lblDOSOutput");
    EXPECT_EQ(preview->text(), " -)JS -(PC -c1 -g2 -p6 -M0 -s4000");
    EXPECT_EQ(preview->toolTip(), preview->text());
}
