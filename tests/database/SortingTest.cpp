#include "MusicManagment/database/sorting/Sorting.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

using Tag = TID3Tag;

template <typename T>
Tag With(T Tag::*field, std::type_identity_t<T> value, Tag song = {}) {
    song.*field = std::move(value);
    return song;
}

// Two songs that differ as told, and the order in which they stand.
struct PairCase {
    const char* Name;
    SongOrder Order;
    TID3Tag First;
    TID3Tag Second;
};

unsigned Below(std::mt19937& random, std::size_t limit) {
    return static_cast<unsigned>(random() % limit);
}

// Few different values, so that ties are many: umlauts, case, emptiness, other scripts, a text that the
// collator ignores.
QString SomeText(std::mt19937& random) {
    static const QStringList texts{
        u""_s,    u"a"_s,   u"A"_s,      u"ä"_s,  u"Ä"_s,      u"ae"_s,  u"AE"_s,     u"b"_s,       u"öl"_s,
        u"Ol"_s,  u"oL"_s,  u"10"_s,     u"9"_s,  u"été"_s,    u"Ete"_s, u"Straße"_s, u"strasse"_s, u"\1"_s,
        u"a b"_s, u"a-b"_s, u"Москва"_s, u"ZZ"_s, u"zz top"_s, u"ab"_s,  u"Zz Top"_s};
    return texts[static_cast<qsizetype>(Below(random, static_cast<unsigned>(texts.size())))];
}

TID3Tag RandomSong(std::mt19937& random) {
    TID3Tag song;
    song.FileName = (Below(random, 4) == 0 ? u":1234ABCD:\\"_s : u"/"_s) +
                    (Below(random, 2) == 0 ? u"x/"_s : QString()) + SomeText(random);
    song.Title = SomeText(random) + SomeText(random);
    // One artist has more songs than are sorted without keys.
    song.Artist = Below(random, 4) != 0 ? u"Die Ärzte"_s : SomeText(random);
    song.Album = SomeText(random);
    song.Comment = SomeText(random);
    song.Year = Below(random, 2) == 0 ? QString::number(1960 + Below(random, 5)) : SomeText(random);
    song.Length = static_cast<quint16>(Below(random, 3));
    song.MainGenre = static_cast<quint8>(Below(random, 2));
    song.Track = static_cast<quint8>(Below(random, 3));
    song.PlayCount = Below(random, 3);
    song.Flags = Below(random, 16);
    song.AddTime = static_cast<double>(Below(random, 5)) - 2.0;
    return song;
}

std::vector<SongOrder> AllOrders() {
    std::vector<SongOrder> orders;
    for (int type = stTitle; type <= stAlbumOrder; ++type)
        for (int sub = sstGATL; sub <= sstPath; ++sub)
            for (const bool backwards : {false, true})
                orders.push_back({static_cast<TSortType>(type), static_cast<TSubSortType>(sub), backwards});
    orders.push_back({.SortType = stFlags, .ShownFlag = sfDamaged});
    return orders;
}

SongList ListOf(const std::vector<TID3Tag>& songs) {
    SongList list;
    for (const TID3Tag& song : songs)
        list.Append(song);
    return list;
}

std::vector<TID3Tag> Contents(const SongList& list) {
    std::vector<TID3Tag> songs;
    for (const auto& entry : list)
        songs.push_back(*entry);
    return songs;
}

// The re-placing rule step by step, as a walk past every entry.
SongIndex WalkedTarget(const SongOrder& order, const SongList& songs, SongIndex i) {
    const auto n = static_cast<SongIndex>(songs.Count());
    if (n == 1) return i;
    const auto compare = [&](SongIndex other) { return CompareSongs(order, songs.At(i), songs.At(other)); };
    SongIndex start = (n - 1) / 2;
    if (i > 0) {
        const bool belowPredecessor = compare(i - 1) < 0;
        if (!belowPredecessor && (i == n - 1 || compare(i + 1) <= 0)) return i;
        start = belowPredecessor ? i - 2 : i + 2;
    }
    if (start < 0) return 0;
    if (start < n && compare(start) < 0) {
        for (SongIndex at = start; at >= 0; --at)
            if (at != i && compare(at) >= 0) return at + 1;
        return 0;
    }
    for (SongIndex at = start; at < n; ++at)
        if (at != i && compare(at) <= 0) return at;
    return n;
}

}  // namespace

TEST(SortingTest, SongsStandInTheOrderOfTheirKeys) {
    const PairCase cases[] = {
        {"TitleIgnoresCase", {stTitle}, With(&Tag::Title, u"ANNA"_s), With(&Tag::Title, u"berta"_s)},
        {"TitleUmlautStandsByItsLetter",
         {stTitle},
         With(&Tag::Title, u"Ärger"_s),
         With(&Tag::Title, u"Bach"_s)},
        {"Artist", {stArtist}, With(&Tag::Artist, u"a"_s), With(&Tag::Artist, u"B"_s)},
        {"Album", {stAlbum}, With(&Tag::Album, u"a"_s), With(&Tag::Album, u"B"_s)},
        {"Comment", {stComment}, With(&Tag::Comment, u""_s), With(&Tag::Comment, u"B"_s)},
        {"YearIsANumber", {stYear}, With(&Tag::Year, u"900"_s), With(&Tag::Year, u"1000"_s)},
        {"YearWithoutNumberIsZero", {stYear}, With(&Tag::Year, u"zzzz"_s), With(&Tag::Year, u"1"_s)},
        {"YearMayBeNegative", {stYear}, With(&Tag::Year, u"-5"_s), With(&Tag::Year, u"0"_s)},
        {"Length", {stLength}, With(&Tag::Length, 9), With(&Tag::Length, 10)},
        {"GenreByItsNumber", {stGenre}, With(&Tag::MainGenre, 13), With(&Tag::MainGenre, 14)},
        {"LocalPathBeforeCdPath",
         {stPath},
         With(&Tag::FileName, u"/z"_s),
         With(&Tag::FileName, u":00000001:\\a"_s)},
        {"PathIgnoresCase", {stPath}, With(&Tag::FileName, u"/A/x"_s), With(&Tag::FileName, u"/a/y"_s)},
        {"PlayCountBeyondSignedRange",
         {stPlayCnt},
         With(&Tag::PlayCount, 1),
         With(&Tag::PlayCount, 4'000'000'000)},
        {"AddTimeByLessThanADay", {stAddTime}, With(&Tag::AddTime, -0.5), With(&Tag::AddTime, 0.25)},
        {"FlagsAsAWhole",
         {stFlags},
         With(&Tag::Flags, sfBurned | sfDamaged),
         With(&Tag::Flags, sfLengthCorrect)},
        {"OnlyTheShownFlagCounts",
         {.SortType = stFlags, .ShownFlag = sfDamaged},
         With(&Tag::Flags, sfRemixed),
         With(&Tag::Flags, sfDamaged)},
        {"FileBeforeSongOfAnAbsentCd",
         {stCacheType},
         With(&Tag::FileName, u"/z"_s),
         With(&Tag::FileName, u":00000001:\\a"_s)},
        {"TieGenreBeforeArtist", {stYear, sstGATL}, With(&Tag::Artist, u"z"_s), With(&Tag::MainGenre, 6)},
        {"TieWithoutGenre",
         {stYear, sstATL},
         With(&Tag::MainGenre, 6, With(&Tag::Artist, u"a"_s)),
         With(&Tag::Artist, u"b"_s)},
        {"TieArtistBeforeTitle", {stYear, sstATL}, With(&Tag::Title, u"z"_s), With(&Tag::Artist, u"b"_s)},
        {"TieTitleBeforeLength", {stYear, sstATL}, With(&Tag::Length, 200), With(&Tag::Title, u"z"_s)},
        {"TieLengthLast", {stYear, sstGATL}, With(&Tag::FileName, u"/z"_s), With(&Tag::Length, 101)},
        {"TieByPathAlone", {stYear, sstPath}, With(&Tag::Title, u"z"_s), With(&Tag::FileName, u"/z"_s)}};
    for (auto [name, order, first, second] : cases) {
        SCOPED_TRACE(name);
        EXPECT_LT(CompareSongs(order, first, second), 0);
        EXPECT_GT(CompareSongs(order, second, first), 0);
        EXPECT_EQ(CompareSongs(order, first, first), 0);
        order.Backwards = true;
        EXPECT_GT(CompareSongs(order, first, second), 0);
    }
}

TEST(SortingTest, SongsThatDifferOnlyInCaseAreEqual) {
    const Tag a = With(&Tag::Title, u"Titel"_s, With(&Tag::Artist, u"Band"_s));
    const Tag b = With(&Tag::Title, u"TITEL"_s, With(&Tag::Artist, u"band"_s));
    EXPECT_EQ(CompareSongs({stTitle, sstGATL}, a, b), 0);
}

TEST(SortingTest, FullSortAgreesWithAStableSortByComparisonInEveryOrder) {
    std::mt19937 random(20);
    std::vector<TID3Tag> songs(1000);
    for (TID3Tag& song : songs)
        song = RandomSong(random);
    for (const SongOrder& order : AllOrders()) {
        SCOPED_TRACE(testing::Message() << "type " << order.SortType << ", sub type " << order.SubSortType
                                        << ", backwards " << order.Backwards);
        SongList list = ListOf(songs);
        auto entries = list.TakeAll();
        SortSongs(order, entries);
        list.PutAll(std::move(entries));
        auto expected = songs;
        std::stable_sort(expected.begin(), expected.end(), [&order](const TID3Tag& a, const TID3Tag& b) {
            return CompareSongs(order, a, b) < 0;
        });
        ASSERT_TRUE(Contents(list) == expected);
        EXPECT_TRUE(IsSorted(order, list));
        list.Move(0, 999);
        EXPECT_FALSE(IsSorted(order, list));
    }
}

TEST(SortingTest, TargetIsTheOneThatTheWalkMeetsFirst) {
    std::mt19937 random(4);
    for (int round = 0; round < 1500; ++round) {
        const SongOrder order{stPlayCnt, sstGATL, round % 2 == 1};
        const auto values = 1 + Below(random, 5);
        std::vector<TID3Tag> songs(1 + Below(random, 12));
        for (TID3Tag& song : songs)
            song.PlayCount = 1 + Below(random, values);
        std::sort(songs.begin(), songs.end(),
                  [&order](const TID3Tag& a, const TID3Tag& b) { return CompareSongs(order, a, b) < 0; });
        for (std::size_t i = 0; i < songs.size(); ++i) {
            for (quint32 count = 0; count <= values + 1; ++count) {
                auto changed = songs;
                changed[i].PlayCount = count;
                const SongList list = ListOf(changed);
                const auto index = static_cast<SongIndex>(i);
                ASSERT_EQ(TargetPosition(order, list, index), WalkedTarget(order, list, index))
                    << "round " << round << ", index " << i << ", new value " << count;
            }
        }
    }
}
