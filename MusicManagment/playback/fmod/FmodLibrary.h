#pragma once

#include <QString>
#include <cstdint>

#include "MusicManagment/playback/backend/SoundOutputTypes.h"
#include "MusicManagment/playback/fmod/FMODErrors.h"

// Tells a stream or a song of the library; never used again for another one, 0 = none. The library answers a
// handle that it does not know with FMOD_ERR_INVALID_PARAM.
enum class FSOUND_STREAM : std::uint64_t { kNone = 0 };
enum class FMUSIC_MODULE : std::uint64_t { kNone = 0 };
// A unit of the signal processing chain; the spectrum's is the only one.
enum class FSOUND_DSPUNIT : int { kNone = 0, kFft = 1 };

// Kinds of song, as FMUSIC_GetType tells them.
enum FMUSIC_TYPES : int {
    FMUSIC_TYPE_NONE,
    FMUSIC_TYPE_MOD,
    FMUSIC_TYPE_S3M,
    FMUSIC_TYPE_XM,
    FMUSIC_TYPE_IT,
    FMUSIC_TYPE_MIDI,
};

inline constexpr int FSOUND_FREE = -1;                    // as a channel: any free one
inline constexpr int FSOUND_STEREOPAN = -1;               // as a pan: both sides at full level
inline constexpr unsigned FSOUND_MPEGACCURATE = 0x20000;  // a stream's exact length is wanted
inline constexpr int FSOUND_SPECTRUM_SIZE = 512;

// The sound library as the back end sees it: a table of functions, so that a test can put its own in place.
// Times are milliseconds. A function that fails answers false, 0, -1 or kNone, and FSOUND_GetError tells why.
// All of them belong to one thread.
class FmodLibrary {
 public:
    virtual ~FmodLibrary() = default;

    virtual float FSOUND_GetVersion() = 0;
    virtual int FSOUND_GetError() = 0;  // a TFmodError

    // Before FSOUND_Init only.
    virtual bool FSOUND_SetOutput(int outputType) = 0;  // a TFSoundOutputTypes
    virtual bool FSOUND_SetDriver(int driver) = 0;
    virtual bool FSOUND_SetMixer(int mixer) = 0;
    virtual bool FSOUND_SetBufferSize(int milliseconds) = 0;
    // Opens the output. Rate in Hz; `softChannels` songs and streams can sound at once.
    virtual bool FSOUND_Init(int mixRate, int softChannels, unsigned flags) = 0;
    // Closes the output, all streams and all songs.
    virtual void FSOUND_Close() = 0;

    // A tracker or MIDI song; kNone when the file is something else.
    virtual FMUSIC_MODULE FMUSIC_LoadSong(const QString& fileName) = 0;
    virtual bool FMUSIC_FreeSong(FMUSIC_MODULE song) = 0;
    virtual bool FMUSIC_PlaySong(FMUSIC_MODULE song) = 0;
    virtual bool FMUSIC_StopSong(FMUSIC_MODULE song) = 0;
    virtual bool FMUSIC_SetPaused(FMUSIC_MODULE song, bool paused) = 0;
    virtual bool FMUSIC_GetPaused(FMUSIC_MODULE song) = 0;
    // True as well while paused, and while the output is lost (FSOUND_GetError then tells FMOD_ERR_INIT).
    virtual bool FMUSIC_IsPlaying(FMUSIC_MODULE song) = 0;
    virtual bool FMUSIC_SetMasterVolume(FMUSIC_MODULE song, int volume) = 0;  // 0 to 256
    virtual int FMUSIC_GetType(FMUSIC_MODULE song) = 0;                       // an FMUSIC_TYPES
    // 0 = mono, 1 = voices as far apart as the song has them.
    virtual bool FMUSIC_SetPanSeperation(FMUSIC_MODULE song, float separation) = 0;
    virtual int FMUSIC_GetOrder(FMUSIC_MODULE song) = 0;
    virtual int FMUSIC_GetRow(FMUSIC_MODULE song) = 0;
    virtual int FMUSIC_GetPatternLength(FMUSIC_MODULE song, int pattern) = 0;  // rows
    virtual int FMUSIC_GetNumOrders(FMUSIC_MODULE song) = 0;
    virtual bool FMUSIC_SetOrder(FMUSIC_MODULE song, int order) = 0;

    virtual FSOUND_STREAM FSOUND_Stream_OpenFile(const QString& fileName, unsigned mode) = 0;
    virtual bool FSOUND_Stream_Close(FSOUND_STREAM stream) = 0;
    virtual int FSOUND_Stream_GetLengthMs(FSOUND_STREAM stream) = 0;
    virtual int FSOUND_Stream_GetTime(FSOUND_STREAM stream) = 0;
    virtual bool FSOUND_Stream_SetTime(FSOUND_STREAM stream, int milliseconds) = 0;
    // Starts the stream on `channel` (FSOUND_FREE); returns the channel, -1 on failure. There are no units
    // that a stream could be sent through, `unit` is kNone.
    virtual int FSOUND_Stream_PlayEx(FSOUND_STREAM stream, int channel, FSOUND_DSPUNIT unit, bool paused) = 0;
    // Stops and goes back to the start.
    virtual bool FSOUND_Stream_Stop(FSOUND_STREAM stream) = 0;

    virtual bool FSOUND_SetPaused(int channel, bool paused) = 0;
    virtual bool FSOUND_GetPaused(int channel) = 0;
    virtual bool FSOUND_IsPlaying(int channel) = 0;              // as FMUSIC_IsPlaying
    virtual bool FSOUND_SetVolume(int channel, int volume) = 0;  // 0 to 255
    virtual bool FSOUND_SetPan(int channel, int pan) = 0;        // 0 left to 255 right, or FSOUND_STEREOPAN

    virtual FSOUND_DSPUNIT FSOUND_DSP_GetFFTUnit() = 0;
    virtual void FSOUND_DSP_SetActive(FSOUND_DSPUNIT unit, bool active) = 0;
    virtual bool FSOUND_DSP_GetActive(FSOUND_DSPUNIT unit) = 0;
    // The amplitudes of FSOUND_SPECTRUM_SIZE bands of what is heard, from 0 Hz to half the mix rate, good
    // until the next call; zeros while the unit is not active.
    virtual const float* FSOUND_DSP_GetSpectrum() = 0;

    // What the back ends remember about the library, all of them together, for as long as it lives.
    struct Initialisation {
        bool done = false;
        TFSoundOutputTypes outputType = FSOUND_OUTPUT_DSOUND;
        int mixRate = 0;
        int softChannels = 0;
    };
    Initialisation initialisation;
};
