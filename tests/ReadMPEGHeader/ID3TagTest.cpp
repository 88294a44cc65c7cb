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

namespace {

// Every field differs from its default and, with another seed, from the other record's.
TID3Tag FullTag(const QString& mark, quint8 seed) {
    TID3Tag tag;
    int field = 0;
    for (QString* text :
         {&tag.FileName, &tag.Title, &tag.Artist, &tag.Album, &tag.Year, &tag.Comment, &tag.MPEGLayer})
        *text = mark + QString::number(field++);
    tag.Length = tag.BitRate = tag.SampleRate = tag.FrameSize = tag.Reserved =
        static_cast<quint16>(seed + 1000);
    tag.Genre = tag.ChannelMode = tag.Emphasis = tag.Track = tag.MainGenre = seed;
    tag.Private = tag.Protected = tag.Copyrighted = tag.Original = tag.Padding = tag.Remix = seed % 2 == 1;
    tag.PlayCount = tag.Flags = seed + 100'000u;
    tag.AddTime = seed + 0.5;
    return tag;
}

void ExpectTags(const TID3Tag& tag, const TID3Tag& source) {
    EXPECT_EQ(tag.Title, source.Title);
    EXPECT_EQ(tag.Artist, source.Artist);
    EXPECT_EQ(tag.Album, source.Album);
    EXPECT_EQ(tag.Year, source.Year);
    EXPECT_EQ(tag.Comment, source.Comment);
    EXPECT_EQ(tag.Genre, source.Genre);
    EXPECT_EQ(tag.Track, source.Track);
}

}  // namespace

TEST(ID3Tag, MergingTagsLeavesTheTechnicalFields) {
    const TID3Tag source = FullTag(u"s"_s, 7);
    for (const auto mode : {MergeMode::Tags, MergeMode::FillEmpty}) {
        TID3Tag target = FullTag(u"t"_s, 4);
        MergeTag(target, source, mode);
        ExpectTags(target, source);
        // Put the tags back: nothing else may have changed.
        const TID3Tag before = FullTag(u"t"_s, 4);
        target.Title = before.Title;
        target.Artist = before.Artist;
        target.Album = before.Album;
        target.Year = before.Year;
        target.Comment = before.Comment;
        target.Genre = before.Genre;
        target.Track = before.Track;
        EXPECT_TRUE(target == before);
    }
}

TEST(ID3Tag, MergingFillsWhatIsEmpty) {
    const TID3Tag source = FullTag(u"s"_s, 7);
    TID3Tag plain;
    MergeTag(plain, source, MergeMode::Tags);
    EXPECT_EQ(plain.FileName, source.FileName);
    EXPECT_TRUE(plain.MPEGLayer.isEmpty());
    EXPECT_EQ(plain.Length, 0);
    EXPECT_EQ(plain.PlayCount, 0u);
    TID3Tag filled;
    MergeTag(filled, source, MergeMode::FillEmpty);
    EXPECT_EQ(filled.MPEGLayer, source.MPEGLayer);
    EXPECT_EQ(filled.Length, source.Length);
    EXPECT_EQ(filled.PlayCount, source.PlayCount);
    EXPECT_EQ(filled.BitRate, 0);
    EXPECT_EQ(filled.AddTime, 0);
}

TEST(ID3Tag, MergingTechnicalFieldsTakesAllButTheFileName) {
    const TID3Tag source = FullTag(u"s"_s, 7);
    TID3Tag target = FullTag(u"t"_s, 4);
    MergeTag(target, source, MergeMode::Technical);
    EXPECT_EQ(target.FileName, FullTag(u"t"_s, 4).FileName);
    target.FileName = source.FileName;
    EXPECT_TRUE(target == source);
    MergeTag(target, TID3Tag(), MergeMode::Technical);
    EXPECT_EQ(target.Length, 0);
    EXPECT_TRUE(target.MPEGLayer.isEmpty());
}

TEST(ID3Tag, TheExtensionDescribesTheFormat) {
    const std::vector<std::pair<QString, QString>> cases = {{u"/m/a.wav"_s, u"Wave"_s},
                                                            {u"a.WMA"_s, u"Windows Media Audio"_s},
                                                            {u"a.b.voc"_s, u"VOC Soundfile"_s},
                                                            {u"a.avi"_s, u"Video (AVI)"_s},
                                                            {u"a.mpg"_s, u"Video (MPG)"_s},
                                                            {u"a.MPEG"_s, u"Video (MPG)"_s},
                                                            {u"a.mid"_s, u"Midi Soundfile"_s},
                                                            {u"a.mod"_s, u"MOD Soundfile"_s},
                                                            {u"a.ogg"_s, u"MPEG ??? Layer ???"_s},
                                                            {u"/folder.wav/a"_s, u"MPEG ??? Layer ???"_s},
                                                            {u"wav"_s, u"MPEG ??? Layer ???"_s}};
    for (const auto& [path, format] : cases) {
        TID3Tag tag;
        ResetTag(false, tag, 0);
        DescribeByExtension(path, tag);
        EXPECT_EQ(tag.MPEGLayer, format) << path.toStdString();
    }
}
