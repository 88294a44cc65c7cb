#include "MusicManagment/playback/extern/ChannelServer.h"

#include <algorithm>

namespace {

constexpr std::size_t kMostPeers = 16;
constexpr int kConnectTimeout = 200;  // ms; the kernel answers at once

bool SomebodyListens(const QString& path) {
    QLocalSocket socket;
    socket.connectToServer(path);
    return socket.waitForConnected(kConnectTimeout);
}

}  // namespace

ChannelServer::ChannelServer(qint64 ownNumber) : ownNumber_(ownNumber) {
    server_.setSocketOptions(QLocalServer::UserAccessOption);
    QObject::connect(&server_, &QLocalServer::newConnection, &server_, [this] { TakeConnections(); });
}

ChannelServer::~ChannelServer() {
    server_.close();
}

bool ChannelServer::Listen(const QString& path) {
    if (path.isEmpty() || SomebodyListens(path)) return false;
    QLocalServer::removeServer(path);
    return server_.listen(path);
}

ChannelPeer* ChannelServer::FindPeer(qint64 number) const {
    const auto found =
        std::ranges::find_if(peers_, [number](const auto& peer) { return peer->Number() == number; });
    return found == peers_.end() ? nullptr : found->get();
}

void ChannelServer::TakeConnections() {
    while (QLocalSocket* next = server_.nextPendingConnection()) {
        std::unique_ptr<QLocalSocket> socket(next);
        socket->setParent(nullptr);
        if (peers_.size() >= kMostPeers) continue;
        ChannelPeer& peer =
            *peers_.emplace_back(std::make_unique<ChannelPeer>(std::move(socket), ownNumber_));
        peer.OnAsked = [this, &peer](const Frame& frame) { return OnAsked ? OnAsked(peer, frame) : 0; };
        peer.OnGone = [this, &peer] { Drop(peer); };
    }
}

// The peer itself may be calling.
void ChannelServer::Drop(ChannelPeer& peer) {
    const auto found = std::ranges::find_if(peers_, [&peer](const auto& one) { return one.get() == &peer; });
    if (found == peers_.end()) return;
    std::unique_ptr<ChannelPeer> dropped = std::move(*found);
    peers_.erase(found);
    if (OnPeerGone) OnPeerGone(*dropped);
    dropped.release()->deleteLater();
}
