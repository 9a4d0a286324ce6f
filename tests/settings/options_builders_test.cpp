#include "support/FakePlatform.h"
#include "support/QtPrinters.h"

#include "settings/SwitchRules.h"
#include "settings/frmSettings.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>

#include <gtest/gtest.h>

#include <cstring>

namespace {

class SwitchBuilders : public ::testing::Test {
protected:
    FakePlatform fake;
    frmSettings w{fake.platform};
};

TEST_F(SwitchBuilders, AtTheInitialStateOnlyPaddleSensitivityAndMouseCaptureSpeak) {
    w.BarColorPaddle->setValue(9);
    w.chkMouseCapture->setChecked(false);
    EXPECT_EQ(w.LaunchSwitches(), " -p9 -M0");
    EXPECT_EQ(w.LaunchSwitches(), " -p9 -M0"); // nothing cached, nothing drifts
    for (auto retired : {&frmSettings::MindlinkLeft, &frmSettings::MindlinkRight,
                         &frmSettings::Joystick, &frmSettings::DrivCont, &frmSettings::KeyCont})
        EXPECT_EQ((w.*retired)(), "");
}

TEST_F(SwitchBuilders, ControllerListsGiveCodesLayoutCaptionsAndDevices) {
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

TEST_F(SwitchBuilders, GrayedBoxesCountUnlessExactlyCheckedIsAsked) {
    for (QCheckBox* box : {w.chkQuiet, w.chkSwapControl, w.chkMouseCapture, w.chkLowerSens})
        box->setCheckState(Qt::PartiallyChecked);
    EXPECT_EQ(w.Quiet(), " -q");
    EXPECT_EQ(w.MouseCapture(), " -M1");
    EXPECT_EQ(w.SwapControl(), "");
    EXPECT_EQ(w.LowerSens(), "");
}

TEST_F(SwitchBuilders, OptionGroupsAndListsGiveTheirSwitch) {
    const struct {
        QRadioButton* button;
        QString (frmSettings::*builder)();
        const char* expected;
    } table[] = {
        {w.optCPNTSC, &frmSettings::ColorPalette, " -c0"},
        {w.optCPPAL, &frmSettings::ColorPalette, " -c1"},
        {w.optDSPLow, &frmSettings::DSP, " -d1"},
        {w.optNarrow1, &frmSettings::Narrow, " -e1"},
        {w.optJoyKey, &frmSettings::Joystick, " -j0"},
        {w.optJoyRev, &frmSettings::Joystick, " -j2"},
        {w.optSCPCX, &frmSettings::ScreenCapture, ""},
        {w.optCPDefault, &frmSettings::ColorPalette, ""},
    };
    for (const auto& row : table) {
        row.button->setChecked(true);
        EXPECT_EQ((w.*row.builder)(), row.expected) << qPrintable(row.button->objectName());
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

TEST_F(SwitchBuilders, NumberFieldsAreTidiedWhetherOrNotTheirSwitchIsOn) {
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
}

TEST_F(SwitchBuilders, InactivatedControllersCountOnlyExactlyCheckedAndEnabled) {
    for (QCheckBox* box : {w.chkIPCKeyboard, w.chkIPCMouse, w.chkIPCJoystick, w.chkIPCStella})
        box->setChecked(true);
    w.chkIPCKeyboard->setEnabled(false);
    EXPECT_EQ(w.IPC(), " -iMJS");
    w.chkIPCJoystick->setCheckState(Qt::PartiallyChecked); // re-derives: keyboard enabled
    EXPECT_EQ(w.IPC(), " -iKMS");
}

TEST_F(SwitchBuilders, TheLaunchTakesItsBuildersInTheirFixedOrder) {
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

} // namespace
