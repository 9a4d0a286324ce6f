#pragma once

#include <QString>

#include <chrono>
#include <memory>

class QNetworkAccessManager;

// Fetching a file from the web into a local file.
class Downloader {
public:
    virtual ~Downloader() = default;

    // Downloads `URL` to `LocalFilename`, blocking until the transfer ends. True only when
    // the whole body of a successful response was stored; on any failure an existing local
    // file is left as it was.
    virtual bool DownloadFile(const QString& URL, const QString& LocalFilename) = 0;
};

// Qt Network. Follows redirects (never from https down to http), gives up when the server
// sends nothing for `stallTimeout`, and streams into a temporary file beside the target
// that replaces it only when the transfer succeeded. While it waits, the event loop keeps
// windows painted but holds back user input, so nothing can be clicked twice.
class QtDownloader final : public Downloader {
public:
    explicit QtDownloader(std::chrono::milliseconds stallTimeout = std::chrono::seconds(30));
    ~QtDownloader() override;

    bool DownloadFile(const QString& URL, const QString& LocalFilename) override;

private:
    std::chrono::milliseconds m_stallTimeout;
    std::unique_ptr<QNetworkAccessManager> m_manager;
};
