#include "MusicManagment/database/GroupLists.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/database/Listing.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Song(const QString& artist, const QString& album, const QString& year, quint16 length, quint8 genre) {
    TID3Tag song;
    song.Artist = artist;
    song.Album = album;
    song.Year = year;
    song.Length = length;
    song.MainGenre = genre;
    return song;
}

// Goes through all values downwards: the list must have the rows in the order of the values nevertheless, a
// stranger last.
template <typename List>
QStringList Rows(QString (*bucket)(int), int most) {
    List list;
    QStringList expected{u"0 fremd"_s};
    list.Insert(expected[0]);
    for (int value = most; value >= 0; --value) {
        if (bucket(value) != expected[0]) expected.prepend(bucket(value));
        list.Insert(bucket(value));
    }
    EXPECT_EQ(TextsOf(list), expected);
    return expected;
}

}  // namespace

TEST(GroupListsTest, BucketsBeginAndEndWhereTheyShouldAndStandInTheirOrder) {
    EXPECT_EQ(Rows<TYearList>(YearBucket, 2051).size(), 11);
    EXPECT_EQ(Rows<TLengthList>(LengthBucket, 65'535).size(), 10);
    EXPECT_EQ(YearBucket(-1), YearBucket(2'147'483'647));
    for (const int first : {1, 1900, 1950, 1960, 1970, 1980, 1990, 2000, 2051})
        EXPECT_NE(YearBucket(first - 1), YearBucket(first)) << first;
    for (const int first : {1, 60, 120, 180, 240, 300, 600, 3600})
        EXPECT_NE(LengthBucket(first - 1), LengthBucket(first)) << first;
}

TEST(GroupListsTest, AYearThatIsNoNumberIsUnknown) {
    EXPECT_EQ(YearNumber(u"1999"_s), 1999);
    EXPECT_EQ(YearNumber(u"-3"_s), -3);
    for (const QString& text : {u""_s, u"19A5"_s, u"99999999999"_s, u"neunzehn"_s})
        EXPECT_EQ(YearNumber(text), 0) << text.toStdString();
}

TEST(GroupListsTest, ArtistsAndAlbumsAreSortedAndTellCasesApart) {
    GroupLists groups;
    for (const QString& name : {u"zz top"_s, u"Ärzte"_s, u"abba"_s, u"ZZ Top"_s, u"Abba"_s, u"Bap"_s, u""_s})
        groups.Add(Song(name, name, QString(), 0, 0));
    groups.Add(Song(u"abba"_s, u"neu"_s, QString(), 0, 0));
    const QStringList expected{u""_s, u"abba"_s, u"Abba"_s, u"Ärzte"_s, u"Bap"_s, u"zz top"_s, u"ZZ Top"_s};
    EXPECT_EQ(TextsOf(groups.Artists()), expected);
    EXPECT_EQ(groups.RowSongCount(ovArtist, 1), 2);
    EXPECT_EQ(groups.RowSongCount(ovArtist, 2), 1);
    EXPECT_EQ(groups.RowCount(ovAlbum), 8);
}

TEST(GroupListsTest, ManySongsAreCountedAsIfOneByOne) {
    GroupLists groups;
    QHash<QString, int> expected;
    for (unsigned i = 0; i < 5000; ++i) {
        const QString artist = QString::number(i * 7919 % 613);
        groups.Add(Song(artist, QString(), QString(), 0, 0));
        ++expected[artist];
        if (i % 3 != 0) continue;
        const QString other = QString::number(i % 613);
        groups.Remove(Song(other, QString(), QString(), 0, 0));
        if (expected.contains(other) && --expected[other] == 0) expected.remove(other);
    }
    ASSERT_EQ(groups.RowCount(ovArtist), expected.size());
    for (const auto& row : groups.Artists())
        EXPECT_EQ(row.Number, expected.value(row.Text)) << row.Text.toStdString();
}

TEST(GroupListsTest, GenreRowsAreAlwaysTwentyAndNeverBelowZero) {
    GroupLists groups;
    groups.Add(Song(QString(), QString(), QString(), 0, 200));
    EXPECT_EQ(groups.RowSongCount(ovGenre, 0), 1) << "a number that is no main genre counts as unknown";
    groups.Remove(Song(QString(), QString(), QString(), 0, 3));
    EXPECT_EQ(groups.RowSongCount(ovGenre, 3), 0);
    groups.Clear();
    EXPECT_EQ(groups.RowCount(ovGenre), 20);
    EXPECT_EQ(groups.RowSongCount(ovGenre, 0), 0);
    EXPECT_EQ(groups.RowCount(ovArtist) + groups.RowCount(ovYear) + groups.RowCount(ovLength), 0);
}

TEST(GroupListsTest, RowsOfAFileAddUpAndMayBeWrong) {
    GroupLists groups;
    groups.AddRow(ovArtist, u"Queen"_s, 3);
    groups.AddRow(ovArtist, u"Queen"_s, 2);
    EXPECT_EQ(groups.RowSongCount(ovArtist, 0), 5);
    groups.Remove(Song(u"not in the file"_s, QString(), QString(), 0, 0));
    EXPECT_EQ(TextsOf(groups.Artists()), QStringList{u"Queen"_s});
}
