#include "platform/QtShell.h"

#include "platform/FileSystem.h"

#include <QDesktopServices>
#include <QFileInfo>
#include <QStandardPaths>
#include <QUrl>

#include <cerrno>
#include <cstring>
#include <vector>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

// Starts a program detached from lum (a grandchild that init adopts), with every argument's
// bytes exactly as the file system names them. Returns 0 or the errno that stopped it.
int startDetached(const QByteArray& program, const std::vector<QByteArray>& arguments,
                  const QByteArray& folder) {
    std::vector<char*> argv{const_cast<char*>(program.constData())};
    for (const QByteArray& argument : arguments)
        argv.push_back(const_cast<char*>(argument.constData()));
    argv.push_back(nullptr);

    // The grandchild reports a failed chdir or exec through the pipe; a successful exec
    // closes it unwritten.
    int report[2];
    if (::pipe2(report, O_CLOEXEC) != 0)
        return errno;
    const pid_t child = ::fork();
    if (child < 0) {
        const int error = errno;
        ::close(report[0]);
        ::close(report[1]);
        return error;
    }
    if (child == 0) {
        // Only calls that are safe between fork and exec from here.
        ::close(report[0]);
        ::setsid();
        const pid_t grandchild = ::fork();
        if (grandchild == 0) {
            if (folder.isEmpty() || ::chdir(folder.constData()) == 0)
                ::execv(argv[0], argv.data());
            const int error = errno;
            [[maybe_unused]] const auto written = ::write(report[1], &error, sizeof error);
            ::_exit(127);
        }
        if (grandchild < 0) {
            const int error = errno;
            [[maybe_unused]] const auto written = ::write(report[1], &error, sizeof error);
        }
        ::_exit(0);
    }
    ::close(report[1]);
    int status = 0;
    while (::waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    int error = 0;
    ssize_t got = 0;
    do
        got = ::read(report[0], &error, sizeof error);
    while (got < 0 && errno == EINTR);
    ::close(report[0]);
    return got == sizeof error ? error : 0;
}

} // namespace

bool QtShell::StartProgram(const QString& program, const QStringList& arguments,
                           const QString& workingFolder, QString* whyNot) {
    // A bare name is looked for on PATH, as a shell would.
    QString path = program;
    if (!program.contains(u'/')) {
        path = QStandardPaths::findExecutable(program);
        if (path.isEmpty()) {
            if (whyNot)
                *whyNot = QString::fromLocal8Bit(std::strerror(ENOENT));
            return false;
        }
    }
    std::vector<QByteArray> bytes;
    for (const QString& argument : arguments)
        bytes.push_back(nameToFileSystem(argument));
    const int error = startDetached(nameToFileSystem(path), bytes, nameToFileSystem(workingFolder));
    if (error != 0 && whyNot)
        *whyNot = QString::fromLocal8Bit(std::strerror(error));
    return error == 0;
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
