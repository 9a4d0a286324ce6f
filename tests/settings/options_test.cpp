#include "support/FakePlatform.h"

#include "settings/SwitchRules.h"
#include "settings/frmSettings.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFocusEvent>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

#include <cstring>

namespace {

// The option controls, the switch builders that read them and the refresh that keeps the
// dependent controls and the preview of the switches in line.
class Options : public ::testing::Test {
protected:
    QString preview() const { return w.lblDOSOutput->text(); }
    bool previewHas(const char* sw) const {
        return preview().split(u' ').contains(QLatin1String(sw));
    }
    void showActive() {
        w.show();
        w.activateWindow();
        ASSERT_TRUE(QTest::qWaitForWindowActive(&w));
    }
    void pickVideoMode(int index) {
        w.comboVideoMode->setCurrentIndex(index);
        emit w.comboVideoMode->activated(index);
    }

    FakePlatform fake;
    frmSettings w{fake.platform};
};

TEST_F(Options, AtTheInitialStateOnlyPaddleSensitivityAndMouseCaptureSpeak) {
    EXPECT_EQ(preview(), "-p" + QString::number(w.BarColorPaddle->Value()) + " -M1");
    w.BarColorPaddle->setValue(9);
    w.chkMouseCapture->setChecked(false);
    EXPECT_EQ(w.LaunchSwitches(), " -p9 -M0");
    EXPECT_EQ(w.LaunchSwitches(), " -p9 -M0"); // nothing cached, nothing drifts
    for (auto retired : {&frmSettings::MindlinkLeft, &frmSettings::MindlinkRight,
                         &frmSettings::Joystick, &frmSettings::DrivCont, &frmSettings::KeyCont})
        EXPECT_EQ((w.*retired)(), "");
}

TEST_F(Options, ControllerListsGiveCodesLayoutCaptionsAndDevices) {
    const struct {
        const char* entry;
        const char* code;
        const char* layout;
        const char* devices;
    } table[] = {
        {"AutoDetect", "", "Standard", "kmjs"},
        {"Joystick", "JS", "Standard", "kmjs"},
        {"Paddle Controller", "PC", "Paddle", "kmjs"},
        {"Keypad", "KP", "Keyboard", "k"},
        {"Driving Controller", "DC", "Driving", "kmjs"},
        {"LightGun", "LG", "Standard", "m"},
        {"CompuMate Keyboard", "CM", "Keyboard", "k"},
        {"Kid Vid Tape Player", "KV", "Standard", "k"},
        {"Mindlink Controller", "ML", "Standard", "m"},
        {"ST Mouse / CX-80 Trak-Ball", "ST", "Standard", "m"},
        {"CX-22 Trak-Ball", "TB", "Standard", "m"},
        {"Amiga Mouse", "AM", "Standard", "m"},
        {"No Controller Connnected", "NC", "Standard", ""},
    };
    ASSERT_EQ(w.comboLeftController->count(), 13);
    for (int i = 0; i < 13; ++i) {
        const auto& row = table[i];
        for (const bool bLeft : {true, false}) {
            QComboBox* list = bLeft ? w.comboLeftController : w.comboRightController;
            QPushButton* picture = bLeft ? w.cmdLeftControlPic : w.cmdRightControlPic;
            EXPECT_EQ(list->itemText(i), row.entry);
            list->setCurrentIndex(i);
            picture->setText(QStringLiteral("stale"));
            const QString code = QLatin1String(row.code);
            EXPECT_EQ(bLeft ? w.LeftController() : w.RightController(),
                      code.isEmpty() ? QString() : QLatin1String(bLeft ? " -)" : " -(") + code);
            // Captioned even without a code.
            EXPECT_EQ(picture->text(), QLatin1String(row.layout) + " Control Layout");
            for (const char device : {'k', 'm', 'j', 's'})
                EXPECT_EQ(w.CheckIPC(bLeft, QString(QLatin1Char(device))),
                          std::strchr(row.devices, device) != nullptr)
                    << row.entry << ' ' << device;
        }
    }
    // Nothing selected: no code, caption and devices untouched.
    w.comboRightController->setCurrentIndex(-1);
    w.cmdRightControlPic->setText(QStringLiteral("kept"));
    EXPECT_EQ(w.RightController(), "");
    EXPECT_EQ(w.cmdRightControlPic->text(), "kept");
    EXPECT_FALSE(w.CheckIPC(false, QStringLiteral("k")));
    for (const char* other : {"K", "x", "", "km"})
        EXPECT_FALSE(w.CheckIPC(true, QLatin1String(other))) << other;
}

TEST_F(Options, GrayedBoxesCountUnlessExactlyCheckedIsAsked) {
    for (QCheckBox* box : {w.chkQuiet, w.chkSwapControl, w.chkMouseCapture, w.chkLowerSens})
        box->setCheckState(Qt::PartiallyChecked);
    EXPECT_EQ(w.Quiet(), " -q");
    EXPECT_EQ(w.MouseCapture(), " -M1");
    EXPECT_EQ(w.SwapControl(), "");
    EXPECT_EQ(w.LowerSens(), "");

    // Controllers are inactivated only by boxes exactly checked and enabled.
    for (QCheckBox* box : {w.chkIPCKeyboard, w.chkIPCMouse, w.chkIPCJoystick, w.chkIPCStella})
        box->setChecked(true);
    w.chkIPCKeyboard->setEnabled(false);
    EXPECT_EQ(w.IPC(), " -iMJS");
    w.chkIPCJoystick->setCheckState(Qt::PartiallyChecked); // re-derives: keyboard enabled
    EXPECT_EQ(w.IPC(), " -iKMS");
}

TEST_F(Options, OptionGroupsAndListsGiveTheirSwitch) {
    // The other groups' buttons: see EveryOptionControlRefreshesThePreview.
    for (const auto& [button, expected] : {std::pair{w.optJoyKey, " -j0"}, {w.optJoyRev, " -j2"}}) {
        button->setChecked(true);
        EXPECT_EQ(w.Joystick(), expected);
    }
    w.comboVideoMode->setCurrentIndex(3);
    EXPECT_EQ(w.VideoMode(), ""); // "Default" ignores the list
    w.optVMFull->setChecked(true);
    EXPECT_EQ(w.VideoMode(), " -v3");
    w.optVMWindow->setChecked(true);
    EXPECT_EQ(w.VideoMode(), " -v13");

    w.comboGT->setCurrentIndex(13);
    EXPECT_EQ(w.GameType(), " -g13");
    w.comboGT->setCurrentIndex(-1);
    EXPECT_EQ(w.GameType(), " -g-1");

    // Mouse paddles: {mouse 1's paddle, mouse 2's, switch}, -1 for "None".
    for (const auto& [m1, m2, expected] :
         {std::tuple{3, -1, " -m3"}, {-1, 2, " -m2"}, {0, 3, " -m103"}, {-1, -1, ""}}) {
        (m1 < 0 ? w.optPaddleM1None : w.optPaddleM1[m1])->setChecked(true);
        (m2 < 0 ? w.optPaddleM2None : w.optPaddleM2[m2])->setChecked(true);
        EXPECT_EQ(w.Paddle(), expected) << m1 << ' ' << m2;
    }
}

TEST_F(Options, NumberFieldsAreTidiedByEveryRefreshWhetherOrNotTheirSwitchIsOn) {
    w.chkLineScan->setChecked(true);
    for (const auto& [typed, tidy] :
         {std::pair{"0012", "12"}, {"", "0"}, {"2.50", "2.5"}, {"12abc", "12"}, {"abc", "0"}}) {
        w.txtScanLines->setText(QLatin1String(typed));
        EXPECT_EQ(w.ScanLines(), ""); // its box is off
        EXPECT_EQ(w.txtScanLines->text(), tidy);
        w.txtLineScan->setText(QLatin1String(typed));
        EXPECT_EQ(w.LineScan(), " -u" + QLatin1String(tidy));
        EXPECT_EQ(w.txtLineScan->text(), tidy);
    }
    // The light gun's fields are tidied even while its frame keeps them off the line.
    w.txtLightGunCycles->setText(QStringLiteral("03"));
    w.txtLightGunScan->setText(QString());
    EXPECT_EQ(w.LightGun(), "");
    EXPECT_EQ(w.txtLightGunCycles->text() + w.txtLightGunScan->text(), "30");
    w.comboLeftController->setCurrentIndex(5);
    EXPECT_EQ(w.LightGun(), " -l3 -a0");

    // Custom frame rate and lower sensitivity pass their text on untidied.
    w.optFPScustom->setChecked(true);
    for (const auto& [typed, expected] :
         {std::pair{" 60 ", " -r60"}, {"", " -r"}, {"5x", " -r5x"}}) {
        w.txtFPScustom->setText(QLatin1String(typed));
        EXPECT_EQ(w.FPS(), expected);
        EXPECT_EQ(w.txtFPScustom->text(), typed);
    }
    w.chkLowerSens->setChecked(true);
    w.txtLowerSens->setText(QStringLiteral("007"));
    EXPECT_EQ(w.LowerSens(), " -P7");
    EXPECT_EQ(w.txtLowerSens->text(), "007");
    w.txtLowerSens->clear();
    EXPECT_EQ(w.LowerSens(), "");
    EXPECT_EQ(w.txtLowerSens->text(), "");

    // Tidying rewrites the field once and the preview once; a refresh with nothing
    // changed rewrites nothing.
    w.chkScanLines->click();
    QSignalSpy fieldChanges(w.txtScanLines, &QLineEdit::textChanged);
    QSignalSpy previewChanges(w.txtDOSOutput, &QLineEdit::textChanged);
    w.txtScanLines->setText(QStringLiteral("0012"));
    EXPECT_EQ(fieldChanges.count(), 2); // as typed, then tidied
    EXPECT_EQ(previewChanges.count(), 1);
    EXPECT_TRUE(previewHas("-h12"));
    w.RefreshOptionStates();
    EXPECT_EQ(fieldChanges.count() + previewChanges.count(), 3);
}

TEST_F(Options, TheLaunchTakesItsBuildersInTheirFixedOrder) {
    w.comboLeftController->setCurrentIndex(1);
    w.comboRightController->setCurrentIndex(5);
    for (QCheckBox* box :
         {w.chkInterlaced, w.chkP0Hard, w.chkP1Hard, w.chkAllow4, w.chkBW, w.chkScanLines,
          w.chkIPCMouse, w.chkLowerSens, w.chkShowScanline, w.chkPALColorLoss, w.chkQuiet,
          w.chkLineScan, w.chkCodeTrace, w.chkSwapControl, w.chkPrintChecksum, w.chkFastCopy,
          w.chkSyncWSound, w.chkMindlinkLeft, w.chkDriveLeft})
        box->setChecked(true);
    for (QRadioButton* button : {w.optSCBMP, w.optCPSECAM, w.optDSPHigh, w.optNarrow2,
                                 w.optFPSmonitor, w.optVMFull, w.optPaddleM1[2], w.optJoyRev})
        button->setChecked(true);
    w.BarColorPhos->setValue(50);
    w.BarColorSoundQueue->setValue(4000);
    w.BarColorPaddle->setValue(6);
    w.comboGT->setCurrentIndex(4);
    EXPECT_EQ(w.LaunchSwitches(), " -)JS -(LG -! -0 -1 -4 -b -B -c2 -d2 -e2 -f50 -g4 -h0 -iM -p6 "
                                  "-P1 -m2 -M1 -l0 -a0 -n -o -q -s4000 -r -u0 -t -v0 -w -x -z -R");
}

TEST(SwitchRules, PlainRules) {
    EXPECT_EQ(switches::numberText(2.5), "2.5");
    EXPECT_EQ(switches::numberText(-0.0), "0");
    EXPECT_EQ(switches::numberText(123456789012), "123456789012");

    // Pairs combine bit by bit: a grayed box (2) does not meet a checked one (1).
    const struct {
        std::int16_t left, right;
        const char* expected;
    } pairs[] = {{0, 0, ""},     {1, 0, " -w1"}, {0, 1, " -w2"}, {1, 1, " -w3"},
                 {2, 1, " -w2"}, {1, 2, " -w2"}, {2, 2, " -w3"}, {2, 0, " -w1"}};
    for (const auto& p : pairs)
        EXPECT_EQ(switches::controllerPairSwitch(u'w', p.left, p.right), p.expected)
            << p.left << ' ' << p.right;

    EXPECT_EQ(switches::withoutLeadingBlank(QStringLiteral("  -c1")), " -c1");
    EXPECT_EQ(switches::emulatorArguments(QStringLiteral("/r/it's \"a b\".bin"),
                                          QStringLiteral("  -c1 \t-g2 ")),
              QStringList({"/r/it's \"a b\".bin", "-c1", "-g2"}));
    EXPECT_EQ(switches::emulatorArguments(QStringLiteral("/r/a"), QString()),
              QStringList({"/r/a"}));
}

TEST_F(Options, EveryOptionControlRefreshesThePreview) {
    const std::pair<QAbstractButton*, const char*> clicks[] = {
        {w.chkAllow4, "-4"},        {w.chkBW, "-b"},
        {w.chkCodeTrace, "-t"},     {w.chkFastCopy, "-z"},
        {w.chkInterlaced, "-!"},    {w.chkIPCJoystick, "-iJ"},
        {w.chkMouseCapture, "-M0"}, {w.chkP0Hard, "-0"},
        {w.chkP1Hard, "-1"},        {w.chkPALColorLoss, "-o"},
        {w.chkPrintChecksum, "-x"}, {w.chkQuiet, "-q"},
        {w.chkShowScanline, "-n"},  {w.chkSwapControl, "-w"},
        {w.chkSyncWSound, "-R"},    {w.chkScanLines, "-h0"},
        {w.chkLineScan, "-u0"},     {w.chkLowerSens, "-P1"},
        {w.optCPNTSC, "-c0"},       {w.optCPPAL, "-c1"},
        {w.optCPSECAM, "-c2"},      {w.optDSPLow, "-d1"},
        {w.optNarrow1, "-e1"},      {w.optSCBMP, "-B"},
        {w.optVMWindow, "-v10"},    {w.optFPSmonitor, "-r"},
        {w.optPaddleM1[3], "-m3"},  {w.optPaddleM2[1], "-m131"},
        {w.optCPDefault, "-m131"},
    };
    for (const auto& [control, sw] : clicks) {
        control->click();
        EXPECT_TRUE(previewHas(sw)) << qPrintable(control->objectName() + ": " + preview());
    }
    w.comboGT->setCurrentIndex(7);
    w.comboLeftController->setCurrentIndex(2);
    w.txtScanLines->setText(QStringLiteral("200"));
    for (const char* sw : {"-g7", "-)PC", "-h200"})
        EXPECT_TRUE(previewHas(sw)) << sw;
    EXPECT_FALSE(previewHas("-c2"));
    EXPECT_EQ(w.txtDOSOutput->text(), preview());

    // The retired controls react to nothing.
    const QString before = preview();
    for (QAbstractButton* retired : std::initializer_list<QAbstractButton*>{
             w.chkDriveLeft, w.chkKeyRight, w.chkLightGun, w.chkMindlinkLeft, w.optJoyKey})
        retired->click();
    EXPECT_EQ(preview(), before);
}

TEST_F(Options, ThePortsDecideTheLightGunAndWhichPcControllersCanBeInactivated) {
    // Ports, then whether the light gun frame shows and the boxes keyboard, mouse, joystick
    // and Stelladaptor can be used ("kmjs", "-" for a disabled box).
    const std::tuple<int, int, bool, const char*> table[] = {
        {3, 3, false, "k---"},   // Keypad on both ports
        {12, 12, false, "----"}, // no controller on either
        {0, 12, false, "kmjs"},  // AutoDetect on one port
        {11, 11, false, "-m--"}, // Amiga Mouse on both
        {3, 5, true, "km--"},    // Keypad, LightGun
        {0, 0, false, "kmjs"},   // back to AutoDetect: no light gun
    };
    w.chkIPCMouse->setChecked(true);
    for (const auto& [left, right, lightGun, boxes] : table) {
        w.comboLeftController->setCurrentIndex(left);
        w.comboRightController->setCurrentIndex(right);
        SCOPED_TRACE(testing::Message() << left << ' ' << right);
        QString enabled;
        for (const QCheckBox* box :
             {w.chkIPCKeyboard, w.chkIPCMouse, w.chkIPCJoystick, w.chkIPCStella})
            enabled += box->isEnabled() ? box->objectName().at(6).toLower() : u'-';
        EXPECT_EQ(enabled, boxes);
        EXPECT_TRUE(w.chkIPCMouse->isChecked()); // disabled, not cleared
        EXPECT_EQ(previewHas("-iM"), w.chkIPCMouse->isEnabled());
        EXPECT_EQ(!w.fraLightgun->isHidden() && w.fraLightgun->isEnabled(), lightGun);
        EXPECT_EQ(previewHas("-l0") && previewHas("-a0"), lightGun);
        EXPECT_EQ(preview().contains("-l") || preview().contains("-a"), lightGun);
        // No keyboard, no keyboard paddle.
        EXPECT_EQ(w.fraPaddleSens->isHidden(), !w.chkIPCKeyboard->isEnabled());
        EXPECT_EQ(preview().contains("-p"), w.chkIPCKeyboard->isEnabled());
    }
    w.chkIPCKeyboard->click();
    EXPECT_TRUE(w.fraPaddleSens->isHidden());
    EXPECT_FALSE(preview().contains("-p"));
    w.chkIPCKeyboard->setCheckState(Qt::PartiallyChecked); // only an exact check counts
    EXPECT_FALSE(w.fraPaddleSens->isHidden());
}

TEST_F(Options, NumberFieldsAreSwitchedOnFocusedAndTakeDigitsOnly) {
    showActive();
    // Each box or button enables its field and moves the focus into it.
    const std::tuple<QAbstractButton*, QLineEdit*, const char*> pairs[] = {
        {w.chkLineScan, w.txtLineScan, "Debug"},
        {w.chkScanLines, w.txtScanLines, "Video"},
        {w.chkLowerSens, w.txtLowerSens, "PaddlesAudio"},
        {w.optFPScustom, w.txtFPScustom, "Video"}};
    for (const auto& [control, field, tab] : pairs) {
        w.SelectTab(QLatin1String(tab));
        control->click();
        EXPECT_TRUE(field->isEnabled()) << qPrintable(field->objectName());
        EXPECT_EQ(QApplication::focusWidget(), field) << qPrintable(field->objectName());
    }
    w.comboLeftController->setCurrentIndex(5);
    for (QLineEdit* field : {w.txtFPScustom, w.txtLightGunCycles, w.txtLightGunScan, w.txtLineScan,
                             w.txtLowerSens, w.txtScanLines}) {
        SCOPED_TRACE(qPrintable(field->objectName()));
        field->clear();
        QTest::keyClicks(field, QStringLiteral("1a-.2 +3,e"));
        QTest::keyClick(field, Qt::Key_Return);
        EXPECT_EQ(field->text(), "123");
        QTest::keyClick(field, Qt::Key_Backspace);
        QTest::keyClick(field, Qt::Key_Home); // keys without a character still work
        QTest::keyClick(field, Qt::Key_Delete);
        EXPECT_EQ(field->text(), "2");

        // Keyboard focus puts the caret at the end, selecting nothing; a click leaves the
        // caret where it was put.
        field->setText(QStringLiteral("1234"));
        for (const auto& [reason, from, to] :
             {std::tuple{Qt::TabFocusReason, 0, 4}, {Qt::MouseFocusReason, 1, 1}}) {
            field->setCursorPosition(from);
            QFocusEvent focusIn(QEvent::FocusIn, reason); // Qt itself would select all
            QApplication::sendEvent(field, &focusIn);
            QApplication::processEvents();
            EXPECT_FALSE(field->hasSelectedText());
            EXPECT_EQ(field->cursorPosition(), to);
        }
    }
    // Losing the focus refreshes: a value set without a reaction of its own shows.
    w.BarColorPhos->setValue(50);
    EXPECT_FALSE(previewHas("-f50"));
    QFocusEvent focusOut(QEvent::FocusOut, Qt::TabFocusReason);
    QApplication::sendEvent(w.txtLowerSens, &focusOut);
    EXPECT_TRUE(previewHas("-f50"));

    // Switched off, the fields are disabled again; so is the frame rate's by its other
    // buttons.
    for (QAbstractButton* off :
         std::initializer_list<QAbstractButton*>{w.chkLineScan, w.chkScanLines, w.chkLowerSens})
        off->click();
    for (QLineEdit* field : {w.txtLineScan, w.txtScanLines, w.txtLowerSens})
        EXPECT_FALSE(field->isEnabled()) << qPrintable(field->objectName());
    for (QRadioButton* other : {w.optFPSmonitor, w.optFPSDefault}) {
        w.optFPScustom->click();
        other->click();
        EXPECT_FALSE(w.txtFPScustom->isEnabled()) << qPrintable(other->objectName());
    }
}

TEST_F(Options, PickingAVideoModeUnderDefaultWarnsEachTime) {
    showActive();
    for (int pick : {3, 3, 5}) {
        pickVideoMode(pick);
        BalloonTip* tip = cTextBoxXP::shownOn(w.txtVidModeBalloon);
        ASSERT_NE(tip, nullptr) << pick;
        EXPECT_EQ(tip->icon(), 1);
        EXPECT_EQ(tip->title() + "|" + tip->text(),
                  "Default Video Mode Selected|You need to select either 'Fullscreen' or\r\n"
                  "'Window' for the Video Mode to be enabled.");
        tip->close();
    }
    EXPECT_EQ(w.comboVideoMode->currentIndex(), 5); // the pick stays
    w.optVMWindow->click();
    pickVideoMode(2);
    EXPECT_EQ(cTextBoxXP::shownOn(w.txtVidModeBalloon), nullptr);
    EXPECT_TRUE(previewHas("-v12"));
    // A loaded file setting the list under "Default" warns nobody.
    w.optVMDefault->click();
    w.comboVideoMode->setCurrentIndex(4);
    EXPECT_EQ(cTextBoxXP::shownOn(w.txtVidModeBalloon), nullptr);
}

// (Enter in the edited switches launches: see the main window's launch tests.)
TEST_F(Options, EditSwitchesSwapsTheLabelForTheEditBox) {
    // Which of the edit box, its instruction and the preview label show.
    const auto shown = [this] {
        return QString::number(!w.txtDOSOutput->isHidden()) +
               QString::number(!w.lblDOSSwitchInstruction->isHidden()) +
               QString::number(!w.lblDOSOutput->isHidden());
    };
    showActive();
    w.SelectTab(QStringLiteral("Debug"));
    w.chkDOSSwitch->click();
    EXPECT_EQ(shown(), "110");
    EXPECT_EQ(QApplication::focusWidget(), w.txtDOSOutput);
    EXPECT_EQ(w.txtDOSOutput->text(), preview());
    QTest::keyClick(w.txtDOSOutput, Qt::Key_A);
    w.chkQuiet->click(); // an option change overwrites the edits
    EXPECT_EQ(w.txtDOSOutput->text(), preview());
    w.chkDOSSwitch->click();
    EXPECT_EQ(shown(), "001");

    // Pasted markup shows as typed.
    w.optFPScustom->click();
    w.txtFPScustom->setText(QStringLiteral("<b>5"));
    EXPECT_EQ(w.lblDOSOutput->textFormat(), Qt::PlainText);
    EXPECT_TRUE(previewHas("-r<b>5"));
}

} // namespace
