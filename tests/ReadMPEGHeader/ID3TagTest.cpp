#include "ReadMPEGHeader/ID3Tag.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

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

// The seven fields that make up the tags.
void CopyTagFields(TID3Tag& target, const TID3Tag& source) {
    target.Title = source.Title;
    target.Artist = source.Artist;
    target.Album = source.Album;
    target.Year = source.Year;
    target.Comment = source.Comment;
    target.Genre = source.Genre;
    target.Track = source.Track;
}

}  // namespace

TEST(ID3Tag, MergingTagsLeavesTheTechnicalFieldsAndFillsWhatIsEmpty) {
    const TID3Tag source = FullTag(u"s"_s, 7);
    for (const auto mode : {MergeMode::Tags, MergeMode::FillEmpty}) {
        TID3Tag target = FullTag(u"t"_s, 4);
        TID3Tag expected = target;
        MergeTag(target, source, mode);
        CopyTagFields(expected, source);
        EXPECT_TRUE(target == expected);

        TID3Tag empty;
        MergeTag(empty, source, mode);
        expected = TID3Tag();
        CopyTagFields(expected, source);
        expected.FileName = source.FileName;
        if (mode == MergeMode::FillEmpty) {
            expected.MPEGLayer = source.MPEGLayer;
            expected.Length = source.Length;
            expected.PlayCount = source.PlayCount;
        }
        EXPECT_TRUE(empty == expected);
    }
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

TEST(SongFileKinds, TheLastExtensionCountsInAnyCase) {
    const std::pair<QString, QString> formats[] = {{u"/m/a.b.wav"_s, u"Wave"_s},
                                                   {u"a.MPEG"_s, u"Video (MPG)"_s},
                                                   {u"a.mp3"_s, u"kept"_s},
                                                   {u"/folder.wav/a"_s, u"kept"_s},
                                                   {u"wav"_s, u"kept"_s}};
    for (const auto& [path, format] : formats) {
        TID3Tag tag;
        tag.MPEGLayer = u"kept"_s;
        DescribeByExtension(path, tag);
        EXPECT_EQ(tag.MPEGLayer, format) << path.toStdString();
    }
}
