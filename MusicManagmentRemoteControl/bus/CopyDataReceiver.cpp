#include "MusicManagmentRemoteControl/bus/CopyDataReceiver.h"

#include <QCoreApplication>
#include <utility>

#include "MusicManagmentRemoteControl/bus/RemoteNames.h"

CopyDataReceiver::CopyDataReceiver(QDBusConnection bus) {
    bus.connect(kRemoteService, kRemotePath, kRemoteInterface, QStringLiteral("CopyData"), this,
                SLOT(Receive(uint, uint, QByteArray)));
}

// What was sent before an answer has come before it, and waits in the event loop.
std::optional<QByteArray> CopyDataReceiver::Take(quint32 code) {
    QCoreApplication::sendPostedEvents(this);
    auto bytes = std::exchange(bytes_, std::nullopt);
    return code == code_ ? bytes : std::nullopt;
}

void CopyDataReceiver::Receive(uint, uint code, const QByteArray& bytes) {
    code_ = code;
    bytes_ = bytes;
}
