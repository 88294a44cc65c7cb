#pragma once

#include <QPointer>
#include <functional>

#include "MusicManagment/playback/PlayController.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/extern/ChannelServer.h"

// Lets the program at the other end of the channel drive a player, and reports to it what the player does.
class PlayerService : private PlayController {
 public:
    // Both must outlive the service.
    PlayerService(TPlaySound& player, ChannelServer& server);
    ~PlayerService() override;
    PlayerService(const PlayerService&) = delete;
    PlayerService& operator=(const PlayerService&) = delete;

    bool HasController() const { return !controller_.isNull(); }

    // The program that drives the player has gone; the player has been stopped.
    std::function<void()> OnControllerGone;
    // A command could not be carried out; the message is for the user.
    std::function<void(const QString& message)> OnFailure;

 private:
    qint64 Serve(const Frame& frame);
    qint64 CarryOut(const Frame& frame);
    bool CarryOutSetting(const Frame& frame);
    void TakeController(qint64 number);
    void LoseController(const ChannelPeer& peer);

    void Feedback(FeedbackCode code, quint32 parameter) override;
    void FeedbackFileName(const QString& fileName) override;
    TCrossover AskCrossover() override;

    TPlaySound& player_;
    ChannelServer& server_;
    QPointer<ChannelPeer> controller_;
    // What is said of a song that is to be faded in, before it is.
    QString fadingFile_;
};
