#include "app/models/CollectionTotals.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

TEST(CollectionTotals, FollowInsertionsChangesAndRemovals) {
    TMusicDatabase database;
    CollectionTotals totals(database);
    EXPECT_EQ(totals.Text(), u"0 Songs, Spielzeit 0:00"_s);
    AddSong(database, u"A"_s, 65);
    EXPECT_EQ(totals.Text(), u"1 Song, Spielzeit 1:05"_s);
    AddSong(database, u"B"_s, 3600);
    EXPECT_EQ(totals.Text(), u"2 Songs, Spielzeit 1:01:05"_s);

    database.UpdateEntry(0, CdSong(u"A"_s, 5));
    EXPECT_EQ(totals.Seconds(), 3605);
    database.RemoveEntry(1);
    EXPECT_EQ(totals.Seconds(), 5);
    for (int i = 0; i < 1200; ++i)
        AddSong(database, u"C%1"_s.arg(i), 144);
    EXPECT_EQ(totals.Text(), u"1.201 Songs, Spielzeit 2 Tage 0:05"_s);
    database.Clear();
    EXPECT_EQ(totals.Seconds(), 0);
}

}  // namespace
