#pragma once

#include <memory>
#include <optional>

#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/PlaySoundSettings.h"

// The player's side of the way to a separate player program: finds it, starts it, and keeps it informed of
// the settings.
class ExternalLink {
 public:
    enum class Reached {
        No,
        Known,
        New,  // a player program that has just got to know this one; it has no song yet
    };

    // The receiver must outlive the link.
    ExternalLink(std::unique_ptr<ExternalPlayer> player, FeedbackReceiver& receiver)
        : player_(std::move(player)), receiver_(receiver) {}

    // Whether the player program that this one knows still runs.
    bool Runs() { return known_ && player_->Find() == known_; }
    // Looks for a player program, starts it when none runs, and gives it three seconds to come up. One that
    // is met for the first time is told where feedback goes and all the settings. Throws EPlaySoundException
    // when there is no place for feedback.
    Reached FindOrStart(const EngineSettings& settings);

    // Tells the player program, when the one it knows runs, what differs.
    void SendChanges(const EngineSettings& before, const EngineSettings& after);
    qint64 Send(ExternalCommand command, qint64 parameter = 0) {
        return player_->SendCommand(command, parameter);
    }
    qint64 SendText(ExternalCommand command, const QString& text) { return player_->SendText(command, text); }

 private:
    Reached Find(const EngineSettings& settings);
    bool Start();
    void Greet(const EngineSettings& settings);
    void MakeFeedback();
    void SendSetting(ExternalCommand command, qint64 number) { Send(command, number); }
    void SendSetting(ExternalCommand command, const QString& text) { SendText(command, text); }

    std::unique_ptr<ExternalPlayer> player_;
    FeedbackReceiver& receiver_;
    std::optional<qint64> known_;     // the player program that has been greeted
    std::optional<qint64> feedback_;  // our number for feedback
};
