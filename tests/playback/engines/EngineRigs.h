#pragma once

#include <functional>
#include <memory>

#include "MusicManagment/playback/EngineChoice.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"

// A real engine over an output that nobody hears. Its time passes when the test says so, as far as the engine
// lets it.
class EngineRig {
 public:
    virtual ~EngineRig() = default;

    virtual std::unique_ptr<TPlaySoundContainer> Make() = 0;
    virtual void Pass(TPlaySoundContainer& sound, int milliseconds) = 0;

    // Lets time pass until the condition holds; false when it has not after half a minute.
    bool Await(TPlaySoundContainer& sound, const std::function<bool()>& condition);
    // Makes a back end for a file and opens it.
    std::unique_ptr<TPlaySoundContainer> Open(const QString& path);
    // The message with which the engine's own kind of exception, or with "output: " in front that of a
    // missing output, refuses a file; empty when it is not refused.
    QString Refusal(const QString& path);

 protected:
    virtual QString OpenError(TPlaySoundContainer& sound) = 0;
};

// `hasOutput` false: with a device that cannot be opened, which goes for MCI from then on. WinAmp stands over
// a player of the desktop that plays any file as two seconds.
std::unique_ptr<EngineRig> MakeRig(TEngine engine, bool hasOutput = true);

// Only one engine is allowed.
EngineSettings Only(TEngine engine);
