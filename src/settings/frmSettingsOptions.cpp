// The settings window's options: every option control edits one EmulatorOptions value,
// which is then shown back with the control states that follow from it and the preview of
// the switches; option sets saved and loaded; the layout-picture buttons.

#include "settings/frmSettingsUi.h"

#include "emulator/OptionFile.h"
#include "emulator/OptionRules.h"
#include "emulator/Switches.h"
#include "platform/Dialogs.h"
#include "platform/Platform.h"
#include "settings/frmPicPreview.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QDir>
#include <QEvent>
#include <QFileInfo>
#include <QFocusEvent>
#include <QGroupBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTimer>

namespace {

const QString kDialogTitle = QStringLiteral("Choose File to Save Configuration");
const QString kDialogFilter =
    QStringLiteral("lum configurations (*.lum)|*.lum|All Files (*.*)|*.*");

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

void showFrame(QWidget* frame, bool bOn) {
    frame->setVisible(bOn);
    frame->setEnabled(bOn);
}

// The option-set chooser of both buttons. It opens in the user's own folder, made if need
// be, where a Default.lum saved becomes the options lum starts with.
FileDialogRequest optionSetRequest(const QString& userFolder, unsigned flags) {
    QDir().mkpath(userFolder);
    FileDialogRequest request;
    request.title = kDialogTitle;
    request.filter = kDialogFilter;
    request.filterIndex = 1;
    request.initialFolder = userFolder;
    request.flags = flags;
    return request;
}

// What the menu's Load says when a set could not be loaded: the file and why.
QString loadFailure(const QString& path, const OptionSetRead& read) {
    QString why = read.error;
    if (read.status == OptionSetRead::Status::Short)
        why = QStringLiteral("It is too short to be a lum settings file.");
    else if (read.status == OptionSetRead::Status::Invalid)
        why = QStringLiteral("It holds a value lum cannot use, so it is corrupt. The settings "
                             "before that value were loaded; please verify them and re-save.");
    return QStringLiteral("%1 could not be loaded:\n%2").arg(QDir::toNativeSeparators(path), why);
}

} // namespace

void frmSettings::connectOptionControls() {
    m_ui->binding = std::make_unique<OptionBinding>(*this, m_options);
    connect(m_ui->binding.get(), &OptionBinding::edited, this, &frmSettings::optionEdited);

    // A box or button that switches a number field on also takes the user there.
    const std::pair<const char*, QLineEdit*> fieldSwitches[] = {
        {"chkLineScan", m_ui->txtLineScan},
        {"chkScanLines", m_ui->txtScanLines},
        {"chkLowerSens", m_ui->txtLowerSens},
        {"optFPScustom", m_ui->txtFPScustom},
        {"optFPSmonitor", m_ui->txtFPScustom}};
    for (const auto& [name, field] : fieldSwitches)
        connect(findChild<QAbstractButton*>(QLatin1String(name)), &QAbstractButton::clicked, field,
                [field = field] {
                    if (field->isEnabled())
                        field->setFocus();
                });
    for (QLineEdit* field : {m_ui->txtFPScustom, m_ui->lightGunFields[0], m_ui->lightGunFields[1],
                             m_ui->txtLineScan, m_ui->txtLowerSens, m_ui->txtScanLines})
        field->installEventFilter(this);

    // The warning answers the user's pick only (each pick, even of the same entry); a
    // loaded file that sets the list shows nothing.
    connect(m_ui->comboVideoMode, &QComboBox::activated, this, &frmSettings::comboVideoMode_Click);
#if QT_VERSION >= QT_VERSION_CHECK(6, 7, 0)
    connect(m_ui->chkDOSSwitch, &QCheckBox::checkStateChanged, this,
            &frmSettings::chkDOSSwitch_Click);
#else
    connect(m_ui->chkDOSSwitch, &QCheckBox::stateChanged, this, &frmSettings::chkDOSSwitch_Click);
#endif
    connect(m_ui->txtDOSOutput, &QLineEdit::returnPressed, this,
            [this] { emit launchRequested(true); });

    connect(m_ui->BarColorPhos, &vbalProgressBar::DblClick, this,
            &frmSettings::BarColorPhos_DblClick);
    vbalProgressBar* queue = m_ui->BarColorSoundQueue;
    connect(queue, &vbalProgressBar::DblClick, this, &frmSettings::BarColorSoundQueue_DblClick);
    connect(queue, &vbalProgressBar::KeyPress, this, &frmSettings::BarColorSoundQueue_KeyPress);
    connect(queue, &vbalProgressBar::RightClick, this, &frmSettings::BarColorSoundQueue_RightClick);

    showOptions(true);
}

void frmSettings::setOptions(const EmulatorOptions& options) {
    m_options = options;
    showOptions(true);
}

void frmSettings::optionEdited() {
    showOptions(false);
    emit optionsChanged(m_options);
}

void frmSettings::showOptions(bool bRescaleSoundQueue) {
    m_options = withTidyNumbers(m_options);
    m_ui->binding->show(m_options, bRescaleSoundQueue);
    RefreshOptionStates();
}

void frmSettings::RefreshOptionStates() {
    const OptionStates states = optionStates(m_options);
    showFrame(m_ui->fraLightgun, states.lightGun);
    for (std::size_t i = 0; i < m_ui->ipc.size(); ++i)
        m_ui->ipc[i]->setEnabled(states.pcDevices[i]);
    showFrame(m_ui->fraPaddleSens, states.keyboardPaddle);
    m_ui->txtScanLines->setEnabled(states.scanLinesField);
    m_ui->txtLineScan->setEnabled(states.startLineField);
    m_ui->txtLowerSens->setEnabled(states.lowerSensitivityField);
    m_ui->txtFPScustom->setEnabled(states.customFrameRateField);
    if (states.leftLayout)
        m_ui->pictureButtons[0]->setText(QLatin1String(states.leftLayout));
    if (states.rightLayout)
        m_ui->pictureButtons[1]->setText(QLatin1String(states.rightLayout));

    const QString preview = launchSwitches(m_options).mid(1);
    if (m_ui->txtDOSOutput->text() != preview)
        m_ui->txtDOSOutput->setText(preview);
    m_ui->lblDOSOutput->setText(preview);
    m_ui->lblDOSOutput->setToolTip(preview);
}

bool frmSettings::numberFieldEvent(QObject* watched, QEvent* event) {
    auto* field = qobject_cast<QLineEdit*>(watched);
    const std::array fields = {m_ui->txtFPScustom, m_ui->lightGunFields[0], m_ui->lightGunFields[1],
                               m_ui->txtLineScan,  m_ui->txtLowerSens,      m_ui->txtScanLines};
    if (field == nullptr || std::find(fields.begin(), fields.end(), field) == fields.end())
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
    default:
        return false;
    }
}

void frmSettings::comboVideoMode_Click() {
    if (m_options.videoStart == VideoStart::Default)
        showBalloonTip(QStringLiteral("txtVidModeBalloon"), 1,
                       QStringLiteral("Default Video Mode Selected"),
                       QStringLiteral("You need to select either 'Fullscreen' or\r\n"
                                      "'Window' for the Video Mode to be enabled."));
}

void frmSettings::chkDOSSwitch_Click() {
    const bool bEdit = switchEditing();
    m_ui->txtDOSOutput->setVisible(bEdit);
    m_ui->lblDOSOutput->setVisible(!bEdit);
    m_ui->lblDOSSwitchInstruction->setVisible(bEdit);
    if (bEdit)
        m_ui->txtDOSOutput->setFocus();
}

bool frmSettings::switchEditing() const {
    return m_ui->chkDOSSwitch->checkState() != Qt::Unchecked;
}

QString frmSettings::editedSwitches() const {
    return m_ui->txtDOSOutput->text();
}

void frmSettings::showSwitches(const QString& switchText) {
    m_ui->lblDOSOutput->setText(switchText);
    m_ui->lblDOSOutput->setToolTip(switchText);
    if (m_ui->txtDOSOutput->text() != switchText)
        m_ui->txtDOSOutput->setText(switchText);
}

void frmSettings::editSwitches() {
    showPage(QStringLiteral("Debug"));
    m_ui->txtDOSOutput->setFocus();
}

// ---- option sets ----

bool frmSettings::LoadSettings(const QString& path) {
    return LoadSettings(readOptionFile(path, m_options));
}

bool frmSettings::LoadSettings(const OptionSetRead& optionSet) {
    // A file that cannot be read or is too short applies nothing; one with a value the
    // window cannot show applies every option before that one.
    setOptions(optionSet.options);
    return optionSet.ok() || reportCorruptOptionSet(QString());
}

bool frmSettings::reportCorruptOptionSet(const QString& why) {
    if (why.isEmpty())
        m_platform.dialogs.MsgBox(this,
                                  QStringLiteral(".lum file is corrupt\r\n"
                                                 "Please verify settings and re-save to correct "
                                                 "this problem"),
                                  MsgButtons::Ok, MsgIcon::None);
    else
        m_platform.dialogs.MsgBox(this, why, MsgButtons::Ok, MsgIcon::Exclamation);
    show();
    selectPage(QStringLiteral("Settings"));
    return false;
}

void frmSettings::showConfigStatus(const QString& text, const QString& tip) {
    m_ui->lblConfig->setText(text);
    m_ui->lblConfig->setToolTip(tip);
}

void frmSettings::cmdSaveDat_Click() {
    saveOptionSet(false);
}

void frmSettings::saveOptionSetFromMenu() {
    saveOptionSet(true);
}

void frmSettings::cmdLoadDat_Click() {
    loadOptionSet(false);
}

void frmSettings::loadOptionSetFromMenu() {
    loadOptionSet(true);
}

void frmSettings::saveOptionSet(bool bFromMenu) {
    const QString chosen = m_platform.dialogs.ShowSave(
        this, optionSetRequest(m_platform.userFolder, kFlagOverwritePrompt));
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
    QString whyNot;
    const bool bSaved = writeOptionFile(path, m_options, &whyNot);
    showConfigStatus(bSaved ? fileTitle + QStringLiteral(" was succesfully saved")
                            : QStringLiteral("error saving ") + fileTitle,
                     QString());
    // From the main window's menu the status line may be out of sight.
    if (!bSaved && bFromMenu)
        m_platform.dialogs.MsgBox(this,
                                  QStringLiteral("%1 could not be saved:\n%2")
                                      .arg(QDir::toNativeSeparators(path), whyNot),
                                  MsgButtons::Ok, MsgIcon::Exclamation);
}

void frmSettings::loadOptionSet(bool bFromMenu) {
    const QString path = m_platform.dialogs.ShowOpen(
        this, optionSetRequest(m_platform.userFolder, kFlagPathMustExist | kFlagFileMustExist));
    if (path.isEmpty())
        return;

    const OptionSetRead optionSet = readOptionFile(path, m_options);
    setOptions(optionSet.options);
    const bool bLoaded =
        optionSet.ok() ||
        reportCorruptOptionSet(bFromMenu ? loadFailure(path, optionSet) : QString());
    QCoreApplication::processEvents();
    const QString fileTitle = QFileInfo(path).fileName();
    showConfigStatus(bLoaded ? fileTitle + QStringLiteral(" was succesfully loaded")
                             : fileTitle + QStringLiteral(" is corrupt.  Plese verify settings "
                                                          "an re-save to correct the problem"),
                     QString());
}

// ---- layout pictures ----

QString frmSettings::GetPicName(const QString& cmdTxt) {
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

void frmSettings::showControlPic(bool bLeft) {
    const QString caption = m_ui->pictureButtons[bLeft ? 0 : 1]->text();
    if (!m_picPreview)
        m_picPreview = new frmPicPreview(m_platform, this);
    // Says "Error loading pic" itself when the picture cannot be shown.
    m_picPreview->showPicture(m_platform.programFolder + GetPicName(caption), caption);
}
