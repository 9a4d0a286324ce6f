#include "settings/DefaultPaths.h"

#include <QDir>
#include <QFileInfo>

namespace {

// "/z26": how a path that already names the emulator ends.
QString z26Suffix() {
    return QLatin1Char('/') + z26FileName();
}

QString withoutTrailingSeparators(QString path) {
    while (path.size() > 1 && path.endsWith(QLatin1Char('/')))
        path.chop(1);
    return path;
}

} // namespace

bool sameFolder(const QString& a, const QString& b) {
    return QDir::cleanPath(QFileInfo(a).absoluteFilePath()) ==
           QDir::cleanPath(QFileInfo(b).absoluteFilePath());
}

bool isArchiveName(const QString& item) {
    return item.size() > 4 && item.endsWith(QLatin1String(".rar"), Qt::CaseInsensitive);
}

QString z26FileName() {
#ifdef Q_OS_WIN
    return QStringLiteral("z26.exe");
#else
    return QStringLiteral("z26");
#endif
}

QString completeZ26Path(const QString& path) {
    // A folder is completed even when its own name is the emulator's, as ~/z26/z26 is a
    // common layout on this platform.
    if (path.endsWith(z26Suffix(), Qt::CaseInsensitive) && !QFileInfo(path).isDir())
        return path;
    const QString folder = withoutTrailingSeparators(path);
    return folder.endsWith(QLatin1Char('/')) ? folder + z26FileName() : folder + z26Suffix();
}

QString z26PathForDisplay(const QString& stored) {
    const QString text = stored.trimmed();
    if (text.size() < z26Suffix().size())
        return text;
    return completeZ26Path(text);
}
