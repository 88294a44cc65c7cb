#include "ReadMPEGHeader/wave/Wave.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

std::optional<TID3Tag> ReadWave(const WaveBuilder& file) {
    MemorySource source(file.Data());
    const auto info = ReadWaveHeader(source);
    if (!info) return std::nullopt;
    return TagFromWave(*info, 7);
}

constexpr std::uint32_t kSecond = 44100 * 4;  // bytes

}  // namespace

TEST(Wave, HeaderGivesTheTechnicalData) {
    const auto tag = ReadWave(WaveBuilder().Format().Chunk("data", 2 * kSecond).Zeros(2 * kSecond));
    ASSERT_TRUE(tag);
    EXPECT_EQ(tag->MPEGLayer, u"Wave"_s);
    EXPECT_EQ(tag->Length, 2);
    EXPECT_EQ(tag->BitRate, 1411);
    EXPECT_EQ(tag->SampleRate, 44100);
    EXPECT_EQ(tag->ChannelMode, 2);
    EXPECT_EQ(tag->Emphasis, 1);
    EXPECT_EQ(tag->FrameSize, 4);
    EXPECT_EQ(tag->AddTime, 7);
}

TEST(Wave, ChunksStandInAnyOrderAndOddOnesArePadded) {
    const auto tag = ReadWave(WaveBuilder()
                                  .Chunk("LIST", 3)
                                  .Zeros(4)
                                  .Chunk("data", kSecond)
                                  .Zeros(kSecond)
                                  .Chunk("junk", 0)
                                  .Format(2, 44100, 24));
    ASSERT_TRUE(tag);
    EXPECT_EQ(tag->Length, 1);
    EXPECT_EQ(tag->SampleRate, 44100);
}

TEST(Wave, SizesThatLieAreHeldAgainstTheFile) {
    for (const std::uint32_t size : {0u, 0xFFFFFFFFu, 5 * kSecond}) {
        const auto tag = ReadWave(WaveBuilder().Format().Chunk("data", size).Zeros(3 * kSecond));
        ASSERT_TRUE(tag);
        EXPECT_EQ(tag->Length, 3) << size;
    }
    const auto empty =
        ReadWave(WaveBuilder().Format().Chunk("data", 0).Chunk("LIST", kSecond).Zeros(kSecond));
    ASSERT_TRUE(empty);
    EXPECT_EQ(empty->Length, 0);
}

TEST(Wave, WhatIsNoWaveFileIsLeftAlone) {
    EXPECT_FALSE(ReadWave(WaveBuilder().Chunk("data", kSecond).Zeros(kSecond)));
    EXPECT_FALSE(ReadWave(WaveBuilder().Chunk("fmt ", 10).Zeros(10)));
    auto avi = WaveBuilder().Format().Data();
    avi[8] = 'A';
    MemorySource source(avi);
    EXPECT_FALSE(ReadWaveHeader(source));
    // A chain of empty chunks ends some time.
    WaveBuilder endless;
    for (int i = 0; i < 100'000; ++i)
        endless.Chunk("none", 0);
    EXPECT_FALSE(ReadWave(endless.Format()));
}
