#include "support/FakePlatform.h"
#include "support/QtPrinters.h"

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
#include <QRadioButton>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

namespace {

class OptionRules : public ::testing::Test {
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

TEST_F(OptionRules, EveryOptionControlRefreshesThePreview) {
    EXPECT_EQ(preview(), "-p" + QString::number(w.BarColorPaddle->Value()) + " -M1");
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
        {w.optCPNTSC, "-c0"},       {w.optDSPLow, "-d1"},
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
    EXPECT_FALSE(previewHas("-c0"));
    EXPECT_EQ(w.txtDOSOutput->text(), preview());

    // The retired controls react to nothing.
    const QString before = preview();
    for (QAbstractButton* retired : std::initializer_list<QAbstractButton*>{
             w.chkDriveLeft, w.chkKeyRight, w.chkLightGun, w.chkMindlinkLeft, w.optJoyKey})
        retired->click();
    EXPECT_EQ(preview(), before);
}

TEST_F(OptionRules, ThePortsDecideTheLightGunAndWhichPcControllersCanBeInactivated) {
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

TEST_F(OptionRules, ClearedFieldsShowZeroOnceAndRefreshOnce) {
    w.comboLeftController->setCurrentIndex(5);
    for (QLineEdit* field :
         {w.txtScanLines, w.txtLineScan, w.txtLightGunCycles, w.txtLightGunScan}) {
        field->setText(QStringLiteral("12"));
        field->clear();
        EXPECT_EQ(field->text(), "0") << qPrintable(field->objectName());
    }
    for (QLineEdit* field : {w.txtLowerSens, w.txtFPScustom}) {
        field->clear();
        EXPECT_EQ(field->text(), "") << qPrintable(field->objectName());
    }

    w.chkScanLines->click();
    QSignalSpy fieldChanges(w.txtScanLines, &QLineEdit::textChanged);
    QSignalSpy previewChanges(w.txtDOSOutput, &QLineEdit::textChanged);
    w.txtScanLines->setText(QStringLiteral("0012"));
    EXPECT_EQ(fieldChanges.count(), 2); // as typed, then tidied
    EXPECT_EQ(previewChanges.count(), 1);
    EXPECT_TRUE(previewHas("-h12"));
    w.RefreshOptionStates(); // nothing changed: nothing rewritten
    EXPECT_EQ(fieldChanges.count() + previewChanges.count(), 3);
}

TEST_F(OptionRules, NumberFieldsAreSwitchedOnFocusedAndTakeDigitsOnly) {
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

TEST_F(OptionRules, PickingAVideoModeUnderDefaultWarnsEachTime) {
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

TEST_F(OptionRules, EditSwitchesSwapsTheLabelForTheEditBoxWhoseEnterLaunches) {
    QList<bool> launches;
    w.setLoadRomHandler([&](bool ForceLoad) { launches << ForceLoad; });
    showActive();
    w.SelectTab(QStringLiteral("Debug"));
    w.chkDOSSwitch->click();
    EXPECT_FALSE(w.txtDOSOutput->isHidden());
    EXPECT_FALSE(w.lblDOSSwitchInstruction->isHidden());
    EXPECT_TRUE(w.lblDOSOutput->isHidden());
    EXPECT_EQ(QApplication::focusWidget(), w.txtDOSOutput);
    EXPECT_EQ(w.txtDOSOutput->text(), preview());

    QTest::keyClick(w.txtDOSOutput, Qt::Key_A);
    EXPECT_TRUE(launches.isEmpty());
    QTest::keyClick(w.txtDOSOutput, Qt::Key_Return);
    QTest::keyClick(w.txtDOSOutput, Qt::Key_Enter);
    EXPECT_EQ(launches, QList<bool>({true, true}));

    w.chkQuiet->click(); // an option change overwrites the edits
    EXPECT_EQ(w.txtDOSOutput->text(), preview());
    w.chkDOSSwitch->click();
    EXPECT_TRUE(w.txtDOSOutput->isHidden());
    EXPECT_TRUE(w.lblDOSSwitchInstruction->isHidden());
    EXPECT_FALSE(w.lblDOSOutput->isHidden());

    // Pasted markup shows as typed.
    w.optFPScustom->click();
    w.txtFPScustom->setText(QStringLiteral("<b>5"));
    EXPECT_EQ(w.lblDOSOutput->textFormat(), Qt::PlainText);
    EXPECT_TRUE(previewHas("-r<b>5"));
}

} // namespace
