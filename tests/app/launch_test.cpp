#include "AppFixture.h"
#include "support/Boxes.h"

#include "library/RomListModel.h"
#include "platform/QtShell.h"
#include "platform/SettingsStore.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>
#include <QTest>

#include <gtest/gtest.h>

namespace {

// The options of the usual example: its switches are -)JS -(PC -c1 -g2 -p6 -M0 -s4000.
void setExampleOptions(frmSettings& s) {
    s.comboLeftController->setCurrentIndex(1);
    s.comboRightController->setCurrentIndex(2);
    s.optCPPAL->click();
    s.comboGT->setCurrentIndex(2);
    s.BarColorSoundQueue->setValue(4000);
    s.chkMouseCapture->setChecked(false);
    s.BarColorPaddle->setValue(6);
}

const QStringList kExampleSwitches = {"-)JS", "-(PC", "-c1", "-g2", "-p6", "-M0", "-s4000"};

void doubleClickRow(frmMain& w, int row) {
    const QPoint at = w.vbalListViewCtl1->visualRect(w.listModel().index(row, 0)).center();
    QTest::mouseClick(w.vbalListViewCtl1->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(w.vbalListViewCtl1->viewport(), Qt::LeftButton, {}, at);
}

class Launch : public ::testing::Test {
protected:
    void SetUp() override {
        emulatorFolder = app.fake.makeFolder("emu");
        emulator = app.fake.writeFile("emu/z26");
        app.fake.store.SaveSetting("Settings", "Z26Path", emulatorFolder);
        app.fake.store.SaveSetting("Settings", "ROMFilter", "*.bin");
        roms = app.romFolder("my roms", {"Pitfall!.bin", "Space Invaders.bin"});
        app.storeFolder(1, roms);
        app.load();
        app.window->vbalListViewCtl1->setCurrentIndex(app.window->listModel().index(1, 0));
    }
    frmMain& w() { return *app.window; }
    frmSettings& s() { return app.window->settingsWindow(); }
    QString rom() const { return QDir::cleanPath(roms + "/Space Invaders.bin"); }
    const std::vector<FakeShell::Start>& started() const { return app.fake.shell.started; }
    const std::vector<FakeDialogs::Box>& boxes() const { return app.fake.dialogs.boxes; }

    AppFixture app;
    QString emulatorFolder, emulator, roms;
};

TEST_F(Launch, TheExampleStartsTheEmulatorOnTheRomWithItsSwitches) {
    setExampleOptions(s());
    w().LoadROM();
    ASSERT_EQ(started().size(), 1u);
    EXPECT_EQ(started()[0].program, QDir::cleanPath(emulator));
    EXPECT_EQ(started()[0].arguments, QStringList{rom()} + kExampleSwitches);
    EXPECT_TRUE(started()[0].workingFolder.isEmpty());
    EXPECT_TRUE(boxes().empty());
    EXPECT_EQ(s().lblDOSOutput->text(), " -)JS -(PC -c1 -g2 -p6 -M0 -s4000");
    EXPECT_EQ(s().lblDOSOutput->toolTip(), s().lblDOSOutput->text());

    // Double-click and Enter on the list launch too; nothing tracks the emulators started.
    doubleClickRow(w(), 0);
    QTest::keyClick(w().vbalListViewCtl1, Qt::Key_Return);
    ASSERT_EQ(started().size(), 3u);
    EXPECT_EQ(started()[1].arguments.value(0), QDir::cleanPath(roms + "/Pitfall!.bin"));
    EXPECT_EQ(started()[2].arguments.value(0), QDir::cleanPath(roms + "/Pitfall!.bin"));
}

TEST_F(Launch, TheEmulatorPathMayNameTheFolderOrTheProgram) {
    for (const QString& stored : {emulatorFolder + u'/', emulator}) {
        app.fake.store.SaveSetting("Settings", "Z26Path", stored);
        w().LoadROM();
        ASSERT_FALSE(started().empty());
        EXPECT_EQ(started().back().program, QDir::cleanPath(emulator)) << qPrintable(stored);
    }
}

// The emulator path in bad shapes is checked with the other bad input.
TEST_F(Launch, AFailedStartOrNoSelectionEndsQuietlyAndAVanishedRomIsReported) {
    app.fake.shell.succeed = false;
    w().LoadROM();
    app.fake.shell.succeed = true;
    w().vbalListViewCtl1->selectionModel()->clear();
    w().LoadROM();
    EXPECT_TRUE(boxes().empty());
    EXPECT_EQ(started().size(), 1u);

    w().vbalListViewCtl1->setCurrentIndex(w().listModel().index(1, 0));
    ASSERT_TRUE(QFile::remove(rom()));
    w().LoadROM();
    EXPECT_EQ(boxLines(app.fake.dialogs),
              Lines{"Invalid ROM Path | ROM path isn't valid.\n\nTry removing the ROM paths and "
                    "re-adding them to correct the problem. | Ok | Exclamation"});
    EXPECT_EQ(started().size(), 1u);
}

TEST_F(Launch, WithoutAnActiveControllerOnlyYesGoesOn) {
    s().comboLeftController->setCurrentIndex(12); // no controller on either port
    s().comboRightController->setCurrentIndex(12);
    const std::pair<MsgResult, size_t> answers[] = {
        {MsgResult::No, 0}, {MsgResult::Cancel, 0}, {MsgResult::Yes, 1}};
    for (const auto& [answer, expectedStarts] : answers) {
        s().hide();
        s().SelectTab(QStringLiteral("Settings"));
        app.fake.dialogs.answers.push_back(answer);
        w().LoadROM();
        EXPECT_EQ(started().size(), expectedStarts);
        if (answer == MsgResult::Yes)
            break;
        EXPECT_TRUE(s().isVisible());
        EXPECT_EQ(s().SelectedTabKey(), "Controls");
        BalloonTip* tip = cTextBoxXP::shownOn(s().txtIPC4Balloon);
        ASSERT_NE(tip, nullptr);
        EXPECT_EQ(tip->icon(), 1);
        EXPECT_EQ(tip->title(), "There Are No Active Controllers");
        EXPECT_EQ(
            tip->text(),
            "Allowing at least one controller to be\r\nactive will make gameplay much easier.");
        tip->close();
    }
    const std::string question =
        "There Are No Active Controllers | It's going to be difficult playing the game\nwith all "
        "the available Controllers inactive\n\nDo you still want to load the ROM? | YesNoCancel | "
        "Information";
    EXPECT_EQ(boxLines(app.fake.dialogs), (Lines{question, question, question}));

    // Keypads leave the keyboard only: a grayed box keeps it active, a checked one not.
    s().comboLeftController->setCurrentIndex(3);
    s().comboRightController->setCurrentIndex(3);
    s().chkIPCKeyboard->setCheckState(Qt::PartiallyChecked);
    w().LoadROM();
    EXPECT_EQ(boxes().size(), 3u);
    s().chkIPCKeyboard->setCheckState(Qt::Checked);
    w().LoadROM();
    EXPECT_EQ(boxes().size(), 4u);
}

TEST_F(Launch, ZeroNumbersStopTheLaunchAfterTheControllerQuestion) {
    s().comboLeftController->setCurrentIndex(12);
    s().comboRightController->setCurrentIndex(12);
    s().chkLowerSens->setChecked(true);
    s().txtLowerSens->setText(QStringLiteral("0"));
    s().optFPScustom->click(); // empty: zero too
    const std::pair<const char*, QLineEdit*> checks[] = {{"PaddlesAudio", s().txtLowerSens},
                                                         {"Video", s().txtFPScustom}};
    for (const auto& [tab, field] : checks) {
        app.fake.dialogs.answers.push_back(MsgResult::Yes);
        w().LoadROM();
        EXPECT_TRUE(started().empty());
        EXPECT_EQ(boxes().back().title, "There Are No Active Controllers");
        EXPECT_EQ(s().SelectedTabKey(), tab);
        BalloonTip* tip = cTextBoxXP::shownOn(field);
        ASSERT_NE(tip, nullptr) << tab;
        EXPECT_EQ(tip->icon(), 3);
        EXPECT_EQ(tip->title(), "Zero Value");
        EXPECT_EQ(tip->text(), "Number Cannot Be Zero");
        s().chkLowerSens->setCheckState(Qt::PartiallyChecked); // grayed: not checked
    }
    s().txtFPScustom->setText(QStringLiteral("30"));
    app.fake.dialogs.answers.push_back(MsgResult::Yes);
    w().LoadROM();
    ASSERT_EQ(started().size(), 1u);
    EXPECT_TRUE(started()[0].arguments.contains("-r30"));
}

TEST_F(Launch, EditSwitchesHandsTheSwitchesToTheUserFirst) {
    s().chkQuiet->setChecked(true);
    s().chkDOSSwitch->setChecked(true);
    w().LoadROM();
    EXPECT_TRUE(started().empty());
    EXPECT_TRUE(s().isVisible());
    EXPECT_EQ(s().SelectedTabKey(), "Debug");
    EXPECT_EQ(s().focusWidget(), s().txtDOSOutput);
    EXPECT_EQ(s().txtDOSOutput->text(),
              " -p" + QString::number(s().BarColorPaddle->Value()) + " -M1 -q");

    // Enter starts with the text as edited; an emptied box with the ROM alone.
    s().txtDOSOutput->setText(QStringLiteral("  -c2  -v13"));
    QTest::keyClick(s().txtDOSOutput, Qt::Key_Return);
    s().txtDOSOutput->clear();
    QTest::keyClick(s().txtDOSOutput, Qt::Key_Enter);
    ASSERT_EQ(started().size(), 2u);
    EXPECT_EQ(started()[0].arguments, QStringList({rom(), "-c2", "-v13"}));
    EXPECT_EQ(started()[1].arguments, QStringList({rom()}));

    // The forced launch checks the paths again.
    ASSERT_TRUE(QFile::remove(rom()));
    QTest::keyClick(s().txtDOSOutput, Qt::Key_Return);
    ASSERT_EQ(boxes().size(), 1u);
    EXPECT_EQ(boxes()[0].title, "Invalid ROM Path");
}

// The whole way: a double-click on a listed ROM starts a real program through the real
// shell, which writes down the arguments it was given.
TEST(LaunchEndToEnd, AStandInEmulatorReceivesExactlyThePreviewedArguments) {
    AppFixture app;
    const QString emulatorFolder = app.fake.makeFolder("z26 emu");
    const QString script = app.fake.writeFile(
        "z26 emu/z26", "#!/bin/sh\n"
                       "out=\"$(dirname \"$0\")/args.txt\"\n"
                       "for a in \"$@\"; do printf '%s\\n' \"$a\"; done > \"$out.tmp\"\n"
                       "mv \"$out.tmp\" \"$out\"\n");
    ASSERT_TRUE(QFile::setPermissions(script, QFile::permissions(script) | QFile::ExeOwner));
    app.fake.store.SaveSetting("Settings", "Z26Path", emulatorFolder);
    app.fake.store.SaveSetting("Settings", "ROMFilter", "*.bin");
    const QString name = QStringLiteral("River Raid (it's \"good\") $HOME.bin");
    const QString roms = app.romFolder("rom folder", {name});
    app.storeFolder(1, roms);

    QtShell shell;
    Platform platform{app.fake.store,           app.fake.dialogs, shell,
                      app.fake.programFolder(), app.fake.network, app.fake.registry};
    frmMain w(platform);
    w.Form_Load();
    w.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&w));
    setExampleOptions(w.settingsWindow());
    w.settingsWindow().RefreshOptionStates();
    const QString preview = w.settingsWindow().lblDOSOutput->text();
    EXPECT_EQ(preview, kExampleSwitches.join(u' '));

    ASSERT_EQ(w.listModel().rowCount(), 1);
    doubleClickRow(w, 0);
    QFile record(emulatorFolder + "/args.txt");
    for (int waited = 0; waited < 10000 && !record.exists(); waited += 50)
        QTest::qWait(50);
    ASSERT_TRUE(record.open(QIODevice::ReadOnly)) << "the stand-in emulator never ran";
    const QStringList arguments =
        QString::fromUtf8(record.readAll()).split(u'\n', Qt::SkipEmptyParts);
    EXPECT_EQ(arguments, QStringList{QDir::cleanPath(roms + u'/' + name)} + kExampleSwitches);
    EXPECT_EQ(arguments.mid(1).join(u' '), preview);
}

} // namespace
