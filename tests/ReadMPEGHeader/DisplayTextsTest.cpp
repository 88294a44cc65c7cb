#include "ReadMPEGHeader/DisplayTexts.h"

#include <gtest/gtest.h>

#include <map>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

using Texts = std::map<int, QString>;

template <typename Format>
void Check(const Texts& expected, Format format) {
    for (const auto& [number, text] : expected)
        EXPECT_EQ(format(number), text) << number;
}

}  // namespace

TEST(DisplayTexts, Lengths) {
    Check({{0, u"0 s"_s},
           {59, u"59 s"_s},
           {60, u"1:00"_s},
           {3599, u"59:59"_s},
           {3600, u"1:00:00"_s},
           {3661, u"1:01:01"_s},
           {65535, u"18:12:15"_s}},
          [](int seconds) { return FormatLength(seconds, false); });
    Check({{5, u"0:05"_s}, {59, u"0:59"_s}, {600, u"10:00"_s}},
          [](int seconds) { return FormatLength(seconds, true); });
}

TEST(DisplayTexts, NumbersBesideTheTables) {
    EXPECT_EQ(FormatBitRate(0), u"??? KBit/s"_s);
    Check({{0, u"?? kHz"_s}, {12000, u"12.000000 kHz"_s}, {44100, u"44.1 kHz"_s}}, FormatSampleRate);
    Check({{0, u"Mono/Stereo"_s}, {3, u"Joint Stereo"_s}, {8, u"Mono/Stereo"_s}}, FormatChannelMode);
    Check({{2, u"Unbekannt"_s}, {4, u"CITT j.17"_s}}, FormatEmphasis);
    Check({{3, u"3 Kanäle"_s}, {6, u"Surround (5.1)"_s}}, FormatChannelCount);
}

TEST(DisplayTexts, TheGenreOfTheTagStandsInForTheMainGenre) {
    TID3Tag tag;
    EXPECT_EQ(GenreDisplayText(tag), u"Unbekannt"_s);
    tag.Genre = 85;
    EXPECT_EQ(GenreDisplayText(tag), u"Bebob"_s);
    tag.MainGenre = 4;
    EXPECT_EQ(GenreDisplayText(tag), u"Jazz/Blues/Latine/Reggae"_s);
}

TEST(DisplayTexts, HeaderFlagsAreJoinedInTheirOrder) {
    TID3Tag tag;
    EXPECT_EQ(FormatHeaderFlags(tag), QString());
    tag.Original = tag.Private = true;
    EXPECT_EQ(FormatHeaderFlags(tag), u"Private, Original"_s);
    tag.Copyrighted = tag.Protected = true;
    EXPECT_EQ(FormatHeaderFlags(tag), u"Private, Error P. (CRC), Copyrighted, Original"_s);
}

TEST(DisplayTexts, ValidYears) {
    for (const auto& year : {u"2004"_s, u"19A5"_s, u"0000"_s, u"ZZZZ"_s})
        EXPECT_TRUE(IsValidYearText(year)) << year.toStdString();
    for (const auto& year : {u""_s, u"199"_s, u"19a5"_s, u"20045"_s, u"19 5"_s, u"٢٠٠٤"_s, u"19Ä5"_s})
        EXPECT_FALSE(IsValidYearText(year)) << year.toStdString();
}

TEST(DisplayTexts, YearsAreExpanded) {
    const std::vector<std::pair<QString, int>> cases = {
        {u"0"_s, 0},     {u"1"_s, 2001}, {u"20"_s, 2020}, {u"21"_s, 1921},
        {u"98"_s, 1998}, {u"99"_s, 99},  {u"100"_s, 100}, {u"1985"_s, 1985},
        {u""_s, 0},      {u"abc"_s, 0},  {u"19A5"_s, 0},  {u"99999999999"_s, 0}};
    for (const auto& [text, year] : cases)
        EXPECT_EQ(ExpandYear(text), year) << text.toStdString();
}
