#include "platform/QtShell.h"

#include <QDesktopServices>
#include <QFileInfo>
#include <QProcess>
#include <QUrl>

bool QtShell::StartProgram(const QString& program, const QStringList& arguments,
                           const QString& workingFolder, QString* whyNot) {
    QProcess process;
    process.setProgram(program);
    process.setArguments(arguments);
    process.setWorkingDirectory(workingFolder);
    if (process.startDetached())
        return true;
    if (whyNot)
        *whyNot = process.errorString();
    return false;
}

bool QtShell::OpenUrl(const QString& url) {
    return QDesktopServices::openUrl(QUrl(url));
}

bool QtShell::OpenTextFile(const QString& path) {
    if (!QFileInfo(path).isFile())
        return false;
    return QDesktopServices::openUrl(QUrl::fromLocalFile(path));
}

bool QtShell::OpenFolder(const QString& path) {
    if (!QFileInfo(path).isDir())
        return false;
    return QDesktopServices::openUrl(QUrl::fromLocalFile(path));
}
