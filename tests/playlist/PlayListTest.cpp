#include "MusicManagment/playlist/PlayList.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/CollectionEdit.h"
#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

namespace {

class PlayListTest : public PlayingTest {
 protected:
    PlayListTest() {
        list_.OnChange = [this](TPlayList&, int index, TChangeType change) {
            changes_ << QString::number(index) + u'/' + QString::number(change);
        };
    }
    QString Changes() { return std::exchange(changes_, {}).join(u' '); }

    QStringList changes_;
};

TID3Tag SongOf(quint16 seconds) {
    TID3Tag song;
    song.Length = seconds;
    return song;
}

}  // namespace

TEST_F(PlayListTest, EntriesComeAndGoWithTheirEvents) {
    Add(u"ABC"_s);
    list_.Insert(-5, {.Name = Path(u"D"_s), .Record = SongOf(100)});
    list_.Insert(99, {.Name = Path(u"E"_s), .Record = SongOf(65'535)});
    EXPECT_EQ(Changes(), u"0/1 1/1 2/1 0/1 4/1"_s);
    EXPECT_EQ(Listed(), u"DABCE"_s);
    EXPECT_EQ(list_.TotalSeconds(), 65'635);
    EXPECT_EQ(list_.IndexOf(Path(u"B"_s)), 2);
    EXPECT_EQ(list_.IndexOf(), -1);

    list_.Remove({4, 1, 4, 7, -1});
    list_.Remove(5);
    EXPECT_EQ(Listed(), u"DBC"_s);
    EXPECT_EQ(Changes(), u"4/2 1/2"_s);
    EXPECT_EQ(list_.TotalSeconds(), 100);
    list_.Clear();
    EXPECT_EQ(Changes(), u"-1/2"_s);
    EXPECT_EQ(list_.TotalSeconds(), 0);
}

TEST_F(PlayListTest, MovedEntriesKeepTheirOrderAndComeBeforeTheOneAimedAt) {
    struct Case {
        std::vector<int> Indices;
        int Before;
        QString Outcome;
        int First;
    };
    const Case cases[] = {
        {{0}, 6, u"BCDEFA"_s, 5},     {{5}, 0, u"FABCDE"_s, 0},        {{4, 1, 1}, 3, u"ACBEDF"_s, 2},
        {{1, 2}, 2, u"ABCDEF"_s, 1},  {{0, 9, -1}, 1, u"ABCDEF"_s, 0}, {{3}, 99, u"ABCEFD"_s, 5},
        {{2, 3}, -4, u"CDABEF"_s, 0}, {{}, 3, u"ABCDEF"_s, 3},
    };
    for (const Case& move : cases) {
        list_.Clear();
        Add(u"ABCDEF"_s);
        EXPECT_EQ(list_.Move(move.Indices, move.Before), move.First) << move.Outcome.toStdString();
        EXPECT_EQ(Listed(), move.Outcome);
    }
}

TEST_F(PlayListTest, ASongOfTheDatabaseNeedsOne) {
    EXPECT_THROW(list_.InsertSong(0, 0), EPlayListException);
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    database.AddEntry(folder_.Add(u"x.wav"_s), SongOf(7));
    Add(u"A"_s);
    Changes();
    list_.InsertSong(1, 0);
    EXPECT_EQ(Changes(), u"1/1"_s);
    EXPECT_EQ(list_.Entry(1).Name, Path(u"x"_s));
    EXPECT_EQ(list_.Entry(1).Record, database.Song(0));
    for (const int none : {-1, 1})
        EXPECT_THROW(list_.InsertSong(0, none), EMusicDatabaseException);
}

TEST_F(PlayListTest, EntriesQueueAndHistoryFollowTheirSongsToOtherPathsAndBack) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    for (const QString& song : {u"a"_s, u"b"_s, u"c"_s})
        database.AddEntry(folder_.Add(song + u".wav"_s), SongOf(7));
    Add(u"abca"_s);
    list_.PlayEntry(0);
    list_.PlayEntry(1);
    list_.Enqueue(2);
    list_.Enqueue(3);
    list_.Save(folder_.Path(u"list.m3u"_s));
    list_.SetStandardFileName(list_.PlayListFileName());

    CollectionEdit edit(database);
    const auto rename = [&](const QString& from, const QString& to) {
        TID3Tag renamed = *database.Songs().Find(Path(from));
        const SongHandle song = database.Songs().HandleOf(*database.Songs().Find(Path(from)));
        renamed.FileName = Path(to);
        edit.Change(song, renamed);
    };
    rename(u"b"_s, u"c"_s);  // these two swap
    rename(u"c"_s, u"b"_s);
    rename(u"a"_s, u"x"_s);
    Changes();
    ASSERT_TRUE(edit.Commit());
    EXPECT_EQ(Listed(), u"xcbx"_s);
    EXPECT_EQ(Changes().split(u' ').size(), 4);
    EXPECT_EQ(list_.Entry(3).Record, *database.Songs().Find(Path(u"x"_s)));
    EXPECT_EQ(Names(list_.Queue()), u"bx"_s);
    EXPECT_EQ(Names(list_.History()), u"cx"_s);
    EXPECT_EQ(Current(), u"c"_s);
    EXPECT_EQ(list_.CurrentFile(), Path(u"c"_s));
    EXPECT_FALSE(list_.Modified());  // the standard file is written anyway

    list_.SetStandardFileName(QString());
    CollectionEdit back(database);
    back.TakeBack(edit.Done());
    ASSERT_TRUE(back.Commit());
    EXPECT_EQ(Listed(), u"abca"_s);
    EXPECT_EQ(Names(list_.History()), u"ba"_s);
    EXPECT_TRUE(list_.Modified());
}

TEST_F(PlayListTest, WhatHasNoFileLeaves) {
    Add(u"aBcD"_s);
    list_.Insert(0, {.Name = u"http://radio.example/live"_s});
    list_.Insert(0, {.Name = u":00000001:\\a.mp3"_s});
    Changes();
    EXPECT_EQ(list_.RemoveUnavailable(), 4);
    EXPECT_EQ(Listed(), u"ac"_s);
    EXPECT_EQ(Changes(), u"5/2 3/2 1/2 0/2"_s);
}

TEST_F(PlayListTest, WhoIsToldOfARemovalMayEmptyTheList) {
    Add(u"ABCD"_s);
    list_.OnChange = [](TPlayList& list, int index, TChangeType) {
        if (index == 3) list.Clear();
    };
    EXPECT_EQ(list_.RemoveUnavailable(), 4);
    EXPECT_EQ(list_.Count(), 0);
}

TEST_F(PlayListTest, MarkingGoesToTheDatabase) {
    TMusicDatabase database;
    database.AddEntry(folder_.Add(u"b.wav"_s), TID3Tag());
    QList<int> marked;
    database.OnMarkSong = [&](TMusicDatabase&, SongIndex index) { marked << index; };
    Add(u"ab"_s);
    EXPECT_FALSE(list_.MarkSong(1));
    list_.SetMusicDatabase(&database);
    EXPECT_FALSE(list_.MarkSong());  // no view that has a current entry
    EXPECT_FALSE(list_.MarkSong(0));
    EXPECT_TRUE(list_.MarkSong(1));
    ScriptedView view;
    view.Current = 1;
    list_.SetView(&view);
    EXPECT_TRUE(list_.MarkSong());
    EXPECT_EQ(marked, (QList<int>{0, 0}));
}

TEST_F(PlayListTest, EachSideForgetsTheOtherWhenItGoes) {
    auto database = std::make_unique<TMusicDatabase>();
    {
        TPlayList list;
        list.SetMusicDatabase(database.get());
        EXPECT_EQ(database->PlayList(), &list);
        EXPECT_EQ(database->SettingsClients().size(), 1u);
    }
    EXPECT_EQ(database->PlayList(), nullptr);
    EXPECT_TRUE(database->SettingsClients().empty());
    list_.SetMusicDatabase(database.get());
    database.reset();
    EXPECT_EQ(list_.MusicDatabase(), nullptr);
    Add(u"a"_s);
    EXPECT_TRUE(list_.PlayEntry(0));
}
