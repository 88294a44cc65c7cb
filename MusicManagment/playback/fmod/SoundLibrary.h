#pragma once

#include <QString>
#include <map>
#include <memory>

#include "MusicManagment/playback/fmod/DecodeAhead.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"
#include "MusicManagment/playback/fmod/Mixer.h"
#include "MusicManagment/playback/fmod/OutputChoice.h"
#include "MusicManagment/playback/fmod/Spectrum.h"

// The sound library itself: mixes streams and songs into one output. Every open file is decoded ahead by a
// thread of its own; the output's thread only mixes.
class SoundLibrary : public FmodLibrary {
 public:
    explicit SoundLibrary(OutputFactory outputs = OutputsOfEnvironment());
    ~SoundLibrary() override;

    // The sound font for MIDI songs; a usual one of the system when it is empty.
    void SetMidiFont(const QString& path);
    // How loud everything is together, 0 to 1; 1 at first. Fades and volumes of single sounds count as well.
    void SetMasterVolume(float gain);
    // Lets an output without a pace of its own take so many frames at the mix rate; nothing otherwise.
    void Advance(std::size_t frames);
    // The output takes nothing any more and cannot be replaced: a file whose disk is full.
    bool OutputLost() const;
    // Frames that have been mixed since FSOUND_Init, and those of them that lacked sound because a file was
    // not decoded in time.
    quint64 FramesPlayed() const;
    quint64 FramesStarved() const;

    float FSOUND_GetVersion() override;
    int FSOUND_GetError() override;
    bool FSOUND_SetOutput(int outputType) override;
    bool FSOUND_SetDriver(int driver) override;
    bool FSOUND_SetMixer(int mixer) override;
    bool FSOUND_SetBufferSize(int milliseconds) override;
    bool FSOUND_Init(int mixRate, int softChannels, unsigned flags) override;
    void FSOUND_Close() override;

    FMUSIC_MODULE FMUSIC_LoadSong(const QString& fileName) override;
    bool FMUSIC_FreeSong(FMUSIC_MODULE song) override;
    bool FMUSIC_PlaySong(FMUSIC_MODULE song) override;
    bool FMUSIC_StopSong(FMUSIC_MODULE song) override;
    bool FMUSIC_SetPaused(FMUSIC_MODULE song, bool paused) override;
    bool FMUSIC_GetPaused(FMUSIC_MODULE song) override;
    bool FMUSIC_IsPlaying(FMUSIC_MODULE song) override;
    bool FMUSIC_SetMasterVolume(FMUSIC_MODULE song, int volume) override;
    int FMUSIC_GetType(FMUSIC_MODULE song) override;
    bool FMUSIC_SetPanSeperation(FMUSIC_MODULE song, float separation) override;
    int FMUSIC_GetOrder(FMUSIC_MODULE song) override;
    int FMUSIC_GetRow(FMUSIC_MODULE song) override;
    int FMUSIC_GetPatternLength(FMUSIC_MODULE song, int pattern) override;
    int FMUSIC_GetNumOrders(FMUSIC_MODULE song) override;
    bool FMUSIC_SetOrder(FMUSIC_MODULE song, int order) override;

    FSOUND_STREAM FSOUND_Stream_OpenFile(const QString& fileName, unsigned mode) override;
    bool FSOUND_Stream_Close(FSOUND_STREAM stream) override;
    int FSOUND_Stream_GetLengthMs(FSOUND_STREAM stream) override;
    int FSOUND_Stream_GetTime(FSOUND_STREAM stream) override;
    bool FSOUND_Stream_SetTime(FSOUND_STREAM stream, int milliseconds) override;
    int FSOUND_Stream_PlayEx(FSOUND_STREAM stream, int channel, FSOUND_DSPUNIT unit, bool paused) override;
    bool FSOUND_Stream_Stop(FSOUND_STREAM stream) override;

    bool FSOUND_SetPaused(int channel, bool paused) override;
    bool FSOUND_GetPaused(int channel) override;
    bool FSOUND_IsPlaying(int channel) override;
    bool FSOUND_SetVolume(int channel, int volume) override;
    bool FSOUND_SetPan(int channel, int pan) override;

    FSOUND_DSPUNIT FSOUND_DSP_GetFFTUnit() override;
    void FSOUND_DSP_SetActive(FSOUND_DSPUNIT unit, bool active) override;
    bool FSOUND_DSP_GetActive(FSOUND_DSPUNIT unit) override;
    const float* FSOUND_DSP_GetSpectrum() override;

 private:
    struct Voice {
        std::unique_ptr<DecodeAhead> ahead;
        quint64 length = 0;  // frames
        int channel = Mixer::kNoChannel;
    };
    struct Song : Voice {
        FMUSIC_TYPES type = FMUSIC_TYPE_NONE;
        int orders = 0;
        float gain = 1;
    };

    bool Fail(TFmodError error);
    bool Initialised();
    bool BeforeInit();
    // Runs what may throw and keeps the reason; false when it did.
    template <typename Action>
    bool Try(Action action);
    template <typename Table, typename Handle>
    auto* Find(Table& table, Handle handle);
    template <typename Table>
    bool HasSpace(const Table& table);

    bool OpenOutput();
    bool OutputWorks();
    bool Sounds(int channel);
    void Render(float* stereo, std::size_t frames);
    bool StartVoice(Voice& voice, float gain, bool paused);
    bool Rewind(Voice& voice);
    std::size_t BufferFrames() const;

    const OutputFactory outputs_;
    QString midiFont_;
    int lastError_ = FMOD_ERR_NONE;
    TFSoundOutputTypes outputType_ = FSOUND_OUTPUT_DSOUND;
    int bufferMs_ = 100;
    int rate_ = 0;
    qint64 lastReopening_ = 0;  // ticks

    // The mixer is there from FSOUND_Init to FSOUND_Close. Files and the output use it, so they go first.
    std::unique_ptr<Mixer> mixer_;
    int channelRounds_ = 0;  // of the mixers before
    std::map<FSOUND_STREAM, Voice> streams_;
    std::map<FMUSIC_MODULE, Song> songs_;
    std::uint64_t lastHandle_ = 0;
    std::unique_ptr<AudioOutput> output_;

    Spectrum spectrum_;
    bool spectrumActive_ = false;
    float masterVolume_ = 1;
};
