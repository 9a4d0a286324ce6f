#include "LocalHttpServer.h"

#include <QTcpSocket>

#include <memory>

LocalHttpServer::LocalHttpServer() {
    m_server.listen(QHostAddress::LocalHost);
    QObject::connect(&m_server, &QTcpServer::newConnection, &m_server, [this] {
        while (QTcpSocket* socket = m_server.nextPendingConnection()) {
            auto received = std::make_shared<QByteArray>();
            QObject::connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
            QObject::connect(socket, &QTcpSocket::readyRead, socket, [this, socket, received] {
                *received += socket->readAll();
                const qsizetype end = received->indexOf("\r\n\r\n");
                if (end < 0)
                    return;
                const QByteArray request = received->left(end);
                received->remove(0, end + 4);
                answer(socket, request);
            });
        }
    });
}

QString LocalHttpServer::base() const {
    return QStringLiteral("http://127.0.0.1:%1").arg(m_server.serverPort());
}

QString LocalHttpServer::refusedBase() {
    QTcpServer probe;
    probe.listen(QHostAddress::LocalHost);
    const quint16 port = probe.serverPort();
    probe.close();
    return QStringLiteral("http://127.0.0.1:%1").arg(port);
}

void LocalHttpServer::answer(QTcpSocket* socket, const QByteArray& request) {
    const QList<QByteArray> words = request.left(request.indexOf("\r\n")).split(' ');
    const QString path = words.size() > 1 ? QString::fromUtf8(words[1]) : QString();
    requests << path;
    const auto found = responses.find(path);
    const Response response =
        found != responses.end() ? found->second : Response{404, "none", {}, false, -1};
    if (response.silent)
        return;
    QByteArray reply = "HTTP/1.1 " + QByteArray::number(response.status) + " Status\r\n";
    reply += "Content-Type: application/octet-stream\r\n";
    const qsizetype length =
        response.claimedLength >= 0 ? response.claimedLength : response.body.size();
    reply += "Content-Length: " + QByteArray::number(length) + "\r\n";
    if (!response.location.isEmpty())
        reply += "Location: " + response.location + "\r\n";
    reply += "Connection: close\r\n\r\n" + response.body;
    socket->write(reply);
    socket->disconnectFromHost();
}
