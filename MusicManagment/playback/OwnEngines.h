#pragma once

#include <functional>
#include <optional>

#include "MusicManagment/playback/FadePair.h"
#include "MusicManagment/playback/PlayTarget.h"
#include "MusicManagment/playback/SongOpener.h"

// Songs play in the sound engines of this program.
class OwnEngines : public PlayTarget {
 public:
    // What others know and this must ask. `TellRefusal` is told why an engine has refused a song.
    struct Hooks {
        std::function<bool()> FadesWanted;
        std::function<void(const QString&)> TellRefusal;
    };

    // The settings must outlive the object; they hold from the next song on.
    OwnEngines(EngineTable engines, const EngineSettings& settings, Hooks hooks);

    bool Reach(const QString&) override { return true; }
    // Throws EPlaySoundException when no engine is allowed for the file, what the last engine throws, and
    // EOutputException; nothing is open then. Throws EAbort when another song was opened or this one closed
    // meanwhile: engines and messages may let the event loop run.
    void Open(const QString& path) override;
    void Close() override;
    // Not: there is no song, or it plays already and has got its full volume back.
    Carried Play() override;
    Carried Stop(StopMode mode) override;
    // Out: it plays again. OnItsWay: it rests.
    Carried PauseResume() override;
    void SetPosition(quint32 milliseconds) override;
    quint32 Position() override;
    quint32 Length() override;
    // A song whose engine fails is as good as closed, one that cannot be heard rests.
    TPSStatus Status() override;
    Carried CrossFadeTo(const QString& path) override;
    void PlayBeside(const QString& path) override;
    void CloseBeside() override { pair_.SetLeaving(nullptr); }
    bool SoundsBeside() override { return pair_.HasLeaving(); }

    bool IsOpen() const { return pair_.Current() != nullptr; }
    // The engine that has the song, be it after others refused.
    std::optional<TEngine> Engine() const { return IsOpen() ? std::optional(engine_) : std::nullopt; }
    const EngineTable& Table() const { return opener_.Table(); }
    // Changes with every song that is opened or closed.
    unsigned Generation() const { return opener_.Generation(); }
    bool CanFade() const { return pair_.CurrentFades() != nullptr; }
    // With a song only.
    TPlaySoundContainer& Song() const { return *pair_.Current(); }
    FadePair& Fades() { return pair_; }

    // The file of the song that sounds beside the current one; empty without one.
    QString FileBeside() const { return pair_.FileOfLeaving(); }
    // The current song's file has this path now.
    void FollowRenamed(const QString& path);

    // 0 to 1 of the amplitude: now and from now on.
    void SetGain(float gain);

 private:
    bool LibraryStays() const;

    const EngineSettings& settings_;
    Hooks hooks_;
    SongOpener opener_;
    FadePair pair_;
    TEngine engine_ = TEngine::FMOD;  // of the current song
    EngineSettings openedWith_;       // the current song
    float gain_ = 1;
};
