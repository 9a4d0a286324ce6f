#include "about/UpdateDescription.h"

#include "lum_version.h"

#include <QIODevice>
#include <QUrl>

namespace {

constexpr qint64 kMajorUnit = 1048576;
constexpr qint64 kMinorUnit = 1024;

// One line without its line end, or nothing at the end of the file.
std::optional<QString> nextLine(QIODevice& file) {
    if (file.atEnd())
        return std::nullopt;
    QByteArray line = file.readLine();
    while (line.endsWith('\n') || line.endsWith('\r'))
        line.chop(1);
    return QString::fromUtf8(line);
}

} // namespace

ProductVersion thisProduct() {
    return {QStringLiteral(LUM_PRODUCT_NAME), LUM_VERSION_MAJOR, LUM_VERSION_MINOR,
            LUM_VERSION_PATCH};
}

qint64 versionNumber(const ProductVersion& version) {
    return version.major * kMajorUnit + version.minor * kMinorUnit + version.revision;
}

QString versionText(const ProductVersion& version) {
    return QStringLiteral("%1.%2.%3").arg(version.major).arg(version.minor).arg(version.revision);
}

QString versionTextFromNumber(qint64 number) {
    const qint64 major = number / kMajorUnit;
    const qint64 remainder = number - major * kMajorUnit;
    const qint64 minor = remainder / kMinorUnit;
    const qint64 revision = remainder - minor * kMinorUnit;
    return QStringLiteral("%1.%2.%3").arg(major).arg(minor).arg(revision);
}

std::optional<qint64> parseVersionNumber(const QString& line) {
    const QString digits = line.trimmed();
    // Eighteen digits keep every value, and the arithmetic on it, inside 64 bits.
    if (digits.isEmpty() || digits.size() > 18)
        return std::nullopt;
    for (const QChar c : digits)
        if (c < u'0' || c > u'9')
            return std::nullopt;
    return digits.toLongLong();
}

bool isSectionHeader(const QString& line, const QString& productName) {
    return line.size() >= 3 && line.startsWith(u"::") && QStringView(line).mid(2) == productName;
}

bool isWebAddress(const QString& text) {
    const QUrl url(text, QUrl::StrictMode);
    const QString scheme = url.scheme().toLower();
    return url.isValid() && (scheme == u"http" || scheme == u"https") && !url.host().isEmpty();
}

bool isTrustedInstallerAddress(const QString& address, const QString& serverBase) {
    const QUrl url(address, QUrl::StrictMode);
    const QUrl server(serverBase, QUrl::StrictMode);
    return isWebAddress(address) && url.host() == server.host() &&
           (url.scheme().toLower() == u"https" ||
            url.scheme().toLower() == server.scheme().toLower());
}

bool isSafeInstallerFileName(const QString& name) {
    if (name.isEmpty() || name.trimmed().isEmpty() || name == u"." || name.contains(u".."))
        return false;
    for (const QChar c : name)
        if (c == u'/' || c == u'\\' || c.unicode() < 0x20 || c.unicode() == 0x7F)
            return false;
    return true;
}

UpdateSection readUpdateSection(QIODevice& file, const QString& productName, bool forumOnly) {
    UpdateSection section;
    std::optional<QString> line;
    do {
        line = nextLine(file);
        if (!line)
            return section;
    } while (!isSectionHeader(*line, productName));

    section.status = UpdateSection::Status::Truncated;
    const std::optional<QString> forum = nextLine(file);
    if (!forum)
        return section;
    section.forumUrl = *forum;
    if (forumOnly) {
        section.status = UpdateSection::Status::Complete;
        return section;
    }

    // The text starts with a line end of its own, so the box shows an empty first line.
    QString message = QStringLiteral("\n");
    bool anyMessage = false;
    line = nextLine(file);
    while (line && line->startsWith(u'\'')) {
        message += line->mid(1);
        message += u'\n';
        anyMessage = true;
        line = nextLine(file);
    }
    if (anyMessage)
        section.message = message;
    if (!line)
        return section;
    const std::optional<qint64> available = parseVersionNumber(*line);
    if (!available) {
        section.status = UpdateSection::Status::BadVersion;
        return section;
    }
    section.availableVersion = *available;

    QString* const rest[] = {&section.releaseDate, &section.installerUrl,
                             &section.installerFileName, &section.runFlag};
    for (QString* value : rest) {
        line = nextLine(file);
        if (!line)
            return section;
        *value = *line;
    }
    section.status = UpdateSection::Status::Complete;
    return section;
}
