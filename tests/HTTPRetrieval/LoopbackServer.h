#pragma once

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QTcpServer>
#include <QTcpSocket>
#include <QTimer>
#include <functional>
#include <memory>

// Lets the event loop run until the condition holds; false when that does not come about.
inline bool Comes(const std::function<bool()>& condition) {
    const QDeadlineTimer patience(20'000);  // ms; only a failing test waits so long
    QTimer beat;                            // so that the patience can end
    beat.start(50);
    while (!condition()) {
        if (patience.hasExpired()) return false;
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    return true;
}

// A server of the tests on this machine, which answers each request as the test says.
template <typename Server = QTcpServer>
class LoopbackServer {
 public:
    // `request` is the head and, of a post, the body. The socket is closed by whoever answers.
    using Answer = std::function<void(QTcpSocket& socket, const QByteArray& request)>;

    explicit LoopbackServer(Answer answer) : answer_(std::move(answer)) {
        qputenv("no_proxy", "127.0.0.1");
        server_.listen(QHostAddress::LocalHost);
        QObject::connect(&server_, &QTcpServer::pendingConnectionAvailable, &server_, [this] { Take(); });
    }

    QString Host() const { return QStringLiteral("127.0.0.1:%1").arg(server_.serverPort()); }
    QString URL(const QString& path) const { return QStringLiteral("http://") + Host() + path; }
    Server& Socket() { return server_; }
    int Requests() const { return requests_; }
    int Gone() const { return gone_; }  // connections that were closed

 private:
    void Take() {
        while (QTcpSocket* socket = server_.nextPendingConnection()) {
            QObject::connect(socket, &QTcpSocket::disconnected, &server_, [this] { ++gone_; });
            QObject::connect(socket, &QTcpSocket::readyRead, &server_, [this, socket] { Read(*socket); });
            Read(*socket);
        }
    }

    void Read(QTcpSocket& socket) {
        const QByteArray request = socket.property("request").toByteArray() + socket.readAll();
        socket.setProperty("request", request);
        const qsizetype head = request.indexOf("\r\n\r\n");
        if (head < 0 || request.size() < head + 4 + LengthIn(request)) return;
        socket.setProperty("request", QByteArray());
        ++requests_;
        answer_(socket, request);
    }

    static qsizetype LengthIn(const QByteArray& request) {
        const qsizetype at = request.toLower().indexOf("content-length:");
        return at < 0 ? 0
                      : request.mid(at + 15, request.indexOf("\r\n", at) - at - 15).trimmed().toLongLong();
    }

    Server server_;
    Answer answer_;
    int requests_ = 0;
    int gone_ = 0;
};

// Sends a whole answer and closes the connection.
inline void SendAnswer(QTcpSocket& socket, const QByteArray& body, const QByteArray& type = "text/html") {
    socket.write("HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Type: " + type +
                 "\r\nContent-Length: " + QByteArray::number(body.size()) + "\r\n\r\n" + body);
    socket.disconnectFromHost();
}
