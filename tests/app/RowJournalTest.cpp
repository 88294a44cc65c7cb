#include "app/models/RowJournal.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <numeric>
#include <random>

namespace {

// The list that the journal stands for: the old row of each entry, -1 for a new one.
class PlainRows {
 public:
    explicit PlainRows(int count) : rows_(static_cast<std::size_t>(count)) {
        std::iota(rows_.begin(), rows_.end(), 0);
    }
    int Count() const { return static_cast<int>(rows_.size()); }
    void Insert(int row, int value = -1) { rows_.insert(rows_.begin() + row, value); }
    int Remove(int row) {
        const int value = rows_[static_cast<std::size_t>(row)];
        rows_.erase(rows_.begin() + row);
        return value;
    }
    int PlaceOf(int oldRow) const {
        const auto found = std::ranges::find(rows_, oldRow);
        return found != rows_.end() ? static_cast<int>(found - rows_.begin()) : -1;
    }

 private:
    std::vector<int> rows_;
};

int Pick(std::mt19937& random, int count) {
    return std::uniform_int_distribution<int>(0, count - 1)(random);
}

void ChangeBoth(std::mt19937& random, RowJournal& journal, PlainRows& plain) {
    const int kind = plain.Count() < 2 ? 0 : Pick(random, 4);
    if (kind <= 1) {
        const int row = Pick(random, plain.Count() + 1);
        journal.Insert(row);
        plain.Insert(row);
    } else if (kind == 2) {
        const int row = Pick(random, plain.Count());
        journal.Remove(row);
        plain.Remove(row);
    } else {
        const int from = Pick(random, plain.Count());
        const int to = Pick(random, plain.Count());
        journal.Move(from, to);
        plain.Insert(to, plain.Remove(from));
    }
}

TEST(RowJournal, FindsEveryOldRowAfterAnyChanges) {
    std::mt19937 random(4711);
    for (int oldCount : {0, 1, 2, 30}) {
        for (int round = 0; round < 200; ++round) {
            RowJournal journal;
            journal.Start(oldCount);
            PlainRows plain(oldCount);
            for (int change = 0; change < 20; ++change)
                ChangeBoth(random, journal, plain);
            ASSERT_EQ(journal.NewCount(), plain.Count());
            bool stay = true;
            for (int row = 0; row < oldCount; ++row) {
                ASSERT_EQ(journal.NewRowOf(row), plain.PlaceOf(row)) << "round " << round << " row " << row;
                stay = stay && plain.PlaceOf(row) == row;
            }
            ASSERT_EQ(journal.OldRowsStay(), stay);
            ASSERT_EQ(journal.NewRowOf(oldCount), -1);
        }
    }
}

TEST(RowJournal, NeighbouringInsertionsStaySmall) {
    RowJournal journal;
    journal.Start(100);
    for (int i = 0; i < 1000; ++i)
        journal.Insert(50 + i / 2);
    EXPECT_LE(journal.Size(), 3u);
    journal.Start(journal.NewCount());
    EXPECT_TRUE(journal.Empty());
}

}  // namespace
