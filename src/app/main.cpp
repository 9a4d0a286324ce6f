#include "app/frmMain.h"
#include "platform/Downloader.h"
#include "platform/IniSettingsStore.h"
#include "platform/Platform.h"
#include "platform/QtDialogs.h"
#include "platform/QtShell.h"
#include "platform/Registry.h"
#include "platform/ReportingSettingsStore.h"

#include <QApplication>
#include <QIcon>

int main(int argc, char** argv) {
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
    Platform platform{store,       dialogs,  shell,        QApplication::applicationDirPath(),
                      network,     registry, folders.user, folders.cache,
                      folders.data};

    frmMain window(platform);
    window.Form_Load();
    window.show();
    return QApplication::exec();
}
