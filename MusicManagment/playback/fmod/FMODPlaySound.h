#pragma once

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/FadingBackend.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"

// The player's settings that concern this engine, copied when a back end is made.
struct TFMODSettings {
    quint32 FadeTime = 10000;  // ms
    TFSoundOutputTypes OutputType = FSOUND_OUTPUT_DSOUND;
    int MixRate = 44100;  // Hz
    int SoftChannels = 32;
    int BufferSize = 0;  // kept for the settings; the library's buffer is always 100 ms
};

// A song that sounds through the sound library: tracker and MIDI files as songs, everything else as streams.
// Fades run in steps: whoever owns the back end calls FadeStep on every tick of its timer.
class TFMODPlaySound : public TPlaySoundContainer, public FadingBackend {
 public:
    // The library must outlive the back end.
    TFMODPlaySound(FmodLibrary& library, const TFMODSettings& settings, QObject* parent = nullptr);
    ~TFMODPlaySound() override;

    // These throw EFMODException, or EOutputException when there is no output. One that is lost while the
    // song plays is opened anew by the library; Play and GetStatus throw EOutputException until it is back,
    // and the song stays where it is.
    void Open() override;
    void Play() override;
    void PauseResume() override;
    TPSStatus GetStatus() override;

    void Close() override;
    void Stop() override;
    quint32 GetPosition() override;
    void SetPosition(quint32 milliseconds) override;
    quint32 GetLength() override;

    void SetVolume(int percent) override;
    quint32 FadeTime() const { return settings_.FadeTime; }
    void SetFadeTime(quint32 milliseconds) override { settings_.FadeTime = milliseconds; }
    void StartFadeIn() override;
    void StartFadeOut() override;
    bool FadeStep() override;
    bool IsFadingIn() const override { return fadeInEnd_ != 0; }
    bool IsFadingOut() const override { return fadeOutEnd_ != 0; }
    void CancelFades() override;
    void CutFadeOut() override;

 private:
    [[noreturn]] void ThrowRefusal(const QString& what);
    bool MustInitialise() const;
    void InitialiseLibrary();
    void OpenStream();
    bool StartSong();
    bool StartStream();
    bool SetPaused(bool paused);
    TPSStatus State();
    quint32 PatternTime() const;

    FmodLibrary& library_;
    TFMODSettings settings_;
    FMUSIC_MODULE song_ = FMUSIC_MODULE::kNone;
    FSOUND_STREAM stream_ = FSOUND_STREAM::kNone;
    int channel_ = -1;
    bool outputLost_ = false;  // when the state was asked for last
    // Tick counts in ms; 0 = no fade runs.
    quint32 fadeInEnd_ = 0;
    quint32 fadeOutEnd_ = 0;
};
