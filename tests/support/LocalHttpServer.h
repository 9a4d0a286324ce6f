#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <QTcpServer>
#include <QTcpSocket>
#include <QTimer>

#include <map>
#include <memory>

// A tiny HTTP server on 127.0.0.1 for the download tests. It runs in the test's own
// thread: the downloader's waiting loop serves it. Paths it was not told about get 404.
class LocalHttpServer {
public:
    struct Response {
        int status = 200;
        QByteArray body{};
        QByteArray location{}; // sent as the Location header when not empty
        bool silent = false;   // accept the request and never answer
        // When set, the length announced in the headers; the connection then closes after
        // `body`, as when a transfer is cut off.
        qsizetype claimedLength = -1;
        bool trickle = false; // send the body a byte every 50 ms
    };

    LocalHttpServer() {
        m_server.listen(QHostAddress::LocalHost);
        QObject::connect(&m_server, &QTcpServer::newConnection, &m_server, [this] {
            while (QTcpSocket* socket = m_server.nextPendingConnection()) {
                auto received = std::make_shared<QByteArray>();
                QObject::connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
                QObject::connect(socket, &QTcpSocket::readyRead, socket, [=, this] {
                    *received += socket->readAll();
                    const qsizetype end = received->indexOf("\r\n\r\n");
                    if (end >= 0) {
                        answer(socket, received->left(end));
                        received->remove(0, end + 4);
                    }
                });
            }
        });
    }

    // "http://127.0.0.1:<port>".
    QString base() const {
        return QStringLiteral("http://127.0.0.1:%1").arg(m_server.serverPort());
    }

    // An address on which nothing listens, so connecting is refused.
    static QString refusedBase() {
        QTcpServer probe;
        probe.listen(QHostAddress::LocalHost);
        return QStringLiteral("http://127.0.0.1:%1").arg(probe.serverPort());
    }

    std::map<QString, Response> responses;
    // The paths of all requests, in order.
    QStringList requests;

private:
    void answer(QTcpSocket* socket, const QByteArray& request) {
        const QList<QByteArray> words = request.left(request.indexOf("\r\n")).split(' ');
        const QString path = words.size() > 1 ? QString::fromUtf8(words[1]) : QString();
        requests << path;
        const auto found = responses.find(path);
        const Response response =
            found != responses.end() ? found->second : Response{.status = 404, .body = "none"};
        if (response.silent)
            return;
        const qsizetype length =
            response.claimedLength >= 0 ? response.claimedLength : response.body.size();
        QByteArray reply = "HTTP/1.1 " + QByteArray::number(response.status) + " Status\r\n" +
                           "Content-Type: application/octet-stream\r\nContent-Length: " +
                           QByteArray::number(length) + "\r\n";
        if (!response.location.isEmpty())
            reply += "Location: " + response.location + "\r\n";
        socket->write(reply + "Connection: close\r\n\r\n");
        if (!response.trickle) {
            socket->write(response.body);
            socket->disconnectFromHost();
            return;
        }
        auto* timer = new QTimer(socket);
        QObject::connect(timer, &QTimer::timeout, socket,
                         [socket, body = response.body, sent = 0]() mutable {
                             if (sent < body.size())
                                 socket->write(body.mid(sent++, 1));
                             else
                                 socket->disconnectFromHost();
                         });
        timer->start(50);
    }

    QTcpServer m_server;
};
