#include "app/models/DuplicateListModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <algorithm>
#include <random>

#include "MusicManagment/database/duplicates/KeptPairs.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

TEST(RowSorting, SlicesOfAnySizeGiveTheOrderOfAStableSortGroupByGroup) {
    std::mt19937 random(7);
    std::vector<std::uint32_t> keys(3000);
    for (auto& key : keys)
        key = static_cast<std::uint32_t>(random() % 500) * 70'001;  // both halves, and equal ones
    RowSorting sorting({.Rows = keys.size(),
                        .SongCount = 4 * keys.size(),
                        .Passes = [](std::uint32_t row) { return row % 3 != 0; },
                        .Key = [&](std::uint32_t row) { return keys[row]; },
                        // A chain for each remainder of 15.
                        .Songs = [](std::uint32_t row) { return std::pair(row + 15, row); },
                        .InGroups = true});
    while (sorting.Work(1 + random() % 50)) {
    }
    std::vector<std::uint32_t> expected;
    for (std::uint32_t row = 0; row < keys.size(); ++row)
        if (row % 3 != 0) expected.push_back(row);
    std::ranges::stable_sort(expected, {}, [&](std::uint32_t row) { return keys[row]; });
    // Ten of them have rows.
    std::vector<std::uint32_t> first(15, RowSorting::kNoGroup);
    std::uint32_t groups = 0;
    for (const std::uint32_t row : expected)
        if (first[row % 15] == RowSorting::kNoGroup) first[row % 15] = groups++;
    std::ranges::stable_sort(expected, {}, [&](std::uint32_t row) { return first[row % 15]; });
    EXPECT_EQ(groups, 10u);
    EXPECT_EQ(sorting.TakeRows(), expected);
    const auto groupOfSong = sorting.TakeGroups();
    EXPECT_EQ(groupOfSong[expected.front()], 0u);
    EXPECT_EQ(groupOfSong[0], RowSorting::kNoGroup);
}

class DuplicateListModelTest : public testing::Test {
 protected:
    DuplicateListModelTest() {
        database_.SetSortType(stTitle);
        int seconds = 300;
        for (const QString& title :
             {u"aaaaaaaa"_s, u"aaaaaaab"_s, u"aaaaaabb"_s, u"zzzzzzzz"_s, u"zzzzzzzy"_s})
            AddSong(database_, title, seconds -= 40);
        FindDuplicates(database_, {.LeastPercent = 80}, model_.Begin(false),
                       [this] { model_.TakeNewRows(); });
        model_.EndSearch();
    }
    // The last letters of the titles, pair by pair.
    QString Shown() const {
        QStringList pairs;
        for (int row = 0; row < model_.rowCount(); ++row)
            pairs << Cell(row, DuplicateListModel::Title1).right(2) +
                         Cell(row, DuplicateListModel::Title2).right(2);
        return pairs.join(u' ');
    }
    QString Cell(int row, int column) const { return model_.index(row, column).data().toString(); }
    QString Shown(DuplicateChoice choice) {
        model_.SetChoice(std::move(choice));
        model_.FinishWork();
        return Shown();
    }
    const TID3Tag& Song(const QString& title) const {
        return *database_.Songs().Find(CdSong(title).FileName);
    }

    TMusicDatabase database_;
    DuplicateListModel model_{database_};
    QAbstractItemModelTester tester_{&model_, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(DuplicateListModelTest, PairsAreChosenSortedAndGrouped) {
    EXPECT_EQ(Shown(), u"aaab aabb abbb zyzz"_s);
    EXPECT_EQ(Cell(0, DuplicateListModel::Title1), u"[CD]  - aaaaaaaa"_s);
    EXPECT_EQ(Cell(3, DuplicateListModel::Length1), u"1:40"_s);
    EXPECT_EQ(Shown({.LeastPercent = 90}), u"aaab abbb zyzz"_s);
    EXPECT_EQ(Shown({.Filter = SongFilter::Parse(u"aaaaaabb")}), u"aabb abbb"_s);
    model_.sort(DuplicateListModel::Title2, Qt::DescendingOrder);
    EXPECT_EQ(Shown({}), u"zyzz aabb abbb aaab"_s);
    model_.sort(DuplicateListModel::Length2);
    EXPECT_EQ(Shown({.InGroups = true}), u"zyzz aabb abbb aaab"_s);
    EXPECT_EQ(Cell(1, DuplicateListModel::Group), u"2 (3 Songs)"_s);
}

TEST_F(DuplicateListModelTest, RowsGoWithTheirSongsAndComeBackWithThem) {
    const TID3Tag gone = Song(u"aaaaaaab"_s);
    database_.RemoveEntry(database_.Songs().PositionOf(Song(u"aaaaaaab"_s)));
    model_.FinishWork();
    EXPECT_EQ(Shown(), u"aabb zyzz"_s);
    database_.AddEntry(QString(), gone);
    model_.FinishWork();
    EXPECT_EQ(Shown(), u"aaab aabb abbb zyzz"_s);
    SetKeptPair(database_, Song(u"aaaaaabb"_s), gone, true);
    model_.NotePairs();
    EXPECT_EQ(Shown({}), u"aaab aabb zyzz"_s);
    EXPECT_EQ(Shown({.WithKeptPairs = true}), u"aaab aabb abbb zyzz"_s);
    EXPECT_TRUE(model_.IsKeptPair(2));
    database_.Clear();
    EXPECT_EQ(model_.rowCount(), 0);
}

}  // namespace
