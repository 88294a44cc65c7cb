#include "ReadMPEGHeader/id3v1/ID3v1.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/CodePage.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag ReadBack(ByteSpan bytes) {
    MemorySource source(bytes);
    TID3Tag tag;
    ReadID3v1(source, source.Size() - 128, tag);
    return tag;
}

}  // namespace

TEST(ID3v1, FieldsAreTrimmedAndEndAtTheFirstZero) {
    const auto bytes =
        Id3v1Bytes(" \tTitel \x1F", std::string_view("Wir\0Ihr", 7), "  ", "1999", "M\xF6glich", 17);
    const TID3Tag tag = ReadBack(bytes);
    EXPECT_EQ(tag.Title, u"Titel"_s);
    EXPECT_EQ(tag.Artist, u"Wir"_s);
    EXPECT_EQ(tag.Album, QString());
    EXPECT_EQ(tag.Year, u"1999"_s);
    EXPECT_EQ(tag.Comment, u"Möglich"_s);
    EXPECT_EQ(tag.Genre, 17);
    EXPECT_EQ(tag.Track, 0);
}

TEST(ID3v1, TrackNeedsAZeroBeforeIt) {
    auto bytes = Id3v1Bytes("t", "a", "", "", std::string(28, 'k'), 0);
    bytes[126] = 7;
    EXPECT_EQ(ReadBack(bytes).Track, 7);
    EXPECT_EQ(ReadBack(bytes).Comment, QString(28, u'k'));
    bytes[125] = 'x';
    bytes[126] = 'y';
    EXPECT_EQ(ReadBack(bytes).Track, 0);
    EXPECT_EQ(ReadBack(bytes).Comment, QString(28, u'k') + u"xy"_s);
}

TEST(ID3v1, WritingCutsTheRecordToWhatTheFileHolds) {
    TID3Tag tag;
    tag.Title = u"12345678901234567890123456789 äß"_s;
    tag.Artist = u"Ð"_s + QString(40, u'Ā');  // Ā is written as A
    tag.Album = u"kurz"_s;
    tag.Year = u"20045"_s;
    tag.Comment = QString(30, u'k');
    tag.Track = 3;
    tag.Genre = 9;
    ByteWriter bytes;
    WriteID3v1(bytes, tag);
    EXPECT_EQ(tag.Title, u"12345678901234567890123456789 "_s);
    EXPECT_EQ(tag.Artist, u"Ð"_s + QString(29, u'A'));
    EXPECT_EQ(tag.Year, u"2004"_s);
    EXPECT_EQ(tag.Comment, QString(28, u'k'));

    ASSERT_EQ(bytes.Size(), kId3v1Size);
    EXPECT_TRUE(StartsWith(bytes.Bytes(), "TAG1234567890"));
    EXPECT_EQ(bytes.Bytes()[125], 0);
    TID3Tag expected = tag;
    expected.Title = tag.Title.trimmed();
    EXPECT_EQ(ReadBack(bytes.Bytes()), expected);

    // Without a track the comment has thirty characters.
    TID3Tag longComment;
    longComment.Comment = QString(31, u'k');
    ByteWriter other;
    WriteID3v1(other, longComment);
    EXPECT_EQ(longComment.Comment, QString(30, u'k'));
    EXPECT_EQ(other.Bytes()[126], 'k');
}

TEST(ID3v1, ACutNeverSplitsACharacterOfTheLegacyPage) {
    CodePage::SetLegacyName(u"UTF-8"_s);
    TID3Tag tag;
    tag.Title = QString(20, u'ö');
    tag.Artist = QString(29, u'a') + u"\U0001F3B5"_s;
    ByteWriter bytes;
    WriteID3v1(bytes, tag);
    CodePage::SetLegacyName(u"windows-1252"_s);
    EXPECT_EQ(tag.Title, QString(15, u'ö'));
    EXPECT_EQ(tag.Artist, QString(29, u'a'));
}
