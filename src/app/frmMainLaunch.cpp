// Starting the emulator on the selected ROM.

#include "app/frmMain.h"

#include "emulator/LeadingNumber.h"
#include "library/RomListModel.h"
#include "platform/Dialogs.h"
#include "platform/FileSystem.h"
#include "platform/Platform.h"
#include "platform/SettingsStore.h"
#include "platform/Shell.h"
#include "settings/DefaultPaths.h"
#include "settings/SwitchRules.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/cTextBoxXP.h"

#include <QApplication>
#include <QCheckBox>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>

namespace {

// A PC controller the user switched off, or one that none of the selected controllers
// can use.
bool isInactive(const QCheckBox* box) {
    return box->checkState() == Qt::Checked || box->testAttribute(Qt::WA_ForceDisabled);
}

void showBalloon(QWidget* box, int icon, const QString& title, const QString& text) {
    cTextBoxXP tip;
    tip.setTextBox(box);
    tip.setBalloonTipIcon(icon);
    tip.setBalloonTipTitle(title);
    tip.setBalloonTipText(text);
    tip.ShowBalloonTip();
}

} // namespace

void frmMain::LoadROM(bool ForceLoad) {
    const QString z26Path =
        m_platform.store.GetSetting(QStringLiteral("Settings"), QStringLiteral("Z26Path"));
    if (!FileExist(z26Path)) {
        m_platform.dialogs.MsgBox(this,
                                  QStringLiteral("z26 path isn't valid.\n\nTry removing the z26 "
                                                 "path and re-adding it to correct the problem."),
                                  MsgButtons::Ok, MsgIcon::Exclamation,
                                  QStringLiteral("Invalid z26 Path"));
        QCoreApplication::processEvents();
        return;
    }

    // From here on anything unexpected (no row selected, an emulator that cannot be
    // started) ends the launch quietly.
    const QString emulator = GetShortPath(completeZ26Path(z26Path));
    if (emulator.isEmpty() || !QFileInfo(emulator).isFile())
        return;

    const int row = vbalListViewCtl1->selectedRow();
    if (row < 0)
        return;
    const QString romPath = GetShortPath(m_listModel->rowPath(row));
    if (!FileExist(romPath)) {
        m_platform.dialogs.MsgBox(
            this,
            QStringLiteral("ROM path isn't valid.\n\nTry removing the ROM paths and re-adding "
                           "them to correct the problem."),
            MsgButtons::Ok, MsgIcon::Exclamation, QStringLiteral("Invalid ROM Path"));
        QCoreApplication::processEvents();
        return;
    }

    frmSettings& settings = settingsWindow();
    const auto showSettingsOn = [&settings](const QString& tab) {
        settings.show();
        settings.raise();
        settings.activateWindow();
        settings.SelectTab(tab);
        QCoreApplication::processEvents();
    };

    if (isInactive(settings.chkIPCKeyboard) && isInactive(settings.chkIPCJoystick) &&
        isInactive(settings.chkIPCMouse) && isInactive(settings.chkIPCStella)) {
        const MsgResult answer = m_platform.dialogs.MsgBox(
            this,
            QStringLiteral("It's going to be difficult playing the game\nwith all the available "
                           "Controllers inactive\n\nDo you still want to load the ROM?"),
            MsgButtons::YesNoCancel, MsgIcon::Information,
            QStringLiteral("There Are No Active Controllers"));
        if (answer != MsgResult::Yes) {
            showSettingsOn(QStringLiteral("Controls"));
            showBalloon(settings.txtIPC4Balloon, 1,
                        QStringLiteral("There Are No Active Controllers"),
                        QStringLiteral("Allowing at least one controller to be\r\nactive will "
                                       "make gameplay much easier."));
            return;
        }
    }

    if (settings.chkLowerSens->checkState() == Qt::Checked &&
        leadingNumber(settings.txtLowerSens->text()) == 0) {
        showSettingsOn(QStringLiteral("PaddlesAudio"));
        showBalloon(settings.txtLowerSens, 3, QStringLiteral("Zero Value"),
                    QStringLiteral("Number Cannot Be Zero"));
        return;
    }
    if (settings.optFPScustom->isChecked() && leadingNumber(settings.txtFPScustom->text()) == 0) {
        showSettingsOn(QStringLiteral("Video"));
        showBalloon(settings.txtFPScustom, 3, QStringLiteral("Zero Value"),
                    QStringLiteral("Number Cannot Be Zero"));
        return;
    }

    QString switchText = ForceLoad ? settings.txtDOSOutput->text() : settings.LaunchSwitches();
    settings.lblDOSOutput->setText(switchText);
    settings.lblDOSOutput->setToolTip(switchText);
    if (settings.txtDOSOutput->text() != switchText)
        settings.txtDOSOutput->setText(switchText);
    switchText = switches::withoutLeadingBlank(switchText);

    if (ForceLoad || settings.chkDOSSwitch->checkState() == Qt::Unchecked) {
        // Never through a shell: the ROM's path is one argument whatever it holds.
        m_platform.shell.StartProgram(emulator, switches::emulatorArguments(romPath, switchText));
        return;
    }

    // "Edit Switches": the user reviews the switches and starts the game with Enter.
    showSettingsOn(QStringLiteral("Debug"));
    settings.txtDOSOutput->setFocus();
}
