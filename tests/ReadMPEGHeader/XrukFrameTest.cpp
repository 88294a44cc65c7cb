#include "ReadMPEGHeader/id3v2/XrukFrame.h"

#include <gtest/gtest.h>

#include <limits>

#include "CommonRUKTools/ByteWriter.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// A frame as the program writes it, for the given format text and file time.
std::vector<std::uint8_t> FrameBytes(std::string_view format, double fileTime) {
    ByteWriter body;
    body.Block("=====", 242);
    body.U8(0);
    body.Raw(format);
    body.U8(0);
    body.U16Le(320);
    body.U16Le(44100);
    for (const int value : {3, 4, 0, 1, 0, 200, 1})  // channel mode, emphasis, five flags
        body.U8(static_cast<std::uint8_t>(value));
    body.U16Le(1044);
    body.U16Le(0xBEEF);
    body.U32Le(0x80000009);
    body.U8(131);
    body.U8(2);
    body.F64Le(fileTime);
    return body.Bytes();
}

}  // namespace

TEST(XrukFrame, KeepsEveryTechnicalField) {
    const auto body = FrameBytes("MPEG 1.0 Layer III", 38000.25);
    ASSERT_EQ(body.size(), 18u + 273u);
    const auto frame = XrukFrame::Parse(body);
    ASSERT_TRUE(frame);
    TID3Tag technical, collection;
    collection.AddTime = 1;
    frame->ApplyTechnicalFields(technical);
    frame->ApplyCollectionFields(collection);

    TID3Tag expected;
    expected.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    expected.BitRate = 320;
    expected.SampleRate = 44100;
    expected.ChannelMode = 3;
    expected.Emphasis = 4;
    expected.Protected = true;
    expected.Original = true;
    expected.Padding = true;
    expected.FrameSize = 1044;
    EXPECT_EQ(technical, expected);

    expected = TID3Tag();
    expected.Reserved = 0xBEEF;
    expected.Flags = 0x80000009;
    expected.MainGenre = 131;
    expected.Remix = true;
    expected.AddTime = 38000.25;
    EXPECT_EQ(collection, expected);
}

TEST(XrukFrame, AnImpossibleFileTimeIsNotTaken) {
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    for (const double time : {std::numeric_limits<double>::quiet_NaN(), kInfinity, -kInfinity, -1.0, 1e300}) {
        const auto frame = XrukFrame::Parse(FrameBytes("", time));
        ASSERT_TRUE(frame);
        TID3Tag tag;
        tag.AddTime = 12.5;
        frame->ApplyCollectionFields(tag);
        EXPECT_EQ(tag.AddTime, 12.5) << time;
    }
}

TEST(XrukFrame, ABodyThatDoesNotFitIsNoFrame) {
    const auto body = FrameBytes("Wave", 1);
    for (std::size_t size = 0; size < body.size(); ++size)
        EXPECT_FALSE(XrukFrame::Parse(ByteSpan(body).first(size))) << size;
    auto longer = body;
    longer.push_back(0);
    EXPECT_FALSE(XrukFrame::Parse(longer));
    auto wide = body;
    wide[242] = 1;
    EXPECT_FALSE(XrukFrame::Parse(wide));
}
