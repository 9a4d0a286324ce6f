#include "app/CommandLine.h"
#include "app/frmMain.h"
#include "platform/Downloader.h"
#include "platform/FileSystem.h"
#include "platform/IniSettingsStore.h"
#include "platform/Platform.h"
#include "platform/QtDialogs.h"
#include "platform/QtShell.h"
#include "platform/Registry.h"
#include "platform/ReportingSettingsStore.h"

#include <QApplication>
#include <QIcon>

#include <cstdio>

int main(int argc, char** argv) {
    // Read before any display is opened: --help and --version need none.
    QStringList arguments;
    for (int i = 0; i < argc; ++i)
        arguments << nameFromFileSystem(argv[i]); // a ROM's name keeps its bytes
    const CommandLine command = parseCommandLine(arguments);
    if (command.mode == CommandLine::Mode::Print || command.mode == CommandLine::Mode::Fail) {
        std::fputs(command.text.toLocal8Bit().constData(),
                   command.mode == CommandLine::Mode::Print ? stdout : stderr);
        return command.exitStatus;
    }

    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("lum"));
    QApplication::setWindowIcon(QIcon(QStringLiteral(":/lum.png")));
    QGuiApplication::setDesktopFileName(QStringLiteral("lum"));

    IniSettingsStore file(IniSettingsStore::defaultFilePath());
    QtDialogs dialogs;
    ReportingSettingsStore store(file, dialogs, file.filePath());
    QtShell shell;
    QtDownloader network;
    ToolRegistry registry;
    const UserFolders folders = desktopUserFolders();
    Platform platform{
        store,        dialogs,        shell,        QApplication::applicationDirPath(),
        network,      registry,       folders.user, folders.cache,
        folders.data, folders.runtime};

    frmMain window(platform);
    if (command.mode != CommandLine::Mode::Window) {
        if (const std::optional<int> status = window.startFromCommandLine(command))
            return *status;
        QObject::connect(&window, &frmMain::commandLineDone, &app, &QCoreApplication::exit);
        return QApplication::exec();
    }
    window.Form_Load();
    window.show();
    return QApplication::exec();
}
