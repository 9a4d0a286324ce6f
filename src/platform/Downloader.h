#pragma once

#include <QString>

#include <chrono>
#include <functional>
#include <memory>

class QNetworkAccessManager;

// What bounds and watches one download.
struct DownloadWatch {
    // The most the whole transfer may take, however steadily bytes arrive; zero: no limit
    // beyond the downloader's own for a silent server.
    std::chrono::milliseconds deadline{0};
    // Told the bytes stored so far and the announced total (-1 when unknown) as the body
    // arrives, and a few times a second while nothing does; returning false cancels the
    // transfer. While it is set, user input goes through during the wait: the caller shows
    // a modal window whose Cancel button must work.
    std::function<bool(qint64 received, qint64 total)> progress;
};

// Fetching a file from the web into a local file.
class Downloader {
public:
    virtual ~Downloader() = default;

    // Downloads `URL` to `LocalFilename`, blocking until the transfer ends. True only when
    // the whole body of a successful response was stored; on any failure or cancel an
    // existing local file is left as it was.
    virtual bool DownloadFile(const QString& URL, const QString& LocalFilename,
                              const DownloadWatch& watch) = 0;
    bool DownloadFile(const QString& URL, const QString& LocalFilename) {
        return DownloadFile(URL, LocalFilename, DownloadWatch());
    }
};

// Qt Network. Follows redirects (never from https down to http), gives up when the server
// sends nothing for `stallTimeout`, and streams into a temporary file beside the target
// that replaces it only when the transfer succeeded. While it waits, the event loop keeps
// windows painted but holds back user input (unless progress is watched), so nothing can
// be clicked twice.
class QtDownloader final : public Downloader {
public:
    explicit QtDownloader(std::chrono::milliseconds stallTimeout = std::chrono::seconds(30));
    ~QtDownloader() override;

    using Downloader::DownloadFile;
    bool DownloadFile(const QString& URL, const QString& LocalFilename,
                      const DownloadWatch& watch) override;

private:
    std::chrono::milliseconds m_stallTimeout;
    std::unique_ptr<QNetworkAccessManager> m_manager;
};
