#include "ReadMPEGHeader/mpeg/MpegFrame.h"

#include <gtest/gtest.h>

#include "ReadMPEGHeader/mpeg/FrameCount.h"

#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

struct HeaderCase {
    std::array<std::uint8_t, 4> Bytes;
    QString Format;
    int BitRate;
    int SampleRate;
    int FrameSize;
    int ModernBitRate = BitRate;
    int ModernFrameSize = FrameSize;
};

}  // namespace

TEST(MpegFrame, OnlyTheModernRulesHaveTheRowsOfTheStandard) {
    const std::array cases = {
        HeaderCase{{0xFF, 0xFB, 0x90, 0x64}, u"MPEG 1.0 Layer III"_s, 128, 44100, 417},
        HeaderCase{{0xFF, 0xFB, 0x92, 0x64}, u"MPEG 1.0 Layer III"_s, 128, 44100, 418},  // padded
        HeaderCase{{0xFF, 0xFB, 0x00, 0x64}, u"MPEG 1.0 Layer III"_s, 24, 44100, 78},    // free format
        HeaderCase{{0xFF, 0xFB, 0xFC, 0x64}, u"MPEG 1.0 Layer III"_s, 384, 24000, 2304},
        HeaderCase{{0xFF, 0xFD, 0xD4, 0x00}, u"MPEG 1.0 Layer II"_s, 320, 48000, 960},
        HeaderCase{{0xFF, 0xFF, 0x0A, 0x00}, u"MPEG 1.0 Layer I"_s, 1, 32000, 5},  // 4 bytes of padding
        HeaderCase{{0xFF, 0xF3, 0x50, 0x00}, u"MPEG 2.0 Layer III"_s, 64, 22050, 208, 40, 130},
        HeaderCase{{0xFF, 0xF3, 0xD8, 0x00}, u"MPEG 2.0 Layer III"_s, 256, 16000, 1152, 144, 648},
        HeaderCase{{0xFF, 0xF5, 0x0C, 0x00}, u"MPEG 2.0 Layer II"_s, 16, 12000, 96},  // reserved rate
        HeaderCase{{0xFF, 0xF5, 0x58, 0x00}, u"MPEG 2.0 Layer II"_s, 80, 16000, 360, 40, 360},
        HeaderCase{{0xFF, 0xF3, 0x00, 0x00}, u"MPEG 2.0 Layer III"_s, 4, 22050, 13, 0, 0},  // free format
        HeaderCase{{0xFF, 0xE3, 0x18, 0x00}, u"MPEG 2.5 Layer III"_s, 32, 8000, 288, 8, 72},
        // MPEG 2.5 has no fourth sample rate: another stream, with the bit rate of the first guess.
        HeaderCase{{0xFF, 0xE3, 0x1C, 0x00}, u"MPEG 2.0 Layer I"_s, 32, 24000, 32},
        HeaderCase{{0xFF, 0xE9, 0x90, 0x00}, u"MPEG ??? Layer ???"_s, 0, 0, 0},
        HeaderCase{{0xFF, 0xF9, 0x92, 0x00}, u"MPEG 1.0 Layer ???"_s, 0, 44100, 1},
    };
    for (const auto& expected : cases) {
        const auto header = MpegHeader::DecodeClassic(expected.Bytes);
        const auto modern = MpegHeader::DecodeModern(expected.Bytes);
        SCOPED_TRACE(testing::Message() << std::hex << +expected.Bytes[1] << ' ' << +expected.Bytes[2]);
        EXPECT_EQ(header.FormatText(), expected.Format);
        EXPECT_EQ(header.BitRate, expected.BitRate);
        EXPECT_EQ(header.SampleRate, expected.SampleRate);
        EXPECT_EQ(header.FrameSize(), expected.FrameSize);
        EXPECT_EQ(modern.FormatText(), expected.Format);
        EXPECT_EQ(modern.BitRate, expected.ModernBitRate);
        EXPECT_EQ(modern.FrameSize(), expected.ModernFrameSize);
    }
}

TEST(MpegFrame, FlagsChannelsAndEmphasisReachTheRecord) {
    const auto plain = AnalyseFirstFrame(Mp3Builder().Frames(1, {{0xFF, 0xFB, 0x90, 0xC1}, 417})).Tag;
    EXPECT_EQ(plain.ChannelMode, 1);
    EXPECT_EQ(plain.Emphasis, 3);
    EXPECT_FALSE(plain.Protected || plain.Padding || plain.Private || plain.Copyrighted || plain.Original);
    const auto all = AnalyseFirstFrame(Mp3Builder().Frames(1, {{0xFF, 0xFA, 0x93, 0x0C}, 418})).Tag;
    EXPECT_TRUE(all.Protected && all.Padding && all.Private && all.Copyrighted && all.Original);
}

TEST(MpegFrame, LengthOfAConstantStreamComesFromTheSizeOfTheFile) {
    // 148 bytes at the end are not sound; ten seconds of 128 kbit/s are 160000 bytes.
    const auto tenSeconds = AnalyseFirstFrame(Mp3Builder().Frames(1).ZerosUpTo(160000 + 148));
    EXPECT_EQ(tenSeconds.Tag.Length, 10);
    EXPECT_EQ(tenSeconds.Tag.FrameSize, 417);
    EXPECT_EQ(tenSeconds.Results.FrameCount, 160000 / 417);
    EXPECT_EQ(tenSeconds.Results.VbrMarker, 0);
    EXPECT_EQ(AnalyseFirstFrame(Mp3Builder().Frames(1).ZerosUpTo(160000 + 147)).Tag.Length, 9);
}

TEST(MpegFrame, NothingIsCountedWhereNothingCanBe) {
    const std::array<std::uint8_t, 2> cut = {0xFF, 0xFB};
    const FrameKind reserved = {{0xFF, 0xE9, 0x90, 0x00}, 5000};
    for (const auto& file : {Mp3Builder().Raw(cut), Mp3Builder().Frames(1, reserved)}) {
        for (const auto& rules : {kClassicMpegRules, kModernMpegRules}) {
            const auto analysis = AnalyseFirstFrame(file, rules);
            EXPECT_EQ(analysis.Results.FrameCount, 0);
            EXPECT_EQ(analysis.Tag.Length, 0);
        }
    }
}

TEST(FrameCount, EveryFrameIsCountedAndDamageIsTold) {
    const auto count = [](const Mp3Builder& file) {
        MemorySource source(file.Data());
        return CountMpegFrames(source, 0);
    };
    // Two bit rates, a VBR header that counts one more, a cut frame, an ID3v1 tag.
    Mp3Builder whole;
    whole.FrameWith(kStereo128, 36, "Xing", {1, 201})
        .Frames(100)
        .Frames(100, {{0xFF, 0xFB, 0xB0, 0x64}, 626});
    const FrameCount exact = count(Mp3Builder(whole).Id3v1("t", "a"));
    EXPECT_EQ(exact.Frames, 200);
    EXPECT_EQ(exact.Announced, 201);
    EXPECT_EQ(exact.Skipped, 0);
    EXPECT_EQ(exact.Seconds(), 5);  // 200 * 1152 / 44100
    EXPECT_EQ(exact.BitRate(), 160);
    EXPECT_EQ(count(Mp3Builder(whole).Raw(kStereo128.Header).Noise(20)).Frames, 200);
    EXPECT_EQ(count(Mp3Builder(whole).Zeros(5000)).Skipped, 0);
    const FrameCount damaged = count(Mp3Builder(whole).Noise(3001).Frames(50));
    EXPECT_EQ(damaged.Frames, 250);
    EXPECT_EQ(damaged.Skipped, 3001);
    EXPECT_EQ(count(Mp3Builder().Noise(100)).Frames, 0);
}
