// Starting the emulator on the selected ROM.

#include "app/frmMain.h"

#include "emulator/OptionRules.h"
#include "emulator/Switches.h"
#include "library/RomListModel.h"
#include "platform/Dialogs.h"
#include "platform/FileSystem.h"
#include "platform/Platform.h"
#include "platform/Shell.h"
#include "platform/StoredSettings.h"
#include "settings/DefaultPaths.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

void frmMain::LoadROM(bool ForceLoad) {
    const QString z26Path = read(m_platform.store, stored::z26Path);
    if (!FileExist(z26Path)) {
        m_platform.dialogs.MsgBox(this,
                                  QStringLiteral("z26 path isn't valid.\n\nTry removing the z26 "
                                                 "path and re-adding it to correct the problem."),
                                  MsgButtons::Ok, MsgIcon::Exclamation,
                                  QStringLiteral("Invalid z26 Path"));
        QCoreApplication::processEvents();
        return;
    }

    const int row = vbalListViewCtl1->selectedRow();
    if (row < 0)
        return;
    const QString emulator = GetShortPath(completeZ26Path(z26Path));
    if (emulator.isEmpty() || !QFileInfo(emulator).isFile()) {
        launchFailed(completeZ26Path(z26Path), QStringLiteral("There is no program file there."));
        return;
    }
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
    const EmulatorOptions& options = settings.options();
    for (const LaunchGuard& guard : launchGuards(options)) {
        if (!guard.question.isEmpty() &&
            m_platform.dialogs.MsgBox(this, guard.question, MsgButtons::YesNoCancel,
                                      MsgIcon::Information, guard.title) == MsgResult::Yes)
            continue;
        settings.showPage(guard.page);
        settings.showBalloonTip(guard.anchor, guard.icon, guard.title, guard.text);
        return;
    }

    QString switchText = ForceLoad ? settings.editedSwitches() : launchSwitches(options);
    settings.showSwitches(switchText);
    switchText = switches::withoutLeadingBlank(switchText);

    if (ForceLoad || !settings.switchEditing()) {
        // Never through a shell: the ROM's path is one argument whatever it holds.
        QString whyNot;
        if (!m_platform.shell.StartProgram(emulator,
                                           switches::emulatorArguments(romPath, switchText),
                                           emulatorWorkingFolder(emulator), &whyNot))
            launchFailed(emulator, whyNot);
        return;
    }

    // "Edit Switches": the user reviews the switches and starts the game with Enter.
    settings.editSwitches();
}

QString frmMain::emulatorWorkingFolder(const QString& emulator) const {
    // z26 writes its log and screenshots where it runs: beside itself when it may, in the
    // user's data folder when it was installed read-only.
    const QString own = QFileInfo(emulator).absolutePath();
    if (QFileInfo(own).isWritable())
        return own;
    QDir().mkpath(m_platform.dataFolder);
    return m_platform.dataFolder;
}

void frmMain::launchFailed(const QString& emulator, const QString& reason) {
    m_platform.dialogs.MsgBox(this,
                              QStringLiteral("z26 could not be started:\n\n") +
                                  QDir::toNativeSeparators(emulator) + QStringLiteral("\n\n") +
                                  reason,
                              MsgButtons::Ok, MsgIcon::Critical, QStringLiteral("Launch Failed"));
}
