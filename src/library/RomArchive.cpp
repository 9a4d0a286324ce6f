#include "library/RomArchive.h"

#include "platform/FileSystem.h"

#include <archive.h>
#include <archive_entry.h>

#include <cerrno>
#include <cstring>
#include <memory>

#include <fcntl.h>
#include <unistd.h>

namespace {

bool isGzipName(const QString& path) {
    return path.endsWith(QStringLiteral(".gz"), Qt::CaseInsensitive);
}

// The last part of a stored name: zip files written on Windows may separate with '\'.
QString safeBaseName(const QString& stored, const QString& archive) {
    QString name = stored.mid(qMax(stored.lastIndexOf(u'/'), stored.lastIndexOf(u'\\')) + 1);
    if (name.isEmpty() || name == QStringLiteral(".") || name == QStringLiteral("..")) {
        name = archive.mid(archive.lastIndexOf(u'/') + 1);
        name.truncate(name.lastIndexOf(u'.'));
    }
    return name.isEmpty() || name == QStringLiteral(".") ? QStringLiteral("rom") : name;
}

ArchiveResult failed(const QString& why) {
    return {QString(), why};
}

QString damaged(archive* reader) {
    const char* detail = archive_error_string(reader);
    return QStringLiteral("It is damaged or is not a zip, 7z or gzip file") +
           (detail ? QStringLiteral(" (") + QString::fromLocal8Bit(detail) + u')' : QString()) +
           u'.';
}

bool writeAll(int fd, const char* bytes, size_t size) {
    while (size > 0) {
        const ssize_t written = ::write(fd, bytes, size);
        if (written < 0 && errno == EINTR)
            continue;
        if (written <= 0)
            return false;
        bytes += written;
        size -= static_cast<size_t>(written);
    }
    return true;
}

// Copies the entry's data to a new file at `target`; the error text, or empty on success.
QString copyEntry(archive* reader, const QByteArray& target, const QString& name) {
    // A file left from an earlier start may still be open in z26: it keeps its copy.
    ::unlink(target.constData());
    const int fd =
        ::open(target.constData(), O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, 0600);
    if (fd < 0)
        return QStringLiteral("The file could not be written: ") +
               QString::fromLocal8Bit(std::strerror(errno)) + u'.';
    QString error;
    char buffer[64 * 1024];
    qint64 total = 0;
    for (;;) {
        const la_ssize_t got = archive_read_data(reader, buffer, sizeof buffer);
        if (got == 0)
            break;
        if (got < 0) {
            error = archive_read_has_encrypted_entries(reader) > 0
                        ? QStringLiteral("It is encrypted.")
                        : damaged(reader);
            break;
        }
        // Counted while reading: a header's size may lie.
        total += got;
        if (total > kLargestArchivedRom) {
            error = QStringLiteral("Its first file, ") + readableName(name) +
                    QStringLiteral(", is larger than 16 MiB: too large for a ROM.");
            break;
        }
        if (!writeAll(fd, buffer, static_cast<size_t>(got))) {
            error = QStringLiteral("The file could not be written: ") +
                    QString::fromLocal8Bit(std::strerror(errno)) + u'.';
            break;
        }
    }
    if (::close(fd) != 0 && error.isEmpty())
        error = QStringLiteral("The file could not be written: ") +
                QString::fromLocal8Bit(std::strerror(errno)) + u'.';
    if (!error.isEmpty())
        ::unlink(target.constData());
    return error;
}

} // namespace

bool isRomArchiveName(const QString& path) {
    return isGzipName(path) || path.endsWith(QStringLiteral(".zip"), Qt::CaseInsensitive) ||
           path.endsWith(QStringLiteral(".7z"), Qt::CaseInsensitive);
}

ArchiveResult extractFirstRom(const QString& archivePath, const QString& intoFolder) {
    const std::unique_ptr<archive, decltype(&archive_read_free)> owner(archive_read_new(),
                                                                       archive_read_free);
    archive* reader = owner.get();
    const bool gzip = isGzipName(archivePath);
    if (gzip) {
        // A .gz holds one compressed file and no names: read as it is, through the filter.
        archive_read_support_filter_gzip(reader);
        archive_read_support_format_raw(reader);
    } else {
        archive_read_support_format_zip(reader);
        archive_read_support_format_7zip(reader);
    }
    if (archive_read_open_filename(reader, nameToFileSystem(archivePath).constData(), 64 * 1024) !=
        ARCHIVE_OK)
        return failed(damaged(reader));
    for (;;) {
        archive_entry* entry = nullptr;
        const int status = archive_read_next_header(reader, &entry);
        if (status == ARCHIVE_EOF)
            return failed(QStringLiteral("It holds no file."));
        if (status < ARCHIVE_WARN)
            return failed(archive_read_has_encrypted_entries(reader) > 0
                              ? QStringLiteral("It is encrypted.")
                              : damaged(reader));
        // The raw reader takes any file as it is; only what the filter unpacked is a .gz.
        if (gzip && archive_filter_code(reader, 0) != ARCHIVE_FILTER_GZIP)
            return failed(QStringLiteral("It is not a gzip file."));
        if (archive_entry_filetype(entry) != AE_IFREG)
            continue;
        if (archive_entry_is_encrypted(entry))
            return failed(QStringLiteral("It is encrypted."));
        const char* stored = archive_entry_pathname(entry);
        const QString storedName = gzip || !stored ? QString() : nameFromFileSystem(stored);
        const QString name = safeBaseName(storedName, archivePath);
        const QString target = intoFolder + u'/' + name;
        if (const QString error = copyEntry(reader, nameToFileSystem(target), name);
            !error.isEmpty())
            return failed(error);
        return {target, QString()};
    }
}
