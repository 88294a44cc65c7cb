#include "MusicManagment/database/GroupLists.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// Writes down every change of a row: "+Artist 0 Abba 1", "=Year 2 5", "-Album 1".
class Recorder {
 public:
    explicit Recorder(GroupLists& groups) {
        GroupEvents& events = groups.Events();
        subscriptions_ += events.Inserted.Subscribe([this](TOVType type, int row, auto& caption, int count) {
            Note(u'+', type, row, u' ' + caption + u' ' + QString::number(count));
        });
        subscriptions_ +=
            events.Deleted.Subscribe([this](TOVType type, int row) { Note(u'-', type, row, QString()); });
        subscriptions_ += events.Updated.Subscribe([this](TOVType type, int row, int count) {
            Note(u'=', type, row, u' ' + QString::number(count));
        });
    }
    QStringList Take() { return std::exchange(changes_, {}); }

 private:
    void Note(QChar sign, TOVType type, int row, const QString& rest) {
        static const QStringList names{u"Artist"_s, u"Album"_s, u"Year"_s, u"Length"_s, u"Genre"_s};
        changes_ << sign + names[type] + u' ' + QString::number(row) + rest;
    }
    QStringList changes_;
    Subscriptions subscriptions_;
};

TID3Tag Song(const QString& artist, const QString& album, const QString& year, quint16 length, quint8 genre) {
    TID3Tag song;
    song.Artist = artist;
    song.Album = album;
    song.Year = year;
    song.Length = length;
    song.MainGenre = genre;
    return song;
}

QStringList Texts(const SortedTextList& list) {
    QStringList texts;
    for (const auto& row : list)
        texts << row.Text;
    return texts;
}

struct Bucket {
    int First;
    int Last;
    const char16_t* Text;
};

// In the order of their ranks.
constexpr Bucket kYears[] = {{0, 0, u"Unbekannt"},
                             {1, 1899, u"Vor 1900"},
                             {1900, 1949, u"1900 bis 1949"},
                             {1950, 1959, u"In den 50ern"},
                             {1960, 1969, u"In den 60ern"},
                             {1970, 1979, u"In den 70ern"},
                             {1980, 1989, u"In den 80ern"},
                             {1990, 1999, u"In den 90ern"},
                             {2000, 2050, u"2000 bis heute"},
                             {2051, 2'147'483'647, u"In ferner Zukunft :)"}};
constexpr Bucket kLengths[] = {{0, 0, u"Fehlerhafte Angabe"},   {1, 59, u"Unter einer Minute"},
                               {60, 119, u"1 bis 2 Minuten"},   {120, 179, u"2 bis 3 Minuten"},
                               {180, 239, u"3 bis 4 Minuten"},  {240, 299, u"4 bis 5 Minuten"},
                               {300, 599, u"5 bis 10 Minuten"}, {600, 3599, u"10 Minuten bis 1 Stunde"},
                               {3600, 65535, u"Über 1 Stunde"}};

// Fills a list backwards and expects its rows in the order of the ranks, a stranger last.
template <typename List, std::size_t N>
void ExpectRankOrder(const Bucket (&buckets)[N]) {
    List list;
    QStringList expected;
    list.Insert(u"0 fremd"_s);
    for (std::size_t i = N; i-- > 0;) {
        list.Insert(QString::fromUtf16(buckets[i].Text));
        expected.prepend(QString::fromUtf16(buckets[i].Text));
    }
    expected << u"0 fremd"_s;
    EXPECT_EQ(Texts(list), expected);
}

}  // namespace

TEST(GroupListsTest, BucketsBeginAndEndWhereTheyShouldAndStandInTheirOrder) {
    for (const Bucket& bucket : kYears) {
        EXPECT_EQ(YearBucket(bucket.First), QString::fromUtf16(bucket.Text));
        EXPECT_EQ(YearBucket(bucket.Last), QString::fromUtf16(bucket.Text));
    }
    EXPECT_EQ(YearBucket(-1), u"In ferner Zukunft :)");
    for (const Bucket& bucket : kLengths) {
        EXPECT_EQ(LengthBucket(bucket.First), QString::fromUtf16(bucket.Text));
        EXPECT_EQ(LengthBucket(bucket.Last), QString::fromUtf16(bucket.Text));
    }
    ExpectRankOrder<TYearList>(kYears);
    ExpectRankOrder<TLengthList>(kLengths);
}

TEST(GroupListsTest, AYearThatIsNoNumberIsUnknown) {
    EXPECT_EQ(YearNumber(u"1999"_s), 1999);
    EXPECT_EQ(YearNumber(u"-3"_s), -3);
    for (const QString& text : {u""_s, u"19A5"_s, u"99999999999"_s, u"neunzehn"_s})
        EXPECT_EQ(YearNumber(text), 0) << text.toStdString();
}

TEST(GroupListsTest, ASongIsCountedInEachListAndTold) {
    GroupLists groups;
    Recorder recorder(groups);
    groups.Add(Song(u"Queen"_s, u"Jazz"_s, u"1978"_s, 200, 8));
    EXPECT_EQ(recorder.Take(),
              (QStringList{u"+Artist 0 Queen 1"_s, u"+Album 0 Jazz 1"_s, u"+Year 0 In den 70ern 1"_s,
                           u"+Length 0 3 bis 4 Minuten 1"_s, u"=Genre 8 1"_s}));
    groups.Add(Song(u"Abba"_s, u"Jazz"_s, u"0000"_s, 61, 8));
    EXPECT_EQ(recorder.Take(), (QStringList{u"+Artist 0 Abba 1"_s, u"=Album 0 2"_s, u"+Year 0 Unbekannt 1"_s,
                                            u"+Length 0 1 bis 2 Minuten 1"_s, u"=Genre 8 2"_s}));
    groups.Remove(Song(u"Abba"_s, u"Jazz"_s, u"0000"_s, 61, 8));
    EXPECT_EQ(recorder.Take(),
              (QStringList{u"-Artist 0"_s, u"=Album 0 1"_s, u"-Year 0"_s, u"-Length 0"_s, u"=Genre 8 1"_s}));
    // Only what a change changes is told.
    groups.Change(Song(u"Queen"_s, u"Jazz"_s, u"1978"_s, 200, 8),
                  Song(u"Queen"_s, u"Live"_s, u"1979"_s, 200, 8));
    EXPECT_EQ(recorder.Take(), (QStringList{u"-Album 0"_s, u"+Album 0 Live 1"_s}));
}

TEST(GroupListsTest, ArtistsAndAlbumsAreSortedAndTellCasesApart) {
    GroupLists groups;
    for (const QString& name : {u"zz top"_s, u"Ärzte"_s, u"abba"_s, u"ZZ Top"_s, u"Abba"_s, u"Bap"_s, u""_s})
        groups.Add(Song(name, name, QString(), 0, 0));
    groups.Add(Song(u"abba"_s, u"neu"_s, QString(), 0, 0));
    const QStringList expected{u""_s, u"abba"_s, u"Abba"_s, u"Ärzte"_s, u"Bap"_s, u"zz top"_s, u"ZZ Top"_s};
    EXPECT_EQ(Texts(groups.Artists()), expected);
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
    Recorder recorder(groups);
    groups.Remove(Song(u"not in the file"_s, QString(), QString(), 0, 0));
    EXPECT_EQ(recorder.Take(), QStringList{u"=Genre 0 0"_s});
}
