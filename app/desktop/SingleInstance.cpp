#include "app/desktop/SingleInstance.h"

#include <QCryptographicHash>
#include <QDeadlineTimer>
#include <QDir>
#include <QEventLoop>
#include <QLocalSocket>
#include <QStandardPaths>
#include <QSysInfo>
#include <QTimer>
#include <algorithm>

#include "app/desktop/StartMessage.h"

using namespace Qt::StringLiterals;
using namespace std::chrono_literals;

namespace {

constexpr char kTaken = '+';
constexpr char kRefused = '-';
// A connection that has not said all it has to say by then is closed.
constexpr auto kServicePatience = 5s;
// A program that is ending needs a moment until the folder is free.
constexpr std::chrono::milliseconds kRetryPause = 50ms;

// The data folder alone makes the name: it is what must have one writer. Copies of the program with folders
// of their own do not meet.
QString SocketName(const QString& dataFolder, const QString& socketFolder) {
    const QString canonical = QDir(dataFolder).canonicalPath();
    const QByteArray hash = QCryptographicHash::hash((canonical.isEmpty() ? dataFolder : canonical).toUtf8(),
                                                     QCryptographicHash::Sha256);
    const QString name = u"tunestead-"_s + QString::fromLatin1(hash.first(8).toHex());
#ifdef Q_OS_WIN
    Q_UNUSED(socketFolder);  // pipes have no folder; the access option keeps other users out
    return name;
#else
    return socketFolder + u'/' + name;
#endif
}

QString MadeFolder(const QString& folder) {
    // Where that fails, the lock fails too, and says so.
    QDir().mkpath(folder);
    return folder;
}

void Pause(std::chrono::milliseconds duration) {
    QEventLoop loop;
    QTimer::singleShot(duration, &loop, &QEventLoop::quit);
    loop.exec();
}

}  // namespace

SingleInstance::SingleInstance(const QString& dataFolder, const QString& socketFolder)
    : folder_(MadeFolder(dataFolder)),
      socketName_(SocketName(folder_, socketFolder)),
      lock_(folder_ + u"/Tunestead3.lock"_s) {
    // A program that runs for days still holds its folder.
    lock_.setStaleLockTime(0);
    QObject::connect(&server_, &QLocalServer::newConnection, &server_, [this] {
        while (QLocalSocket* socket = server_.nextPendingConnection())
            Serve(*socket);
    });
}

QString SingleInstance::RuntimeFolder() {
    return QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
}

SingleInstance::Role SingleInstance::Start(const StartRequest& request, std::chrono::milliseconds patience) {
    const QDeadlineTimer deadline(patience);
    while (!TakeFolder()) {
        const auto left = std::chrono::milliseconds(deadline.remainingTime());
        const Answer answer = HandOver(request, std::max(kRetryPause, left));
        if (answer == Answer::Taken) return Role::HandedOver;
        if (deadline.hasExpired()) return Role::Unanswered;
        Pause(kRetryPause);
    }
    Listen();
    return Role::First;
}

QString SingleInstance::Holder() const {
    qint64 process = 0;
    QString computer;
    QString program;
    if (!lock_.getLockInfo(&process, &computer, &program)) return u"unbekannt"_s;
    const QString text = u"Prozess "_s + QString::number(process);
    return computer == QSysInfo::machineHostName() ? text : text + u" auf dem Rechner "_s + computer;
}

// A folder in which no lock can be made is one in which nobody can write a database either.
bool SingleInstance::TakeFolder() {
    return lock_.tryLock(0) || lock_.error() != QLockFile::LockFailedError;
}

void SingleInstance::Listen() {
    // The folder is ours, so what is left under the name belongs to a program that is gone.
    QLocalServer::removeServer(socketName_);
    server_.setSocketOptions(QLocalServer::UserAccessOption);
    if (!server_.listen(socketName_))
        qWarning("%s",
                 qPrintable(u"Weitere Starts können nicht angenommen werden: "_s + server_.errorString()));
}

SingleInstance::Answer SingleInstance::HandOver(const StartRequest& request,
                                                std::chrono::milliseconds patience) const {
    QLocalSocket socket;
    QEventLoop loop;
    QTimer::singleShot(patience, &loop, &QEventLoop::quit);
    QObject::connect(&socket, &QLocalSocket::readyRead, &loop, &QEventLoop::quit);
    QObject::connect(&socket, &QLocalSocket::disconnected, &loop, &QEventLoop::quit);
    QObject::connect(&socket, &QLocalSocket::errorOccurred, &loop, &QEventLoop::quit, Qt::QueuedConnection);
    QObject::connect(&socket, &QLocalSocket::connected, &socket,
                     [&] { socket.write(StartMessage::Encode(request)); });
    socket.connectToServer(socketName_);
    loop.exec();
    char answer = 0;
    if (socket.bytesAvailable() == 0 || !socket.getChar(&answer)) return Answer::None;
    return answer == kTaken ? Answer::Taken : Answer::Refused;
}

void SingleInstance::Serve(QLocalSocket& socket) {
    socket.setReadBufferSize(StartMessage::kHeadSize + StartMessage::kLargestBody);
    QObject::connect(&socket, &QLocalSocket::disconnected, &socket, &QObject::deleteLater);
    QObject::connect(&socket, &QLocalSocket::readyRead, &socket, [this, &socket] { Receive(socket); });
    QTimer::singleShot(kServicePatience, &socket, [&socket] { socket.abort(); });
    Receive(socket);
}

void SingleInstance::Receive(QLocalSocket& socket) {
    if (socket.bytesAvailable() < StartMessage::kHeadSize) return;
    const auto size = StartMessage::BodySize(socket.peek(StartMessage::kHeadSize));
    if (!size) return socket.abort();
    if (socket.bytesAvailable() < StartMessage::kHeadSize + qint64{*size}) return;
    socket.skip(StartMessage::kHeadSize);
    const auto request = StartMessage::DecodeBody(socket.read(*size));
    if (!request) return socket.abort();
    socket.putChar(OnStart && OnStart(*request) ? kTaken : kRefused);
    socket.disconnectFromServer();
}
