#include "MusicManagment/database/BannList.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/MusicManagment.h"
#include "tests/PrintQt.h"
#include "tests/database/Listing.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class BannListTest : public testing::Test {
 protected:
    SongFolder folder_;
    QString path_ = folder_.Path(u"Tunestead3_BannList.str"_s);
    SortedTextList list_;
};

TEST_F(BannListTest, TakesAnyLineEndAndBothCodePages) {
    struct Case {
        QByteArray Text;
        QStringList Entries;
    };
    const Case cases[] = {{"A - 1\r\nB - 2\r\n", {u"A - 1"_s, u"B - 2"_s}},
                          {"A - 1\nB - 2", {u"A - 1"_s, u"B - 2"_s}},
                          {"\rB - 2\r\r\n\nA - 1", {u"A - 1"_s, u"B - 2"_s}},
                          {"A - 1\r\nA - 1\r\n", {u"A - 1"_s}},
                          {" - \r\nA - 1 \r\n", {u" - "_s, u"A - 1 "_s}},
                          {"\xEF\xBB\xBF\xC3\x84 - 1", {u"Ä - 1"_s}},
                          {"A - \xC4\r\nB - \xC3\x84", {u"A - Ä"_s, u"B - Ä"_s}},
                          {"\r\n", {}},
                          {"", {}}};
    for (const Case& each : cases) {
        folder_.Put(u"Tunestead3_BannList.str"_s, each.Text);
        LoadBannList(list_, path_);
        EXPECT_EQ(TextsOf(list_), each.Entries) << each.Text.toStdString();
    }
}

TEST_F(BannListTest, AFileThatCannotBeReadOrWrittenLeavesEverythingAsItWas) {
    list_.Insert(u"A - 1"_s);
    EXPECT_THROW(LoadBannList(list_, path_), EStreamError);
    EXPECT_THROW(LoadBannList(list_, folder_.Path()), EStreamError);
    EXPECT_EQ(list_.Count(), 1);
    EXPECT_THROW(SaveBannList(list_, folder_.Path(u"missing/list.str"_s)), EStreamError);
}

// A tag may hold a line break, a line of the file cannot.
TEST_F(BannListTest, ASongWithALineBreakStaysBannedAfterLoading) {
    TID3Tag song;
    song.Artist = u"Two\r\nLines"_s;
    song.Title = u"Title\n"_s;
    list_.Insert(BanEntry(song));
    SaveBannList(list_, path_);
    TMusicDatabase database;
    LoadBannList(database.BannList(), path_);
    EXPECT_EQ(database.BannList().Count(), 1);
    EXPECT_TRUE(database.IsBanned(song));
}

}  // namespace
