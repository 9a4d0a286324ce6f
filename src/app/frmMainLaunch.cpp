// Starting the emulator on the selected ROM.

#include "app/frmMain.h"

#include "app/CommandLine.h"

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
#include <QTemporaryDir>

void frmMain::LoadROM(bool ForceLoad) {
    launchRom(m_commandLineRom.isEmpty() ? selectedRowPath() : m_commandLineRom, ForceLoad);
}

frmMain::Launch frmMain::launchRom(const QString& romFile, bool ForceLoad) {
    const QString z26Path = read(m_platform.store, stored::z26Path);
    if (!FileExist(z26Path)) {
        m_platform.dialogs.MsgBox(boxOwner(),
                                  QStringLiteral("z26 path isn't valid.\n\nTry removing the z26 "
                                                 "path and re-adding it to correct the problem."),
                                  MsgButtons::Ok, MsgIcon::Exclamation,
                                  QStringLiteral("Invalid z26 Path"));
        QCoreApplication::processEvents();
        return Launch::NotStarted;
    }

    if (romFile.isEmpty())
        return Launch::NotStarted;
    const QString emulator = GetShortPath(completeZ26Path(z26Path));
    if (emulator.isEmpty() || !QFileInfo(emulator).isFile()) {
        launchFailed(completeZ26Path(z26Path), QStringLiteral("There is no program file there."));
        return Launch::NotStarted;
    }
    QString romPath = GetShortPath(romFile);
    if (!FileExist(romPath)) {
        m_platform.dialogs.MsgBox(
            boxOwner(),
            QStringLiteral("ROM path isn't valid.\n\nTry removing the ROM paths and re-adding "
                           "them to correct the problem."),
            MsgButtons::Ok, MsgIcon::Exclamation, QStringLiteral("Invalid ROM Path"));
        QCoreApplication::processEvents();
        return Launch::NotStarted;
    }
    if (isRomArchiveName(romPath)) {
        const ArchiveResult unpacked = unpackArchive(romPath);
        if (unpacked.path.isEmpty()) {
            m_platform.dialogs.MsgBox(
                boxOwner(),
                QStringLiteral("No ROM could be taken from the archive:\n\n") +
                    readableName(QDir::toNativeSeparators(romFile)) + QStringLiteral("\n\n") +
                    unpacked.error,
                MsgButtons::Ok, MsgIcon::Exclamation, QStringLiteral("Archive Not Usable"));
            return Launch::NotStarted;
        }
        romPath = unpacked.path;
    }

    frmSettings& settings = settingsWindow();
    const EmulatorOptions& options = settings.options();
    for (const LaunchGuard& guard : launchGuards(options)) {
        if (!guard.question.isEmpty() &&
            m_platform.dialogs.MsgBox(boxOwner(), guard.question, MsgButtons::YesNoCancel,
                                      MsgIcon::Information, guard.title) == MsgResult::Yes)
            continue;
        if (!m_commandLineRom.isEmpty() && !settings.isVisible()) {
            // Mended in a window that ends with the run, an option would be lost: say what
            // to mend in lum instead.
            m_platform.dialogs.MsgBox(
                boxOwner(),
                QStringLiteral("The ROM was not started:\n\n") + QDir::toNativeSeparators(romFile) +
                    QStringLiteral("\n\n") +
                    QString(guard.text).replace(QStringLiteral("\r\n"), QStringLiteral(" ")) +
                    QStringLiteral("\n\nMend it on the page \"") +
                    frmSettings::pageCaption(guard.page) +
                    QStringLiteral("\" of lum's Settings, Configuration, and save the options "
                                   "as Default.lum."),
                MsgButtons::Ok, MsgIcon::Exclamation, guard.title);
            return Launch::NotStarted;
        }
        settings.showPage(guard.page);
        settings.showBalloonTip(guard.anchor, guard.icon, guard.title, guard.text);
        return Launch::NotStarted;
    }

    QString switchText = ForceLoad ? settings.editedSwitches() : launchSwitches(options);
    settings.showSwitches(switchText);
    switchText = switches::withoutLeadingBlank(switchText);

    if (ForceLoad || !settings.switchEditing()) {
        // Never through a shell: the ROM's path is one argument whatever it holds.
        QString whyNot;
        if (!m_platform.shell.StartProgram(emulator,
                                           switches::emulatorArguments(romPath, switchText),
                                           emulatorWorkingFolder(emulator), &whyNot)) {
            launchFailed(emulator, whyNot);
            return Launch::NotStarted;
        }
        writeRecentRoms(m_platform.store, withRecentRom(readRecentRoms(m_platform.store),
                                                        QFileInfo(romFile).absoluteFilePath()));
        fillRecentMenu(true);
        if (!m_commandLineRom.isEmpty())
            emit commandLineDone(0);
        return Launch::Started;
    }

    // "Edit Switches": the user reviews the switches and starts the game with Enter.
    settings.editSwitches();
    return Launch::EditingSwitches;
}

std::optional<int> frmMain::startFromCommandLine(const CommandLine& command) {
    if (command.mode == CommandLine::Mode::Refuse) {
        m_platform.dialogs.MsgBox(nullptr, command.text, MsgButtons::Ok, MsgIcon::Exclamation);
        return command.exitStatus;
    }
    m_catalogue.dropPrefetch(); // no list this run
    m_commandLineRom = command.romPath;
    loadStartOptions();
    storedOrFoundZ26Path();
    switch (launchRom(m_commandLineRom, false)) {
    case Launch::Started:
        return 0;
    case Launch::NotStarted:
        return 1;
    case Launch::EditingSwitches:
        break;
    }
    // The run ends with z26 started from the edited switches, or with the window closed.
    settingsWindow().installEventFilter(this);
    return std::nullopt;
}

ArchiveResult frmMain::unpackArchive(const QString& archive) {
    if (!m_unpacked) {
        // Private: other users of the machine need not see what is played.
        QDir().mkpath(m_platform.runtimeFolder);
        QFile::setPermissions(m_platform.runtimeFolder,
                              QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        m_unpacked =
            std::make_unique<QTemporaryDir>(m_platform.runtimeFolder + QStringLiteral("/XXXXXX"));
    }
    if (!m_unpacked->isValid())
        return {QString(), QStringLiteral("There is no folder to extract it into: ") +
                               m_unpacked->errorString() + u'.'};
    // A command-line run ends as z26 starts: the file must outlive it (the session clears
    // the runtime folder).
    m_unpacked->setAutoRemove(m_commandLineRom.isEmpty());
    return extractFirstRom(archive, m_unpacked->path());
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

QWidget* frmMain::boxOwner() {
    // A command-line start keeps this window hidden: its boxes stand alone.
    return isVisible() ? this : nullptr;
}

void frmMain::launchFailed(const QString& emulator, const QString& reason) {
    m_platform.dialogs.MsgBox(boxOwner(),
                              QStringLiteral("z26 could not be started:\n\n") +
                                  QDir::toNativeSeparators(emulator) + QStringLiteral("\n\n") +
                                  reason,
                              MsgButtons::Ok, MsgIcon::Critical, QStringLiteral("Launch Failed"));
}
