#pragma once

#include <QLocalServer>
#include <functional>
#include <memory>
#include <vector>

#include "MusicManagment/playback/extern/ChannelPeer.h"

// The end of a channel that others come to. Only programs of the same user reach it.
class ChannelServer {
 public:
    // `ownNumber` tells this program apart from one that runs later.
    explicit ChannelServer(qint64 ownNumber);
    ~ChannelServer();
    ChannelServer(const ChannelServer&) = delete;
    ChannelServer& operator=(const ChannelServer&) = delete;

    // False when somebody listens there already, or there is no such place. What a program that crashed has
    // left there is cleared away.
    bool Listen(const QString& path);

    // The peer that has given this number in its greeting; nullptr when there is none.
    ChannelPeer* FindPeer(qint64 number) const;

    // Answers a peer.
    std::function<qint64(ChannelPeer&, const Frame&)> OnAsked;
    std::function<void(ChannelPeer&)> OnPeerGone;

 private:
    void TakeConnections();
    void Drop(ChannelPeer& peer);

    const qint64 ownNumber_;
    QLocalServer server_;
    std::vector<std::unique_ptr<ChannelPeer>> peers_;
};
