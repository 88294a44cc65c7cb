#pragma once

#include <QStringList>
#include <map>

#include "MusicManagment/playback/fmod/FmodLibrary.h"

// A sound library that plays nothing, answers as it is told to and notes what it is asked for.
class ScriptedFmod : public FmodLibrary {
 public:
    QStringList calls;

    float version = 3.75F;
    int error = FMOD_ERR_NONE;
    bool initWorks = true;
    bool isSong = false;
    int songType = FMUSIC_TYPE_XM;
    bool streamOpens = true;
    std::map<unsigned, int> lengths;  // ms, by the mode that the stream was opened with
    bool playWorks = true;
    bool pauseWorks = true;
    bool playing = false;
    bool paused = false;
    int volume = -1;  // the last one set
    int order = 0, row = 0, rows = 64, orders = 10;
    int time = 0;

    float FSOUND_GetVersion() override { return version; }
    int FSOUND_GetError() override { return error; }
    bool FSOUND_SetOutput(int type) override { return Note("SetOutput %d", type); }
    bool FSOUND_SetDriver(int driver) override { return Note("SetDriver %d", driver); }
    bool FSOUND_SetMixer(int mixer) override { return Note("SetMixer %d", mixer); }
    bool FSOUND_SetBufferSize(int ms) override { return Note("SetBufferSize %d", ms); }
    bool FSOUND_Init(int rate, int channels, unsigned flags) override {
        Note("Init %d %d %u", rate, channels, flags);
        return initWorks;
    }
    void FSOUND_Close() override { Note("Close"); }

    FMUSIC_MODULE FMUSIC_LoadSong(const QString&) override {
        return isSong ? FMUSIC_MODULE{7} : FMUSIC_MODULE::kNone;
    }
    bool FMUSIC_FreeSong(FMUSIC_MODULE) override { return Note("FreeSong"); }
    bool FMUSIC_PlaySong(FMUSIC_MODULE) override {
        Note("PlaySong");
        playing = playWorks;
        return playWorks;
    }
    bool FMUSIC_StopSong(FMUSIC_MODULE) override {
        playing = false;
        return Note("StopSong");
    }
    bool FMUSIC_SetPaused(FMUSIC_MODULE, bool on) override { return Pause("PauseSong %d", on); }
    bool FMUSIC_GetPaused(FMUSIC_MODULE) override { return paused; }
    bool FMUSIC_IsPlaying(FMUSIC_MODULE) override { return playing; }
    bool FMUSIC_SetMasterVolume(FMUSIC_MODULE, int value) override {
        volume = value;
        return Note("SongVolume %d", value);
    }
    int FMUSIC_GetType(FMUSIC_MODULE) override { return songType; }
    bool FMUSIC_SetPanSeperation(FMUSIC_MODULE, float separation) override {
        return Note("Separation %.2f", static_cast<double>(separation));
    }
    int FMUSIC_GetOrder(FMUSIC_MODULE) override { return order; }
    int FMUSIC_GetRow(FMUSIC_MODULE) override { return row; }
    int FMUSIC_GetPatternLength(FMUSIC_MODULE, int pattern) override { return pattern == 0 ? rows : 1; }
    int FMUSIC_GetNumOrders(FMUSIC_MODULE) override { return orders; }
    bool FMUSIC_SetOrder(FMUSIC_MODULE, int value) override { return Note("SetOrder %d", value); }

    FSOUND_STREAM FSOUND_Stream_OpenFile(const QString&, unsigned mode) override {
        Note("OpenFile %x", mode);
        mode_ = mode;
        return streamOpens ? FSOUND_STREAM{9} : FSOUND_STREAM::kNone;
    }
    bool FSOUND_Stream_Close(FSOUND_STREAM) override { return Note("StreamClose"); }
    int FSOUND_Stream_GetLengthMs(FSOUND_STREAM) override {
        const auto length = lengths.find(mode_);
        return length != lengths.end() ? length->second : 180000;
    }
    int FSOUND_Stream_GetTime(FSOUND_STREAM) override { return time; }
    bool FSOUND_Stream_SetTime(FSOUND_STREAM, int ms) override { return Note("SetTime %d", ms); }
    int FSOUND_Stream_PlayEx(FSOUND_STREAM, int channel, FSOUND_DSPUNIT unit, bool on) override {
        Note("PlayEx %d %d %d", channel, static_cast<int>(unit), on);
        playing = playWorks;
        paused = on;
        return playWorks ? 3 : -1;
    }
    bool FSOUND_Stream_Stop(FSOUND_STREAM) override {
        playing = false;
        return Note("StreamStop");
    }

    bool FSOUND_SetPaused(int channel, bool on) override {
        return Pause(channel == 3 ? "Pause %d" : "Pause of a wrong channel %d", on);
    }
    bool FSOUND_GetPaused(int) override { return paused; }
    bool FSOUND_IsPlaying(int channel) override { return channel == 3 && playing; }
    bool FSOUND_SetVolume(int, int value) override {
        volume = value;
        return Note("Volume %d", value);
    }
    bool FSOUND_SetPan(int, int pan) override { return Note("Pan %d", pan); }

    FSOUND_DSPUNIT FSOUND_DSP_GetFFTUnit() override { return FSOUND_DSPUNIT::kFft; }
    void FSOUND_DSP_SetActive(FSOUND_DSPUNIT, bool) override {}
    bool FSOUND_DSP_GetActive(FSOUND_DSPUNIT) override { return false; }
    const float* FSOUND_DSP_GetSpectrum() override { return nullptr; }

 private:
    template <typename... Values>
    bool Note(const char* format, Values... values) {
        calls << QString::asprintf(format, values...);
        return true;
    }
    bool Pause(const char* format, bool on) {
        Note(format, on);
        if (pauseWorks) paused = on;
        return pauseWorks;
    }

    unsigned mode_ = 0;
};
