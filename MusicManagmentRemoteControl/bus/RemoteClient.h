#pragma once

#include <QDBusConnection>
#include <optional>

#include "MusicManagmentRemoteControl/RemoteChannel.h"
#include "MusicManagmentRemoteControl/bus/CopyDataReceiver.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The other end: speaks to the program that runs. Each call waits for its answer, however long that takes,
// and throws ERemoteControlException when there is none.
class RemoteClient {
 public:
    explicit RemoteClient(const QDBusConnection& bus);

    qint32 Send(quint32 message, quint32 p = 0, quint32 l = 0);
    qint32 OpenFile(const QString& path);
    // The song at this position of the collection, -1: the one that plays. Nothing when there is none.
    std::optional<TID3Tag> Song(qint32 index);

 private:
    QVariant Call(const QString& method, const QVariantList& arguments);
    std::optional<QByteArray> AskAboutSong(quint32 message, qint32 index, quint32 code);

    QDBusConnection bus_;
    CopyDataReceiver copied_;
    quint32 window_ = 0;  // our handle; 0: not registered yet
};
