#pragma once

#include <QByteArray>
#include <QHash>
#include <QHostAddress>
#include <QList>
#include <QTcpServer>
#include <QTcpSocket>

namespace verbloom::test {

/// A tiny HTTP server on 127.0.0.1 for browser tests: answers GET requests from a table of
/// paths; a path marked "hang" is accepted but never answered.
class LocalHttpServer final : public QTcpServer
{
public:
    LocalHttpServer()
    {
        connect(this, &QTcpServer::newConnection, this, &LocalHttpServer::Accept);
        listen(QHostAddress::LocalHost, 0);
    }

    void AddPage(const QByteArray &path, const QByteArray &html) { m_pages.insert(path, html); }
    void AddHangingPath(const QByteArray &path) { m_hanging.append(path); }

    QString Url(const QByteArray &path) const
    {
        return QStringLiteral("http://127.0.0.1:") + QString::number(serverPort())
            + QString::fromLatin1(path);
    }

    QHash<QByteArray, int> RequestsByPath; ///< the browser's own requests (favicon) included

private:
    void Accept()
    {
        while (QTcpSocket *socket = nextPendingConnection()) {
            socket->setParent(this);
            connect(socket, &QTcpSocket::readyRead, this, [this, socket] { Answer(socket); });
        }
    }

    void Answer(QTcpSocket *socket)
    {
        QByteArray &request = m_buffers[socket];
        request += socket->readAll();
        if (!request.contains("\r\n\r\n"))
            return;
        const QList<QByteArray> words = request.left(request.indexOf("\r\n")).split(' ');
        const QByteArray path = words.value(1);
        ++RequestsByPath[path];
        m_buffers.remove(socket);
        if (m_hanging.contains(path))
            return;
        const bool found = m_pages.contains(path);
        const QByteArray body = found ? m_pages.value(path) : QByteArray("<html><body>Not found</body></html>");
        QByteArray response = found ? "HTTP/1.1 200 OK\r\n" : "HTTP/1.1 404 Not Found\r\n";
        response += "Content-Type: text/html; charset=utf-8\r\nContent-Length: "
            + QByteArray::number(body.size()) + "\r\nConnection: close\r\n\r\n" + body;
        socket->write(response);
        socket->disconnectFromHost();
    }

    QHash<QByteArray, QByteArray> m_pages;
    QList<QByteArray> m_hanging;
    QHash<QTcpSocket *, QByteArray> m_buffers;
};

} // namespace verbloom::test
