#include <gtest/gtest.h>

#include "MusicManagment/playback/fmod/FMODPlaySound.h"
#include "tests/HandClock.h"
#include "tests/playback/Listening.h"

namespace {

constexpr quint32 kFade = 4000;  // ms
constexpr int kStep = 250;       // ms between two ticks of the player's timer
constexpr double kOld = 440;     // Hz
constexpr double kNew = 880;

// Two back ends, the sound library and the clock, run as the player runs them.
class CrossFadeTest : public Listening {
 protected:
    CrossFadeTest() {
        WriteWav(Path("old.wav"), Sine({.frequency = kOld, .amplitude = 0.45}, 8));
        WriteWav(Path("new.wav"), Sine({.frequency = kNew, .amplitude = 0.45}, 8));
        oldSound.SetBackendFile(Path("old.wav"));
        newSound.SetBackendFile(Path("new.wav"));
    }
    // True when the old sound's fade has ended.
    bool Tick() {
        newSound.FadeStep();
        const bool ended = oldSound.FadeStep();
        Hear(kStep / 1000.0);
        clock.Milliseconds += kStep;
        return ended;
    }
    void StartCrossFade() {
        oldSound.Open();
        oldSound.Play();
        Tick();
        newSound.Open();
        oldSound.StartFadeOut();
        newSound.StartFadeIn();
        newSound.Play();
        faded = HeardFrames();
    }

    HandClock clock;
    TFMODPlaySound oldSound{library, {.FadeTime = kFade, .OutputType = FSOUND_OUTPUT_NOSOUND}};
    TFMODPlaySound newSound{library, {.FadeTime = kFade, .OutputType = FSOUND_OUTPUT_NOSOUND}};
    std::size_t faded = 0;  // the frame at which the fade began
};

TEST_F(CrossFadeTest, OneToneFallsAsTheOtherRises) {
    StartCrossFade();
    for (int i = 0; i < 16; ++i) {
        const std::size_t from = HeardFrames() + Mixer::kBlock;
        EXPECT_FALSE(Tick());
        const int left = 100 * (16 - i) * kStep / static_cast<int>(kFade);
        EXPECT_NEAR(AmplitudeOf(kOld, *heard, from, Frames(0.2)), 0.0045 * left, 0.002) << i;
        EXPECT_NEAR(AmplitudeOf(kNew, *heard, from, Frames(0.2)), 0.0045 * (100 - left), 0.002) << i;
    }
    EXPECT_FALSE(Tick());  // the end itself
    EXPECT_EQ(oldSound.GetStatus(), psPlaying);
    EXPECT_TRUE(Tick());
    EXPECT_EQ(oldSound.GetStatus(), psStopped);
    EXPECT_EQ(newSound.GetStatus(), psPlaying);

    EXPECT_LT(*std::max_element(heard->begin(), heard->end()), 0.95F);
    EXPECT_EQ(library.FramesStarved(), 0U);
    // The new tone is where it must be after so many frames: none was dropped on the way.
    Tick();
    const std::size_t from = HeardFrames() - Frames(0.2);
    // Steps of the volume glide: nothing in the sum of two tones changes faster than the tones themselves.
    EXPECT_LT(LargestStep(*heard, faded + Mixer::kBlock),
              1.05 * SteepestStep({.frequency = kNew, .amplitude = 0.45}));
    EXPECT_LT(
        Difference(*heard, from, Sine({.frequency = kNew, .amplitude = 0.45}, 8), from - faded, Frames(0.2)),
        1e-3);
}

// What another back end still holds of the library before must not reach the sounds of the new one.
TEST_F(CrossFadeTest, NewSettingsCloseWhatAnotherBackEndPlays) {
    StartCrossFade();
    TFMODPlaySound third(library, {.OutputType = FSOUND_OUTPUT_NOSOUND, .SoftChannels = 16});
    third.SetBackendFile(Path("old.wav"));
    third.Open();
    EXPECT_EQ(oldSound.GetStatus(), psStopped);
    EXPECT_THROW(oldSound.Play(), EFMODException);
    third.Play();
    oldSound.SetVolume(0);
    newSound.SetVolume(0);
    oldSound.Close();
    const std::size_t from = HeardFrames() + Frames(0.1);
    Hear(0.4);
    EXPECT_EQ(third.GetStatus(), psPlaying);
    EXPECT_NEAR(AmplitudeOf(kOld, *heard, from, Frames(0.2)), 0.45, 0.002);
}

TEST_F(CrossFadeTest, ASoundThatIsStoppedOrCutOffGlidesIntoSilence) {
    constexpr Tone kLow = {.frequency = 100, .amplitude = 0.45};
    WriteWav(Path("low.wav"), Sine(kLow, 8));
    newSound.SetBackendFile(Path("low.wav"));
    using Ending = void (*)(TFMODPlaySound&);
    for (const Ending end :
         {Ending{[](TFMODPlaySound& sound) { sound.Stop(); }},
          Ending{[](TFMODPlaySound& sound) { sound.Close(); }}, Ending{[](TFMODPlaySound& sound) {
              sound.StartFadeOut();
              sound.CutFadeOut();
              sound.FadeStep();
          }}}) {
        newSound.Open();
        newSound.Play();
        Hear(0.5025);  // a crest
        const std::size_t ended = HeardFrames();
        end(newSound);
        Hear(0.1);
        EXPECT_LT(LargestStep(*heard, ended - 10), SteepestStep(kLow) + kLow.amplitude / Mixer::kBlock);
        EXPECT_EQ(heard->back(), 0);
    }
}

}  // namespace
