#pragma once

#include <QString>
#include <QtGlobal>
#include <functional>
#include <optional>

#include "MusicManagment/playback/PlayController.h"

// What a separate player program is told. The numbers are part of the protocol.
enum ExternalCommand : int {
    ecGetPosition = 1,
    ecSetPosition = 2,
    ecGetLength = 3,
    ecGetStatus = 4,
    ecFadingFileName = 7,  // a text
    ecOpenFading = 8,
    ecFadingTime = 10,
    ecStartFading = 12,
    ecClose = 13,
    ecCloseFading = 14,
    ecPlay = 15,
    ecPlayFading = 16,
    ecOpenFile = 17,  // a text
    ecNewFading = 18,
    ecStop = 19,  // parameter 1: fade
    ecPauseResume = 20,
    ecPlayWithCrossFade = 21,  // a text; answers whether it was possible
    ecFeedbackHandle = 22,
    ecUseFMOD = 23,
    ecUseMCI = 24,
    ecUseEldoS = 25,
    ecUseWinAmp = 26,
    ecCrossoverTime = 27,
    ecSoundOutputTypes = 28,
    ecMixRate = 29,
    ecSoftChannels = 30,
    ecBufferSize = 31,
    ecWinAmpClassName = 32,  // a text
    ecWinAmpFile = 33,       // a text
    ecEldoSBufferCount = 34,
    ecEldoSBufferSize = 35,
};

// What a separate player program reports. It is handed over in the player's own thread.
class FeedbackReceiver {
 public:
    virtual ~FeedbackReceiver() = default;
    // The answer is 0 but for fbCrossoverQuery. An unknown code does nothing.
    virtual qint64 HandleFeedback(int code, quint32 parameter) = 0;
    virtual void HandleFeedbackText(int code, const QString& text) = 0;
};

// The way to a separate player program.
class ExternalPlayer {
 public:
    virtual ~ExternalPlayer() = default;

    // Tells a running player program apart from one that runs later; nothing when none runs.
    virtual std::optional<qint64> Find() = 0;
    // Starts a program that lies beside this one, `program` relative to its folder. False when that is not
    // possible. Whether the player has come up Find tells later.
    virtual bool Start(const QString& program, const QString& argument) = 0;
    virtual void Wait(int milliseconds) = 0;

    // Both wait for the answer; 0 when the player has gone.
    virtual qint64 SendCommand(ExternalCommand command, qint64 parameter) = 0;
    virtual qint64 SendText(ExternalCommand command, const QString& text) = 0;

    // Makes a place for feedback, then one for this player in it, whose number ecFeedbackHandle carries.
    virtual bool RegisterFeedback() = 0;
    virtual std::optional<qint64> CreateFeedback(FeedbackReceiver& receiver) = 0;
};
