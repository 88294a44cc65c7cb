#include "ReadMPEGHeader/id3v2/XrukFrame.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using namespace Qt::StringLiterals;

namespace {

std::optional<XrukFrame> Parse(std::string_view body) {
    return XrukFrame::Parse(AsBytes(body));
}

}  // namespace

TEST(XrukFrame, AnImpossibleFileTimeIsNotTaken) {
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    for (const double time : {std::numeric_limits<double>::quiet_NaN(), kInfinity, -kInfinity, -1.0, 1e300}) {
        TID3Tag tag;
        tag.AddTime = time;
        const auto frame = Parse(XrukBody(tag));
        ASSERT_TRUE(frame);
        tag.AddTime = 12.5;
        frame->ApplyCollectionFields(tag);
        EXPECT_EQ(tag.AddTime, 12.5) << time;
    }
}

TEST(XrukFrame, ABodyThatDoesNotFitIsNoFrame) {
    const auto body = XrukBody(WaveRecord());
    for (std::size_t size = 0; size < body.size(); ++size)
        EXPECT_FALSE(Parse(std::string_view(body).substr(0, size))) << size;
    EXPECT_FALSE(Parse(body + '\0'));
    auto wide = body;
    wide[242] = 1;
    EXPECT_FALSE(Parse(wide));
}
