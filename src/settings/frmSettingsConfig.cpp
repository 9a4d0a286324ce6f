// Option sets: the option controls saved to a .lum file and a file loaded back into them,
// and the two buttons that show the layout picture of the controller on each port.

#include "settings/frmSettings.h"

#include "emulator/ConfigRecord.h"
#include "emulator/LeadingNumber.h"
#include "emulator/OptionFile.h"
#include "platform/Dialogs.h"
#include "platform/Platform.h"
#include "settings/OptionLists.h"
#include "settings/SliderRules.h"
#include "settings/frmPicPreview.h"
#include "ui/vbalProgressBar.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>

#include <algorithm>
#include <cmath>
#include <optional>
#include <vector>

namespace {

using F = ConfigField;
using K = ConfigFieldKind;

const QString kDialogTitle = QStringLiteral("Choose File to Save Configuration");
const QString kDialogFilter =
    QStringLiteral("lum configurations (*.lum)|*.lum|All Files (*.*)|*.*");

// The control that holds a field of the record.
QWidget* controlOf(const frmSettings& w, ConfigField field) {
    switch (field) {
    case F::comboVideoMode:
        return w.comboVideoMode;
    case F::optVMDefault:
        return w.optVMDefault;
    case F::optVMFull:
        return w.optVMFull;
    case F::optVMWindow:
        return w.optVMWindow;
    case F::optDSPDefault:
        return w.optDSPDefault;
    case F::optDSPLow:
        return w.optDSPLow;
    case F::optDSPHigh:
        return w.optDSPHigh;
    case F::chkP0Hard:
        return w.chkP0Hard;
    case F::chkP1Hard:
        return w.chkP1Hard;
    case F::chkBW:
        return w.chkBW;
    case F::optSCPCX:
        return w.optSCPCX;
    case F::optSCBMP:
        return w.optSCBMP;
    case F::comboLeftController:
        return w.comboLeftController;
    case F::comboRightController:
        return w.comboRightController;
    case F::chkIPCKeyboard:
        return w.chkIPCKeyboard;
    case F::chkIPCMouse:
        return w.chkIPCMouse;
    case F::chkIPCJoystick:
        return w.chkIPCJoystick;
    case F::chkIPCStella:
        return w.chkIPCStella;
    case F::BarColorPaddle:
        return w.BarColorPaddle;
    case F::chkLightGun:
        return w.chkLightGun;
    case F::txtLightGunCycles:
        return w.txtLightGunCycles;
    case F::txtLightGunScan:
        return w.txtLightGunScan;
    case F::chkSwapControl:
        return w.chkSwapControl;
    case F::chkQuiet:
        return w.chkQuiet;
    case F::BarColorSoundQueue:
        return w.BarColorSoundQueue;
    case F::chkLowerSens:
        return w.chkLowerSens;
    case F::txtLowerSens:
        return w.txtLowerSens;
    case F::optPaddleKey0:
    case F::optPaddleKey1:
    case F::optPaddleKey2:
    case F::optPaddleKey3:
        return w.optPaddleKey[static_cast<size_t>(configFieldInfo(field).element)];
    case F::optPaddleM1_0:
    case F::optPaddleM1_1:
    case F::optPaddleM1_2:
    case F::optPaddleM1_3:
        return w.optPaddleM1[static_cast<size_t>(configFieldInfo(field).element)];
    case F::optPaddleM2_0:
    case F::optPaddleM2_1:
    case F::optPaddleM2_2:
    case F::optPaddleM2_3:
        return w.optPaddleM2[static_cast<size_t>(configFieldInfo(field).element)];
    case F::chkPALColorLoss:
        return w.chkPALColorLoss;
    case F::chkInterlaced:
        return w.chkInterlaced;
    case F::chkSyncWSound:
        return w.chkSyncWSound;
    case F::optFPSDefault:
        return w.optFPSDefault;
    case F::optFPSmonitor:
        return w.optFPSmonitor;
    case F::optFPScustom:
        return w.optFPScustom;
    case F::txtFPScustom:
        return w.txtFPScustom;
    case F::optNarrowNot:
        return w.optNarrowNot;
    case F::optNarrow1:
        return w.optNarrow1;
    case F::optNarrow2:
        return w.optNarrow2;
    case F::optCPDefault:
        return w.optCPDefault;
    case F::optCPNTSC:
        return w.optCPNTSC;
    case F::optCPPAL:
        return w.optCPPAL;
    case F::optCPSECAM:
        return w.optCPSECAM;
    case F::BarColorPhos:
        return w.BarColorPhos;
    case F::chkScanLines:
        return w.chkScanLines;
    case F::txtScanLines:
        return w.txtScanLines;
    case F::chkMouseCapture:
        return w.chkMouseCapture;
    case F::chkShowScanline:
        return w.chkShowScanline;
    case F::chkCodeTrace:
        return w.chkCodeTrace;
    case F::chkPrintChecksum:
        return w.chkPrintChecksum;
    case F::chkFastCopy:
        return w.chkFastCopy;
    case F::chkAllow4:
        return w.chkAllow4;
    case F::comboGT:
        return w.comboGT;
    case F::chkLineScan:
        return w.chkLineScan;
    case F::txtLineScan:
        return w.txtLineScan;
    }
    return nullptr;
}

// An option group whose last flag in load order is `field`, with the button that stands
// for "nothing chosen": a file whose flags select none of the group gets that one, so the
// window never shows a group without a choice. (For the paddle frames that button is
// "None", which is what four clear flags mean.)
struct OptionGroup {
    std::vector<QRadioButton*> members;
    QRadioButton* fallback = nullptr;
};

std::optional<OptionGroup> groupEndingWith(const frmSettings& w, ConfigField field) {
    const auto paddles = [](const std::array<QRadioButton*, 4>& b, QRadioButton* none) {
        return OptionGroup{{b[0], b[1], b[2], b[3], none}, none};
    };
    switch (field) {
    case F::optVMWindow:
        return OptionGroup{{w.optVMDefault, w.optVMFull, w.optVMWindow}, w.optVMDefault};
    case F::optDSPHigh:
        return OptionGroup{{w.optDSPDefault, w.optDSPLow, w.optDSPHigh}, w.optDSPDefault};
    case F::optSCBMP:
        return OptionGroup{{w.optSCPCX, w.optSCBMP}, w.optSCPCX};
    case F::optPaddleKey3:
        return paddles(w.optPaddleKey, w.optPaddleKeyNone);
    case F::optPaddleM1_3:
        return paddles(w.optPaddleM1, w.optPaddleM1None);
    case F::optPaddleM2_3:
        return paddles(w.optPaddleM2, w.optPaddleM2None);
    case F::optFPScustom:
        return OptionGroup{{w.optFPSDefault, w.optFPSmonitor, w.optFPScustom}, w.optFPSDefault};
    case F::optNarrow2:
        return OptionGroup{{w.optNarrowNot, w.optNarrow1, w.optNarrow2}, w.optNarrowNot};
    case F::optCPSECAM:
        return OptionGroup{{w.optCPDefault, w.optCPNTSC, w.optCPPAL, w.optCPSECAM}, w.optCPDefault};
    default:
        return std::nullopt;
    }
}

// Clears an option button. Qt keeps one button of an exclusive group selected, so the
// exclusivity is lifted for the moment it takes.
void clearOption(QRadioButton* button) {
    if (!button->isChecked())
        return;
    if (QButtonGroup* group = button->group()) {
        const bool bExclusive = group->exclusive();
        group->setExclusive(false);
        button->setChecked(false);
        group->setExclusive(bExclusive);
    } else {
        const bool bAutoExclusive = button->autoExclusive();
        button->setAutoExclusive(false);
        button->setChecked(false);
        button->setAutoExclusive(bAutoExclusive);
    }
}

qint16 checkValue(const QCheckBox* box) {
    switch (box->checkState()) {
    case Qt::Checked:
        return 1;
    case Qt::PartiallyChecked:
        return 2;
    case Qt::Unchecked:
        break;
    }
    return 0;
}

// The option controls as a record, read in load order.
ConfigRecord recordFromControls(const frmSettings& w) {
    ConfigRecord record;
    for (const ConfigFieldInfo& info : configFields()) {
        QWidget* control = controlOf(w, info.field);
        switch (info.kind) {
        case K::ListIndex:
            setConfigInt(record, info.field,
                         static_cast<qint16>(static_cast<QComboBox*>(control)->currentIndex()));
            break;
        case K::Flag:
            setConfigFlag(record, info.field, static_cast<QRadioButton*>(control)->isChecked());
            break;
        case K::Check:
            setConfigInt(record, info.field, checkValue(static_cast<QCheckBox*>(control)));
            break;
        case K::Text:
            setConfigSingle(record, info.field,
                            leadingSingle(static_cast<QLineEdit*>(control)->text()));
            break;
        case K::Slider:
        case K::SoundQueue:
            setConfigSingle(record, info.field,
                            static_cast<float>(static_cast<vbalProgressBar*>(control)->Value()));
            break;
        }
    }
    return record;
}

// Writes one field into its control, which reacts as it does to the user. False when the
// control cannot take the value.
bool applyField(const frmSettings& w, const ConfigRecord& record, const ConfigFieldInfo& info) {
    QWidget* control = controlOf(w, info.field);
    switch (info.kind) {
    case K::ListIndex: {
        auto* list = static_cast<QComboBox*>(control);
        const int index = configInt(record, info.field);
        if (index < -1 || index >= list->count())
            return false;
        list->setCurrentIndex(index);
        return true;
    }
    case K::Flag: {
        auto* button = static_cast<QRadioButton*>(control);
        if (configFlag(record, info.field))
            button->setChecked(true);
        else
            clearOption(button);
        if (const std::optional<OptionGroup> group = groupEndingWith(w, info.field)) {
            const auto& members = group->members;
            if (std::none_of(members.begin(), members.end(),
                             [](const QRadioButton* b) { return b->isChecked(); }))
                group->fallback->setChecked(true);
        }
        return true;
    }
    case K::Check: {
        auto* box = static_cast<QCheckBox*>(control);
        const qint16 state = configInt(record, info.field);
        if (state < 0 || state > 2)
            return false;
        if (state == 2) {
            box->setCheckState(Qt::PartiallyChecked);
        } else {
            // A grayed state is one a file gives; the user's clicks go on between the two.
            box->setTristate(false);
            box->setCheckState(state == 1 ? Qt::Checked : Qt::Unchecked);
        }
        return true;
    }
    case K::Text: {
        const float value = configSingle(record, info.field);
        if (!std::isfinite(value))
            return false;
        static_cast<QLineEdit*>(control)->setText(shortestDecimalText(value));
        return true;
    }
    case K::Slider: {
        const std::optional<int> value = sliderValueFor(configSingle(record, info.field));
        if (!value)
            return false;
        static_cast<vbalProgressBar*>(control)->setValue(*value);
        return true;
    }
    case K::SoundQueue: {
        const std::optional<SoundQueueScale> scale =
            soundQueueScaleFor(configSingle(record, info.field));
        if (!scale)
            return false;
        auto* bar = static_cast<vbalProgressBar*>(control);
        bar->setMin(scale->min);
        bar->setMax(scale->max);
        bar->setValue(scale->value);
        return true;
    }
    }
    return false;
}

// The three bars' texts after their values.
void showSliderTexts(const frmSettings& w) {
    w.BarColorSoundQueue->setText(sliders::SoundQueueText(w.BarColorSoundQueue->Value()));
    w.BarColorPaddle->setText(sliders::PlainText(w.BarColorPaddle->Value()));
    w.BarColorPhos->setText(sliders::PlainText(w.BarColorPhos->Value()));
}

// The option-set chooser of both buttons, opening in the program folder.
FileDialogRequest optionSetRequest(const QString& programFolder, unsigned flags) {
    FileDialogRequest request;
    request.title = kDialogTitle;
    request.filter = kDialogFilter;
    request.filterIndex = 1;
    request.initialFolder = programFolder;
    request.flags = flags;
    return request;
}

} // namespace

void frmSettings::connectConfigControls() {
    connect(cmdSaveDat, &QPushButton::clicked, this, &frmSettings::cmdSaveDat_Click);
    connect(cmdLoadDat, &QPushButton::clicked, this, &frmSettings::cmdLoadDat_Click);
    connect(cmdLeftControlPic, &QPushButton::clicked, this, &frmSettings::cmdLeftControlPic_Click);
    connect(cmdRightControlPic, &QPushButton::clicked, this,
            &frmSettings::cmdRightControlPic_Click);
}

ConfigDecode frmSettings::readOptionSet(const QString& path) {
    // The lists' sizes are fixed, so a file can be checked before the window exists.
    const ConfigLimits limits{int(kVideoModeEntries.size()), int(kControllerEntries.size()),
                              int(kGameTypeEntries.size())};
    return readOptionFile(path, limits);
}

bool frmSettings::LoadSettings(const QString& path) {
    return LoadSettings(readOptionSet(path));
}

bool frmSettings::LoadSettings(const ConfigDecode& decoded) {
    // A file that cannot be read or is too short applies nothing; one with a value the
    // window rejects applies every field before that one.
    const auto& fields = configFields();
    for (int i = 0; i < decoded.applicableCount(); ++i)
        if (!applyField(*this, decoded.record, fields[static_cast<size_t>(i)]))
            return reportCorruptOptionSet();
    if (!decoded.ok())
        return reportCorruptOptionSet();

    showSliderTexts(*this);
    RefreshOptionStates();
    return true;
}

bool frmSettings::reportCorruptOptionSet() {
    // What was applied shows as it is: the bars' texts match their values and the switch
    // preview matches the controls.
    showSliderTexts(*this);
    RefreshOptionStates();
    m_platform.dialogs.MsgBox(this,
                              QStringLiteral(".lum file is corrupt\r\n"
                                             "Please verify settings and re-save to correct "
                                             "this problem"),
                              MsgButtons::Ok, MsgIcon::None);
    show();
    SelectTab(QStringLiteral("Settings"));
    return false;
}

void frmSettings::cmdSaveDat_Click() {
    const QString chosen = m_platform.dialogs.ShowSave(
        this, optionSetRequest(m_platform.programFolder, kFlagOverwritePrompt));
    if (chosen.isEmpty())
        return;

    const QString fileTitle = QFileInfo(chosen).fileName();
    const QString path = withLumExtension(chosen);
    // The chooser asked about the name as typed; a ".lum" added here can name another
    // file, which is not replaced without asking either.
    if (path != chosen && QFileInfo::exists(path)) {
        const QString question = QFileInfo(path).fileName() +
                                 QStringLiteral(" already exists.\r\nDo you want to replace it?");
        if (m_platform.dialogs.MsgBox(this, question, MsgButtons::YesNo, MsgIcon::Exclamation,
                                      kDialogTitle) != MsgResult::Yes)
            return;
    }

    // Whether the write worked, not whether some file of that name exists: a failed save
    // over an older file must not report success.
    if (writeOptionFile(path, recordFromControls(*this)))
        lblConfig->setText(fileTitle + QStringLiteral(" was succesfully saved"));
    else
        lblConfig->setText(QStringLiteral("error saving ") + fileTitle);
    lblConfig->setToolTip(QString());
}

void frmSettings::cmdLoadDat_Click() {
    const QString path = m_platform.dialogs.ShowOpen(
        this, optionSetRequest(m_platform.programFolder, kFlagPathMustExist | kFlagFileMustExist));
    if (path.isEmpty())
        return;

    const bool bLoaded = LoadSettings(path);
    QCoreApplication::processEvents();
    const QString fileTitle = QFileInfo(path).fileName();
    if (bLoaded)
        lblConfig->setText(fileTitle + QStringLiteral(" was succesfully loaded"));
    else
        lblConfig->setText(fileTitle +
                           QStringLiteral(" is corrupt.  Plese verify settings an re-save to "
                                          "correct the problem"));
    lblConfig->setToolTip(QString());
}

QString frmSettings::GetPicName(const QString& cmdTxt) const {
    static const std::pair<const char*, const char*> kPictures[] = {
        {"standard", "/lum Standard.jpg"},
        {"paddle", "/lum Paddles.jpg"},
        {"keyboard", "/lum Keyboard.jpg"},
        {"driving", "/lum Driving.jpg"},
    };
    const QString caption = cmdTxt.toLower();
    QString name;
    // A later word wins over an earlier one.
    for (const auto& [word, file] : kPictures)
        if (caption.contains(QLatin1String(word)))
            name = QLatin1String(file);
    return name;
}

void frmSettings::cmdLeftControlPic_Click() {
    showControlPic(cmdLeftControlPic);
}

void frmSettings::cmdRightControlPic_Click() {
    showControlPic(cmdRightControlPic);
}

void frmSettings::showControlPic(const QPushButton* button) {
    if (!m_picPreview)
        m_picPreview = new frmPicPreview(m_platform, this);
    // Says "Error loading pic" itself when the picture cannot be shown.
    m_picPreview->showPicture(m_platform.programFolder + GetPicName(button->text()),
                              button->text());
}
