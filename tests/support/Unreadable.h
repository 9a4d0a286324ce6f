#pragma once

#include <QByteArray>
#include <QFile>
#include <QString>

#include <cstring>

#include <linux/capability.h>
#include <sys/syscall.h>
#include <unistd.h>

// A file that exists but cannot be read; returns its path, or the empty text when it could
// not be made. Any file already there is replaced. For an ordinary user it is `content`
// with no permission bits. Root reads through any permission bits, so for root a link to
// /proc/self/mem stands in: it opens like a regular file, and every read at its start
// fails (EIO).
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

// While it lives, the calling thread has no power to pass over permission bits: a file or
// folder without them refuses root as it refuses anyone (open and opendir fail with
// EACCES), so tests of unreadable files and folders run as root too. It drops only the
// thread's effective capabilities that override read and search permissions, and gives
// them back when it ends; for other users it does nothing.
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

    // False when root kept its override (the capabilities could not be changed): a test
    // that needs a refused read must then skip.
    bool holds() const { return geteuid() != 0 || m_lowered; }

private:
    __user_cap_header_struct m_header{_LINUX_CAPABILITY_VERSION_3, 0};
    __user_cap_data_struct m_saved[2]{};
    bool m_lowered = false;
};
