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
#include <QLabel>
#include <QProgressDialog>
#include <QSaveFile>
#include <QTemporaryDir>
#include <QUrl>

#include <algorithm>
#include <cstdio>
#include <optional>
#include <utility>

namespace {

constexpr QLatin1String kFailedCheckTitle{"Update Check Failed"};
constexpr QLatin1String kNoUpdateTitle{"No update needed"};

// The description is small: a server that sends it a byte at a time must not hold the
// window for longer than this.
constexpr std::chrono::seconds kDescriptionDeadline{30};

// A busy cursor for as long as a blocking download runs.
class BusyCursor {
public:
    BusyCursor() { QGuiApplication::setOverrideCursor(Qt::WaitCursor); }
    ~BusyCursor() { QGuiApplication::restoreOverrideCursor(); }
    BusyCursor(const BusyCursor&) = delete;
    BusyCursor& operator=(const BusyCursor&) = delete;
};

} // namespace

UpdateCheck::UpdateCheck(Platform& platform, QWidget* owner, QString serverBase,
                         ProductVersion product)
    : m_platform(platform), m_owner(owner), m_serverBase(std::move(serverBase)),
      m_product(std::move(product)) {}

QString UpdateCheck::localCopyPath() const {
    return m_platform.cacheFolder + QStringLiteral("/tmp");
}

QString UpdateCheck::updateFolder() const {
    return m_platform.cacheFolder + QStringLiteral("/Update");
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

bool UpdateCheck::downloadDescription(const QString& localFilename) {
    const BusyCursor busy;
    DownloadWatch watch;
    watch.deadline = kDescriptionDeadline;
    return m_platform.network.DownloadFile(m_serverBase + web::kUpdateDescriptionPath,
                                           localFilename, watch);
}

UpdateCheck::Fetched UpdateCheck::downloadInstaller(const QString& url,
                                                    const QString& localFilename) {
    // Application-modal, so that nothing but its Cancel button takes input meanwhile.
    QPointer<QProgressDialog> progress = new QProgressDialog(m_owner);
    progress->setObjectName(QStringLiteral("progressDownload"));
    progress->setWindowTitle(QStringLiteral("Downloading Update"));
    progress->setWindowModality(Qt::ApplicationModal);
    auto* label = new QLabel(progress);
    label->setTextFormat(Qt::PlainText); // the file name comes from the server
    label->setText(QStringLiteral("Downloading ") + QFileInfo(localFilename).fileName() +
                   QStringLiteral(" ..."));
    progress->setLabel(label);
    progress->setAutoReset(false);
    progress->setAutoClose(false);
    progress->setRange(0, 0); // busy until the server tells the size
    progress->show();

    DownloadWatch watch;
    watch.progress = [&progress](qint64 received, qint64 total) {
        if (!progress)
            return false;
        if (total > 0) {
            progress->setMaximum(1000);
            progress->setValue(int(std::min(received, total) * 1000 / total));
        }
        return !progress->wasCanceled();
    };
    // The older installer stays until a new one has arrived whole and with something in it.
    const QString partial = localFilename + QStringLiteral(".part");
    const bool bArrived = m_platform.network.DownloadFile(url, partial, watch);
    const bool bCancelled = !progress || progress->wasCanceled();
    delete progress.data();
    const bool bPlaced = bArrived && !bCancelled && QFileInfo(partial).size() > 0 &&
                         std::rename(QFile::encodeName(partial).constData(),
                                     QFile::encodeName(localFilename).constData()) == 0;
    if (!bPlaced)
        QFile::remove(partial);
    return bPlaced ? Fetched::Whole : bCancelled ? Fetched::Cancelled : Fetched::Failed;
}

void UpdateCheck::reportFailedCheck(const QString& text) {
    m_platform.dialogs.MsgBox(m_owner, text, MsgButtons::Ok, MsgIcon::Information,
                              kFailedCheckTitle);
}

UpdateCheck::Outcome UpdateCheck::Run(bool forumRequest) {
    // When the cache folder cannot be written (a read-only home, something in the way),
    // the description goes to a private temporary folder, rather than the check failing
    // as if offline.
    QDir().mkpath(m_platform.cacheFolder);
    QString localCopy = localCopyPath();
    std::optional<QTemporaryDir> spare;
    if (!canWrite(localCopy)) {
        spare.emplace();
        if (spare->isValid())
            localCopy = spare->filePath(QStringLiteral("tmp"));
    }
    if (!downloadDescription(localCopy)) {
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
    // Nor may the description send the user's machine elsewhere for the program it runs.
    if (!isTrustedInstallerAddress(section.installerUrl, m_serverBase)) {
        reportFailedCheck(QStringLiteral("The update offers its installer from an address that "
                                         "cannot be trusted: \"%1\"\nUpdates are only "
                                         "downloaded over https from %2.")
                              .arg(section.installerUrl, QUrl(m_serverBase).host()));
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
    switch (downloadInstaller(section.installerUrl, installerPath)) {
    case Fetched::Whole:
        break;
    case Fetched::Cancelled:
        return Outcome::Finished; // the user's choice: nothing to report
    case Fetched::Failed:
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
    // The folder that holds the installer: it no longer lies inside the program folder.
    m_platform.shell.OpenFolder(updateFolder());
    return Outcome::Finished;
}
