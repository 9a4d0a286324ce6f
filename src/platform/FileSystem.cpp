#include "platform/FileSystem.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

bool FileExist(const QString& path) {
    if (path.isEmpty())
        return false;
    const QFileInfo info(path);
    const QString name = info.fileName();
    if (!name.contains(u'*') && !name.contains(u'?'))
        return info.exists();
    // A wildcard matches against the names in the folder, hidden ones included.
    QDir folder = info.dir();
    if (!folder.exists())
        return false;
    return !folder
                .entryList({name},
                           QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot)
                .isEmpty();
}

QString GetShortPath(const QString& path) {
    if (path.isEmpty())
        return QString();
    const QFileInfo info(path);
    if (!info.exists())
        return QString();
    return QDir::cleanPath(info.absoluteFilePath());
}

QString findProgramOnPath(const QString& name) {
    const QString found = QStandardPaths::findExecutable(name);
    return found.isEmpty() ? found : QDir::cleanPath(QFileInfo(found).absoluteFilePath());
}
