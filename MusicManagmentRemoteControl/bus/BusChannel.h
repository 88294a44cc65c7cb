#pragma once

#include <QDBusConnection>
#include <QDBusServiceWatcher>
#include <QMap>
#include <QStringList>
#include <vector>

#include "MusicManagmentRemoteControl/RemoteChannel.h"
#include "MusicManagmentRemoteControl/bus/BusDoor.h"

// The remote control on the message bus of the user's session (docs/remote.md).
class BusChannel : public RemoteChannel {
 public:
    explicit BusChannel(const QDBusConnection& bus);
    ~BusChannel() override;

    void Open(RemoteReceiver& receiver) override;
    void Close() override;
    bool SendCopyData(quint32 window, quint32 code, const QByteArray& bytes) override;
    void AnswerWaiting(qint32 answer) override;

 private:
    bool Handle(const QDBusMessage& call, const QDBusConnection& bus);
    void Send(const QDBusMessage& call);
    void ReceiveCopyData(const QDBusMessage& call);
    void Register(const QDBusMessage& call);
    void Wait(const QDBusMessage& call);
    void Watch(const QString& client);
    void Forget(const QString& client);
    quint32 FreeHandle();

    QDBusConnection bus_;
    BusDoor door_;
    RemoteReceiver* receiver_ = nullptr;
    QStringList serviceNames_;        // held or waited for
    QMap<quint32, QString> clients_;  // those who have registered, by handle
    quint32 lastHandle_;
    std::vector<QDBusMessage> waiting_;  // for the end of the song
    QDBusServiceWatcher watcher_;
};
