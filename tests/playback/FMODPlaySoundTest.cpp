#include "MusicManagment/playback/fmod/FMODPlaySound.h"

#include <gtest/gtest.h>

#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/playback/ScriptedFmod.h"

using namespace Qt::StringLiterals;

namespace {

class FMODPlaySoundTest : public testing::Test {
 protected:
    FMODPlaySoundTest() { sound.SetBackendFile(u"/music/a.mp3"_s); }

    // The message of the exception that `action` throws; empty when it throws none.
    template <typename Action>
    static QString Refusal(Action action) {
        try {
            action();
        } catch (const EFMODException& refusal) {
            return refusal.Message();
        }
        return {};
    }
    void OpenSong() {
        library.isSong = true;
        sound.Open();
        library.calls.clear();
    }
    void PlayStream() {
        sound.Open();
        sound.Play();
        library.calls.clear();
    }

    HandClock clock;
    ScriptedFmod library;
    TFMODPlaySound sound{library, {}};
};

TEST_F(FMODPlaySoundTest, OldLibraryIsRefused) {
    library.version = 3.49F;
    EXPECT_EQ(Refusal([&] { sound.Open(); }),
              u"FMOD-DLL Version 3.49 ist zu alt (mind. Version 3.50 benötigt)"_s);
    EXPECT_TRUE(library.calls.isEmpty());
    library.version = 3.5F;
    EXPECT_EQ(Refusal([&] { sound.Open(); }), QString());
}

TEST_F(FMODPlaySoundTest, FirstOpenInitialisesTheLibrary) {
    sound.Open();
    EXPECT_EQ(library.calls,
              QStringList({u"SetOutput 2"_s, u"SetDriver 0"_s, u"SetMixer 0"_s, u"SetBufferSize 100"_s,
                           u"Init 44100 32 2"_s, u"OpenFile 20029"_s}));
}

TEST_F(FMODPlaySoundTest, FailedInitialisationIsToldAndTriedAgain) {
    library.initWorks = false;
    library.error = FMOD_ERR_INIT;
    EXPECT_EQ(Refusal([&] { sound.Open(); }),
              u"Fehler beim Initialisieren von FMOD: Error initializing output device"_s);
    EXPECT_EQ(sound.GetStatus(), psClosed);
    library.initWorks = true;
    sound.Open();
    EXPECT_EQ(sound.GetStatus(), psStopped);
    EXPECT_FALSE(library.calls.contains(u"Close"_s));
}

TEST_F(FMODPlaySoundTest, OnlySettingsOfTheMixInitialiseAnew) {
    struct Case {
        TFMODSettings settings;
        bool again;
    };
    TFMODSettings rate, type, channels, buffer, fade;
    rate.MixRate = 48000;
    type.OutputType = FSOUND_OUTPUT_ALSA;
    channels.SoftChannels = 16;
    buffer.BufferSize = 500;
    fade.FadeTime = 3000;
    for (const auto& [settings, again] :
         {Case{rate, true}, Case{type, true}, Case{channels, true}, Case{buffer, false}, Case{fade, false}}) {
        ScriptedFmod shared;
        TFMODPlaySound first(shared, {});
        first.Open();
        shared.calls.clear();
        TFMODPlaySound second(shared, settings);
        second.Open();
        EXPECT_EQ(shared.calls.value(0) == u"Close"_s, again);
        EXPECT_EQ(shared.calls.filter(u"Init"_s).size(), again ? 1 : 0);
    }
}

TEST_F(FMODPlaySoundTest, SongIsTakenBeforeAStream) {
    library.isSong = true;
    for (const int type : {FMUSIC_TYPE_MOD, FMUSIC_TYPE_S3M, FMUSIC_TYPE_XM, FMUSIC_TYPE_MIDI}) {
        library.songType = type;
        library.calls.clear();
        sound.Open();
        EXPECT_TRUE(library.calls.contains(u"SongVolume 255"_s));
        EXPECT_EQ(library.calls.contains(u"Separation 0.15"_s), type <= 2) << type;
        EXPECT_TRUE(library.calls.filter(u"OpenFile"_s).isEmpty());
    }
}

TEST_F(FMODPlaySoundTest, ShortStreamIsOpenedASecondTimeWithoutTheExactLength) {
    library.lengths[0x20029] = 29999;
    library.lengths[0x29] = 29500;
    sound.Open();
    EXPECT_EQ(library.calls.mid(5), QStringList({u"OpenFile 20029"_s, u"StreamClose"_s, u"OpenFile 29"_s}));
    EXPECT_EQ(sound.GetLength(), 29500U);

    library.lengths[0x20029] = 30000;
    library.calls.clear();
    sound.Open();
    EXPECT_EQ(library.calls.filter(u"OpenFile"_s), QStringList({u"OpenFile 20029"_s}));
}

TEST_F(FMODPlaySoundTest, FileThatDoesNotOpenLeavesTheBackEndClosed) {
    library.streamOpens = false;
    library.error = FMOD_ERR_FILE_FORMAT;
    EXPECT_EQ(Refusal([&] { sound.Open(); }),
              u"Fehler beim Öffnen der Datei /music/a.mp3 in FMOD: Unknown file format"_s);
    EXPECT_EQ(sound.GetStatus(), psClosed);
    sound.Play();
    sound.PauseResume();
    sound.SetPosition(5);
    sound.Stop();
    EXPECT_EQ(sound.GetPosition(), 0U);
    EXPECT_EQ(sound.GetLength(), 0U);
    EXPECT_EQ(library.calls.last(), u"OpenFile 20029"_s);
}

TEST_F(FMODPlaySoundTest, StreamStartsPausedAtFullLevelAndThenSounds) {
    sound.Open();
    library.calls.clear();
    sound.Play();
    EXPECT_EQ(library.calls, QStringList({u"PlayEx -1 0 1"_s, u"Pan -1"_s, u"Volume 255"_s, u"Pause 0"_s}));
    EXPECT_EQ(sound.GetStatus(), psPlaying);
}

TEST_F(FMODPlaySoundTest, SongStartsAtFullVolume) {
    OpenSong();
    sound.Play();
    EXPECT_EQ(library.calls, QStringList({u"PlaySong"_s, u"SongVolume 256"_s}));
}

TEST_F(FMODPlaySoundTest, FailureToPlayOrPauseIsTold) {
    sound.Open();
    library.playWorks = false;
    library.error = FMOD_ERR_CHANNEL_ALLOC;
    EXPECT_EQ(Refusal([&] { sound.Play(); }),
              u"Fehler beim Abspielen von /music/a.mp3 in FMOD: Failed to allocate a new channel"_s);
    library.playWorks = true;
    sound.Play();
    library.pauseWorks = false;
    library.error = 99;
    EXPECT_EQ(Refusal([&] { sound.PauseResume(); }),
              u"Fehler beim Pausieren/Fortsetzen von /music/a.mp3 in FMOD: Unknown error"_s);
}

TEST_F(FMODPlaySoundTest, PauseResumeTurnsWithTheStatus) {
    for (const bool song : {false, true}) {
        library.isSong = song;
        sound.Open();
        sound.PauseResume();
        EXPECT_EQ(sound.GetStatus(), psStopped);
        sound.Play();
        sound.PauseResume();
        EXPECT_EQ(sound.GetStatus(), psPaused);
        sound.PauseResume();
        EXPECT_EQ(sound.GetStatus(), psPlaying);
        sound.PauseResume();
        sound.Play();
        EXPECT_EQ(sound.GetStatus(), psPlaying);
        library.playing = false;  // it came to its end
        EXPECT_EQ(sound.GetStatus(), psStopped);
    }
}

TEST_F(FMODPlaySoundTest, StopAndCloseGiveEverythingBack) {
    PlayStream();
    sound.StartFadeIn();
    sound.StartFadeOut();
    sound.Stop();
    EXPECT_EQ(library.calls, QStringList({u"StreamStop"_s}));
    EXPECT_FALSE(sound.IsFadingIn() || sound.IsFadingOut());
    library.playing = true;  // another one took the channel
    EXPECT_EQ(sound.GetStatus(), psStopped);
    sound.Close();
    EXPECT_EQ(library.calls, QStringList({u"StreamStop"_s, u"StreamStop"_s, u"StreamClose"_s}));
    EXPECT_EQ(sound.GetStatus(), psClosed);
    OpenSong();
    sound.Close();
    EXPECT_EQ(library.calls, QStringList({u"FreeSong"_s}));
}

TEST_F(FMODPlaySoundTest, SongCountsEveryRowAs144Milliseconds) {
    OpenSong();
    library.order = 3;
    library.row = 5;
    EXPECT_EQ(sound.GetPosition(), (3 * 64 + 5) * 144U);
    EXPECT_EQ(sound.GetLength(), 10 * 64 * 144U);
    sound.SetPosition(2 * 64 * 144);
    sound.SetPosition(2 * 64 * 144 - 1);
    EXPECT_EQ(library.calls, QStringList({u"SetOrder 2"_s, u"SetOrder 1"_s}));
    library.rows = 0;
    sound.SetPosition(1000);
    EXPECT_EQ(library.calls.size(), 2);
}

TEST_F(FMODPlaySoundTest, VolumeIsBoundedAndRounded) {
    struct Case {
        int percent, stream, song;
    };
    for (const auto& [percent, stream, song] :
         {Case{150, 255, 256}, Case{-5, 0, 0}, Case{33, 84, 84}, Case{50, 128, 128}, Case{99, 252, 253},
          Case{100, 255, 256}}) {
        library.isSong = false;
        PlayStream();
        sound.SetVolume(percent);
        EXPECT_EQ(library.volume, stream) << percent;
        OpenSong();
        sound.SetVolume(percent);
        EXPECT_EQ(library.volume, song) << percent;
    }
    library.isSong = false;
    sound.Open();
    library.calls.clear();
    sound.SetVolume(50);  // no channel yet
    EXPECT_TRUE(library.calls.isEmpty());
}

struct FadeMoment {
    quint32 after;  // ms
    int in, out;    // percent
};

class FadeTest : public FMODPlaySoundTest, public testing::WithParamInterface<FadeMoment> {};

TEST_P(FadeTest, VolumeFollowsALineInWholePercent) {
    library.isSong = true;
    sound.Open();
    sound.SetFadeTime(3000);
    const auto [after, in, out] = GetParam();
    sound.StartFadeIn();
    clock.Milliseconds += after;
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(library.volume, (in * 256 + 50) / 100);
    sound.CancelFades();
    sound.StartFadeOut();
    clock.Milliseconds += after;
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(library.volume, (out * 256 + 50) / 100);
}

INSTANTIATE_TEST_SUITE_P(Moments, FadeTest,
                         testing::Values(FadeMoment{0, 0, 100}, FadeMoment{1, 1, 99}, FadeMoment{29, 1, 99},
                                         FadeMoment{30, 1, 99}, FadeMoment{31, 2, 98},
                                         FadeMoment{1500, 50, 50}, FadeMoment{2999, 100, 0}));

TEST_F(FMODPlaySoundTest, FadesEndOnTheTickAfterTheirEnd) {
    PlayStream();
    sound.StartFadeIn();
    clock.Milliseconds += 10000;
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_TRUE(library.calls.isEmpty());
    EXPECT_TRUE(sound.IsFadingIn());
    clock.Milliseconds += 1;
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(library.volume, 255);
    EXPECT_FALSE(sound.IsFadingIn());

    sound.StartFadeOut();
    clock.Milliseconds += 10000;
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(sound.GetStatus(), psPlaying);
    clock.Milliseconds += 1;
    EXPECT_TRUE(sound.FadeStep());
    EXPECT_EQ(sound.GetStatus(), psStopped);
    EXPECT_EQ(library.volume, 255);  // silence came from stopping, not from one last loud step
    EXPECT_FALSE(sound.FadeStep());
}

TEST_F(FMODPlaySoundTest, PlayingAgainOrCuttingEndsAFadeAtTheNextStep) {
    PlayStream();
    sound.StartFadeIn();
    sound.Play();
    EXPECT_TRUE(library.calls.isEmpty());
    EXPECT_FALSE(sound.FadeStep());
    EXPECT_EQ(library.volume, 255);
    sound.StartFadeOut();
    sound.Play();
    EXPECT_TRUE(sound.FadeStep());

    sound.CutFadeOut();
    EXPECT_FALSE(sound.IsFadingOut());
    sound.Play();
    sound.StartFadeOut();
    sound.CutFadeOut();
    EXPECT_TRUE(sound.FadeStep());
    EXPECT_EQ(sound.GetStatus(), psStopped);
}

TEST(FMODErrorsTest, EveryCodeHasItsText) {
    EXPECT_EQ(FMODErrorText(0), u"No errors"_s);
    EXPECT_EQ(FMODErrorText(FMOD_ERR_BUSY),
              u"Cannot call this command after FSOUND_Init.  Call FSOUND_Close first"_s);
    EXPECT_EQ(FMODErrorText(FMOD_ERR_CHANNEL_ALLOC), u"Failed to allocate a new channel"_s);
    EXPECT_EQ(FMODErrorText(18), u"Required Mediaplayer codec is not installed"_s);
    EXPECT_EQ(FMODErrorText(19), u"Unknown error"_s);
    EXPECT_EQ(FMODErrorText(-1), u"Unknown error"_s);
}

}  // namespace
