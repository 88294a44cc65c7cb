#include "MusicManagment/playback/fmod/FMODPlaySound.h"

#include <gtest/gtest.h>

#include "tests/ErrorOf.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/playback/Listening.h"
#include "tests/playback/SongFiles.h"

using namespace Qt::StringLiterals;

namespace {

// The sound library, which notes what it is asked for.
class NotingLibrary : public SoundLibrary {
 public:
    using SoundLibrary::SoundLibrary;

    QStringList calls;
    std::map<unsigned, int>
        lengths;      // ms, by the mode that the stream was opened with, instead of the true one
    int volume = -1;  // the last one set
    bool pauseWorks = true;

    bool FSOUND_SetOutput(int type) override {
        return Noted(SoundLibrary::FSOUND_SetOutput(type), "SetOutput %d", type);
    }
    bool FSOUND_Init(int rate, int channels, unsigned flags) override {
        return Noted(SoundLibrary::FSOUND_Init(rate, channels, flags), "Init %d %d %u", rate, channels,
                     flags);
    }
    FSOUND_STREAM FSOUND_Stream_OpenFile(const QString& name, unsigned mode) override {
        mode_ = mode;
        return Noted(SoundLibrary::FSOUND_Stream_OpenFile(name, mode), "OpenFile %x", mode);
    }
    int FSOUND_Stream_GetLengthMs(FSOUND_STREAM stream) override {
        const auto length = lengths.find(mode_);
        return length != lengths.end() ? length->second : SoundLibrary::FSOUND_Stream_GetLengthMs(stream);
    }
    bool FMUSIC_SetPanSeperation(FMUSIC_MODULE song, float value) override {
        return Noted(SoundLibrary::FMUSIC_SetPanSeperation(song, value), "Separation %.2f",
                     static_cast<double>(value));
    }
    bool FMUSIC_SetMasterVolume(FMUSIC_MODULE song, int value) override {
        volume = value;
        return SoundLibrary::FMUSIC_SetMasterVolume(song, value);
    }
    bool FSOUND_SetVolume(int channel, int value) override {
        volume = value;
        return SoundLibrary::FSOUND_SetVolume(channel, value);
    }
    bool FSOUND_SetPaused(int channel, bool paused) override {
        return pauseWorks && SoundLibrary::FSOUND_SetPaused(channel, paused);
    }

 private:
    template <typename Result, typename... Values>
    Result Noted(Result result, const char* format, Values... values) {
        calls << QString::asprintf(format, values...);
        return result;
    }

    unsigned mode_ = 0;
};

class FMODPlaySoundTest : public Listening {
 protected:
    FMODPlaySoundTest() {
        WriteWav(Path("a.wav"), Sine({}, 0.5));
        WriteBytes(Path("a.mod"), Mod({}));
        WriteBytes(Path("a.xm"), Xm({}));
        sound.SetBackendFile(Path("a.wav"));
    }

    void PlaySong(const char* name) {
        sound.SetBackendFile(Path(name));
        sound.Open();
        sound.Play();
    }

    HandClock clock;
    NotingLibrary noting{[this](TFSoundOutputTypes) { return std::make_unique<CaptureOutput>(heard); }};
    TFMODPlaySound sound{noting, {}};
};

TEST_F(FMODPlaySoundTest, OnlySettingsOfTheMixInitialiseAnew) {
    TFMODSettings rate, type, channels, buffer, fade;
    rate.MixRate = 48000;
    type.OutputType = FSOUND_OUTPUT_ALSA;
    channels.SoftChannels = 16;
    buffer.BufferSize = 500;
    fade.FadeTime = 3000;
    for (const auto& [settings, calls] : {std::pair(rate, u"SetOutput 2,Init 48000 32 2,"_s),
                                          std::pair(type, u"SetOutput 6,Init 44100 32 2,"_s),
                                          std::pair(channels, u"SetOutput 2,Init 44100 16 2,"_s),
                                          std::pair(buffer, QString()), std::pair(fade, QString())}) {
        sound.Open();
        noting.calls.clear();
        TFMODPlaySound second(noting, settings);
        second.SetBackendFile(Path("a.wav"));
        second.Open();
        EXPECT_TRUE(noting.calls.join(u',').startsWith(calls + u"OpenFile"_s))
            << noting.calls.join(u',').toStdString();
    }
}

TEST_F(FMODPlaySoundTest, AShortStreamIsOpenedASecondTimeWithoutTheExactLength) {
    noting.lengths = {{0x20029, 29999}, {0x29, 29500}};
    sound.Open();
    EXPECT_EQ(noting.calls.filter(u"OpenFile"_s), QStringList({u"OpenFile 20029"_s, u"OpenFile 29"_s}));
    EXPECT_EQ(sound.GetLength(), 29500U);
}

TEST_F(FMODPlaySoundTest, FailureToPlayOrPauseIsTold) {
    TFMODPlaySound only(noting, {.SoftChannels = 1});
    only.SetBackendFile(Path("a.wav"));
    only.Open();
    only.Play();
    TFMODPlaySound late(noting, {.SoftChannels = 1});
    late.SetBackendFile(Path("a.wav"));
    late.Open();
    EXPECT_EQ(
        ErrorOf<EFMODException>([&] { late.Play(); }),
        u"Fehler beim Abspielen von "_s + Path("a.wav") + u" in FMOD: Failed to allocate a new channel"_s);
    noting.pauseWorks = false;
    EXPECT_EQ(ErrorOf<EFMODException>([&] { only.PauseResume(); }),
              u"Fehler beim Pausieren/Fortsetzen von "_s + Path("a.wav") + u" in FMOD: No errors"_s);
    EXPECT_EQ(FMODErrorText(19), u"Unknown error"_s);
}

TEST_F(FMODPlaySoundTest, ASongCountsEveryRowAs144MillisecondsAndOldOnesAreNarrow) {
    PlaySong("a.xm");
    EXPECT_TRUE(noting.calls.filter(u"Separation"_s).isEmpty());
    PlaySong("a.mod");
    EXPECT_EQ(noting.calls.filter(u"Separation"_s), QStringList{u"Separation 0.15"_s});
    EXPECT_EQ(noting.volume, 256);
    sound.SetPosition(2 * 64 * 144 - 1);
    EXPECT_EQ(sound.GetPosition(), 64 * 144U);
    sound.SetPosition(2 * 64 * 144);
    EXPECT_EQ(sound.GetPosition(), 2 * 64 * 144U);
}

TEST_F(FMODPlaySoundTest, VolumeIsBoundedAndRounded) {
    struct Case {
        int percent, stream, song;
    };
    sound.Open();
    sound.SetVolume(50);  // no channel yet
    EXPECT_EQ(noting.volume, -1);
    for (const auto& [percent, stream, song] :
         {Case{150, 255, 256}, Case{-5, 0, 0}, Case{33, 84, 84}, Case{50, 128, 128}, Case{99, 252, 253}}) {
        PlaySong("a.wav");
        EXPECT_EQ(noting.volume, 255);
        sound.SetVolume(percent);
        EXPECT_EQ(noting.volume, stream) << percent;
        PlaySong("a.mod");
        sound.SetVolume(percent);
        EXPECT_EQ(noting.volume, song) << percent;
    }
}

TEST_F(FMODPlaySoundTest, PlayingAgainOrCuttingEndsAFadeAtTheNextStep) {
    PlaySong("a.wav");
    noting.volume = -1;
    sound.StartFadeIn();
    sound.Play();
    EXPECT_EQ(noting.volume, -1);
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(noting.volume, 255);
    sound.StartFadeOut();
    sound.Play();
    EXPECT_TRUE(sound.FadeStep());

    sound.CutFadeOut();
    EXPECT_FALSE(sound.IsFadingOut());
    sound.Play();
    sound.StartFadeIn();
    sound.StartFadeOut();
    sound.CutFadeOut();
    EXPECT_TRUE(sound.FadeStep());
    EXPECT_EQ(sound.GetStatus(), psStopped);
    EXPECT_FALSE(sound.IsFadingIn());
}

}  // namespace
