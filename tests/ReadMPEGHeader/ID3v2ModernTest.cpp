#include <gtest/gtest.h>

#include <QByteArray>

#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using namespace Qt::StringLiterals;
using namespace std::string_literals;

namespace {

constexpr std::uint8_t kUnsync = 0x80;
constexpr std::uint8_t kExtended = 0x40;
constexpr std::uint8_t kFooter = 0x10;

Id3v2Outcome Read(const Id3v2Builder& builder) {
    return ReadWith(ReadID3v2Modern, builder.Build());
}

TID3Tag ReadText(std::uint8_t version, std::string_view id, const std::string& text) {
    return Read(Id3v2Builder(version).Text(id, text)).Tag;
}

// Four bytes with the length, then the compressed text.
std::string Compressed(const std::string& text) {
    return qCompress(QByteArray::fromStdString(text)).toStdString();
}

}  // namespace

TEST(ID3v2Modern, Version22HasShortFrames) {
    const auto outcome = Read(Id3v2Builder(2)
                                  .Text("TT2", "Titel")
                                  .Text("TP1", "Band")
                                  .Text("TAL", "Album")
                                  .Text("TYE", "1984")
                                  .Text("TRK", "4/9")
                                  .Text("TCO", "(9)")
                                  .Text("TLE", "60000")
                                  .Frame("CNT", "\0\0\0\5"s)
                                  .Frame("COM", "\0engx\0Falsch"s)
                                  .Frame("COM", "\0eng\0Gut"s)
                                  .Frame("PIC", "\0JPG\3Bild\0xxxx"s)
                                  .Padding(7));
    TID3Tag expected;
    expected.Title = u"Titel"_s;
    expected.Artist = u"Band"_s;
    expected.Album = u"Album"_s;
    expected.Year = u"1984"_s;
    expected.Comment = u"Gut"_s;
    expected.Track = 4;
    expected.Genre = 9;
    expected.MainGenre = 14;
    expected.Length = 60;
    expected.PlayCount = 5;
    EXPECT_EQ(outcome.Tag, expected);
    ASSERT_EQ(outcome.Reports.size(), 11u);
    EXPECT_EQ(outcome.Reports[0].Id, u"TT2"_s);
    EXPECT_EQ(outcome.Reports[10].Text, u"Cover (Vorne), JPG, Bild"_s);
    EXPECT_EQ(outcome.Reports[10].Number, 4);
    // The old letters in a new frame.
    EXPECT_EQ(ReadText(3, "TT2\0"s, "alt").Title, u"alt"_s);
}

TEST(ID3v2Modern, EveryEncodingIsKnown) {
    const auto title = [](std::uint8_t version, const std::string& body) {
        return Read(Id3v2Builder(version).Frame("TIT2", body)).Tag.Title;
    };
    for (const std::uint8_t version : {std::uint8_t{3}, std::uint8_t{4}}) {
        EXPECT_EQ(title(version, "\0\xF6"s), u"ö"_s);
        EXPECT_EQ(title(version, "\1\xFF\xFE\xF6\0"s), u"ö"_s);
        EXPECT_EQ(title(version, "\1\xFE\xFF\0\xF6"s), u"ö"_s);
        EXPECT_EQ(title(version, "\1\xF6\0"s), u"ö"_s);
        EXPECT_EQ(title(version, "\2\0\xF6"s), u"ö"_s);
        EXPECT_EQ(title(version, "\3\xEF\xBB\xBF\xC3\xB6\0x"s), u"ö"_s);
    }
    // A byte-order mark holds for the texts behind it.
    EXPECT_EQ(Read(Id3v2Builder(3).Frame("COMM", "\1eng\xFE\xFF\0\0\0G\0u\0t"s)).Tag.Comment, u"Gut"_s);
}

TEST(ID3v2Modern, ListsExistSinceVersion24) {
    EXPECT_EQ(ReadText(4, "TPE1", "A\0B\0"s).Artist, u"A, B"_s);
    EXPECT_EQ(ReadText(3, "TPE1", "A\0B"s).Artist, u"A"_s);
    EXPECT_EQ(ReadText(4, "TIT2", "A\0B"s).Title, u"A"_s);
    EXPECT_EQ(Read(Id3v2Builder(4).Frame("TPE1", "\1\xFF\xFE"s + "A\0\0\0\xFF\xFE"s + "B\0"s)).Tag.Artist,
              u"A, B"_s);
}

TEST(ID3v2Modern, YearComesFromTheRecordingTimeFirst) {
    EXPECT_EQ(ReadText(4, "TDRC", "2004-05-01T12:00").Year, u"2004"_s);
    EXPECT_EQ(ReadText(4, "TYER", "1999").Year, u"1999"_s);
    EXPECT_EQ(ReadText(3, "TYER", "1999-12-31").Year, u"1999"_s);
    EXPECT_EQ(Read(Id3v2Builder(4).Text("TDRC", "2004").Text("TYER", "1999")).Tag.Year, u"2004"_s);
    EXPECT_EQ(Read(Id3v2Builder(4).Text("TYER", "1999").Text("TDRC", "2004")).Tag.Year, u"2004"_s);
    EXPECT_EQ(
        Read(Id3v2Builder(4).Text("TYER", "1999").Text("TDRC", "unbekannt").Text("TDRL", "2004")).Tag.Year,
        u"1999"_s);
}

TEST(ID3v2Modern, CommentWithoutDescriptionIsTheUsersOwn) {
    const auto comment = [](std::initializer_list<std::string> bodies) {
        Id3v2Builder builder(4);
        for (const auto& body : bodies)
            builder.Frame("COMM", "\0eng"s + body);
        return Read(builder).Tag.Comment;
    };
    EXPECT_EQ(comment({"iTunNORM\0 0001"s, "ID3v1 Comment\0eins"s, "x\0zwei"s, "\0Gut"s, "\0spät"s}),
              u"Gut"_s);
    EXPECT_EQ(comment({"iTunNORM\0 0001"s, "\0"s, "ID3v1 Comment\0eins"s, "x\0zwei"s}), u"eins"_s);
    EXPECT_EQ(comment({"iTunNORM\0 0001"s}), QString());
}

TEST(ID3v2Modern, UnsynchronisationIsUndone) {
    const std::string body = "\1\xFF\xFE\xFF\0\xFF\xFF"s;  // U+00FF U+FFFF
    const QString title = u"\xFF\xFFFF"_s;
    EXPECT_EQ(Read(Id3v2Builder(3, kUnsync).Frame("TIT2", body).Text("TPE1", "x").Unsynchronise()).Tag.Title,
              title);
    const std::string spread = "\1\xFF\0\xFE\xFF\0\0\xFF\0\xFF\0"s;
    const auto framewise =
        Read(Id3v2Builder(4).Frame("TIT2", "\0\0\0\7"s + spread, 0x03).Text("TPE1", "x")).Tag;
    EXPECT_EQ(framewise.Title, title);
    EXPECT_EQ(framewise.Artist, u"x"_s);
    EXPECT_EQ(Read(Id3v2Builder(4, kUnsync).Frame("TIT2", spread)).Tag.Title, title);
}

TEST(ID3v2Modern, ExtendedHeaderAndFooterAreSkipped) {
    const auto three = Read(Id3v2Builder(3, kExtended).Raw("\0\0\0\6\0\0\0\0\0\0"s).Text("TIT2", "x"));
    EXPECT_EQ(three.Tag.Title, u"x"_s);
    EXPECT_EQ(three.Reports.size(), 1u);
    const auto four = Read(Id3v2Builder(4, kExtended).Raw("\0\0\0\6\1\0"s).Text("TIT2", "x"));
    EXPECT_EQ(four.Tag.Title, u"x"_s);
    // Announced and not there.
    EXPECT_EQ(Read(Id3v2Builder(3, kExtended).Text("TIT2", "x")).Tag.Title, u"x"_s);
    EXPECT_FALSE(Read(Id3v2Builder(3, kExtended).Raw("\x7F\0\0\6\0\0\0\0\0\0\0"s)).Threw);

    auto bytes = Id3v2Builder(4, kFooter).Text("TIT2", "x").Build();
    bytes.resize(bytes.size() + 10);
    const auto footer = ReadWith(ReadID3v2Modern, bytes);
    EXPECT_TRUE(footer.Read);
    EXPECT_EQ(footer.End, static_cast<std::int64_t>(bytes.size()));
}

TEST(ID3v2Modern, CodedFramesAreDecoded) {
    const std::string text = "\0"s + std::string(300, 'a');
    const QString title(300, u'a');
    EXPECT_EQ(Read(Id3v2Builder(3).Frame("TIT2", Compressed(text), 0x80)).Tag.Title, title);
    // The group stands behind the length in 2.3 and before it in 2.4.
    auto grouped = Compressed(text);
    grouped.insert(4, 1, 'g');
    EXPECT_EQ(Read(Id3v2Builder(3).Frame("TIT2", grouped, 0xA0)).Tag.Title, title);
    auto packed = Compressed(text);
    packed.replace(0, 4, "g\0\0\2\x2D"s);
    EXPECT_EQ(Read(Id3v2Builder(4).Frame("TIT2", packed, 0x49)).Tag.Title, title);
}

TEST(ID3v2Modern, FramesThatCannotBeDecodedAreOnlyReported) {
    auto lying = Compressed("\0abc"s);
    lying[3] = 5;
    const auto outcome = Read(Id3v2Builder(3)
                                  .Frame("TIT2", "\x80geheim", 0x40)
                                  .Frame("TALB", lying, 0x80)
                                  .Frame("TALB", "\0"s, 0x80)
                                  .Text("TPE1", "Band"));
    EXPECT_EQ(outcome.Tag.Title, QString());
    EXPECT_EQ(outcome.Tag.Album, QString());
    EXPECT_EQ(outcome.Tag.Artist, u"Band"_s);
    ASSERT_EQ(outcome.Reports.size(), 4u);
    EXPECT_EQ(outcome.Reports[0].Text, u"Verschlüsselt"_s);
    EXPECT_EQ(outcome.Reports[1].Text, u"Nicht lesbar"_s);
    EXPECT_EQ(outcome.Reports[1].Number, static_cast<qint64>(lying.size()));
}

TEST(ID3v2Modern, CompressedFramesOfATagMayNotGrowWithoutBound) {
    const std::string ten = "\0"s + std::string(10 * 1024 * 1024, 'a');
    const auto bomb = Compressed(ten);
    Id3v2Builder builder(3);
    for (const char* id : {"TIT2", "TALB"})
        builder.Frame(id, bomb, 0x80);
    const TID3Tag tag = Read(builder).Tag;
    EXPECT_EQ(tag.Title.size(), 10 * 1024 * 1024);
    EXPECT_EQ(tag.Album, QString());
}

TEST(ID3v2Modern, PlainSizesInVersion24AreRecognised) {
    for (const std::uint32_t size : {1u, 127u, 128u, 200u, 16384u, 70000u}) {
        const std::string body = "\0"s + std::string(size - 1, 'a');
        for (const bool plain : {false, true}) {
            Id3v2Builder builder(4);
            builder.SizedFrame("TIT2", plain ? size : Id3v2Builder::SynchSafe(size), body);
            const auto last = Read(builder);
            builder.Text("TPE1", "Band").Padding(20);
            const auto first = Read(builder);
            EXPECT_EQ(last.Tag.Title.size(), static_cast<qsizetype>(size) - 1) << size << plain;
            EXPECT_EQ(first.Tag.Artist, u"Band"_s) << size << plain;
        }
    }
}

TEST(ID3v2Modern, FramesBeforeADamagedOneAreKept) {
    const auto check = [](const Id3v2Builder& builder) {
        const auto outcome = Read(builder);
        EXPECT_TRUE(outcome.Read);
        EXPECT_EQ(outcome.Tag.Title, u"da"_s);
        EXPECT_EQ(outcome.Tag.Artist, QString());
    };
    check(Id3v2Builder(3).Text("TIT2", "da").SizedFrame("TALB", 1000, "x").Text("TPE1", "weg"));
    check(Id3v2Builder(4).Text("TIT2", "da").Text("tAlB", "x").Text("TPE1", "weg"));
    check(Id3v2Builder(3).Text("TIT2", "da").Padding(30).Text("TPE1", "weg"));
    check(Id3v2Builder(2).Text("TT2", "da").Text("T.2", "x").Text("TP1", "weg"));

    auto cut = Id3v2Builder(4).Text("TIT2", "da").Padding(100).Build();
    const auto size = static_cast<std::int64_t>(cut.size());
    cut.resize(40);
    const auto outcome = ReadWith(ReadID3v2Modern, cut);
    EXPECT_TRUE(outcome.Read);
    EXPECT_EQ(outcome.End, size);
    EXPECT_EQ(outcome.Tag.Title, u"da"_s);
}

TEST(ID3v2Modern, UnknownVersionsAreSkipped) {
    for (const auto& builder : {Id3v2Builder(5), Id3v2Builder(1), Id3v2Builder(2, 0x40)}) {
        auto tag = builder;
        const auto outcome = Read(tag.Raw("TT2\0\0\2\0x"s));
        EXPECT_FALSE(outcome.Read);
        EXPECT_EQ(outcome.End, 18);
        EXPECT_EQ(outcome.Tag.Title, QString());
    }
}
