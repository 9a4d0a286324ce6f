// The settings window's option behaviour: the switch builders that turn the controls into
// the emulator's command line, the option-state refresh and the controls' reactions.

#include "settings/frmSettings.h"

#include "emulator/LeadingNumber.h"
#include "settings/SliderRules.h"
#include "settings/SwitchRules.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QEvent>
#include <QFocusEvent>
#include <QGroupBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTimer>

namespace {

// A box counts as on in any state but unchecked, so a grayed one counts too.
bool isOn(const QCheckBox* box) {
    return box->checkState() != Qt::Unchecked;
}

bool isExactlyChecked(const QCheckBox* box) {
    return box->checkState() == Qt::Checked;
}

// The box's state as the configuration file and the pair switches know it.
std::int16_t boxState(const QCheckBox* box) {
    switch (box->checkState()) {
    case Qt::Checked:
        return 1;
    case Qt::PartiallyChecked:
        return 2;
    default:
        return 0;
    }
}

// The control's own enabled flag, whatever its window's state: a disabled settings window
// must not change what the options say.
bool ownEnabled(const QWidget* widget) {
    return !widget->testAttribute(Qt::WA_ForceDisabled);
}

QString flag(const QCheckBox* box, const char* switchText) {
    return isOn(box) ? QLatin1String(switchText) : QString();
}

// The selected "Paddle n" button of a mouse, the last one winning, or -1.
int selectedPaddle(const std::array<QRadioButton*, 4>& buttons) {
    int selected = -1;
    for (int i = 0; i < 4; ++i)
        if (buttons[static_cast<size_t>(i)]->isChecked())
            selected = i;
    return selected;
}

// A port's switch; captions the port's picture button after the selected controller.
QString controllerSwitch(const QComboBox* list, QPushButton* picture, const char* mark) {
    const switches::Controller* controller = switches::controllerAt(list->currentIndex());
    if (controller == nullptr)
        return QString();
    picture->setText(QLatin1String(controller->layout));
    const QLatin1String code(controller->code);
    if (code.isEmpty())
        return QString();
    return QLatin1String(" -") + QLatin1String(mark) + code;
}

bool isNumberKey(const QKeyEvent* key) {
    switch (key->key()) {
    case Qt::Key_Backspace:
    case Qt::Key_Delete:
    case Qt::Key_Tab:
    case Qt::Key_Backtab:
    case Qt::Key_Escape:
        return true;
    default:
        break;
    }
    const QString text = key->text();
    // Keys without a character (arrows, Home, End) and editing shortcuts pass.
    if (text.isEmpty() || (key->modifiers() & (Qt::ControlModifier | Qt::MetaModifier)))
        return true;
    for (const QChar c : text)
        if (c < u'0' || c > u'9')
            return false;
    return true;
}

} // namespace

// ---- switch builders ----

bool frmSettings::CheckIPC(bool bLeft, const QString& device) const {
    const QComboBox* list = bLeft ? comboLeftController : comboRightController;
    return switches::controllerUsesDevice(list->currentIndex(), device);
}

QString frmSettings::LeftController() {
    return controllerSwitch(comboLeftController, cmdLeftControlPic, ")");
}

QString frmSettings::RightController() {
    return controllerSwitch(comboRightController, cmdRightControlPic, "(");
}

QString frmSettings::Interlaced() {
    return flag(chkInterlaced, " -!");
}

QString frmSettings::P0Hard() {
    return flag(chkP0Hard, " -0");
}

QString frmSettings::P1Hard() {
    return flag(chkP1Hard, " -1");
}

QString frmSettings::All4() {
    return flag(chkAllow4, " -4");
}

QString frmSettings::StartBW() {
    return flag(chkBW, " -b");
}

QString frmSettings::ScreenCapture() {
    return optSCBMP->isChecked() ? QStringLiteral(" -B") : QString();
}

QString frmSettings::ColorPalette() {
    QString result;
    if (optCPNTSC->isChecked())
        result = QStringLiteral(" -c0");
    if (optCPPAL->isChecked())
        result = QStringLiteral(" -c1");
    if (optCPSECAM->isChecked())
        result = QStringLiteral(" -c2");
    return result;
}

QString frmSettings::DSP() {
    QString result;
    if (optDSPLow->isChecked())
        result = QStringLiteral(" -d1");
    if (optDSPHigh->isChecked())
        result = QStringLiteral(" -d2");
    return result;
}

QString frmSettings::Narrow() {
    QString result;
    if (optNarrow1->isChecked())
        result = QStringLiteral(" -e1");
    if (optNarrow2->isChecked())
        result = QStringLiteral(" -e2");
    return result;
}

QString frmSettings::Phos() {
    const int value = BarColorPhos->Value();
    return value == sliders::kPhosDefault ? QString()
                                          : QStringLiteral(" -f") + QString::number(value);
}

QString frmSettings::GameType() {
    const int index = comboGT->currentIndex();
    return index == 0 ? QString() : QStringLiteral(" -g") + QString::number(index);
}

QString frmSettings::ScanLines() {
    const QString value = normaliseField(txtScanLines);
    return isOn(chkScanLines) ? QStringLiteral(" -h") + value : QString();
}

QString frmSettings::IPC() {
    // A box the selected controllers make pointless is disabled and never counts.
    const std::pair<const QCheckBox*, char> devices[] = {
        {chkIPCKeyboard, 'K'}, {chkIPCMouse, 'M'}, {chkIPCJoystick, 'J'}, {chkIPCStella, 'S'}};
    QString letters;
    for (const auto& [box, letter] : devices)
        if (isExactlyChecked(box) && ownEnabled(box))
            letters += QLatin1Char(letter);
    return letters.isEmpty() ? QString() : QStringLiteral(" -i") + letters;
}

QString frmSettings::MindlinkLeft() {
    return flag(chkMindlinkLeft, " -i2");
}

QString frmSettings::MindlinkRight() {
    return flag(chkMindlinkRight, " -i1");
}

QString frmSettings::Joystick() {
    QString result;
    if (optJoyKey->isChecked())
        result = QStringLiteral(" -j0");
    if (optJoyRev->isChecked())
        result = QStringLiteral(" -j2");
    return result;
}

QString frmSettings::PaddleSens() {
    return ownEnabled(fraPaddleSens)
               ? QStringLiteral(" -p") + QString::number(BarColorPaddle->Value())
               : QString();
}

QString frmSettings::LowerSens() {
    const QString text = txtLowerSens->text();
    if (!isExactlyChecked(chkLowerSens) || text.isEmpty())
        return QString();
    // Only pasted text can hold more than digits; its leading number is what counts.
    return QStringLiteral(" -P") + switches::numberText(leadingNumber(text));
}

QString frmSettings::Paddle() {
    return switches::mousePaddleSwitch(selectedPaddle(optPaddleM1), selectedPaddle(optPaddleM2));
}

QString frmSettings::MouseCapture() {
    return isOn(chkMouseCapture) ? QStringLiteral(" -M1") : QStringLiteral(" -M0");
}

QString frmSettings::LightGun() {
    const QString cycles = normaliseField(txtLightGunCycles);
    const QString scan = normaliseField(txtLightGunScan);
    if (!ownEnabled(fraLightgun))
        return QString();
    QString result = QStringLiteral(" -l") + cycles;
    if (!scan.isEmpty())
        result += QStringLiteral(" -a") + scan;
    return result;
}

QString frmSettings::ShowScanline() {
    return flag(chkShowScanline, " -n");
}

QString frmSettings::PALColorLoss() {
    return flag(chkPALColorLoss, " -o");
}

QString frmSettings::Quiet() {
    return flag(chkQuiet, " -q");
}

QString frmSettings::SoundQueue() {
    const int value = BarColorSoundQueue->Value();
    return value == sliders::kSoundQueueDefault ? QString()
                                                : QStringLiteral(" -s") + QString::number(value);
}

QString frmSettings::FPS() {
    QString result;
    if (optFPSmonitor->isChecked())
        result = QStringLiteral(" -r");
    if (optFPScustom->isChecked())
        result = QStringLiteral(" -r") + txtFPScustom->text().trimmed();
    return result;
}

QString frmSettings::CodeTrace() {
    return flag(chkCodeTrace, " -t");
}

QString frmSettings::LineScan() {
    const QString value = normaliseField(txtLineScan);
    return isOn(chkLineScan) ? QStringLiteral(" -u") + value : QString();
}

QString frmSettings::VideoMode() {
    const QString mode = QString::number(comboVideoMode->currentIndex());
    QString result;
    if (optVMFull->isChecked())
        result = QStringLiteral(" -v") + mode;
    if (optVMWindow->isChecked())
        result = QStringLiteral(" -v1") + mode;
    return result;
}

QString frmSettings::DrivCont() {
    return switches::controllerPairSwitch(u'w', boxState(chkDriveLeft), boxState(chkDriveRight));
}

QString frmSettings::SwapControl() {
    return isExactlyChecked(chkSwapControl) ? QStringLiteral(" -w") : QString();
}

QString frmSettings::KeyCont() {
    return switches::controllerPairSwitch(u'y', boxState(chkKeyLeft), boxState(chkKeyRight));
}

QString frmSettings::PrintChecksum() {
    return flag(chkPrintChecksum, " -x");
}

QString frmSettings::FastCopy() {
    return flag(chkFastCopy, " -z");
}

QString frmSettings::SyncWSound() {
    return flag(chkSyncWSound, " -R");
}

QString frmSettings::LaunchSwitches() {
    // The emulator reads its switches in any order; this one is what users have always
    // seen, so the preview and saved habits stay familiar.
    static constexpr QString (frmSettings::*kLaunchOrder[])() = {
        &frmSettings::LeftController,
        &frmSettings::RightController,
        &frmSettings::Interlaced,
        &frmSettings::P0Hard,
        &frmSettings::P1Hard,
        &frmSettings::All4,
        &frmSettings::StartBW,
        &frmSettings::ScreenCapture,
        &frmSettings::ColorPalette,
        &frmSettings::DSP,
        &frmSettings::Narrow,
        &frmSettings::Phos,
        &frmSettings::GameType,
        &frmSettings::ScanLines,
        &frmSettings::IPC,
        &frmSettings::PaddleSens,
        &frmSettings::LowerSens,
        &frmSettings::Paddle,
        &frmSettings::MouseCapture,
        &frmSettings::LightGun,
        &frmSettings::ShowScanline,
        &frmSettings::PALColorLoss,
        &frmSettings::Quiet,
        &frmSettings::SoundQueue,
        &frmSettings::FPS,
        &frmSettings::LineScan,
        &frmSettings::CodeTrace,
        &frmSettings::VideoMode,
        &frmSettings::SwapControl,
        &frmSettings::PrintChecksum,
        &frmSettings::FastCopy,
        &frmSettings::SyncWSound,
    };
    static_assert(std::size(kLaunchOrder) == 32);
    QString text;
    for (const auto builder : kLaunchOrder)
        text += (this->*builder)();
    return text;
}

QString frmSettings::normaliseField(QLineEdit* field) {
    const QString text = switches::normalisedNumberText(field->text());
    // Only a real change rewrites the field, so the refresh it sets off finds nothing more.
    if (field->text() != text)
        field->setText(text);
    return text;
}

// ---- option-state refresh ----

void frmSettings::RefreshOptionStates() {
    if (m_bRefreshing) {
        m_bRefreshAgain = true;
        return;
    }
    m_bRefreshing = true;
    // A field tidied by a pass, or focus leaving a field that a pass disabled, asks for
    // another; that one finds everything in place. The bound only guards against a loop.
    for (int pass = 0; pass < 4; ++pass) {
        m_bRefreshAgain = false;

        const bool bLightGun = comboLeftController->currentIndex() == switches::kLightGunIndex ||
                               comboRightController->currentIndex() == switches::kLightGunIndex;
        fraLightgun->setVisible(bLightGun);
        fraLightgun->setEnabled(bLightGun);

        const std::pair<QCheckBox*, const char*> devices[] = {
            {chkIPCKeyboard, "k"}, {chkIPCMouse, "m"}, {chkIPCJoystick, "j"}, {chkIPCStella, "s"}};
        for (const auto& [box, letter] : devices) {
            const QString device = QLatin1String(letter);
            box->setEnabled(CheckIPC(true, device) || CheckIPC(false, device));
        }

        const bool bKeyboardPaddle =
            ownEnabled(chkIPCKeyboard) && !isExactlyChecked(chkIPCKeyboard);
        fraPaddleSens->setVisible(bKeyboardPaddle);
        fraPaddleSens->setEnabled(bKeyboardPaddle);

        const QString preview = LaunchSwitches().mid(1);
        if (txtDOSOutput->text() != preview)
            txtDOSOutput->setText(preview);
        lblDOSOutput->setText(preview);
        lblDOSOutput->setToolTip(preview);

        if (!m_bRefreshAgain)
            break;
    }
    m_bRefreshing = false;
}

// ---- reactions ----

void frmSettings::setLoadRomHandler(std::function<void(bool)> handler) {
    m_loadRom = std::move(handler);
}

void frmSettings::connectOptionControls() {
    // The preview shows switches, never markup, whatever was pasted into a field.
    lblDOSOutput->setTextFormat(Qt::PlainText);

    const auto refresh = [this] { RefreshOptionStates(); };
    const auto onCheckChange = [this](QCheckBox* box, auto reaction) {
#if QT_VERSION >= QT_VERSION_CHECK(6, 7, 0)
        connect(box, &QCheckBox::checkStateChanged, this, reaction);
#else
        connect(box, &QCheckBox::stateChanged, this, reaction);
#endif
    };
    // Option buttons react when they become selected, by a click or by a loaded file.
    const auto onSelect = [this](QRadioButton* button, auto reaction) {
        connect(button, &QRadioButton::toggled, this, [reaction](bool bOn) {
            if (bOn)
                reaction();
        });
    };

    for (QCheckBox* box : {chkAllow4, chkBW, chkCodeTrace, chkFastCopy, chkInterlaced,
                           chkIPCJoystick, chkIPCKeyboard, chkIPCMouse, chkIPCStella,
                           chkMouseCapture, chkP0Hard, chkP1Hard, chkPALColorLoss, chkPrintChecksum,
                           chkQuiet, chkShowScanline, chkSwapControl, chkSyncWSound})
        onCheckChange(box, refresh);

    for (QRadioButton* button :
         {optCPDefault, optCPNTSC, optCPPAL, optCPSECAM, optDSPDefault, optDSPLow, optDSPHigh,
          optNarrowNot, optNarrow1, optNarrow2, optSCPCX, optSCBMP, optVMDefault, optVMFull,
          optVMWindow, optPaddleKeyNone, optPaddleM1None, optPaddleM2None})
        onSelect(button, refresh);
    for (const auto* group : {&optPaddleKey, &optPaddleM1, &optPaddleM2})
        for (QRadioButton* button : *group)
            onSelect(button, refresh);
    onSelect(optFPScustom, [this] { optFPS_Click(); });
    onSelect(optFPSmonitor, [this] { optFPS_Click(); });
    onSelect(optFPSDefault, [this] { optFPS_Click(); });

    for (QComboBox* list : {comboGT, comboLeftController, comboRightController, comboVideoMode})
        connect(list, &QComboBox::currentIndexChanged, this, refresh);
    // The warning answers the user's pick only (each pick, even of the same entry); a
    // loaded file that sets the list shows nothing.
    connect(comboVideoMode, &QComboBox::activated, this, &frmSettings::comboVideoMode_Click);

    const std::pair<QCheckBox*, QLineEdit*> numberChecks[] = {
        {chkLineScan, txtLineScan}, {chkScanLines, txtScanLines}, {chkLowerSens, txtLowerSens}};
    for (const auto& [box, field] : numberChecks)
        onCheckChange(box, [this, box = box, field = field] { numberCheck_Click(box, field); });

    for (QLineEdit* field : {txtFPScustom, txtLightGunCycles, txtLightGunScan, txtLineScan,
                             txtLowerSens, txtScanLines}) {
        field->installEventFilter(this);
        connect(field, &QLineEdit::textChanged, this, refresh);
    }

    onCheckChange(chkDOSSwitch, [this] { chkDOSSwitch_Click(); });
    connect(txtDOSOutput, &QLineEdit::returnPressed, this, &frmSettings::txtDOSOutput_KeyPress);

    // The retired controls in picGraveyard react to nothing.

    RefreshOptionStates();
}

void frmSettings::numberCheck_Click(QCheckBox* box, QLineEdit* field) {
    const bool bOn = isOn(box);
    field->setEnabled(bOn);
    // The window may be hidden (a file being loaded); the field then gets the focus when
    // the window next becomes active.
    if (bOn)
        field->setFocus();
    RefreshOptionStates();
}

void frmSettings::optFPS_Click() {
    const bool bCustom = optFPScustom->isChecked();
    // "Default" also greys the custom rate: it is not used then, as with "Monitor Speed".
    txtFPScustom->setEnabled(bCustom);
    if (bCustom)
        txtFPScustom->setFocus();
    RefreshOptionStates();
}

void frmSettings::comboVideoMode_Click() {
    if (optVMDefault->isChecked()) {
        cTextBoxXP tip;
        tip.setTextBox(txtVidModeBalloon);
        tip.setBalloonTipIcon(1);
        tip.setBalloonTipTitle(QStringLiteral("Default Video Mode Selected"));
        tip.setBalloonTipText(QStringLiteral("You need to select either 'Fullscreen' or\r\n"
                                             "'Window' for the Video Mode to be enabled."));
        tip.ShowBalloonTip();
    }
    RefreshOptionStates();
}

void frmSettings::chkDOSSwitch_Click() {
    const bool bEdit = isOn(chkDOSSwitch);
    txtDOSOutput->setVisible(bEdit);
    lblDOSOutput->setVisible(!bEdit);
    lblDOSSwitchInstruction->setVisible(bEdit);
    if (bEdit)
        txtDOSOutput->setFocus();
}

void frmSettings::txtDOSOutput_KeyPress() {
    if (m_loadRom)
        m_loadRom(true);
}

bool frmSettings::optionControlEvent(QObject* watched, QEvent* event) {
    auto* field = qobject_cast<QLineEdit*>(watched);
    if (field == nullptr ||
        (field != txtFPScustom && field != txtLightGunCycles && field != txtLightGunScan &&
         field != txtLineScan && field != txtLowerSens && field != txtScanLines))
        return false;
    switch (event->type()) {
    case QEvent::KeyPress:
        // Digits and Backspace only: no sign, point, blank or Enter.
        return !isNumberKey(static_cast<QKeyEvent*>(event));
    case QEvent::FocusIn:
        // A click puts the caret where it was clicked, as a user expects.
        if (static_cast<QFocusEvent*>(event)->reason() == Qt::MouseFocusReason)
            return false;
        // After the field's own focus handling, which may select everything.
        QTimer::singleShot(0, field, [field] {
            field->deselect();
            field->end(false);
        });
        return false;
    case QEvent::FocusOut:
        RefreshOptionStates();
        return false;
    default:
        return false;
    }
}
