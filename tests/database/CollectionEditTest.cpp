#include "MusicManagment/database/CollectionEdit.h"

#include <gtest/gtest.h>

#include <random>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// Follows a collection by what it tells alone.
class Mirror {
 public:
    explicit Mirror(TMusicDatabase& database) : database_(database) {
        CollectionEvents& events = database.Events();
        subscriptions_ += events.Inserted.Subscribe(
            [this](SongIndex at) { Songs.insert(Songs.begin() + at, database_.Song(at)); });
        subscriptions_ += events.Removed.Subscribe([this](SongIndex at, const TID3Tag& record) {
            EXPECT_TRUE(Songs[static_cast<std::size_t>(at)] == record);
            Songs.erase(Songs.begin() + at);
        });
        subscriptions_ += events.Moved.Subscribe([this](SongIndex from, SongIndex to) {
            const TID3Tag song = Songs[static_cast<std::size_t>(from)];
            Songs.erase(Songs.begin() + from);
            Songs.insert(Songs.begin() + to, song);
        });
        subscriptions_ +=
            events.Changed.Subscribe([this](SongIndex at, const TID3Tag& before, const TID3Tag& after) {
                TID3Tag& song = Songs[static_cast<std::size_t>(at)];
                EXPECT_TRUE(song == before);
                song = after;
            });
        subscriptions_ +=
            events.Renamed.Subscribe([this](const PathChanges& paths) { Renamed << paths.values(); });
        subscriptions_ += events.Reordered.Subscribe([this] { Songs = Contents(); });
    }
    std::vector<TID3Tag> Contents() const {
        std::vector<TID3Tag> songs;
        for (const auto& song : database_.Songs())
            songs.push_back(*song);
        return songs;
    }

    std::vector<TID3Tag> Songs;
    QStringList Renamed;

 private:
    TMusicDatabase& database_;
    Subscriptions subscriptions_;
};

class CollectionEditTest : public testing::Test {
 protected:
    int Below(int limit) { return static_cast<int>(random_() % static_cast<unsigned>(limit)); }
    TID3Tag RandomSong() {
        TID3Tag song;
        song.FileName = u":00000001:\\"_s + QString::number(++paths_);
        song.Artist = QString::number(Below(5));
        song.Album = QString::number(Below(3));
        song.Title = QString::number(Below(30));
        song.MainGenre = static_cast<quint8>(Below(4));
        song.AddTime = 40'000;
        return song;
    }
    SongHandle Pick() { return database_.Songs().HandleOf(Below(database_.Count())); }

    std::mt19937 random_{7};
    int paths_ = 0;
    TMusicDatabase database_;
    Mirror mirror_{database_};
};

}  // namespace

// Small edits are placed song by song, large ones together; listeners, order, counts and the way back agree.
TEST_F(CollectionEditTest, EditsAreToldKeepTheOrderAndCanBeTakenBack) {
    for (int i = 0; i < 200; ++i)
        database_.AddEntry(QString(), RandomSong());
    for (int round = 0; round < 60; ++round) {
        SCOPED_TRACE(round);
        const auto before = mirror_.Contents();
        CollectionEdit edit(database_);
        const int steps = round % 3 == 0 ? 120 : 6;
        for (int i = 0; i < steps; ++i) {
            const SongHandle song = Pick();
            const int kind = Below(8);
            if (kind == 0) {
                edit.Remove(song);
            } else if (kind == 1) {
                edit.Add(RandomSong());
            } else if (kind == 2) {
                TID3Tag renamed = *database_.Songs().Find(song);
                renamed.FileName = u":00000002:\\"_s + QString::number(++paths_);
                edit.Change(song, renamed);
            } else {
                TID3Tag changed = RandomSong();
                changed.FileName = database_.Songs().Find(song)->FileName;
                edit.Change(song, changed);
            }
        }
        ASSERT_TRUE(edit.Commit());
        ASSERT_TRUE(mirror_.Songs == mirror_.Contents());
        ASSERT_TRUE(IsSorted(database_.Order(), database_.Songs()));
        int counted = 0;
        for (int row = 0; row < database_.Groups().RowCount(ovAlbum); ++row)
            counted += database_.Groups().RowSongCount(ovAlbum, row);
        EXPECT_EQ(counted, database_.Count());

        if (round % 2 == 0) continue;
        CollectionEdit back(database_);
        EXPECT_EQ(back.TakeBack(edit.Done()), 0);
        ASSERT_TRUE(back.Commit());
        auto after = mirror_.Contents();
        EXPECT_TRUE(std::is_permutation(after.begin(), after.end(), before.begin(), before.end()));
    }
    EXPECT_FALSE(mirror_.Renamed.isEmpty());
}

TEST_F(CollectionEditTest, WhatHasGoneOrChangedSinceIsLeftAlone) {
    for (int i = 0; i < 3; ++i)
        database_.AddEntry(QString(), RandomSong());
    const SongHandle gone = database_.Songs().HandleOf(0);
    const SongHandle played = database_.Songs().HandleOf(1);
    CollectionEdit edit(database_);
    for (const SongHandle song : {gone, played}) {
        TID3Tag changed = *database_.Songs().Find(song);
        changed.Comment = u"neu"_s;
        edit.Change(song, changed);
    }
    ASSERT_TRUE(database_.RemoveEntry(0));
    ASSERT_TRUE(edit.Commit());
    ASSERT_EQ(edit.Done().size(), 1u);
    EXPECT_EQ(database_.Songs().PositionOf(gone), -1);

    TID3Tag counted = *database_.Songs().Find(played);
    counted.PlayCount = 5;
    database_.UpdateEntry(database_.Songs().PositionOf(played), counted);
    CollectionEdit back(database_);
    EXPECT_EQ(back.TakeBack(edit.Done()), 0) << "being played is no change of a song";
    ASSERT_TRUE(back.Commit());
    EXPECT_EQ(database_.Songs().Find(played)->Comment, QString());
    EXPECT_EQ(database_.Songs().Find(played)->PlayCount, 5u);

    database_.BeginBusy();
    back.Remove(played);
    EXPECT_FALSE(back.Commit());
    database_.EndBusy();
}
