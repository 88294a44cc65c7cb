#include "ReadMPEGHeader/ID3Tag.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(ID3Tag, DefaultsDependOnTheKeepFlag) {
    TID3Tag tag;
    tag.Title = u"x"_s;
    ResetTag(false, tag, 12.5);
    EXPECT_EQ(tag.Year, u"0000"_s);
    EXPECT_EQ(tag.MPEGLayer, u"MPEG ??? Layer ???"_s);
    EXPECT_EQ(tag.Genre, 255);
    EXPECT_EQ(tag.AddTime, 12.5);
    EXPECT_TRUE(tag.Title.isEmpty());
    ResetTag(true, tag, 12.5);
    EXPECT_TRUE(tag.Year.isEmpty());
    EXPECT_TRUE(tag.MPEGLayer.isEmpty());
    EXPECT_EQ(tag.AddTime, 0);
}
