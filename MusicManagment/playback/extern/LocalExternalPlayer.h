#pragma once

#include <memory>

#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/extern/ChannelPeer.h"
#include "MusicManagment/playback/extern/PlayerChannel.h"

// The way to the small player program over a socket of the user's own.
class LocalExternalPlayer : public ExternalPlayer {
 public:
    // `answerTimeout` in milliseconds: a player that needs longer hangs. It is left, and costs no time any
    // more before it greets anew.
    explicit LocalExternalPlayer(QString path = PlayerChannelPath(), int answerTimeout = 2000);
    ~LocalExternalPlayer() override;

    std::optional<qint64> Find() override;
    // False as well while one hangs: a second one would not be let in beside it.
    bool Start(const QString& program, const QString& argument) override;
    // Takes nothing in meanwhile.
    void Wait(int milliseconds) override;
    qint64 SendCommand(ExternalCommand command, qint64 parameter) override;
    qint64 SendText(ExternalCommand command, const QString& text) override;
    // The connection itself is the place.
    bool RegisterFeedback() override { return true; }
    std::optional<qint64> CreateFeedback(FeedbackReceiver& receiver) override;

 private:
    qint64 Ask(const Frame& frame);
    bool Connect();
    void Disconnect();

    const QString path_;
    const int answerTimeout_;
    const qint64 ownNumber_;
    std::unique_ptr<ChannelPeer> peer_;
    bool hangs_ = false;
    FeedbackReceiver* receiver_ = nullptr;
};
