#pragma once

#include <functional>

#include "MusicManagment/playback/EngineChoice.h"

// Opens a song in the first engine that takes it, and in others when that one refuses.
class SongOpener {
 public:
    struct Opened {
        std::unique_ptr<TPlaySoundContainer> Song;
        TEngine Engine;
    };

    // `tell` is told why an engine has refused and which one is tried next; it may let the event loop run.
    // The settings must outlive the opener.
    SongOpener(EngineTable table, const EngineSettings& settings, std::function<void(const QString&)> tell);

    // Throws EPlaySoundException when no engine is allowed for the file, what the last engine throws, and
    // EOutputException, after which no other engine is tried. Throws EAbort when it was abandoned meanwhile.
    Opened Open(const QString& path);
    // In this engine only.
    std::unique_ptr<TPlaySoundContainer> OpenIn(TEngine engine, const QString& path);
    // Whoever waits for a song to be opened waits no longer.
    void Abandon();
    // Counts the calls of Abandon: who lets others act meanwhile sees whether they have.
    unsigned Generation() const { return generation_; }

    const EngineTable& Table() const { return table_; }

 private:
    using Song = std::unique_ptr<TPlaySoundContainer>;

    Song Make(TEngine engine, const QString& path) const;
    void OpenWithFallBack(TEngine engine, const QString& path);
    bool OpenInEnginesAfter(TEngine failed, const QString& path, const QString& message);

    EngineTable table_;
    const EngineSettings& settings_;
    std::function<void(const QString&)> tell_;
    Song opening_;  // waits for its engine
    Song opened_;
    TEngine engine_ = TEngine::FMOD;  // of opened_
    unsigned generation_ = 0;
};

// The first engine that is allowed and takes such files. Throws EPlaySoundException.
TEngine RequireEngine(const QString& path, const EngineSettings& settings);
