#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Errors.h"
#include "tests/CountingSource.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

namespace {

TID3Tag Read(const Id3v2Builder& builder) {
    return ReadWith(ReadID3v2, builder.Build()).Tag;
}

TID3Tag ReadText(std::string_view id, std::string_view text) {
    return Read(Id3v2Builder().Text(id, text));
}

QString ReadComment(const std::string& body) {
    return Read(Id3v2Builder().Frame("COMM", body)).Comment;
}

}  // namespace

TEST(ID3v2Reader, TextsFillAFreshRecord) {
    TID3Tag tag;
    tag.Year = u"0000"_s;
    tag.Comment = u"alt"_s;
    tag.Track = 9;
    const auto bytes = Id3v2Builder()
                           .Text("TIT2", "M\xF6glich\0mehr"s)
                           .Text("TPE1", "Band")
                           .Text("TALB", "Album")
                           .Text("TFLT", "/3")
                           .Frame("PCNT", "\0\0\1\2"s)
                           .Build();
    MemorySource source(bytes);
    std::int64_t end = 0;
    EXPECT_TRUE(ReadID3v2(source, 0, end, tag, {}));
    TID3Tag expected;
    expected.Title = u"Möglich"_s;
    expected.Artist = u"Band"_s;
    expected.Album = u"Album"_s;
    expected.MPEGLayer = u"MPEG 1/2 Layer III"_s;
    expected.PlayCount = 258;
    EXPECT_EQ(tag, expected);
    EXPECT_EQ(ReadText("TYER", "19A5").Year, u"19A5"_s);
}

TEST(ID3v2Reader, AnyEncodingButZeroIsLittleEndian) {
    const auto title = [](const std::string& body) { return Read(Id3v2Builder().Frame("TIT2", body)).Title; };
    EXPECT_EQ(title("\1\xFF\xFEH\0\xF6\0"s), u"Hö"_s);
    EXPECT_EQ(title("\2H\0\xF6\0\0\0x\0"s), u"Hö"_s);
    EXPECT_EQ(title("\3H\0i\0!"s), u"Hi"_s);
    EXPECT_EQ(title("\1\xFE\xFF\0H"s), u"\xFFFE\x4800"_s);
    EXPECT_EQ(title(""), QString());
}

TEST(ID3v2Reader, NumbersThatDoNotParseAreZero) {
    const std::pair<std::string, int> tracks[] = {{"3/12", 3}, {" 08 ", 8}, {"255", 255}, {"256", 0},
                                                  {"-1", 0},   {"/12", 0},  {"3a/12", 0}, {"", 0}};
    for (const auto& [text, track] : tracks)
        EXPECT_EQ(ReadText("TRCK", text).Track, track) << text;
    const std::pair<std::string, int> lengths[] = {{"245000", 245},     {"999", 0},     {"65535999", 65535},
                                                   {"65536000", 0},     {"-245000", 0}, {"3:05", 0},
                                                   {"4294967296000", 0}};
    for (const auto& [text, length] : lengths)
        EXPECT_EQ(ReadText("TLEN", text).Length, length) << text;
    EXPECT_EQ(Read(Id3v2Builder().Frame("PCNT", "\1\0\0\0\0"s)).PlayCount, 0xFFFFFFFF);
}

TEST(ID3v2Reader, GenreIsANumberInParenthesesOrWithModernRulesAlsoAName) {
    struct Case {
        std::string Text;
        int Genre;
        bool Remix;
        int ModernGenre;
        int MainGenre;  // with the modern rules
    };
    const Case cases[] = {
        {"(17)", 17, false, 17, 8},
        {"(17)German Rock (RX)", 17, true, 17, 8},
        {"(17)German Rock", 17, false, 17, 3},
        {"(17)Schlager", 17, false, 17, 8},
        {"(17)(RX)", 17, true, 17, 8},
        {"(17", 17, false, 255, 0},
        {"(", 255, false, 255, 0},
        {"(300)", 255, false, 255, 0},
        {"(-1)", 255, false, 255, 0},
        {"17", 255, false, 17, 8},
        {"rock", 255, false, 17, 8},
        {"Rock (RX)", 255, true, 255, 0},
        {"Schlager", 255, false, 255, 12},
        {"Schlager\0Pop"s, 255, false, 13, 8},
        {"(51)(39)", 51, false, 51, 15},
        {"(RX)(17)", 255, true, 17, 8},
        {"(200)", 200, false, 200, 0},
        {"(200)Pop", 200, false, 13, 8},
        {"((Pop)", 255, false, 255, 0},
    };
    for (const auto& [text, genre, remix, modernGenre, mainGenre] : cases) {
        const auto bytes = Id3v2Builder(4).Text("TCON", text).Build();
        const TID3Tag classic = ReadWith(ReadID3v2, bytes).Tag;
        const TID3Tag modern = ReadWith(ReadID3v2Modern, bytes).Tag;
        EXPECT_EQ(classic.Genre, genre) << text;
        EXPECT_EQ(classic.MainGenre, 0) << text;
        EXPECT_EQ(modern.Genre, modernGenre) << text;
        EXPECT_EQ(modern.MainGenre, mainGenre) << text;
        EXPECT_EQ(classic.Remix, remix) << text;
        EXPECT_EQ(modern.Remix, remix) << text;
    }
}

TEST(ID3v2Reader, CommentStandsBehindLanguageAndDescription) {
    EXPECT_EQ(ReadComment("\0deuKurz\0Der Text"s), u"Der Text"_s);
    EXPECT_EQ(ReadComment("\0deu\0Der Text\0Rest"s), u"Der Text"_s);
    EXPECT_EQ(ReadComment("\0deuDer Text"s), u"Der Text"_s);
    EXPECT_EQ(ReadComment("\1eng\xFF\xFE\0\0\xFF\xFEG\0u\0t\0"s), u"Gut"_s);
    // As this program writes it: no language.
    EXPECT_EQ(ReadComment("\0\0\0\0\0Gut"s), u"Gut"_s);
    // Only the leading bytes in range name a language.
    EXPECT_EQ(ReadComment("\0d\0\0\0Gut"s), u"Gut"_s);
    // Bytes that can be no language are text already.
    EXPECT_EQ(ReadComment("\0\xC4\xD6\xDCx\0Gut"s), u"Gut"_s);
    EXPECT_EQ(ReadComment("\0\xC4\xD6\xDCx"s), u"ÄÖÜx"_s);
    EXPECT_EQ(ReadComment("\1\xFF\xFE\0\0\xFF\xFEG\0u\0t\0"s), u"Gut"_s);
}

TEST(ID3v2Reader, CommentTakesInPrivateTextAndAddresses) {
    const Id3v2Builder written = Id3v2Builder()
                                     .Frame("WXXX", "\0Seite (neu)\0http://a.de"s)
                                     .Frame("PRIV", "abc")
                                     .Frame("COMM", "\0\0\0\0\0Gut"s)
                                     .Frame("WXXX", "\0\0http://b.de"s);
    EXPECT_EQ(Read(written).Comment,
              u"Gut\nPrivate Angaben:\nabc\nURL:(Seite [neu]) http://a.de\nURL:http://b.de"_s);
    // What other programs keep for themselves is not for the user.
    const Id3v2Builder foreign = Id3v2Builder()
                                     .Frame("PRIV", "PeakValue\0\x12\x34\0\0"s)
                                     .Frame("PRIV", "\x01\x02\x03")
                                     .Frame("WXXX", "\0\0\x07\x08"s);
    EXPECT_EQ(Read(foreign).Comment, QString());
}

TEST(ID3v2Reader, DamageEndsTheTagAndKeepsWhatWasRead) {
    const auto check = [](const std::vector<std::uint8_t>& bytes, std::int64_t end) {
        const auto outcome = ReadWith(ReadID3v2, bytes);
        EXPECT_TRUE(outcome.Threw);
        EXPECT_EQ(outcome.End, end);
        EXPECT_EQ(outcome.Tag.Title, u"da"_s);
        EXPECT_EQ(outcome.Tag.Comment, u"Gut"_s);
        EXPECT_EQ(outcome.Tag.Artist, QString());
    };
    const Id3v2Builder good = Id3v2Builder().Text("TIT2", "da").Frame("COMM", "\0\0\0\0\0Gut"s);
    auto lying = good;
    lying.SizedFrame("TPE1", 0x7FFFFFFF, "\0x"s);
    check(lying.Build(), 10 + 13 + 18 + 12);
    auto cut = good;
    auto bytes = cut.Text("TPE1", "Band").Build();
    bytes.pop_back();
    check(bytes, 10 + 13 + 18 + 15);
    auto cutPadding = good;
    bytes = cutPadding.Padding(50).Build();
    bytes.resize(60);
    check(bytes, 10 + 13 + 18 + 50);
}

TEST(ID3v2Reader, AFrameThatReachesBeyondTheTagIsTheLast) {
    // A size of 200 as ID3v2.4 writes it is 328 here; behind it stands sound.
    auto bytes = Id3v2Builder(4).Text("TIT2", "da").Frame("APIC", std::string(200, 'x')).Build();
    const auto tagSize = bytes.size();
    bytes.resize(tagSize + 1000);
    // Of a picture the record wants nothing, so it may end beyond the file as well, and the tag with it.
    for (const std::size_t size : {bytes.size(), tagSize + 10, tagSize - 50}) {
        bytes.resize(size);
        const auto outcome = ReadWith(ReadID3v2, bytes);
        EXPECT_TRUE(outcome.Read) << size;
        EXPECT_EQ(outcome.End, static_cast<std::int64_t>(tagSize));
        EXPECT_EQ(outcome.Tag.Title, u"da"_s);
        EXPECT_EQ(outcome.Reports.size(), 2u);
    }
}

TEST(ID3v2Reader, PicturesAreNotReadUnlessSomebodyListens) {
    const auto bytes = Id3v2Builder().Frame("APIC", std::string(200000, 'x')).Text("TIT2", "Titel").Build();
    CountingSource source(bytes);
    TID3Tag tag;
    std::int64_t end = 0;
    EXPECT_TRUE(ReadID3v2(source, 0, end, tag, {}));
    EXPECT_EQ(tag.Title, u"Titel"_s);
    EXPECT_LT(source.Bytes, 100u);
    EXPECT_TRUE(ReadID3v2Modern(source, 0, end, tag, {}));
    EXPECT_LT(source.Bytes, 200u);
}
