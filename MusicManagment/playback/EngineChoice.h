#pragma once

#include <QString>
#include <exception>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <vector>

#include "MusicManagment/playback/PlaySoundSettings.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"

// The sound engines, in the order in which they are preferred.
enum class TEngine { FMOD, EldoS, MCI, WinAmp };

// "FMOD", "EldoS", "MCI" or "WinAmp".
QString EngineName(TEngine engine);

bool IsAllowed(TEngine engine, const EngineSettings& settings);

// The first engine that is allowed and takes files with this extension; nothing when there is none.
std::optional<TEngine> ChooseEngine(const QString& fileName, const EngineSettings& settings);

// The engines that are tried after this one has failed, whether or not they take such files; those that are
// not allowed are left out.
std::vector<TEngine> EnginesAfter(TEngine failed, const EngineSettings& settings);

// Makes back ends. The player knows the engines only by this table, so that a build can leave engines out and
// a test can put its own in.
class EngineTable {
 public:
    using Maker = std::function<std::unique_ptr<TPlaySoundContainer>(const EngineSettings&)>;

    // Replaces the former maker.
    void Register(TEngine engine, Maker maker) { makers_[engine] = std::move(maker); }
    // Throws EPlaySoundException when nothing is registered, and what the engine throws.
    std::unique_ptr<TPlaySoundContainer> Create(TEngine engine, const EngineSettings& settings) const;

    // Sets how loud the back ends are that share a sound library, 0 to 1 of the amplitude; the others have a
    // loudness each (GainBackend.h).
    std::function<void(float gain)> SetSharedGain;
    // Asks the other player how long a song is, in milliseconds. Throws EWinAmpMissing when there is none,
    // EWinAmpException when it does not tell.
    std::function<quint32(const QString& path, const EngineSettings& settings)> AskLength;

 private:
    std::map<TEngine, Maker> makers_;
};
