#include "ReadMPEGHeader/asf/Asf.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Clock.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/AsfBuilder.h"

using namespace Qt::StringLiterals;

namespace {

using Attributes = std::vector<AsfBuilder::Attribute>;

std::optional<TASFInfo> Read(const std::vector<std::uint8_t>& bytes) {
    MemorySource source(bytes);
    return ReadAsfHeader(source);
}

TASFInfo ReadGood(const AsfBuilder& builder) {
    const auto info = Read(builder.Build());
    EXPECT_TRUE(info.has_value());
    return info.value_or(TASFInfo());
}

// 2004-05-06 07:08:09 UTC in 100-ns units since 1601.
constexpr std::uint64_t kCreation = 127'283'008'890'000'000;

AsfBuilder WholeHeader() {
    AsfBuilder builder;
    builder.FileProperties(kCreation, 104'370'000, 3100)
        .Content(u"Öl & Töne"_s, u"Künstler"_s, u"Kommentar"_s)
        .Extended({AsfBuilder::TextAttribute(u"WM/AlbumTitle"_s, u"Album"_s),
                   AsfBuilder::TextAttribute(u"WM/Year"_s, u"2004-05-06"_s),
                   AsfBuilder::TextAttribute(u"WM/TrackNumber"_s, u"7/12"_s),
                   AsfBuilder::TextAttribute(u"WM/Genre"_s, u"rock"_s)})
        .Stream(AsfBuilder::kVideo, 9, 9, 9, 9)
        .Stream(AsfBuilder::kAudio, 2, 44100, 16001, 743, 0x8001)
        .Stream(AsfBuilder::kAudio, 1, 8000, 1000, 1)
        .Codecs({{1, u"Video"_s, u"x"_s}, {2, u"WMA 9"_s, u"128 kbps"_s}, {2, u"Later"_s, u"y"_s}});
    return builder;
}

}  // namespace

TEST(Asf, TheWholeHeaderBecomesTheRecord) {
    const TID3Tag tag = TagFromAsf(ReadGood(WholeHeader()), AsfLength::AsStored);
    TID3Tag expected;
    expected.Title = u"Öl & Töne"_s;
    expected.Artist = u"Künstler"_s;
    expected.Album = u"Album"_s;
    expected.Year = u"2004"_s;
    expected.Comment = u"Kommentar"_s;
    expected.MPEGLayer = u"WMA 9 128 kbps"_s;
    expected.Length = 10;
    expected.Genre = 17;
    expected.BitRate = 128;
    expected.SampleRate = 44100;
    expected.ChannelMode = 2;
    expected.Emphasis = 1;
    expected.Private = true;
    expected.FrameSize = 743;
    expected.Track = 7;
    expected.AddTime = ToDayCount(QDateTime(QDate(2004, 5, 6), QTime(7, 8, 9), Qt::UTC).toLocalTime());
    EXPECT_TRUE(tag == expected) << tag.Title.toStdString() << tag.MPEGLayer.toStdString() << tag.AddTime;
    EXPECT_EQ(TagFromAsf(ReadGood(WholeHeader()), AsfLength::LessPreroll).Length, 7);
}

TEST(Asf, AHeaderWithoutTagsHasTheDefaults) {
    AsfBuilder builder;
    builder.Stream(AsfBuilder::kAudio, 5, 96000, 0xFFFFFFFF, 4);
    const TID3Tag tag = TagFromAsf(ReadGood(builder), AsfLength::LessPreroll);
    EXPECT_EQ(tag.Year, u"0000"_s);
    EXPECT_EQ(tag.MPEGLayer, u"Windows Media Audio"_s);
    EXPECT_EQ(tag.Genre, 255);
    EXPECT_EQ(tag.ChannelMode, 0);
    EXPECT_EQ(tag.SampleRate, 65535);  // saturated
    EXPECT_EQ(tag.BitRate, 65535);
    EXPECT_EQ(tag.AddTime, 0);
}

TEST(Asf, TimesThatCannotBeAreNotTaken) {
    const auto tagOf = [](std::uint64_t creation, std::uint64_t duration, std::uint64_t preroll,
                          std::uint32_t flags, AsfLength length) {
        AsfBuilder builder;
        builder.FileProperties(creation, duration, preroll, flags, 64'000);
        return TagFromAsf(ReadGood(builder), length);
    };
    const TID3Tag broadcast = tagOf(kCreation, 104'370'000, 0, 1, AsfLength::AsStored);
    EXPECT_EQ(broadcast.Length, 0);
    EXPECT_EQ(broadcast.AddTime, 0);
    EXPECT_EQ(broadcast.BitRate, 64);  // the header's maximum where no stream tells its own
    EXPECT_EQ(tagOf(0, 1, UINT64_MAX, 0, AsfLength::LessPreroll).Length, 0);
    EXPECT_EQ(tagOf(0, 30'000'000, 3000, 0, AsfLength::LessPreroll).Length, 0);
    EXPECT_EQ(tagOf(UINT64_MAX, UINT64_MAX, 0, 0, AsfLength::AsStored).Length, 65535);
    EXPECT_EQ(tagOf(UINT64_MAX, 0, 0, 0, AsfLength::AsStored).AddTime, 0);
}

const auto Text = AsfBuilder::TextAttribute;
const auto Number = AsfBuilder::NumberAttribute;

TEST(Asf, AttributesStandInTheExtendedContentOrInTheLibrary) {
    struct AttributeCase {
        Attributes Values;
        const char16_t* Year;
        int Track;
        int Genre;
    };
    const AttributeCase cases[] = {
        {{Number(u"WM/Year"_s, 3, 1999, 4), Number(u"WM/TrackNumber"_s, 3, 12, 4)}, u"1999", 12, 255},
        {{Number(u"WM/Track"_s, 3, 4, 4), Text(u"WM/GenreID"_s, u"(17)"_s)}, u"", 5, 17},
        {{Number(u"WM/Track"_s, 3, 4, 4), Number(u"WM/TrackNumber"_s, 5, 9, 2)}, u"", 9, 255},
        {{Number(u"WM/Track"_s, 4, UINT64_MAX, 8), Text(u"WM/Genre"_s, u"Keins davon"_s)}, u"", 0, 255},
        {{Number(u"WM/TrackNumber"_s, 3, 256, 4), Number(u"WM/Year"_s, 3, 0, 4)}, u"", 0, 255},
        {{Text(u"WM/GenreID"_s, u"(200)"_s), Text(u"WM/Genre"_s, u"Blues"_s)}, u"", 0, 0},
        {{{u"WM/Year"_s, 1, {'1', '9'}}, Text(u"Date"_s, u"MCMXC"_s)}, u"MCMXC", 0, 255},
        {{Number(u"WM/Year"_s, 2, 1, 2), {u"WM/TrackNumber"_s, 3, {}}}, u"1", 0, 255}};
    for (const auto& [values, year, track, genre] : cases) {
        for (const bool library : {false, true}) {
            AsfBuilder builder;
            library ? builder.Library(values) : builder.Extended(values);
            const TASFInfo info = ReadGood(builder);
            EXPECT_EQ(info.Year, QString::fromUtf16(year));
            EXPECT_EQ(info.Track, track);
            EXPECT_EQ(info.Genre, genre);
        }
    }
}

TEST(Asf, AttributesFillWhatTheContentDescriptionLeavesEmpty) {
    AsfBuilder builder;
    builder.Extended({Text(u"Title"_s, u"other"_s), Text(u"author"_s, u"Artist"_s)})
        .Content(u"Title"_s, {}, {});
    EXPECT_EQ(ReadGood(builder).Title, u"Title"_s);
    EXPECT_EQ(ReadGood(builder).Artist, u"Artist"_s);
}

TEST(Asf, PicturesAndForeignAttributesArePassedOver) {
    AsfBuilder builder;
    const std::vector<std::uint8_t> picture(3'000'000, 0xFF);
    builder.Library({{u"WM/Picture"_s, 1, picture},
                     {u"WM/AlbumTitle"_s, 0, picture},
                     Text(QString(500, u'n'), u"x"_s),
                     Text(u"WM/AlbumTitle"_s, u"Album"_s)});
    EXPECT_EQ(ReadGood(builder).Album, u"Album"_s);
}

TEST(Asf, ADamagedObjectCostsOnlyItself) {
    const ByteWriter good = AsfBuilder::ExtendedBody({Text(u"WM/AlbumTitle"_s, u"lost"_s)});
    ByteWriter lying;
    lying.U16Le(2);  // announces one attribute more than there is
    lying.Raw(ByteSpan(good.Bytes()).subspan(2));
    AsfBuilder builder;
    builder.Add(AsfBuilder::Object(AsfBuilder::kExtendedContent, lying))
        .Add(AsfBuilder::Object(AsfBuilder::kStreamProperties, ByteWriter()))
        .Content(u"Title"_s, u"Artist"_s, {});
    const TASFInfo info = ReadGood(builder);
    EXPECT_EQ(info.Title, u"Title"_s);
    EXPECT_EQ(info.Album, QString());
}

TEST(Asf, SizesThatLieEndTheWalk) {
    for (const std::uint64_t size :
         {std::uint64_t{1}, std::uint64_t{23}, std::uint64_t{1} << 40, UINT64_MAX}) {
        AsfBuilder builder;
        builder.Content(u"Title"_s, u"Artist"_s, {})
            .Add(AsfBuilder::Object(AsfBuilder::kFileProperties, ByteWriter(), size))
            .Content(u"never reached"_s, {}, {});
        for (const std::uint64_t declared : {std::uint64_t{0}, UINT64_MAX}) {
            const auto info = Read(builder.Build(declared));
            ASSERT_TRUE(info.has_value());
            EXPECT_EQ(info->Title, u"Title"_s);
        }
    }
}

TEST(Asf, AHeaderThatIsCutAnywhereIsReadAsFarAsItGoes) {
    const auto whole = WholeHeader().Library({Text(u"WM/Picture"_s, u"x"_s)}).Build();
    int readable = 0;
    for (std::size_t size = 0; size <= whole.size(); ++size)
        if (Read({whole.begin(), whole.begin() + static_cast<long>(size)})) ++readable;
    // From the end of the first object on.
    EXPECT_EQ(readable, static_cast<int>(whole.size()) - (30 + 104) + 1);
}

TEST(Asf, OnlyTheIdentifierMakesAHeader) {
    auto bytes = WholeHeader().Build();
    EXPECT_TRUE(IsAsf(bytes));
    EXPECT_FALSE(IsAsf(ByteSpan(bytes).first(15)));
    bytes[15] ^= 1;
    EXPECT_FALSE(IsAsf(bytes));
    EXPECT_FALSE(Read(bytes).has_value());
    EXPECT_FALSE(Read(AsfBuilder().Build()).has_value());
    EXPECT_FALSE(Read(WholeHeader().Build(29)).has_value());
}
