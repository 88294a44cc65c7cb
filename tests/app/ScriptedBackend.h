#pragma once

#include <memory>

#include "MusicManagment/playback/EngineChoice.h"

// What the back ends of a player have in common: the song that sounds, as the test sees and sets it.
struct ScriptedSong {
    QString File;
    TPSStatus Status = psClosed;
    quint32 Position = 0;      // ms
    quint32 Length = 240'000;  // ms
};

// A back end that makes no sound.
class ScriptedBackend : public TPlaySoundContainer {
 public:
    explicit ScriptedBackend(ScriptedSong& song) : song_(song) {}
    ~ScriptedBackend() override { song_.Status = psClosed; }

    void Open() override {
        song_.File = BackendFile();
        song_.Status = psStopped;
        song_.Position = 0;
    }
    void Close() override { song_.Status = psClosed; }
    void Play() override { song_.Status = psPlaying; }
    void Stop() override { song_.Status = psStopped; }
    void PauseResume() override { song_.Status = song_.Status == psPlaying ? psPaused : psPlaying; }
    quint32 GetPosition() override { return song_.Position; }
    void SetPosition(quint32 milliseconds) override { song_.Position = milliseconds; }
    quint32 GetLength() override { return song_.Length; }
    TPSStatus GetStatus() override { return song_.Status; }

 private:
    ScriptedSong& song_;
};

inline EngineTable ScriptedEngines(ScriptedSong& song) {
    EngineTable engines;
    engines.Register(TEngine::FMOD,
                     [&song](const EngineSettings&) { return std::make_unique<ScriptedBackend>(song); });
    return engines;
}
