#include <gtest/gtest.h>

#include <QFile>

#include "MusicManagment/database/batches/BurningBatch.h"
#include "MusicManagment/database/batches/CacheBatch.h"
#include "MusicManagment/database/intake/BackupCd.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// Copies of songs on media, and for new ones.

namespace {

class MediaBatchTest : public testing::Test {
 protected:
    MediaBatchTest() {
        database_.SetMP3MoveRootDir(disk_.Path(u"root"_s));
        database_.SetModernMedia(true);
    }
    void TakeInStick(const QStringList& names) {
        stick_.Add(names);
        volumes_.Mount(stick_.Path(), 7, u"STICK"_s);
        CatalogueMedium(database_, stick_.Path());
        AddPaths(database_, {stick_.Path()}, true);
    }
    void TakeInDisk(const QStringList& names) {
        for (const QString& name : names)
            AddPaths(database_, {disk_.Add(name)}, true);
    }
    QString PlayedFrom(const QString& name) {
        return database_.ResolveSongPath(u":00000007:\\"_s + name, {.Ask = false});
    }

    SongFolder stick_, disk_;
    ScriptedVolumes volumes_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
};

}  // namespace

TEST_F(MediaBatchTest, SongsAreCopiedOnceAndOnlyOurCopiesAreRemoved) {
    TakeInStick({u"A - gone.wav"_s, u"A - one.wav"_s, u"A - there.wav"_s, u"A - two.wav"_s});
    const QString one = disk_.Path(u"root/Unsorted/A - one.wav"_s);
    const QString two = disk_.Path(u"root/Unsorted/A - two.wav"_s);
    disk_.Put(u"root/Unsorted/A - there.wma"_s, QByteArray("mine"));
    QFile::remove(stick_.Path(u"A - gone.wav"_s));
    QFile::setPermissions(stick_.Path(u"A - one.wav"_s), QFile::ReadOwner);
    const QString file = disk_.Path(u"x.tsdb"_s);
    database_.SaveDatabase(file);

    dialogs_.Answers = {0, 0};  // enough room; go on after the one that is gone
    const MediaBatchResult cached = CacheSongs(database_, AllSongs(database_));
    EXPECT_EQ(cached.Done, 2);
    ASSERT_EQ(dialogs_.Questions.size(), 2);
    EXPECT_EQ(dialogs_.Questions[1], u"Die Datei "_s + stick_.Path(u"A - gone.wav"_s) +
                                         u" konnte nicht gecachet werden. Trotzdem fortfahren?"_s);
    EXPECT_EQ(PlayedFrom(u"A - one.wav"_s), one);  // also while the medium is there
    volumes_.Unmount();
    EXPECT_EQ(PlayedFrom(u"A - two.wav"_s), two);
    EXPECT_EQ(PlayedFrom(u"A - there.wav"_s), disk_.Path(u"root/Unsorted/A - there.wma"_s));
    EXPECT_EQ(FileWithinReach(database_, u":00000007:\\A - one.wav"_s), one);
    EXPECT_EQ(FileWithinReach(database_, u":00000007:\\A - gone.wav"_s), QString());
    EXPECT_TRUE(QFileInfo(one).isWritable());
    EXPECT_EQ(AddPaths(database_, {one, two}, true).Known, 2);

    // Noted at once, the copies are known after a restart, and by other tags.
    TMusicDatabase restarted;
    restarted.SetMP3MoveRootDir(disk_.Path(u"root"_s));
    restarted.OpenDatabase(file);
    TID3Tag song = restarted.GetEntry(-1, u":00000007:\\A - two.wav"_s);
    song.Title = u"zwei"_s;
    restarted.UpdateEntry(restarted.IndexOf(song.FileName), song);
    EXPECT_EQ(restarted.ResolveSongPath(song.FileName), two);
    song.FileName = one;
    restarted.AddEntry(one, song);  // a song of its own now
    EXPECT_EQ(DropCaches(restarted, AllSongs(restarted)).Done, 2);
    EXPECT_TRUE(QFile::exists(one));
    EXPECT_FALSE(QFile::exists(two));
    EXPECT_EQ(disk_.Get(u"root/Unsorted/A - there.wma"_s), "mine");
    EXPECT_EQ(DropCaches(restarted, AllSongs(restarted)).Done, 0);
}

TEST_F(MediaBatchTest, AMediumThatIsNotPutInIsAskedForOnce) {
    TakeInStick({u"A - one.wav"_s, u"A - two.wav"_s});
    volumes_.Unmount();
    dialogs_.Answers = {0};
    const MediaBatchResult result = CacheSongs(database_, AllSongs(database_));
    EXPECT_EQ(result.Missing.size(), 2);
    EXPECT_EQ(dialogs_.Prompts.size(), 1);
    EXPECT_FALSE(QFile::exists(disk_.Path(u"root"_s)));
}

TEST_F(MediaBatchTest, BurningTakesSongsOfMediaAsTheUserAnswers) {
    struct Case {
        std::deque<int> Answers;  // after the one about the room
        QStringList Taken;
        qsizetype Asked;
    };
    TakeInStick({u"A - 1.wav"_s, u"A - 2.wav"_s, u"A - 3.wav"_s});
    TakeInDisk({u"B - 4.wav"_s});
    database_.SetOrder({.SortType = stTitle});
    const std::vector<Case> cases = {{{0, 2, 0}, {u"A - 1.wav"_s, u"A - 3.wav"_s, u"B - 4.wav"_s}, 3},
                                     {{2, 1}, {u"A - 2.wav"_s, u"A - 3.wav"_s, u"B - 4.wav"_s}, 2},
                                     {{0, 3}, {u"A - 1.wav"_s, u"B - 4.wav"_s}, 2},
                                     {{0, 4}, {u"A - 1.wav"_s}, 2}};
    for (std::size_t i = 0; i < cases.size(); ++i) {
        const QString folder = disk_.Path(u"burn%1"_s.arg(i));
        dialogs_.Questions.clear();
        dialogs_.Answers = cases[i].Answers;
        dialogs_.Answers.push_front(0);
        const MediaBatchResult result = PrepareBurning(database_, AllSongs(database_), folder);
        EXPECT_EQ(QDir(folder).entryList(QDir::Files, QDir::Name), cases[i].Taken) << i;
        EXPECT_EQ(result.Done, cases[i].Taken.size()) << i;
        EXPECT_EQ(result.Stopped, i == 3) << i;
        EXPECT_EQ(dialogs_.Questions.size(), cases[i].Asked + 1) << i;
    }
    EXPECT_EQ(dialogs_.Questions[1],
              u"Die Datei A - 1 befindet sich bereits auf einer CD. Soll sie dennoch in die Liste der zu "
              "brennenden Dateien aufgenommen werden?"_s);
}

TEST_F(MediaBatchTest, AFileOfABackupCdIsTiedToTheSongThatItIs) {
    TakeInDisk({u"m/Queen - Jealousy.wav"_s, u"m/Queen - Jealous Guy.wav"_s, u"m/Abba - Fernando.wav"_s});
    stick_.Add(u"Queen - Jealousy.wav"_s, 10);  // another length
    stick_.Add({u"Queen - Jealosy.wav"_s, u"Neu - Ganz anders.wav"_s});
    volumes_.Mount(stick_.Path(), 7, u"BACKUP"_s, 0);
    const QString own = disk_.Path(u"m/Queen - Jealousy.wav"_s);

    dialogs_.Answers = {0};  // what is like no song is new
    dialogs_.Inputs = {u"BACKUP ("_s + stick_.Path() + u')', u"Sicherung"_s,
                       u"093%: Queen - Jealousy (***)"_s, u"Überspringen"_s};
    const BackupResult result = ReadBackupCd(database_);
    EXPECT_EQ(result.Tied, 1);
    EXPECT_EQ(result.Added, 1);
    EXPECT_FALSE(result.Stopped);
    const TID3Tag tied = database_.GetEntry(-1, u":00000007:\\Queen - Jealosy.wav"_s);
    EXPECT_EQ(tied.Title, u"Jealousy"_s);
    EXPECT_TRUE(QFile::exists(own));
    EXPECT_FALSE(database_.Contains(own));
    EXPECT_TRUE(database_.Contains(u":00000007:\\Neu - Ganz anders.wav"_s));
    EXPECT_EQ(database_.CDNameOf(tied.FileName), u"Sicherung"_s);
}

TEST_F(MediaBatchTest, NoSongOfABatchReplacesAnotherOrItself) {
    TakeInDisk({u"root/Rap/A - 1.wav"_s, u"x/B - 2.wav"_s, u"y/B - 2.wav"_s, u"burn/C - 3.wav"_s});
    disk_.Put(u"burn/Rap/A - 1.wav"_s, QByteArray("old"));
    dialogs_.Answers = {0};
    const MediaBatchResult result = PrepareBurning(database_, AllSongs(database_), disk_.Path(u"burn/"_s));
    EXPECT_EQ(result.Done, 3);
    EXPECT_TRUE(result.Failed.isEmpty());
    EXPECT_EQ(QDir(disk_.Path(u"burn"_s)).entryList(QDir::Files, QDir::Name),
              (QStringList{u"B - 2 (2).wav"_s, u"B - 2.wav"_s, u"C - 3.wav"_s}));
    EXPECT_EQ(disk_.Get(u"burn/Rap/A - 1.wav"_s), disk_.Get(u"root/Rap/A - 1.wav"_s));
}
