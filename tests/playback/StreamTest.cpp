#include <gtest/gtest.h>

#include <QDir>

#include "tests/PrintQt.h"
#include "tests/playback/Listening.h"

using namespace Qt::StringLiterals;

namespace {

class StreamTest : public Listening {
 protected:
    StreamTest() { Init(); }
};

TEST_F(StreamTest, PlainSoundIsHeardAsItWasRecorded) {
    const Samples sweep = Sweep(1.5);
    WriteWav(Path("a.wav"), sweep);
    const Samples all = HearAll(Path("a.wav"));
    ASSERT_GE(all.size(), sweep.size());
    EXPECT_LT(Difference(all, 0, sweep, 0, sweep.size() / 2), 1e-4);
    EXPECT_EQ(std::count(all.begin() + static_cast<std::ptrdiff_t>(sweep.size()), all.end(), 0.0F),
              static_cast<std::ptrdiff_t>(all.size() - sweep.size()));
    EXPECT_EQ(library.FramesStarved(), 0U);
    EXPECT_EQ(library.FramesPlayed(), all.size() / 2);
}

TEST_F(StreamTest, OtherRatesMonoAndRawSoundTheSame) {
    const Tone tone{.frequency = 441, .amplitude = 0.4};
    WriteWav(Path("48000.wav"), Sine(tone, 1, 48000), 48000);
    WriteWav(Path("8000.wav"), Sine(tone, 1, 8000), 8000);
    WriteWav(Path("mono.wav"), Sine(tone, 1), kRate, 1);
    WriteRaw(Path("a.raw"), Sine(tone, 1));
    for (const char* name : {"48000.wav", "8000.wav", "mono.wav", "a.raw"}) {
        const Samples all = HearAll(Path(name));
        ASSERT_GE(all.size() / 2, Frames(1)) << name;
        EXPECT_LT(Difference(all, 500, Sine(tone, 1), 500, Frames(0.9)), 2e-3) << name;
    }
}

TEST_F(StreamTest, VolumeAndPanChangeTheSides) {
    WriteWav(Path("a.wav"), Sine({.frequency = 441, .amplitude = 0.5}, 3));
    const int channel = Play(OpenStream(Path("a.wav")));
    struct Case {
        int volume, pan;
        double left, right;
    };
    for (const auto& [volume, pan, left, right] :
         {Case{255, -1, 0.5, 0.5}, Case{51, -1, 0.1, 0.1}, Case{255, 0, 0.5, 0}, Case{255, 255, 0, 0.5},
          Case{0, 128, 0, 0}, Case{300, 51, 0.4, 0.1}}) {
        EXPECT_TRUE(library.FSOUND_SetVolume(channel, volume));
        EXPECT_TRUE(library.FSOUND_SetPan(channel, pan));
        Hear(0.1);  // the glide
        const std::size_t from = HeardFrames();
        Hear(0.2);
        EXPECT_NEAR(AmplitudeOf(441, *heard, from, Frames(0.2), 0), left, 1e-3);
        EXPECT_NEAR(AmplitudeOf(441, *heard, from, Frames(0.2), 1), right, 1e-3);
    }
    EXPECT_FALSE(library.FSOUND_SetPan(channel, 256));
}

TEST_F(StreamTest, LoudSumIsClampedAndQuietOneIsNot) {
    WriteWav(Path("a.wav"), Sine({.frequency = 440, .amplitude = 0.9}, 1));
    WriteWav(Path("b.wav"), Sine({.frequency = 880, .amplitude = 0.08}, 1));
    const int loud = Play(OpenStream(Path("a.wav")));
    Play(OpenStream(Path("b.wav")));
    Hear(0.5);
    EXPECT_LT(*std::max_element(heard->begin(), heard->end()), 0.99F);
    Play(OpenStream(Path("a.wav")));
    Hear(0.4);
    EXPECT_EQ(*std::max_element(heard->begin(), heard->end()), 1.0F);
    EXPECT_EQ(*std::min_element(heard->begin(), heard->end()), -1.0F);
    EXPECT_TRUE(library.FSOUND_IsPlaying(loud));
}

TEST_F(StreamTest, PauseAndResumeLoseNothing) {
    const Samples sweep = Sweep(2);
    WriteWav(Path("a.wav"), sweep);
    const FSOUND_STREAM stream = OpenStream(Path("a.wav"));
    const int channel = Play(stream);
    Hear(0.5);
    const std::size_t played = HeardFrames() + Mixer::kBlock;  // one block fades out
    EXPECT_TRUE(library.FSOUND_SetPaused(channel, true));
    Hear(0.3);
    EXPECT_TRUE(library.FSOUND_GetPaused(channel));
    EXPECT_TRUE(library.FSOUND_IsPlaying(channel));
    const int position = library.FSOUND_Stream_GetTime(stream);
    EXPECT_EQ(position, static_cast<int>(played * 1000 / kRate));
    EXPECT_EQ(heard->back(), 0.0F);
    library.FSOUND_SetPaused(channel, false);
    const std::size_t resumed = HeardFrames();
    Hear(1);
    EXPECT_LT(Difference(*heard, resumed + Mixer::kBlock, sweep, played + Mixer::kBlock, Frames(0.9)), 1e-4);
    // No click where it goes on: one block glides up.
    EXPECT_LT(std::abs(heard->at(2 * resumed)), 0.01F);
    EXPECT_EQ(library.FramesStarved(), 0U);
}

TEST_F(StreamTest, TimeLengthAndEnd) {
    WriteWav(Path("a.wav"), Sine({}, 0.5));
    const FSOUND_STREAM stream = OpenStream(Path("a.wav"));
    EXPECT_EQ(library.FSOUND_Stream_GetLengthMs(stream), 500);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 0);
    const int channel = Play(stream);
    Hear(0.2);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 200);
    Hear(0.4);
    EXPECT_FALSE(library.FSOUND_IsPlaying(channel));
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 500);
    // A seek does not wake it; playing again starts where it leads.
    library.FSOUND_Stream_SetTime(stream, 300);
    EXPECT_FALSE(library.FSOUND_IsPlaying(channel));
    Play(stream);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 300);
    Hear(0.4);
    // Without one it starts from the front.
    Play(stream);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 0);
    library.FSOUND_Stream_SetTime(stream, 100'000);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 500);
    library.FSOUND_Stream_Stop(stream);
    EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), 0);
}

struct CodedFile {
    const char* name;
    Encoding encoding;
    int delay;  // frames that the encoder put in front and nobody took away; below 0: its decoder left so
                // many out
};

class CodedStreamTest : public StreamTest, public testing::WithParamInterface<CodedFile> {
 protected:
    static constexpr double kSeconds = 9;
};

TEST_P(CodedStreamTest, LengthSeeksAndPaddingAreExact) {
    const Samples sweep = Sweep(kSeconds);
    Encode(Path(GetParam().name), sweep, GetParam().encoding);
    const Samples all = HearAll(Path(GetParam().name));
    const auto from = static_cast<std::size_t>(4096 + GetParam().delay);
    EXPECT_LT(Difference(all, from, sweep, 4096, Frames(2)), 0.05);

    const FSOUND_STREAM stream = OpenStream(Path(GetParam().name));
    EXPECT_NEAR(library.FSOUND_Stream_GetLengthMs(stream), kSeconds * 1000, 60);
    const int channel = Play(stream);
    Hear(0.1);
    for (const int target : {5000, 1, 8500, 3333, 3300, 0}) {
        ASSERT_TRUE(library.FSOUND_Stream_SetTime(stream, target));
        EXPECT_EQ(library.FSOUND_Stream_GetTime(stream), target);
        Hear(0.1);
        const std::size_t at = HeardFrames();
        Hear(0.05);
        // The piece is looked for around its place.
        const std::size_t place = Frames(target / 1000.0 + 0.1);
        double best = 1;
        std::size_t found = 0;
        for (std::size_t i = place - std::min<std::size_t>(place, 2205); i < place + 2205; ++i) {
            const double difference = Difference(*heard, at, all, i, 300);
            if (difference < best) found = i;
            best = std::min(best, difference);
        }
        EXPECT_LT(best, 0.05) << target;
        EXPECT_NEAR(static_cast<double>(found), static_cast<double>(place), 60) << target;  // 1.4 ms
    }
    Hear(kSeconds - 0.5);
    EXPECT_TRUE(library.FSOUND_IsPlaying(channel));
    Hear(1);
    EXPECT_FALSE(library.FSOUND_IsPlaying(channel));
    EXPECT_NEAR(library.FSOUND_Stream_GetLengthMs(stream), library.FSOUND_Stream_GetTime(stream), 50);
    EXPECT_EQ(library.FramesStarved(), 0U);
}

INSTANTIATE_TEST_SUITE_P(
    Files, CodedStreamTest,
    testing::Values(
        CodedFile{"cbr.mp3", {.codec = "libmp3lame", .format = "mp3"}, 0},
        CodedFile{"vbr.mp3", {.codec = "libmp3lame", .format = "mp3", .bitRate = 0}, 0},
        CodedFile{"bare-cbr.mp3", {.codec = "libmp3lame", .format = "mp3", .header = false}, 1105},
        CodedFile{
            "bare-vbr.mp3", {.codec = "libmp3lame", .format = "mp3", .bitRate = 0, .header = false}, 1105},
        CodedFile{"a.mp2", {.codec = "mp2", .format = "mp2", .bitRate = 192'000}, 481},
        CodedFile{"a.wma", {.codec = "wmav2", .format = "asf"}, -2048},
        CodedFile{"a.asf", {.codec = "wmav1", .format = "asf"}, -2048},
        CodedFile{"a.ogg", {.codec = "libvorbis", .format = "ogg"}, 0},
        CodedFile{"a.wav", {.codec = "pcm_s16le", .format = "wav"}, 0}),
    [](const auto& file) {
        std::string name = file.param.name;
        std::replace_if(
            name.begin(), name.end(), [](unsigned char c) { return std::isalnum(c) == 0; }, '_');
        return name;
    });

TEST_F(StreamTest, DamageCostsOnlyItsPlaceAndACutOnlyTheRest) {
    Encode(Path("a.mp3"), Sweep(6), {.codec = "libmp3lame", .format = "mp3"});
    QByteArray bytes = ReadBytes(Path("a.mp3"));
    WriteBytes(Path("cut.mp3"), bytes.left(bytes.size() / 3));
    EXPECT_NEAR(library.FSOUND_Stream_GetLengthMs(OpenStream(Path("cut.mp3"))), 2000, 60);
    for (qsizetype i = bytes.size() / 3; i < bytes.size() / 3 + 4000; ++i)
        bytes[i] = static_cast<char>(i * 167 + 13);
    WriteBytes(Path("a.mp3"), bytes);
    EXPECT_NEAR(library.FSOUND_Stream_GetLengthMs(OpenStream(Path("a.mp3"))), 6000, 600);
    EXPECT_GT(HearAll(Path("a.mp3")).size() / 2, Frames(5.2));
}

TEST_F(StreamTest, WhatCannotBePlayedIsRefusedWithItsReason) {
    WriteBytes(Path("empty.raw"), {});
    WriteBytes(Path("header.wav"), QByteArray::fromHex("524946462400000057415645666d7420"));
    QDir(folder.path()).mkdir(u"folder.mp3"_s);
    for (const auto& [path, error] : {std::pair(Path("missing.mp3"), FMOD_ERR_FILE_NOTFOUND),
                                      std::pair(Path("empty.raw"), FMOD_ERR_FILE_FORMAT),
                                      std::pair(Path("header.wav"), FMOD_ERR_FILE_FORMAT),
                                      std::pair(Path("folder.mp3"), FMOD_ERR_FILE_BAD),
                                      std::pair(u"http://localhost/a.mp3"_s, FMOD_ERR_FILE_NOTFOUND)}) {
        EXPECT_EQ(OpenStream(path), FSOUND_STREAM::kNone) << path.toStdString();
        EXPECT_EQ(library.FSOUND_GetError(), error) << path.toStdString();
    }
}

TEST_F(StreamTest, NamesAreTakenAsTheyAre) {
    for (const char* name : {"Käse – 50%20?.wav", "a:b|c.wav", "%d.wav", "subfile,,start,0,:a.wav"}) {
        WriteWav(Path(name), Sine({}, 0.2));
        EXPECT_NE(OpenStream(Path(name)), FSOUND_STREAM::kNone) << name;
    }
}

TEST_F(StreamTest, SpectrumShowsATone) {
    const double frequency = 100 * 44100.0 / 1024;
    WriteWav(Path("a.wav"), Sine({.frequency = frequency, .amplitude = 0.4}, 1));
    Play(OpenStream(Path("a.wav")));
    Hear(0.2);
    const float* bands = library.FSOUND_DSP_GetSpectrum();
    EXPECT_EQ(*std::max_element(bands, bands + FSOUND_SPECTRUM_SIZE), 0);
    library.FSOUND_DSP_SetActive(library.FSOUND_DSP_GetFFTUnit(), true);
    bands = library.FSOUND_DSP_GetSpectrum();
    EXPECT_NEAR(bands[100], 0.4, 0.002);
    EXPECT_NEAR(bands[99], 0.2, 0.002);
    EXPECT_LT(*std::max_element(bands, bands + 98), 0.001);
    EXPECT_LT(*std::max_element(bands + 103, bands + FSOUND_SPECTRUM_SIZE), 0.001);
}

}  // namespace
