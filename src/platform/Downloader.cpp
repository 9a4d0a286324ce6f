#include "platform/Downloader.h"

#include <QEventLoop>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <QSaveFile>
#include <QTimer>
#include <QUrl>

QtDownloader::QtDownloader(std::chrono::milliseconds stallTimeout) : m_stallTimeout(stallTimeout) {}

QtDownloader::~QtDownloader() = default;

bool QtDownloader::DownloadFile(const QString& URL, const QString& LocalFilename,
                                const DownloadWatch& watch) {
    const QUrl url(URL, QUrl::StrictMode);
    const QString scheme = url.scheme().toLower();
    // Only the web: a description file must not be able to copy local files around.
    if (!url.isValid() || (scheme != u"http" && scheme != u"https") || url.host().isEmpty())
        return false;

    QSaveFile target(LocalFilename);
    // Unbuffered, so that a short write (a full disk) shows at once: commit() flushes a
    // buffered one without noticing the failure and would put a cut-off file in place.
    if (!target.open(QIODevice::WriteOnly | QIODevice::Unbuffered))
        return false;

    if (!m_manager)
        m_manager = std::make_unique<QNetworkAccessManager>();

    QNetworkRequest request(url);
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute,
                         QNetworkRequest::NoLessSafeRedirectPolicy);
    request.setTransferTimeout(int(m_stallTimeout.count()));

    QNetworkReply* reply = m_manager->get(request);
    bool writeFailed = false;
    qint64 written = 0;
    const auto store = [&](const QByteArray& chunk) {
        if (!writeFailed && target.write(chunk) != chunk.size())
            writeFailed = true;
        written += chunk.size();
    };
    QEventLoop loop;
    qint64 total = -1;
    bool bReporting = false;
    const auto report = [&] {
        // The watcher may run events itself (a modal progress window does); a report that
        // arrives meanwhile is skipped rather than nested.
        if (!watch.progress || bReporting || reply->isFinished())
            return;
        bReporting = true;
        const bool bGoOn = watch.progress(written, total);
        bReporting = false;
        if (!bGoOn)
            reply->abort();
    };
    QObject::connect(reply, &QNetworkReply::readyRead, &loop, [&] {
        store(reply->readAll());
        if (writeFailed)
            reply->abort();
        else
            report();
    });
    QObject::connect(reply, &QNetworkReply::downloadProgress, &loop,
                     [&](qint64, qint64 all) { total = all; });
    QObject::connect(reply, &QNetworkReply::finished, &loop, &QEventLoop::quit);
    // A cancel must be noticed while the server is silent too.
    QTimer tick;
    QObject::connect(&tick, &QTimer::timeout, &loop, report);
    if (watch.progress)
        tick.start(std::chrono::milliseconds(100));
    // The stall timeout restarts with every byte; a server that trickles them must not
    // hold the caller past its deadline.
    QTimer deadline;
    deadline.setSingleShot(true);
    QObject::connect(&deadline, &QTimer::timeout, reply, &QNetworkReply::abort);
    if (watch.deadline.count() > 0)
        deadline.start(watch.deadline);
    if (!reply->isFinished())
        loop.exec(watch.progress ? QEventLoop::AllEvents : QEventLoop::ExcludeUserInputEvents);
    tick.stop();
    deadline.stop();

    if (reply->isOpen())
        store(reply->readAll());

    // A body the server cut off is not always reported as an error; the length it announced
    // tells. (A compressed body is announced at its compressed length, so it cannot be told.)
    const QVariant announced = reply->header(QNetworkRequest::ContentLengthHeader);
    const QByteArray encoding = reply->rawHeader("Content-Encoding");
    const bool bWhole = !announced.isValid() || !(encoding.isEmpty() || encoding == "identity") ||
                        written == announced.toLongLong();
    const int status = reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    const bool ok = !writeFailed && bWhole && reply->error() == QNetworkReply::NoError &&
                    status >= 200 && status < 300;
    reply->deleteLater();
    if (!ok) {
        target.cancelWriting();
        return false;
    }
    return target.commit();
}
