#include <gtest/gtest.h>

#include <QFile>

#include "MusicManagment/database/CollectionEdit.h"
#include "MusicManagment/database/batches/BurningBatch.h"
#include "MusicManagment/database/batches/CacheBatch.h"
#include "MusicManagment/database/batches/MediaCommands.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/intake/Update.h"
#include "MusicManagment/database/intake/UpdateFolders.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// Songs on media that can be taken away.

namespace {

constexpr quint32 kSerial = 0x1A2B3C4D;

QString OnStick(const QString& path) {
    return u":1A2B3C4D:\\"_s + path;
}

class MediaTest : public testing::Test {
 protected:
    MediaTest() { database_.SetMP3MoveRootDir(disk_.Path(u"root"_s)); }
    // Catalogues the stick and takes its songs in.
    void TakeInStick(const QStringList& names) {
        stick_.Add(names);
        volumes_.Mount(stick_.Path(), kSerial, u"STICK"_s);
        CatalogueMedium(database_, stick_.Path());
        ASSERT_EQ(AddPaths(database_, {stick_.Path()}, true).Added, names.size());
    }
    QString Found(const QString& path, bool useCache = false) {
        return database_.ResolveSongPath(path, {.Ask = false, .UseCache = useCache});
    }
    IntakeResult AddStick() { return AddFolder(database_, stick_.Path(), true); }

    SongFolder stick_, disk_;
    ScriptedVolumes volumes_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
};

const QString kSong = OnStick(u"a\\Band - Lied.wav"_s);

}  // namespace

TEST_F(MediaTest, OneDriveIsLookedAtOrAll) {
    int redraws = 0;
    const auto changes = database_.Events().MediaChanged.Subscribe([&] { ++redraws; });
    volumes_.Mount(u"/stick"_s, 7);
    volumes_.Mount(u"/cd"_s, kSerial, {}, 0);
    volumes_.Mount(u"/dvd"_s, 9, {}, 0);
    EXPECT_EQ(Found(kSong), u"/cd/a/Band - Lied.wav"_s);
    EXPECT_EQ(Found(u":00000009:\\x.mp3"_s), QString());
    EXPECT_EQ(redraws, 1);
    volumes_.Now[1].Serials = {7};  // another disc in the drive
    EXPECT_EQ(Found(kSong), QString());
    EXPECT_EQ(Found(u":00000007:\\x.mp3"_s), u"/cd/x.mp3"_s);
    database_.SetModernMedia(true);
    EXPECT_EQ(Found(u":00000009:\\x.mp3"_s), u"/dvd/x.mp3"_s);
    EXPECT_EQ(redraws, 2);
}

TEST_F(MediaTest, WhatIsNoSerialNumberIsFoundNowhere) {
    database_.SetModernMedia(true);
    volumes_.Mount(u"/cd"_s, kSerial, {}, 0);
    volumes_.Mount(u"/null"_s, 0, {}, 0);
    database_.SetCDNames({{u"Rock"_s, kSerial}});
    for (const QString& path :
         {u":1A2B3C4:\\a.mp3"_s, u":+1A2B3C4:\\a.mp3"_s, u":00000000:\\a.mp3"_s, u":"_s}) {
        EXPECT_EQ(Found(path), QString()) << qPrintable(path);
        EXPECT_EQ(database_.CDNameOf(path), path);
    }
    EXPECT_EQ(Found(u":1a2b3c4d:\\..\\b\\..\\a.mp3"_s), u"/cd/b/a.mp3"_s);
    EXPECT_EQ(database_.CDNameOf(kSong), u"Rock"_s);
    EXPECT_EQ(database_.CDNameOf(u"/x.mp3"_s), u"/x.mp3"_s);
}

TEST_F(MediaTest, TheUserSaysWhereAMediumIs) {
    volumes_.Mount(u"/media/b"_s, kSerial, u"ROCK"_s);
    volumes_.Mount(u"/media/a"_s, 7);
    dialogs_.Inputs = {u"/media/a"_s, u"ROCK (/media/b)"_s};
    EXPECT_EQ(database_.ResolveSongPath(kSong), u"/media/b/a/Band - Lied.wav"_s);
    EXPECT_EQ(dialogs_.Prompts, QStringList(2, u"Bitte legen Sie die passende CD ins CD-Laufwerk:"_s));
    EXPECT_EQ(database_.ResolveSongPath(u":00000008:\\x"_s), QString());  // cancelled
    EXPECT_EQ(Found(kSong), u"/media/b/a/Band - Lied.wav"_s);             // the drive stays known
}

TEST_F(MediaTest, AnIntakeKnowsTheSongsOfAMediumWhereverItIs) {
    TakeInStick({u"a/Band - Lied.wav"_s, u"Band - Zwei.wav"_s});
    EXPECT_EQ(database_.GetEntry(-1, kSong).Artist, u"Band"_s);
    QFile::link(stick_.Path(), disk_.Path(u"link"_s));
    EXPECT_EQ(AddPaths(database_, {disk_.Path(u"link/a/Band - Lied.wav"_s), stick_.Path()}, true).Known, 3);

    // Mounted elsewhere, and without its name, it is the same disk.
    database_.SetCDNames({});
    database_.Side().Forget();
    const SongFolder elsewhere;
    elsewhere.Add({u"a/Band - Lied.wav"_s, u"Band - Neu.wav"_s});
    volumes_.Unmount();
    volumes_.Mount(elsewhere.Path(), kSerial);
    EXPECT_EQ(AddPaths(database_, {elsewhere.Path()}, true).NewFiles,
              QStringList{OnStick(u"Band - Neu.wav"_s)});
}

TEST_F(MediaTest, AnUpdateFollowsAFolderToWhereItsMediumIs) {
    database_.SetModernMedia(true);
    TakeInStick({u"a/Band - Lied.wav"_s});
    RememberFolders(database_, {stick_.Path(u"a"_s)});
    QDir(stick_.Path(u"a"_s)).removeRecursively();
    volumes_.Unmount();
    EXPECT_EQ(UpdateDatabase(database_, UpdateTags::Reread).MissingFolders, stick_.Paths({u"a"_s}));
    EXPECT_TRUE(database_.Contains(kSong));

    const SongFolder elsewhere;
    elsewhere.Add({u"a/Band - Lied.wav"_s, u"a/Band - Neu.wav"_s, u"b/Band - Nicht.wav"_s});
    volumes_.Mount(elsewhere.Path(), kSerial);
    const UpdateResult update = UpdateDatabase(database_, UpdateTags::Keep);
    EXPECT_EQ(update.Intake.NewFiles, QStringList{OnStick(u"a\\Band - Neu.wav"_s)});
    EXPECT_EQ(update.MissingFolders, QStringList());
    EXPECT_EQ(database_.UpdateFolders(), stick_.Paths({u"a"_s}));
}

TEST_F(MediaTest, AMediumIsAskedAboutOnce) {
    database_.SetModernMedia(true);
    stick_.Add(u"Band - Lied.wav"_s);
    volumes_.Mount(stick_.Path(), kSerial, u"STICK"_s);
    EXPECT_THROW(AddStick(), EAbort);
    dialogs_.Answers = {1};
    EXPECT_EQ(AddStick().NewFiles, stick_.Paths({u"Band - Lied.wav"_s}));
    EXPECT_EQ(AddStick().Known, 1);

    database_.Clear();
    dialogs_.Answers = {0};
    dialogs_.Inputs = {u"Urlaub"_s};
    EXPECT_EQ(AddStick().NewFiles, QStringList{OnStick(u"Band - Lied.wav"_s)});
    EXPECT_EQ(AddStick().Known, 1);
    EXPECT_EQ(database_.CDNameOf(kSong), u"Urlaub"_s);
    EXPECT_EQ(dialogs_.Asked.size(), 3U);
}

TEST_F(MediaTest, AMediumThatIsPulledWhileItsNameIsAskedForNamesNoOther) {
    struct Pulling : ScriptedDialogs {
        std::optional<QString> Input(const QString&, const QString&, const QStringList&,
                                     const QString&) override {
            Pull();
            return u"Urlaub"_s;
        }
        std::function<void()> Pull;
    } dialogs;
    dialogs.Answers = {0};
    dialogs.Pull = [this] { volumes_.Now.pop_back(); };
    database_.SetModernMedia(true);
    volumes_.Mount(u"/"_s, 7);
    volumes_.Mount(stick_.Path(), kSerial, u"STICK"_s);
    EXPECT_THROW(AddStick(), EMusicDatabaseException);
    EXPECT_TRUE(database_.CDNames().empty());
}

TEST_F(MediaTest, MediaOfOneLabelAreNamedApart) {
    database_.AddEntry(kSong, {}, AddAs::Returning);
    volumes_.Mount(u"/a"_s, 7, u"ROCK"_s);
    volumes_.Mount(u"/b"_s, kSerial, u"ROCK"_s);
    dialogs_.Inputs = {u"ROCK (1A2B3C4D)"_s, u" Urlaub "_s, u"Urlaub (1A2B3C4D)"_s, u" "_s};
    NameMediaCommand(database_);
    NameMediaCommand(database_);  // an empty name is none
    EXPECT_TRUE(dialogs_.Inputs.empty());
    EXPECT_EQ(database_.CDNameOf(kSong), u"Urlaub"_s);
    database_.SetCDNames({});  // where the user has no list of his own, the database knows it
    EXPECT_EQ(database_.CDNameOf(kSong), u"Urlaub"_s);
}

TEST_F(MediaTest, PathsAreComparedWithoutDriveAndMedium) {
    volumes_.Mount(u"/media/x"_s, 1);
    const auto isSame = &TMusicDatabase::SameFileIgnoringMedium;
    EXPECT_TRUE(isSame(kSong, u"D:\\a\\Band - Lied.wav"_s));
    EXPECT_TRUE(isSame(u"/media/x/a/Band - Lied.wav"_s, kSong));
    EXPECT_FALSE(isSame(kSong, u"D:\\b\\Band - Lied.wav"_s));
    EXPECT_FALSE(isSame(kSong, kSong));
}

TEST_F(MediaTest, TheOrderByCacheTypeFollowsWhatIsPluggedIn) {
    volumes_.Mount(u"/cd"_s, 5);
    database_.SetOrder({.SortType = stCacheType});
    for (const QString& path : {u":00000006:\\x"_s, u":00000005:\\x"_s, u"/x"_s})
        database_.AddEntry(path, {}, AddAs::Returning);
    EXPECT_EQ(database_.IndexOf(u"/x"_s), 0);
    EXPECT_EQ(database_.IndexOf(u":00000006:\\x"_s), 2);
    volumes_.Now[0].Serials = {6};
    database_.EnsureSorted();
    EXPECT_EQ(database_.IndexOf(u":00000006:\\x"_s), 1);
}

TEST_F(MediaTest, NotesFollowTheSongsAndStayWithTheDatabase) {
    const QString old = u"/alt\t\\ü.mp3"_s;
    const QString renamed = u"/neu\n.mp3"_s;
    database_.AddEntry(old, {}, AddAs::Returning);
    TID3Tag song = database_.Song(0);
    song.FileName = renamed;
    database_.Side().Add(u"pairs"_s, {old, u"/b.mp3"_s});
    database_.Side().Add(u"pairs"_s, {u"/b.mp3"_s, old});
    CollectionEdit edit(database_);
    edit.Change(database_.Songs().HandleOf(0), song);
    edit.Commit();
    const QString file = disk_.Path(u"x.tsdb"_s);
    database_.SaveDatabase(file);
    TMusicDatabase loaded;
    loaded.OpenDatabase(file);
    EXPECT_EQ(loaded.Side().Values(u"pairs"_s, renamed), QStringList{u"/b.mp3"_s});
    EXPECT_EQ(loaded.Side().Values(u"pairs"_s, u"/b.mp3"_s), QStringList{renamed});

    // What cannot be read is told, holds up nothing, and is not lost.
    disk_.Put(u"x.tsdb.side"_s, QByteArray("Notizen eines Fremden\n"));
    loaded.OpenDatabase(file);
    loaded.Side().Add(u"pairs"_s, {u"/a"_s, u"/b"_s});
    loaded.SaveDatabase();
    EXPECT_EQ(dialogs_.Messages.size(), 2);
    EXPECT_EQ(disk_.Get(u"x.tsdb.side"_s), "Notizen eines Fremden\n");
}

TEST_F(MediaTest, SongsAreCopiedOnceAndOnlyOurCopiesAreRemoved) {
    TakeInStick({u"A - gone.wav"_s, u"A - one.wav"_s, u"A - there.wav"_s, u"A - two.wav"_s});
    const QString one = disk_.Path(u"root/Unsorted/A - one.wav"_s);
    const QString two = disk_.Path(u"root/Unsorted/A - two.wav"_s);
    const QString there = disk_.Put(u"root/Unsorted/A - there.wma"_s, QByteArray("mine"));
    QFile::remove(stick_.Path(u"A - gone.wav"_s));
    database_.SetModernMedia(true);
    database_.SaveDatabase(disk_.Path(u"x.tsdb"_s));

    dialogs_.Answers = {0, 0};  // enough room; go on after the one that is gone
    EXPECT_EQ(CacheSongs(database_, AllSongs(database_)).Done, 2);
    EXPECT_EQ(dialogs_.Questions.value(1), u"Die Datei "_s + stick_.Path(u"A - gone.wav"_s) +
                                               u" konnte nicht gecachet werden. Trotzdem fortfahren?"_s);
    EXPECT_EQ(Found(OnStick(u"A - one.wav"_s), true), one);  // also while the medium is there
    volumes_.Unmount();
    EXPECT_EQ(Found(OnStick(u"A - there.wav"_s), true), there);
    EXPECT_EQ(FileWithinReach(database_, OnStick(u"A - gone.wav"_s)), QString());
    EXPECT_EQ(AddPaths(database_, {one, two}, true).Known, 2);

    // Noted at once, the copies are known after a restart, and by other tags.
    TMusicDatabase restarted;
    restarted.OpenDatabase(disk_.Path(u"x.tsdb"_s));
    EXPECT_EQ(restarted.ResolveSongPath(OnStick(u"A - two.wav"_s)), two);
    restarted.AddEntry(one, {});  // a song of its own now
    QStringList played;           // let go of, and given back
    restarted.OnReleaseFile = [&](const QString& path) {
        played << path;
        return [&](const QString& now) { played << now; };
    };
    EXPECT_EQ(DropCaches(restarted, AllSongs(restarted)).Done, 2);
    EXPECT_EQ(played, (QStringList{two, two}));
    EXPECT_TRUE(QFile::exists(one) && QFile::exists(there));
    EXPECT_FALSE(QFile::exists(two));
}

TEST_F(MediaTest, AMediumThatIsNotPutInIsAskedForOnceABatch) {
    TakeInStick({u"A - one.wav"_s, u"A - two.wav"_s});
    volumes_.Unmount();
    dialogs_.Answers = {0};
    EXPECT_EQ(CacheSongs(database_, AllSongs(database_)).Missing.size(), 2);
    EXPECT_EQ(dialogs_.Prompts.size(), 1);
}

TEST_F(MediaTest, BurningTakesSongsOfMediaAsTheUserAnswers) {
    struct Case {
        std::deque<int> Answers;  // the first is about the room
        QStringList Taken;
    };
    TakeInStick({u"1.wav"_s, u"2.wav"_s, u"3.wav"_s});
    AddPaths(database_, {disk_.Add(u"4.wav"_s)}, true);
    database_.SetModernMedia(true);
    database_.SetOrder({.SortType = stTitle});
    const std::vector<Case> cases = {{{0, 0, 2, 0}, {u"1.wav"_s, u"3.wav"_s, u"4.wav"_s}},
                                     {{0, 2, 1}, {u"2.wav"_s, u"3.wav"_s, u"4.wav"_s}},
                                     {{0, 0, 3}, {u"1.wav"_s, u"4.wav"_s}},
                                     {{0, 0, 4}, {u"1.wav"_s}}};
    for (const Case& each : cases) {
        const QString folder = disk_.Path(each.Taken.join(u'-'));
        dialogs_.Questions.clear();
        dialogs_.Answers = each.Answers;
        const bool stopped = PrepareBurning(database_, AllSongs(database_), folder).Stopped;
        EXPECT_EQ(QDir(folder).entryList(QDir::Files, QDir::Name), each.Taken);
        EXPECT_EQ(stopped, each.Answers.back() == 4);
        EXPECT_EQ(dialogs_.Questions.size(), each.Answers.size());
    }
}

TEST_F(MediaTest, NoSongOfABatchReplacesAnotherOrItself) {
    const QStringList songs =
        disk_.Add({u"root/Rap/A - 1.wav"_s, u"x/B - 2.wav"_s, u"y/B - 2.wav"_s, u"burn/C - 3.wav"_s});
    AddPaths(database_, songs, true);
    disk_.Put(u"burn/Rap/A - 1.wav"_s, QByteArray("old"));
    dialogs_.Answers = {0};
    EXPECT_EQ(PrepareBurning(database_, AllSongs(database_), disk_.Path(u"burn/"_s)).Done, 3);
    EXPECT_EQ(QDir(disk_.Path(u"burn"_s)).entryList(QDir::Files, QDir::Name),
              (QStringList{u"B - 2 (2).wav"_s, u"B - 2.wav"_s, u"C - 3.wav"_s}));
    EXPECT_EQ(disk_.Get(u"burn/Rap/A - 1.wav"_s), disk_.Get(u"root/Rap/A - 1.wav"_s));
}
