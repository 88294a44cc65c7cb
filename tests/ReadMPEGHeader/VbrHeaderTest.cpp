#include "ReadMPEGHeader/mpeg/VbrHeader.h"

#include <gtest/gtest.h>

#include "ReadMPEGHeader/mpeg/MpegFrame.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

// A first frame of `kind` with a header at `offset`, and some more bytes behind it.
FrameAnalysis Analyse(const MpegRules& rules, const FrameKind& kind, std::size_t offset,
                      std::string_view text, std::initializer_list<std::uint32_t> numbers) {
    return AnalyseFirstFrame(Mp3Builder().FrameWith(kind, offset, text, numbers).Zeros(1000), rules);
}

constexpr std::uint32_t kFlags = 3;  // frames and bytes follow

}  // namespace

TEST(VbrHeader, XingReplacesTheEstimate) {
    // 1000 frames of 500 bytes: 26 s of 153 kbit/s.
    const auto xing = Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 1000, 500000});
    EXPECT_EQ(xing.Results.VbrName, u"Xing"_s);
    EXPECT_EQ(xing.Results.VbrMarker, 3);
    EXPECT_EQ(xing.Results.FrameCount, 1000);
    EXPECT_EQ(xing.Tag.FrameSize, 500);
    EXPECT_EQ(xing.Tag.Length, 144 * 1000 * 8 / 44100);
    EXPECT_EQ(xing.Tag.BitRate, 500 * 44100 / 144 / 1000);
    // Rounded, and padded as the first frame is.
    const FrameKind padded = {{0xFF, 0xFB, 0x92, 0x64}, 418};
    EXPECT_EQ(Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 2, 1001}).Tag.FrameSize, 501);
    EXPECT_EQ(Analyse(kClassicMpegRules, padded, 36, "Xing", {kFlags, 4, 2001}).Tag.FrameSize, 501);
}

TEST(VbrHeader, TheLengthNeedsOnlyTheFrames) {
    // 1417 bytes less 148 are in the file.
    const auto classic = Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 400, 0});
    const auto modern = Analyse(kModernMpegRules, kStereo128, 36, "Xing", {kFlags, 400, 0});
    for (const auto& found : {classic, modern}) {
        EXPECT_EQ(found.Results.FrameCount, 400);
        EXPECT_EQ(found.Tag.Length, 10);
    }
    EXPECT_EQ(classic.Tag.BitRate, 0);
    EXPECT_EQ(modern.Tag.FrameSize, (1417 - 148 + 200) / 400);
    // The modern rules know only the fields that the flags announce.
    const auto framesOnly = Analyse(kModernMpegRules, kStereo128, 36, "Xing", {1, 4, 500000});
    EXPECT_EQ(framesOnly.Tag.FrameSize, 317);
    EXPECT_EQ(Analyse(kModernMpegRules, kStereo128, 36, "Xing", {0, 4, 5000}).Tag.FrameSize, 417);
}

TEST(VbrHeader, ClassicOffsetsOfMpeg2AreExchanged) {
    struct Case {
        FrameKind Kind;
        std::size_t Classic;
        std::size_t Modern;
    };
    const std::array cases = {Case{kStereo128, 36, 36}, Case{kMono64, 21, 21}, Case{kLsfStereo64, 13, 21},
                              Case{kLsfMono64, 21, 13}};
    const auto frames = [](const MpegRules& rules, const FrameKind& kind, std::size_t offset) {
        return Analyse(rules, kind, offset, "Xing", {kFlags, 777, 300000}).Results.FrameCount;
    };
    for (const auto& [kind, classic, modern] : cases) {
        EXPECT_EQ(frames(kClassicMpegRules, kind, classic), 777);
        EXPECT_EQ(frames(kModernMpegRules, kind, modern), 777);
        if (classic == modern) continue;
        EXPECT_NE(frames(kClassicMpegRules, kind, modern), 777);
        EXPECT_NE(frames(kModernMpegRules, kind, classic), 777);
    }
}

TEST(VbrHeader, VbriStandsAtByte36OfEveryKindOfFrame) {
    // Version, delay, quality: six bytes; then bytes and frames.
    for (const auto& kind : {kStereo128, kLsfMono64}) {
        const auto vbri =
            Analyse(kClassicMpegRules, kind, 36, std::string_view("VBRI\2\1\0\0\0\0", 10), {480000, 1200});
        EXPECT_EQ(vbri.Results.VbrName, u"FhG (VBRI)"_s);
        EXPECT_EQ(vbri.Results.VbrMarker, 2);
        EXPECT_EQ(vbri.Results.FrameCount, 1200);
        EXPECT_EQ(vbri.Tag.FrameSize, 400);
    }
}

TEST(VbrHeader, ConstantBitRateStands) {
    const auto isConstant = [](const FrameAnalysis& analysis) {
        return analysis.Tag.FrameSize == 417 && analysis.Tag.BitRate == 128;
    };
    // No frames.
    EXPECT_TRUE(isConstant(Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 0, 500000})));
    EXPECT_TRUE(isConstant(Analyse(kModernMpegRules, kStereo128, 36, "Xing", {kFlags, 0, 500000})));
    // LAME's mark of a constant stream.
    const auto info = Analyse(kClassicMpegRules, kStereo128, 36, "Info", {kFlags, 1000, 500000});
    EXPECT_TRUE(isConstant(info));
    EXPECT_TRUE(info.Results.VbrName.isEmpty());
    // Side information: the frame sounds, the mark is chance.
    auto sounding = Mp3Builder().FrameWith(kStereo128, 36, "Xing", {kFlags, 1000, 500000}).Zeros(1000).Data();
    sounding[8] = 1;
    MemorySource source(sounding);
    TID3Tag tag;
    EXPECT_TRUE(AnalyseMpegFrame(source, 0, kClassicMpegRules, tag).VbrName.isEmpty());
    // 256 bytes are too few to be asked, 257 are not.
    auto shortFile = Mp3Builder().FrameWith({kStereo128.Header, 257}, 36, "Xing", {kFlags, 10, 5000}).Data();
    MemorySource enough(shortFile);
    EXPECT_EQ(AnalyseMpegFrame(enough, 0, kClassicMpegRules, tag).FrameCount, 10);
    shortFile.pop_back();
    MemorySource tooFew(shortFile);
    EXPECT_NE(AnalyseMpegFrame(tooFew, 0, kClassicMpegRules, tag).FrameCount, 10);
}

TEST(VbrHeader, HugeCountsAreSaturatedNotWrapped) {
    const auto huge = Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 0xFFFFFFFF, 0xFFFFFFFF});
    EXPECT_EQ(huge.Tag.Length, 65535);
    EXPECT_EQ(huge.Results.FrameCount, 0x7FFFFFFF);
    const auto fat = Analyse(kClassicMpegRules, kStereo128, 36, "Xing", {kFlags, 1, 0x12345678});
    EXPECT_EQ(fat.Tag.FrameSize, 65535);
    EXPECT_EQ(fat.Tag.BitRate, 65535);
    EXPECT_EQ(fat.Results.FrameSize, 0x12345678);
}

TEST(VbrHeader, ModernTakesBitRateAndLengthOfConstantStreamsFromLame) {
    // 40 kbit/s at 22050 Hz: 130 bytes a frame, and the frame that holds the header.
    const FrameKind lsf40 = {{0xFF, 0xF3, 0x50, 0x04}, 208};
    const auto info = Analyse(kModernMpegRules, lsf40, 21, "Info", {kFlags, 2000, 2001 * 130 + 1224});
    EXPECT_EQ(info.Tag.BitRate, 40);
    EXPECT_EQ(info.Tag.FrameSize, 130);
    EXPECT_EQ(info.Tag.Length, 52);
    EXPECT_TRUE(info.Results.VbrName.isEmpty());
}
