#pragma once

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/playback/PlaySoundContainer.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"

// The sound library refuses; the message is for the user.
class EFMODException : public ERukException {
 public:
    using ERukException::ERukException;
};

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
class TFMODPlaySound : public TPlaySoundContainer {
 public:
    // The library must outlive the back end.
    TFMODPlaySound(FmodLibrary& library, const TFMODSettings& settings, QObject* parent = nullptr);
    ~TFMODPlaySound() override;

    // These throw EFMODException.
    void Open() override;
    void Play() override;
    void PauseResume() override;

    void Close() override;
    void Stop() override;
    quint32 GetPosition() override;
    void SetPosition(quint32 milliseconds) override;
    quint32 GetLength() override;
    TPSStatus GetStatus() override;

    // Below 0 is 0, above 100 is 100.
    void SetVolume(int percent);

    quint32 FadeTime() const { return settings_.FadeTime; }
    void SetFadeTime(quint32 milliseconds) { settings_.FadeTime = milliseconds; }
    // The volume goes from silence to full, or from full to silence, within the fade time from now on.
    void StartFadeIn();
    void StartFadeOut();
    // Sets the volume that the running fades ask for now. True when a fade-out has come to its end in this
    // step; the back end has stopped itself then.
    bool FadeStep();
    bool IsFadingIn() const { return fadeInEnd_ != 0; }
    bool IsFadingOut() const { return fadeOutEnd_ != 0; }
    // Forgets both fades and leaves the volume as it is.
    void CancelFades();
    // A running fade-out ends with the next step.
    void CutFadeOut();

 private:
    QString LibraryError();
    bool MustInitialise() const;
    void InitialiseLibrary();
    void OpenStream();
    bool StartSong();
    bool StartStream();
    bool SetPaused(bool paused);
    quint32 RowTime() const;

    FmodLibrary& library_;
    TFMODSettings settings_;
    FMUSIC_MODULE song_ = FMUSIC_MODULE::kNone;
    FSOUND_STREAM stream_ = FSOUND_STREAM::kNone;
    int channel_ = -1;
    // Tick counts in ms; 0 = no fade runs.
    quint32 fadeInEnd_ = 0;
    quint32 fadeOutEnd_ = 0;
};
