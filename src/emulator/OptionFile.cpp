#include "emulator/OptionFile.h"

#include <QFile>
#include <QFileInfo>
#include <QSaveFile>

QString withLumExtension(const QString& path) {
    if (path.right(4).toLower() == QLatin1String(".lum"))
        return path;
    return path + QStringLiteral(".lum");
}

bool writeOptionFile(const QString& path, const ConfigRecord& record) {
    const QByteArray bytes = record.encode();
    QSaveFile file(path);
    // Unbuffered, so a short write (a full disk) shows here: a buffered one is flushed by
    // commit(), which does not notice it and would put a cut-off file in place.
    if (!file.open(QIODevice::WriteOnly | QIODevice::Unbuffered))
        return false;
    if (file.write(bytes) != bytes.size()) {
        file.cancelWriting();
        return false;
    }
    return file.commit();
}

ConfigDecode readOptionFile(const QString& path, const ConfigLimits& limits) {
    ConfigDecode unreadable;
    unreadable.status = ConfigStatus::Unreadable;
    unreadable.firstBad = ConfigField::comboVideoMode;

    // Only regular files: a folder cannot be read and a pipe or device could block.
    if (!QFileInfo(path).isFile())
        return unreadable;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return unreadable;
    QByteArray bytes;
    bytes.reserve(ConfigRecord::kSize);
    // read() may return less than asked for before the end, so read until full or done.
    while (bytes.size() < ConfigRecord::kSize) {
        const QByteArray chunk = file.read(ConfigRecord::kSize - bytes.size());
        if (chunk.isEmpty())
            break;
        bytes += chunk;
    }
    if (file.error() != QFileDevice::NoError)
        return unreadable;
    return decodeConfig(bytes, limits);
}
