#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <QTcpServer>

#include <map>

class QTcpSocket;

// A tiny HTTP server on 127.0.0.1 for the download tests. It runs in the test's own
// thread: the downloader's waiting loop serves it.
class LocalHttpServer {
public:
    struct Response {
        int status = 200;
        QByteArray body;
        QByteArray location; // sent as the Location header when not empty
        bool silent = false; // accept the request and never answer
        // When set, the length announced in the headers; the connection then closes after
        // `body`, as when a transfer is cut off.
        qsizetype claimedLength = -1;
    };

    LocalHttpServer();

    // "http://127.0.0.1:<port>".
    QString base() const;
    void serve(const QString& path, const QByteArray& body) {
        responses[path] = {200, body, {}, false};
    }
    void redirect(const QString& path, const QString& target) {
        responses[path] = {302, {}, target.toUtf8(), false};
    }
    void fail(const QString& path, int status) { responses[path] = {status, {}, {}, false}; }
    void stall(const QString& path) { responses[path] = {200, {}, {}, true}; }
    // Announces `claimed` bytes, sends `body` and hangs up.
    void cutOff(const QString& path, const QByteArray& body, qsizetype claimed) {
        responses[path] = {200, body, {}, false, claimed};
    }

    // An address on which nothing listens, so connecting is refused.
    static QString refusedBase();

    // Paths not listed here are answered with 404.
    std::map<QString, Response> responses;
    // The paths of all requests, in order.
    QStringList requests;

private:
    void answer(QTcpSocket* socket, const QByteArray& request);

    QTcpServer m_server;
};
