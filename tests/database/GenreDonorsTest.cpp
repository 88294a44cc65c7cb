#include "MusicManagment/database/batches/GenreDonors.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <vector>

#include "CommonRUKTools/CompStr.h"
#include "tests/PlainDistance.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// Few letters, so that names are alike often; lengths on both sides of a machine word.
QString RandomName(std::mt19937& random, int longest) {
    static const QString letters = u"abB ÄäßΣ😀"_s;
    QString name;
    for (auto left = static_cast<int>(random() % static_cast<unsigned>(longest)); left > 0; --left)
        name += letters[static_cast<qsizetype>(random() % 8)];
    return name;
}

void AddSong(TMusicDatabase& database, const QString& artist, quint8 mainGenre) {
    TID3Tag song;
    song.Artist = artist;
    song.MainGenre = mainGenre;
    database.AddEntry(u"/%1.mp3"_s.arg(database.Count(), 6, 10, QChar(u'0')), song, AddAs::Returning);
}

}  // namespace

TEST(CompStr, DistanceIsThatOfThePlainMatrix) {
    std::mt19937 random(7);
    for (int i = 0; i < 3000; ++i) {
        const std::u32string a = CompareKey(RandomName(random, i % 10 == 0 ? 150 : 12));
        const std::u32string b = CompareKey(RandomName(random, i % 7 == 0 ? 150 : 12));
        ASSERT_EQ(EditDistance(a, b), PlainDistance(a, b)) << i;
    }
}

TEST(CompStr, PercentIsOfTheLongerTextInLowerCaseAndComposed) {
    EXPECT_EQ(CompStr(u"", u""), 100);
    EXPECT_EQ(CompStr(u"", u"ab"), 0);
    EXPECT_EQ(CompStr(u"Mötley", u"MO\u0308TLEY"), 100);
    EXPECT_EQ(CompStr(u"abcde", u"abcxy"), 60);
    EXPECT_EQ(CompStr(u"😀a", u"😀b"), 50);  // code points, not the halves of a pair
    EXPECT_TRUE(IsAlike(2, 5) && !IsAlike(3, 5) && !IsAlike(41, 102));
}

TEST(GenreDonors, AnArtistIsFoundInAnyCaseAndElseTheMostAlikeOne) {
    TMusicDatabase database;
    database.SetOrder({.SortType = stPath, .SubSortType = sstPath});
    AddSong(database, u"Quen"_s, 0);
    AddSong(database, u"QUEEN"_s, 8);
    AddSong(database, u"Queen"_s, 3);
    AddSong(database, u"Queem"_s, 5);
    const GenreDonors donors(database);
    ASSERT_NE(donors.OfArtist(u"queen"_s), nullptr);
    EXPECT_EQ(donors.OfArtist(u"queen"_s)->MainGenre, 8);
    EXPECT_EQ(donors.OfArtist(u"Quen"_s), nullptr);
    const auto like = donors.MostAlike(u"Queex"_s);  // equally far from both: the first counts
    ASSERT_TRUE(like);
    EXPECT_EQ(like->From.Artist, u"QUEEN"_s);
    EXPECT_EQ(like->Percent, 80);
    EXPECT_FALSE(donors.MostAlike(u"Abba"_s));
}

TEST(GenreDonors, TheMostAlikeIsTheOneThatALookAtAllOfThemFinds) {
    std::mt19937 random(11);
    TMusicDatabase database;
    database.SetOrder({.SortType = stPath, .SubSortType = sstPath});
    for (int i = 0; i < 400; ++i)
        AddSong(database, RandomName(random, 14), static_cast<quint8>(1 + i % 19));
    const GenreDonors donors(database);
    for (int i = 0; i < 400; ++i) {
        const QString wanted = RandomName(random, 14);
        const std::u32string key = CompareKey(wanted);
        double best = 0;
        QString expected;
        for (SongIndex song = 0; song < database.Count(); ++song) {
            const std::u32string other = CompareKey(database.Song(song).Artist);
            if (!IsAlike(PlainDistance(key, other), std::max(key.size(), other.size()))) continue;
            const double likeness = CompStr(wanted, database.Song(song).Artist);
            if (likeness <= best) continue;
            best = likeness;
            expected = database.Song(song).Artist;
        }
        const auto found = donors.MostAlike(wanted);
        ASSERT_EQ(found ? found->From.Artist : QString(), expected) << i;
        ASSERT_EQ(found ? found->Percent : 0, static_cast<int>(best));
    }
}
