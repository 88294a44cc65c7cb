#include <gtest/gtest.h>

#include <QCoreApplication>
#include <cmath>
#include <limits>

#include "MusicManagment/playback/spectrum/SpectrumCollector.h"
#include "MusicManagment/playback/spectrum/SpectrumFeed.h"

using namespace Qt::StringLiterals;

namespace {

// A block that no other run of the tests has.
QString OwnKey(const QString& name) {
    return u"RUK DSP test %1 %2"_s.arg(QCoreApplication::applicationPid()).arg(name);
}

SpectrumBands Tone(std::size_t band, float amplitude) {
    SpectrumBands bands{};
    bands[band] = amplitude;
    return bands;
}

}  // namespace

// --- The block ---

TEST(SpectrumBlockTest, WhatIsReadIsNeverHalfOfTwoSpectra) {
    SpectrumBlock writer(OwnKey(u"torn"_s));
    SpectrumBlock reader(OwnKey(u"torn"_s));
    ASSERT_TRUE(writer.Open() && reader.Open());
    std::jthread writing([&](const std::stop_token& stop) {
        SpectrumBands bands;
        for (float value = 1; !stop.stop_requested(); value = value < 1000 ? value + 1 : 1) {
            bands.fill(value);
            writer.Write(bands);
        }
    });
    SpectrumBands bands;
    for (int found = 0; found < 50;) {
        if (!reader.Read(bands)) continue;
        ++found;
        ASSERT_EQ(bands.front(), bands.back());
    }
}

// --- Columns ---

TEST(SpectrumLevelsTest, HeightsAreDecibelsAndNonsenseIsSilence) {
    struct Case {
        float Amplitude;
        float Height;
    };
    const float inf = std::numeric_limits<float>::infinity();
    for (const auto& [amplitude, height] :
         {Case{1.0F, 1.0F}, Case{0.0316F, 0.5F}, Case{0.001F, 0.0F}, Case{4.0F, 1.0F}, Case{-1.0F, 0.0F},
          Case{std::nanf(""), 0.0F}, Case{inf, 1.0F}}) {
        SpectrumLevels levels;
        levels.Take(Tone(511, amplitude));
        EXPECT_NEAR(levels.Columns().Heights.back(), height, 0.01) << amplitude;
    }
}

TEST(SpectrumLevelsTest, EveryBandButTheFirstHasItsColumnFromLowToHigh) {
    std::size_t last = 0;
    for (std::size_t band = 1; band < kSpectrumBands; ++band) {
        SpectrumLevels levels;
        levels.Take(Tone(band, 1.0F));
        std::size_t lit = kSpectrumColumns;
        for (std::size_t i = 0; i < kSpectrumColumns; ++i)
            if (levels.Columns().Heights[i] > 0) lit = i;
        ASSERT_LT(lit, kSpectrumColumns) << band;
        ASSERT_GE(lit, last);
        last = lit;
    }
    EXPECT_EQ(last, kSpectrumColumns - 1);
    SpectrumLevels levels;
    levels.Take(Tone(0, 1.0F));
    EXPECT_TRUE(levels.IsSilent());
}

TEST(SpectrumLevelsTest, ColumnsFallSlowlyAndPeaksMoreSlowly) {
    SpectrumLevels levels;
    levels.Take(Tone(511, 1.0F));
    levels.Take({});
    const float height = levels.Columns().Heights.back();
    const float peak = levels.Columns().Peaks.back();
    EXPECT_LT(height, 1.0F);
    EXPECT_GT(height, 0.8F);
    EXPECT_GT(peak, height);
    int steps = 0;
    for (; !levels.IsSilent() && steps < 1000; ++steps)
        levels.Fall();
    EXPECT_LT(steps, 200);
}

// --- Threads ---

TEST(SpectrumCollectorTest, GivesWhatIsWrittenAndEndsWhenAsked) {
    const QString key = OwnKey(u"collector"_s);
    SpectrumBlock writer(key);
    ASSERT_TRUE(writer.Open());
    SpectrumCollector collector(key);
    collector.Start();
    writer.Write(Tone(300, 1.0F));
    std::stop_source source;
    const auto columns = collector.Next(source.get_token());
    ASSERT_TRUE(columns.has_value());
    EXPECT_NE(*columns, SpectrumColumns());
    collector.Stop();
    source.request_stop();
    while (collector.Next(source.get_token())) {
    }
}

TEST(SpectrumFeedTest, AWatchingFeedWorksOnlyWhileSomebodyLooks) {
    const QString key = OwnKey(u"watch"_s);
    std::vector<bool> active;
    const SpectrumBands bands = Tone(300, 1.0F);
    SpectrumFeed feed(
        {.SetActive = [&](bool on) { active.push_back(on); }, .Get = [&] { return bands.data(); }}, key);
    SpectrumBlock reader(key);
    feed.Look();
    EXPECT_TRUE(active.empty());
    ASSERT_TRUE(reader.Open());
    SpectrumBands read{};
    EXPECT_FALSE(reader.Read(read));
    feed.Look();
    EXPECT_EQ(active, std::vector<bool>{true});
    feed.Step();
    EXPECT_TRUE(reader.Read(read));
    EXPECT_EQ(read, bands);
    EXPECT_FALSE(reader.Read(read)) << "each spectrum comes once";
    feed.Look();
    EXPECT_EQ(active, std::vector<bool>{true});
    feed.Look();
    EXPECT_EQ(active, std::vector<bool>({true, false}));
    EXPECT_TRUE(reader.Read(read));
    EXPECT_EQ(read, SpectrumBands{});
}
