#include "app/CommandLine.h"

#include "platform/FileSystem.h"

#include <QCommandLineParser>
#include <QDir>
#include <QFileInfo>

#include "lum_version.h"

#include <cerrno>
#include <cstring>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Why a ROM file cannot be opened, or the empty text when it can.
// By the name's bytes, so that a name that is not UTF-8 is found as well.
QString whyUnreadable(const QString& path) {
    const QByteArray bytes = nameToFileSystem(path);
    struct stat status {};
    if (::stat(bytes.constData(), &status) != 0)
        return QStringLiteral("There is no such file.");
    if (S_ISDIR(status.st_mode))
        return QStringLiteral("It is a folder, not a file.");
    const int fd = ::open(bytes.constData(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (fd < 0)
        return QString::fromLocal8Bit(std::strerror(errno));
    ::close(fd);
    return QString();
}

} // namespace

CommandLine parseCommandLine(const QStringList& arguments) {
    QCommandLineParser parser;
    parser.setApplicationDescription(
        QStringLiteral("A front end for the z26 Atari 2600 emulator. Without FILE it shows "
                       "the ROM list; with FILE it starts z26 on that ROM with the options "
                       "of Default.lum."));
    const QCommandLineOption help({QStringLiteral("h"), QStringLiteral("help")},
                                  QStringLiteral("Shows this help and ends."));
    const QCommandLineOption version({QStringLiteral("v"), QStringLiteral("version")},
                                     QStringLiteral("Shows the version and ends."));
    parser.addOption(help);
    parser.addOption(version);
    parser.addPositionalArgument(QStringLiteral("FILE"), QStringLiteral("A ROM file to play."),
                                 QStringLiteral("[FILE]"));

    CommandLine command;
    const QString usage = QStringLiteral("Usage: lum [options] [FILE]\n");
    if (!parser.parse(arguments)) {
        command.mode = CommandLine::Mode::Fail;
        command.text = QStringLiteral("lum: ") + parser.errorText() + u'\n' + usage +
                       QStringLiteral("Try 'lum --help' for more.\n");
        command.exitStatus = 1;
        return command;
    }
    if (parser.isSet(help)) {
        // The parser's own text names the executable from an application object, which
        // --help must not need.
        QString text = parser.helpText();
        text = usage + text.mid(text.indexOf(u'\n') + 1);
        return {CommandLine::Mode::Print, text, {}, 0};
    }
    if (parser.isSet(version))
        return {CommandLine::Mode::Print, QStringLiteral("lum " LUM_VERSION_TEXT "\n"), {}, 0};

    const QStringList files = parser.positionalArguments();
    if (files.isEmpty())
        return command;
    if (files.size() > 1) {
        command.mode = CommandLine::Mode::Fail;
        command.text = QStringLiteral("lum: one ROM file at a time.\n") + usage;
        command.exitStatus = 1;
        return command;
    }
    command.romPath = QFileInfo(files.first()).absoluteFilePath();
    if (const QString why = whyUnreadable(command.romPath); !why.isEmpty()) {
        command.mode = CommandLine::Mode::Refuse;
        command.text = QStringLiteral("The ROM file cannot be opened:\n\n") +
                       QDir::toNativeSeparators(command.romPath) + QStringLiteral("\n\n") + why;
        command.exitStatus = 1;
        return command;
    }
    command.mode = CommandLine::Mode::Launch;
    return command;
}
