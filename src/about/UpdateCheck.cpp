#include "about/UpdateCheck.h"

#include "platform/Dialogs.h"
#include "platform/Downloader.h"
#include "platform/Platform.h"
#include "platform/Shell.h"
#include "platform/WebAddresses.h"

#include <QCoreApplication>
#include <QCursor>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QSaveFile>
#include <QTemporaryDir>
#include <QUrl>

#include <cstdio>
#include <optional>
#include <utility>

namespace {

constexpr QLatin1String kFailedCheckTitle{"Update Check Failed"};
constexpr QLatin1String kNoUpdateTitle{"No update needed"};

// A busy cursor for as long as a blocking download runs.
class BusyCursor {
public:
    BusyCursor() { QGuiApplication::setOverrideCursor(Qt::WaitCursor); }
    ~BusyCursor() { QGuiApplication::restoreOverrideCursor(); }
    BusyCursor(const BusyCursor&) = delete;
    BusyCursor& operator=(const BusyCursor&) = delete;
};

bool isWebAddress(const QString& text) {
    const QUrl url(text, QUrl::StrictMode);
    const QString scheme = url.scheme().toLower();
    return url.isValid() && (scheme == u"http" || scheme == u"https") && !url.host().isEmpty();
}

} // namespace

UpdateCheck::UpdateCheck(Platform& platform, QWidget* owner, QString serverBase,
                         ProductVersion product)
    : m_platform(platform), m_owner(owner), m_serverBase(std::move(serverBase)),
      m_product(std::move(product)) {}

QString UpdateCheck::localCopyPath() const {
    return m_platform.programFolder + QStringLiteral("/tmp");
}

QString UpdateCheck::updateFolder() const {
    return m_platform.programFolder + QStringLiteral("/Update");
}

bool UpdateCheck::canWrite(const QString& path) {
    if (QFileInfo(path).isDir())
        return false;
    QSaveFile probe(path);
    if (!probe.open(QIODevice::WriteOnly))
        return false;
    probe.cancelWriting();
    return true;
}

bool UpdateCheck::download(const QString& url, const QString& localFilename) {
    const BusyCursor busy;
    return m_platform.network.DownloadFile(url, localFilename);
}

bool UpdateCheck::downloadNonEmpty(const QString& url, const QString& localFilename) {
    const QString partial = localFilename + QStringLiteral(".part");
    const bool ok = download(url, partial) && QFileInfo(partial).size() > 0 &&
                    std::rename(QFile::encodeName(partial).constData(),
                                QFile::encodeName(localFilename).constData()) == 0;
    if (!ok)
        QFile::remove(partial);
    return ok;
}

void UpdateCheck::reportFailedCheck(const QString& text) {
    m_platform.dialogs.MsgBox(m_owner, text, MsgButtons::Ok, MsgIcon::Information,
                              kFailedCheckTitle);
}

UpdateCheck::Outcome UpdateCheck::Run(bool forumRequest) {
    // The program folder of an installed copy cannot be written: the description then
    // goes to a private temporary folder, rather than the check failing as if offline.
    QString localCopy = localCopyPath();
    std::optional<QTemporaryDir> spare;
    if (!canWrite(localCopy)) {
        spare.emplace();
        if (spare->isValid())
            localCopy = spare->filePath(QStringLiteral("tmp"));
    }
    if (!download(m_serverBase + web::kUpdateDescriptionPath, localCopy)) {
        reportFailedCheck(QStringLiteral("Failed to connect to the internet"));
        return Outcome::Finished;
    }

    UpdateSection section;
    {
        QFile file(localCopy);
        if (!file.open(QIODevice::ReadOnly)) {
            reportFailedCheck(QStringLiteral("The update information could not be read."));
            return Outcome::Finished;
        }
        section = readUpdateSection(file, m_product.name, forumRequest);
    }

    if (forumRequest) {
        openForum(section);
        return Outcome::Finished;
    }
    switch (section.status) {
    case UpdateSection::Status::NotFound:
        m_platform.dialogs.MsgBox(m_owner, QStringLiteral("No Updates Found"), MsgButtons::Ok,
                                  MsgIcon::None, QStringLiteral("No updates available"));
        return Outcome::Finished;
    case UpdateSection::Status::Truncated:
        reportFailedCheck(QStringLiteral("The update information is incomplete."));
        return Outcome::Finished;
    case UpdateSection::Status::BadVersion:
        reportFailedCheck(QStringLiteral("The update information holds no valid version."));
        return Outcome::Finished;
    case UpdateSection::Status::Complete:
        break;
    }
    return runUpdate(section);
}

void UpdateCheck::openForum(const UpdateSection& section) {
    // Without a section, or with something other than a web page in it, the general forum
    // stands in: the description file must not make the desktop open local files.
    if (section.status == UpdateSection::Status::Complete && isWebAddress(section.forumUrl))
        m_platform.shell.OpenUrl(section.forumUrl);
    else
        m_platform.shell.OpenUrl(m_serverBase + web::kForumPath);
}

UpdateCheck::Outcome UpdateCheck::runUpdate(const UpdateSection& section) {
    if (!section.message.isEmpty())
        m_platform.dialogs.MsgBox(m_owner, section.message, MsgButtons::Ok, MsgIcon::Information,
                                  QStringLiteral("Update Message"));

    const qint64 own = versionNumber(m_product);
    if (own == section.availableVersion) {
        m_platform.dialogs.MsgBox(m_owner,
                                  QStringLiteral("You have the current version ") +
                                      versionText(m_product) + QStringLiteral(" Released ") +
                                      section.releaseDate + QStringLiteral("\nNo update is needed"),
                                  MsgButtons::Ok, MsgIcon::None, kNoUpdateTitle);
        return Outcome::Finished;
    }
    if (own > section.availableVersion) {
        m_platform.dialogs.MsgBox(m_owner,
                                  QStringLiteral("Huh, that's odd... \n"
                                                 "This Version is newer that what's available\n"
                                                 "on the internet."),
                                  MsgButtons::Ok, MsgIcon::None, kNoUpdateTitle);
        return Outcome::Finished;
    }

    // The file name comes from the web: it must not lead out of the Update folder.
    if (!isSafeInstallerFileName(section.installerFileName)) {
        reportFailedCheck(QStringLiteral("The update names an installer file that cannot be "
                                         "accepted: \"%1\"")
                              .arg(section.installerFileName));
        return Outcome::Finished;
    }

    const MsgResult answer = m_platform.dialogs.MsgBox(
        m_owner,
        QStringLiteral("Version ") + versionTextFromNumber(section.availableVersion) +
            QStringLiteral(" released ") + section.releaseDate +
            QStringLiteral(" is available.\n\nDo you wish to update now?"),
        MsgButtons::YesNoCancel, MsgIcon::None, QStringLiteral("Update available"));
    if (answer != MsgResult::Yes)
        return Outcome::Finished;

    const QString installerPath = updateFolder() + u'/' + section.installerFileName;
    if (!QFileInfo(updateFolder()).isDir())
        QDir().mkpath(updateFolder());
    // An installer arrives whole and with something in it, or the older one stays.
    if (!downloadNonEmpty(section.installerUrl, installerPath)) {
        m_platform.dialogs.MsgBox(m_owner, QStringLiteral("Failed to Download Update"),
                                  MsgButtons::Ok, MsgIcon::None, QStringLiteral("Download Failed"));
        return Outcome::Finished;
    }

    if (section.runFlag == u"1") {
        QCoreApplication::processEvents();
        // A download never arrives executable; the user agreed to run it.
        QFile::setPermissions(installerPath, QFile::permissions(installerPath) |
                                                 QFileDevice::ExeOwner | QFileDevice::ExeUser);
        const QStringList arguments = {
            QStringLiteral("/SP-"), QStringLiteral("/silent"), QStringLiteral("/noicons"),
            QStringLiteral("/dir=") + QDir::toNativeSeparators(m_platform.programFolder)};
        if (m_platform.shell.StartProgram(installerPath, arguments))
            return Outcome::EndProgram;
        // The installer would not start: keep running and say where the file is instead.
    }
    m_platform.dialogs.MsgBox(m_owner,
                              QStringLiteral("The update has been downloaded to ") +
                                  QDir::toNativeSeparators(installerPath) + u'\n',
                              MsgButtons::Ok, MsgIcon::Information,
                              QStringLiteral("Download Complete"));
    m_platform.shell.OpenFolder(m_platform.programFolder);
    return Outcome::Finished;
}
