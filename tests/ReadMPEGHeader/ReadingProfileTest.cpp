#include "ReadMPEGHeader/ReadingProfile.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

// Where the first frame is, and the tags that were found on the way there.
struct Search {
    std::optional<std::int64_t> Frame;
    std::vector<std::int64_t> Tags;
};

Search Find(const ReadingProfile& profile, ByteSpan bytes) {
    MemorySource source(bytes);
    Search search;
    search.Frame = profile.FindFirstFrame(source, [&](std::int64_t position) {
        search.Tags.push_back(position);
        std::int64_t end = position;
        TID3Tag tag;
        profile.ReadTag(source, position, end, tag, {}, nullptr);
        return end;
    });
    return search;
}

Search FindClassic(const Mp3Builder& file) {
    return Find(ClassicProfile(), file.Data());
}

Search FindModern(const Mp3Builder& file) {
    return Find(ModernProfile(), file.Data());
}

constexpr std::array<std::uint8_t, 2> kSync = {0xFF, 0xE0};

Bytes BigTag(std::size_t size) {
    return TitledTag("Title", "Artist").Frame("APIC", std::string(size, '\xFF')).Build();
}

}  // namespace

TEST(ClassicSearch, ASyncIsFoundWhereverItStands) {
    for (const std::size_t position : {0u, 1u, 30u, 31u, 32u, 63u, 8191u, 262142u}) {
        const auto file = Mp3Builder().Noise(position).Raw(kSync).ZerosUpTo(262144 + 32);
        EXPECT_EQ(FindClassic(file).Frame, position);
    }
}

TEST(ClassicSearch, OnlyWholeBlocksOfTheFirst256KilobytesAreExamined) {
    EXPECT_FALSE(FindClassic(Mp3Builder().Noise(262144).Raw(kSync).ZerosUpTo(262150)).Frame);
    EXPECT_FALSE(FindClassic(Mp3Builder().Noise(262143).Raw(kSync).ZerosUpTo(262150)).Frame);
    EXPECT_FALSE(FindClassic(Mp3Builder().Noise(32).Raw(kSync).ZerosUpTo(63)).Frame);
    EXPECT_EQ(FindClassic(Mp3Builder().Noise(32).Raw(kSync).ZerosUpTo(64)).Frame, 32);
}

TEST(ClassicSearch, ATagIsFoundWhereverItStandsAndSkipped) {
    const auto tag = TitledTag("\xFF\xFB", "x").Padding(50).Build();
    for (const std::size_t position : {0u, 29u, 30u, 31u, 32u, 5000u}) {
        const auto file = Mp3Builder().Noise(position).Raw(tag).Frames(2);
        // A title that looks like a sync hides the tag when both marks end in the same block.
        const bool hidden = (position + 2) / 32 == (position + 22) / 32;
        const auto search = FindClassic(file);
        if (hidden) {
            EXPECT_EQ(search.Frame, position + 21);
            EXPECT_TRUE(search.Tags.empty());
        } else {
            EXPECT_EQ(search.Frame, position + tag.size());
            EXPECT_EQ(search.Tags, std::vector<std::int64_t>{static_cast<std::int64_t>(position)});
        }
    }
}

TEST(ClassicSearch, ATagIsNoPartOfASyncThatFollowsIt) {
    // The tag ends with 0xFF at the end of a block; 0xFB behind it is no sync with that.
    const auto tag = Id3v2Builder().Frame("APIC", std::string(11, 'x') + '\xFF').Build();
    ASSERT_EQ(tag.size(), 32u);
    const auto file = Mp3Builder().Raw(tag).Raw(std::array<std::uint8_t, 1>{0xFB}).Noise(99).Frames(1);
    EXPECT_EQ(FindClassic(file).Frame, 32 + 100);
}

TEST(ClassicSearch, OnlyOneTagIsReadWhereverWithModernRulesOnlyAtTheHead) {
    const auto tag = TitledTag("Title", "Artist").Padding(40).Build();
    EXPECT_EQ(FindClassic(Mp3Builder().Raw(tag).Raw(tag).Frames(1)).Tags.size(), 1u);
    EXPECT_TRUE(FindModern(Mp3Builder().Frames(1).Raw(tag).Frames(1)).Tags.empty());
}

TEST(ModernSearch, AudioBehindALargePictureIsFound) {
    const auto tag = BigTag(1'000'000);
    const auto file = Mp3Builder().Raw(tag).Frames(3);
    EXPECT_EQ(FindModern(file).Frame, tag.size());
    EXPECT_FALSE(FindClassic(file).Frame);
    // The range begins where the tag ends.
    EXPECT_EQ(FindModern(Mp3Builder().Raw(tag).Noise(262143).Frames(3)).Frame, tag.size() + 262143);
    EXPECT_FALSE(FindModern(Mp3Builder().Raw(tag).Noise(262144).Frames(3)).Frame);
}

TEST(ModernSearch, StackedTagsAreSkippedAndTheFirstIsRead) {
    const auto tag = BigTag(3000);
    const auto search = FindModern(Mp3Builder().Raw(tag).Raw(tag).Raw(tag).Frames(2));
    EXPECT_EQ(search.Frame, 3 * tag.size());
    EXPECT_EQ(search.Tags, std::vector<std::int64_t>{0});
}

TEST(ModernSearch, AFrameIsConfirmedByWhatFollowsIt) {
    const Bytes stray = {0xFF, 0xFB, 0x90, 0x64};  // nothing follows 417 bytes on
    const auto found = [&stray](const Mp3Builder& tail) {
        return FindModern(Mp3Builder().Raw(stray).Noise(96).Raw(tail.Data())).Frame == 100;
    };
    EXPECT_TRUE(found(Mp3Builder().Frames(2)));
    EXPECT_TRUE(found(Mp3Builder().Frames(1)));
    EXPECT_TRUE(found(Mp3Builder().Frames(1).Id3v1("a", "b")));
    EXPECT_TRUE(found(Mp3Builder().FrameWith(kStereo128, 36, "Xing", {3, 10, 5000}).Noise(500)));
    // Other stream behind it, reserved codes, cut off: the first sync has to do.
    EXPECT_FALSE(found(Mp3Builder().Frames(1).Frames(1, kLsfMono64).Noise(1)));
    EXPECT_FALSE(found(Mp3Builder().Frames(1).Noise(500)));
    EXPECT_FALSE(found(Mp3Builder().Frames(2, {{0xFF, 0xFB, 0xF0, 0x64}, 417}).Noise(1)));
    EXPECT_FALSE(found(Mp3Builder().Frames(1, {kStereo128.Header, 400})));
    EXPECT_EQ(FindModern(Mp3Builder().Noise(7).Raw(stray).Noise(96)).Frame, 7);
}

TEST(ModernSearch, FramesAreFollowedWithTheSizesOfTheStandard) {
    const std::array kinds = {
        FrameKind{{0xFF, 0xFB, 0xE0, 0x00}, 1044},                           // Layer III, 320 kbit/s
        FrameKind{{0xFF, 0xFD, 0xA6, 0x00}, 577},                            // Layer II, 48 kHz, padded
        FrameKind{{0xFF, 0xFF, 0xC2, 0x00}, 4 * (12 * 384000 / 44100 + 1)},  // Layer I, padded
        FrameKind{{0xFF, 0xF3, 0x50, 0x00}, 130},                            // MPEG 2 Layer III, 40 kbit/s
        FrameKind{{0xFF, 0xF5, 0xE8, 0x00}, 1440},                           // MPEG 2 Layer II, 16 kHz
        FrameKind{{0xFF, 0xE3, 0x18, 0x00}, 72},                             // MPEG 2.5 Layer III, 8 kHz
        FrameKind{{0xFF, 0xE5, 0xEA, 0x00}, 2881},                           // MPEG 2.5 Layer II, the largest
    };
    for (const auto& kind : kinds)
        EXPECT_EQ(FindModern(Mp3Builder().Raw(kSync).Noise(98).Frames(2, kind)).Frame, 100) << kind.Size;
}

TEST(ModernSearch, ConfirmationReachesAcrossThePiecesInWhichTheFileIsRead) {
    for (std::size_t position = 1; position < 60000; position += 1237) {
        const auto file = Mp3Builder().Noise(position).Frames(2).Zeros(100'000);
        EXPECT_EQ(FindModern(file).Frame, position);
    }
}
