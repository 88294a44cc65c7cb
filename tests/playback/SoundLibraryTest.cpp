#include "MusicManagment/playback/fmod/SoundLibrary.h"

#include <gtest/gtest.h>

#include <QScopeGuard>
#include <atomic>
#include <thread>

#include "CommonRUKTools/ByteReader.h"
#include "MusicManagment/playback/fmod/FMODPlaySound.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/playback/Listening.h"

using namespace Qt::StringLiterals;

namespace {

class SoundLibraryTest : public Listening {};

TEST_F(SoundLibraryTest, OrderOfCallsIsWatched) {
    EXPECT_EQ(OpenStream(Path("a.wav")), FSOUND_STREAM::kNone);
    EXPECT_EQ(library.FMUSIC_LoadSong(Path("a.mod")), FMUSIC_MODULE::kNone);
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_UNINITIALIZED);
    EXPECT_FALSE(library.FSOUND_Init(1, 32, 2));
    EXPECT_FALSE(library.FSOUND_SetOutput(8));
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_INVALID_PARAM);
    Init();
    EXPECT_FALSE(library.FSOUND_SetOutput(0) || library.FSOUND_SetDriver(0) || library.FSOUND_SetMixer(0) ||
                 library.FSOUND_SetBufferSize(100) || library.FSOUND_Init(44100, 32, 2));
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_BUSY);
    library.FSOUND_Close();
    EXPECT_TRUE(library.FSOUND_Init(48000, 32, 2));
}

TEST_F(SoundLibraryTest, OldAndWrongHandlesAreRefused) {
    Init();
    WriteWav(Path("a.wav"), Sine({}, 1));
    const FSOUND_STREAM stream = OpenStream(Path("a.wav"));
    const int channel = Play(stream);
    library.FSOUND_Stream_Stop(stream);
    const int next = Play(stream);
    for (const int wrong : {channel, -1, -7, 99'999'999})
        EXPECT_FALSE(library.FSOUND_SetPaused(wrong, true) || library.FSOUND_SetVolume(wrong, 10) ||
                     library.FSOUND_IsPlaying(wrong) || library.FSOUND_GetPaused(wrong));
    EXPECT_TRUE(library.FSOUND_IsPlaying(next));
    EXPECT_TRUE(library.FSOUND_Stream_Close(stream));
    EXPECT_FALSE(library.FSOUND_IsPlaying(next));
    const auto song = static_cast<FMUSIC_MODULE>(stream);
    EXPECT_FALSE(library.FSOUND_Stream_Close(stream) || library.FSOUND_Stream_SetTime(stream, 1) ||
                 library.FMUSIC_PlaySong(song) || library.FMUSIC_SetOrder(song, 0) ||
                 library.FMUSIC_FreeSong(song));
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_INVALID_PARAM);
    EXPECT_EQ(Play(stream), -1);
    EXPECT_EQ(library.FSOUND_Stream_GetLengthMs(stream), 0);
}

TEST_F(SoundLibraryTest, ChannelsComeBackAndOpenFilesAreCounted) {
    Init(1);
    WriteWav(Path("a.wav"), Sine({}, 0.3));
    const FSOUND_STREAM first = OpenStream(Path("a.wav"));
    const FSOUND_STREAM second = OpenStream(Path("a.wav"));
    EXPECT_GE(Play(first), 0);
    EXPECT_EQ(Play(second), -1);
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_CHANNEL_ALLOC);
    Hear(0.4);
    EXPECT_GE(Play(second), 0);
    library.FSOUND_Stream_Stop(second);
    EXPECT_GE(Play(first), 0);

    int opened = 2;
    while (opened < 1000 && OpenStream(Path("a.wav")) != FSOUND_STREAM::kNone)
        ++opened;
    EXPECT_EQ(opened, 256);
    EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_MEMORY);
}

TEST(OutputChoiceTest, OutputThatIsNotThereFailsAtInitialisation) {
    const auto restore = qScopeGuard([] { qunsetenv("TUNESTEAD_AUDIO"); });
    struct Case {
        const char* variable;
        TFSoundOutputTypes type;
    };
    for (const auto& [variable, type] :
         {Case{"", FSOUND_OUTPUT_NOSOUND}, Case{"loudspeaker", FSOUND_OUTPUT_NOSOUND},
          Case{"sdl:nosuchdriver", FSOUND_OUTPUT_NOSOUND},
          Case{"capture:/no/such/folder/a.wav", FSOUND_OUTPUT_NOSOUND}, Case{nullptr, FSOUND_OUTPUT_A3D},
          Case{nullptr, FSOUND_OUTPUT_XBOX}}) {
        variable != nullptr ? qputenv("TUNESTEAD_AUDIO", variable) : qunsetenv("TUNESTEAD_AUDIO");
        SoundLibrary library;
        library.FSOUND_SetOutput(type);
        EXPECT_FALSE(library.FSOUND_Init(44100, 32, 2)) << type;
        EXPECT_EQ(library.FSOUND_GetError(), FMOD_ERR_INIT);
    }
    qputenv("TUNESTEAD_AUDIO", "null");
    SoundLibrary library;
    library.FSOUND_SetOutput(FSOUND_OUTPUT_DSOUND);
    EXPECT_TRUE(library.FSOUND_Init(44100, 32, 2));
}

TEST_F(SoundLibraryTest, TheMasterVolumeGlidesAndStaysWithANewInitialisation) {
    WriteWav(Path("tone.wav"), Sine({.frequency = 440, .amplitude = 0.4}, 3));
    library.SetMasterVolume(0.5F);
    Init();
    Play(OpenStream(Path("tone.wav")));
    Hear(0.5);
    EXPECT_NEAR(AmplitudeOf(440, *heard, Frames(0.2), Frames(0.2)), 0.2, 0.004);
    const std::size_t turned = HeardFrames();
    library.SetMasterVolume(0);
    Hear(0.5);
    // Louder by a step than any neighbour in a sine of this pitch would be a click.
    for (std::size_t i = 2 * turned; i + 2 < heard->size(); i += 2)
        ASSERT_LT(std::abs((*heard)[i + 2] - (*heard)[i]), 0.02F) << i / 2 - turned;
    EXPECT_NEAR(AmplitudeOf(440, *heard, turned + Frames(0.2), Frames(0.2)), 0, 0.001);
    library.SetMasterVolume(7);
    Hear(0.5);
    EXPECT_NEAR(AmplitudeOf(440, *heard, HeardFrames() - Frames(0.3), Frames(0.2)), 0.4, 0.008);
}

TEST_F(SoundLibraryTest, WavFileHoldsWhatWasHeard) {
    const Samples sine = Sine({.frequency = 441, .amplitude = 0.4}, 0.5);
    WriteWav(Path("a.wav"), sine);
    for (const bool floats : {false, true}) {
        {
            SoundLibrary writing(OutputsFor({.kind = OutputChoice::Kind::WavFile,
                                             .name = Path("out.wav"),
                                             .floats = floats,
                                             .unpaced = true}));
            ASSERT_TRUE(writing.FSOUND_Init(44100, 32, 2));
            const FSOUND_STREAM stream = writing.FSOUND_Stream_OpenFile(Path("a.wav"), 0x29);
            writing.FSOUND_Stream_PlayEx(stream, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
            writing.Advance(10'000);
            writing.Advance(12'050);
        }
        const QByteArray bytes = ReadBytes(Path("out.wav"));
        EXPECT_EQ(bytes.size(), 44 + 22'050 * (floats ? 8 : 4));
        ByteReader sizes(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())}));
        sizes.Seek(4);
        EXPECT_EQ(sizes.U32Le(), bytes.size() - 8);
        sizes.Seek(40);
        EXPECT_EQ(sizes.U32Le(), bytes.size() - 44);
        if (library.FSOUND_GetError() == FMOD_ERR_NONE) library.FSOUND_Close();
        Init();
        EXPECT_LT(Difference(HearAll(Path("out.wav")), 0, sine, 0, Frames(0.5)), 1e-4);
    }
}

TEST_F(SoundLibraryTest, NothingPlaysOnIntoAFileThatTakesNoMore) {
    const QString full = u"/dev/full"_s;
    if (!QFile::exists(full)) GTEST_SKIP() << "no device that is always full";
    WriteWav(Path("a.wav"), Sine({}, 1));
    SoundLibrary writing(
        OutputsFor({.kind = OutputChoice::Kind::WavFile, .name = full, .floats = true, .unpaced = true}));
    ASSERT_TRUE(writing.FSOUND_Init(44100, 32, 2));
    const FSOUND_STREAM stream = writing.FSOUND_Stream_OpenFile(Path("a.wav"), 0x29);
    const int channel = writing.FSOUND_Stream_PlayEx(stream, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
    EXPECT_TRUE(writing.FSOUND_IsPlaying(channel));
    writing.Advance(22'050);
    EXPECT_LT(writing.FSOUND_Stream_GetTime(stream), 500);
    EXPECT_FALSE(writing.FSOUND_IsPlaying(channel));
}

TEST(SinkOutputTest, RealTimeOutputPullsByItself) {
    for (int i = 0; i < 3; ++i) {
        std::atomic<int> pulls = 0;
        NullOutput output(SinkOutput::Pace::RealTime);
        ASSERT_TRUE(output.Open(44100, 64, [&](float*, std::size_t frames) {
            pulls += frames == 64 ? 1 : 1000;
            pulls.notify_all();
        }));
        output.Advance(10'000);
        output.Start();
        pulls.wait(0);
        output.Stop();
        const int after = pulls;
        output.Close();
        EXPECT_EQ(pulls, after);
        EXPECT_LT(after, 1000);
    }
}

// A device that asks for frames all the time.
class GreedyOutput : public AudioOutput {
 public:
    ~GreedyOutput() override { GreedyOutput::Close(); }
    bool Open(int, std::size_t frames, Pull pull) override {
        buffer_.resize(2 * frames);
        pull_ = std::move(pull);
        return true;
    }
    void Start() override {
        thread_ = std::jthread([this](const std::stop_token& stop) {
            while (!stop.stop_requested())
                pull_(buffer_.data(), buffer_.size() / 2);
        });
    }
    void Stop() override { thread_ = {}; }
    void Close() override { Stop(); }
    bool Failed() const override { return false; }

 private:
    Samples buffer_;
    Pull pull_;
    std::jthread thread_;
};

// Nothing here can fail by itself: the sanitizers watch.
TEST_F(SoundLibraryTest, EverythingMayHappenWhileAnotherThreadMixes) {
    Encode(Path("a.mp3"), Sweep(3), {.codec = "libmp3lame", .format = "mp3"});
    WriteWav(Path("b.wav"), Sweep(3));
    SoundLibrary mixing([](TFSoundOutputTypes) { return std::make_unique<GreedyOutput>(); });
    ASSERT_TRUE(mixing.FSOUND_Init(44100, 3, 2));
    mixing.FSOUND_DSP_SetActive(FSOUND_DSPUNIT::kFft, true);
    for (int round = 0; round < 20; ++round) {
        const FSOUND_STREAM a = mixing.FSOUND_Stream_OpenFile(Path("a.mp3"), 0x29);
        const FSOUND_STREAM b = mixing.FSOUND_Stream_OpenFile(Path("b.wav"), 0x20029);
        const int channel = mixing.FSOUND_Stream_PlayEx(a, FSOUND_FREE, FSOUND_DSPUNIT::kNone, true);
        mixing.FSOUND_Stream_PlayEx(b, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
        ASSERT_GE(channel, 0);
        for (int i = 0; i < 10; ++i) {
            mixing.FSOUND_SetPaused(channel, i % 3 == 2);
            mixing.FSOUND_SetVolume(channel, i * 25);
            mixing.FSOUND_SetPan(channel, i * 25 - 1);
            mixing.FSOUND_Stream_SetTime(i % 2 == 0 ? a : b, i * 300);
            EXPECT_LE(mixing.FSOUND_Stream_GetTime(a), 3000);
            EXPECT_GE(mixing.FSOUND_DSP_GetSpectrum()[3], 0);
        }
        mixing.FSOUND_Stream_Stop(a);
        mixing.FSOUND_Stream_Close(b);
        mixing.FSOUND_Stream_Close(a);
    }
}

// Takes what Advance pulls, unless it is lost.
class LosableOutput : public SinkOutput {
 public:
    explicit LosableOutput(const bool& lost) : SinkOutput(Pace::Caller), lost_(lost) {}
    ~LosableOutput() override { Close(); }
    bool Replaceable() const override { return true; }

 private:
    bool Begin(int) override { return !lost_; }
    bool Accept(std::span<const float>) override { return !lost_; }

    const bool& lost_;
};

TEST_F(SoundLibraryTest, ALostDeviceKeepsThePlaceUntilItIsBack) {
    WriteWav(Path("a.wav"), Sine({}, 3));
    const HandClock clock;
    bool lost = false;
    SoundLibrary playing([&](TFSoundOutputTypes) { return std::make_unique<LosableOutput>(lost); });
    TFMODPlaySound sound(playing, {});
    sound.SetBackendFile(Path("a.wav"));
    sound.Open();
    sound.Play();
    playing.Advance(kRate);
    lost = true;
    playing.Advance(1024);
    EXPECT_THROW(sound.GetStatus(), EOutputException);
    EXPECT_THROW(sound.Play(), EOutputException);
    const quint32 position = sound.GetPosition();
    EXPECT_NEAR(position, 1000, 100);
    sound.PauseResume();
    EXPECT_EQ(sound.GetStatus(), psPaused);
    sound.PauseResume();
    lost = false;
    EXPECT_THROW(sound.GetStatus(), EOutputException);  // not looked for at every call
    clock.Milliseconds += 5000;
    EXPECT_EQ(sound.GetStatus(), psPlaying);
    EXPECT_EQ(sound.GetPosition(), position);
    playing.Advance(kRate);
    EXPECT_EQ(sound.GetPosition(), position + 1000);
}

}  // namespace
