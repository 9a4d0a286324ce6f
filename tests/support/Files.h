#pragma once

// Files for the tests: their bytes, pictures, and the disks and permissions that refuse them.

#include <QBuffer>
#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QImage>
#include <QString>
#include <QStringList>

#include <csignal>
#include <cstring>

#include <linux/capability.h>
#include <sys/resource.h>
#include <sys/syscall.h>
#include <unistd.h>

// A file's bytes; a marker when it cannot be read, so that a lost file never compares equal.
inline QByteArray fileBytes(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<unreadable>");
}

// Writes `bytes` to `path`, replacing what was there; false when that failed.
inline bool putFile(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    return file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size();
}

// Everything in a folder, hidden files too, so that a left-over temporary file shows.
inline QStringList folderEntries(const QString& folder) {
    return QDir(folder).entryList(QDir::AllEntries | QDir::System | QDir::Hidden |
                                  QDir::NoDotAndDotDot);
}

// A plain picture of the given size in a file format ("PNG", "JPG").
inline QByteArray encodedPicture(int width, int height, const char* format) {
    QImage image(width, height, QImage::Format_RGB32);
    image.fill(Qt::darkCyan);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, format);
    return bytes;
}

// While it lives, files cannot grow past `bytes`: writes fail as they do on a full disk.
// (Tests run as root, which passes every permission check, but not this.)
class DiskFull {
public:
    explicit DiskFull(rlim_t bytes) {
        getrlimit(RLIMIT_FSIZE, &m_saved);
        m_oldHandler = std::signal(SIGXFSZ, SIG_IGN); // a failed write, not a dead process
        rlimit limit = m_saved;
        limit.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~DiskFull() {
        setrlimit(RLIMIT_FSIZE, &m_saved);
        std::signal(SIGXFSZ, m_oldHandler);
    }
    DiskFull(const DiskFull&) = delete;
    DiskFull& operator=(const DiskFull&) = delete;

private:
    rlimit m_saved{};
    void (*m_oldHandler)(int) = nullptr;
};

// A file that exists but cannot be read, replacing any there; its path, or "" when it could
// not be made. For an ordinary user `content` without permission bits; root reads through
// those, so a link to /proc/self/mem stands in: it opens, and every read at its start fails.
inline QString makeUnreadable(const QString& path, const QByteArray& content = {}) {
    QFile::remove(path);
    if (geteuid() == 0)
        return QFile::link(QStringLiteral("/proc/self/mem"), path) ? path : QString();
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly) || file.write(content) != content.size())
        return QString();
    file.close();
    return QFile::setPermissions(path, {}) ? path : QString();
}

// While it lives, the calling thread cannot pass over permission bits, so that a file or
// folder without them refuses root too: it drops the thread's effective capabilities that
// override read and search permissions, and gives them back when it ends.
class NoPermissionOverride {
public:
    NoPermissionOverride() {
        if (syscall(SYS_capget, &m_header, m_saved) != 0)
            return;
        __user_cap_data_struct lowered[2];
        std::memcpy(lowered, m_saved, sizeof lowered);
        lowered[0].effective &= ~((1u << CAP_DAC_OVERRIDE) | (1u << CAP_DAC_READ_SEARCH));
        m_lowered = syscall(SYS_capset, &m_header, lowered) == 0;
    }
    ~NoPermissionOverride() {
        if (m_lowered)
            syscall(SYS_capset, &m_header, m_saved);
    }
    NoPermissionOverride(const NoPermissionOverride&) = delete;
    NoPermissionOverride& operator=(const NoPermissionOverride&) = delete;

    // False when root kept its override: a test that needs a refused read must then skip.
    bool holds() const { return geteuid() != 0 || m_lowered; }

private:
    __user_cap_header_struct m_header{_LINUX_CAPABILITY_VERSION_3, 0};
    __user_cap_data_struct m_saved[2]{};
    bool m_lowered = false;
};
