#include "platform/FileSystem.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

#include <sys/stat.h>

namespace {

constexpr char16_t kStrayByte = 0xDC00;

bool isStrayByte(char16_t unit) {
    return unit >= kStrayByte + 0x80 && unit <= kStrayByte + 0xFF;
}

// The length of the well-formed UTF-8 sequence at `at`, or 0 (RFC 3629: no overlong forms,
// no surrogates, nothing above U+10FFFF).
qsizetype utf8Sequence(QByteArrayView bytes, qsizetype at) {
    const auto byte = [&](qsizetype i) { return static_cast<unsigned char>(bytes[i]); };
    const unsigned char lead = byte(at);
    if (lead < 0x80)
        return 1;
    qsizetype length = 0;
    unsigned char low = 0x80, high = 0xBF;
    if (lead >= 0xC2 && lead <= 0xDF)
        length = 2;
    else if (lead >= 0xE0 && lead <= 0xEF) {
        length = 3;
        low = lead == 0xE0 ? 0xA0 : 0x80;
        high = lead == 0xED ? 0x9F : 0xBF;
    } else if (lead >= 0xF0 && lead <= 0xF4) {
        length = 4;
        low = lead == 0xF0 ? 0x90 : 0x80;
        high = lead == 0xF4 ? 0x8F : 0xBF;
    } else
        return 0;
    if (at + length > bytes.size() || byte(at + 1) < low || byte(at + 1) > high)
        return 0;
    for (qsizetype i = 2; i < length; ++i)
        if (byte(at + i) < 0x80 || byte(at + i) > 0xBF)
            return 0;
    return length;
}

} // namespace

QString nameFromFileSystem(QByteArrayView bytes) {
    QString name;
    name.reserve(bytes.size());
    qsizetype runStart = 0; // of the well-formed bytes not yet converted
    for (qsizetype at = 0; at < bytes.size();) {
        if (const qsizetype length = utf8Sequence(bytes, at); length > 0) {
            at += length;
            continue;
        }
        name += QString::fromUtf8(bytes.sliced(runStart, at - runStart));
        name += QChar(char16_t(kStrayByte + static_cast<unsigned char>(bytes[at])));
        runStart = ++at;
    }
    return name + QString::fromUtf8(bytes.sliced(runStart));
}

QByteArray nameToFileSystem(QStringView name) {
    QByteArray bytes;
    bytes.reserve(name.size());
    qsizetype runStart = 0;
    for (qsizetype i = 0; i <= name.size(); ++i) {
        if (i < name.size() && !isStrayByte(name[i].unicode()))
            continue;
        bytes += name.sliced(runStart, i - runStart).toUtf8();
        if (i < name.size())
            bytes += static_cast<char>(name[i].unicode() - kStrayByte);
        runStart = i + 1;
    }
    return bytes;
}

QString readableName(QStringView name) {
    QString text = name.toString();
    for (QChar& c : text)
        if (isStrayByte(c.unicode()))
            c = QChar(char16_t(c.unicode() - kStrayByte));
    return text;
}

bool FileExist(const QString& path) {
    if (path.isEmpty())
        return false;
    const QFileInfo info(path);
    const QString name = info.fileName();
    if (!name.contains(u'*') && !name.contains(u'?')) {
        struct stat status {};
        return ::stat(nameToFileSystem(path).constData(), &status) == 0;
    }
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
    const QString absolute = QDir::cleanPath(QFileInfo(path).absoluteFilePath());
    struct stat status {};
    if (::stat(nameToFileSystem(absolute).constData(), &status) != 0)
        return QString();
    return absolute;
}

QString findProgramOnPath(const QString& name) {
    const QString found = QStandardPaths::findExecutable(name);
    return found.isEmpty() ? found : QDir::cleanPath(QFileInfo(found).absoluteFilePath());
}
