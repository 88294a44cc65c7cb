#include <gtest/gtest.h>

#include <QFile>

#include "MusicManagment/database/CollectionEdit.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/intake/Update.h"
#include "MusicManagment/database/media/CachePlace.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

// Songs on media that can be taken away.

namespace {

constexpr quint32 kSerial = 0x1A2B3C4D;

class MediaTest : public testing::Test {
 protected:
    MediaTest() {
        database_.SetMP3MoveRootDir(disk_.Path(u"root"_s));
        changes_ = database_.Events().MediaChanged.Subscribe([this] { ++redraws_; });
    }
    // Catalogues the stick and takes its songs in.
    void TakeInStick(const QStringList& names) {
        stick_.Add(names);
        volumes_.Mount(stick_.Path(), kSerial, u"STICK"_s);
        CatalogueMedium(database_, stick_.Path());
        ASSERT_EQ(AddPaths(database_, {stick_.Path()}, true).Added, names.size());
    }
    QString Found(const QString& path) {
        return database_.ResolveSongPath(path, {.Ask = false, .UseCache = false});
    }

    SongFolder stick_, disk_;
    ScriptedVolumes volumes_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    Subscription changes_;
    int redraws_ = 0;
};

const QString kSong = u":1A2B3C4D:\\a\\Band - Lied.wav"_s;

}  // namespace

TEST_F(MediaTest, TheFirstFullDriveIsLookedAt) {
    volumes_.Mount(u"/stick"_s, 7);
    volumes_.Mount(u"/cd"_s, kSerial, {}, 0);
    volumes_.Mount(u"/dvd"_s, 9, {}, 0);
    EXPECT_EQ(Found(kSong), u"/cd/a/Band - Lied.wav"_s);
    EXPECT_EQ(redraws_, 1);
    EXPECT_EQ(Found(u":00000009:\\x.mp3"_s), QString());  // only one drive counts
    volumes_.Now[1].Serials = {7};                        // another disc in the drive
    EXPECT_EQ(Found(kSong), QString());
    EXPECT_EQ(Found(u":00000007:\\x.mp3"_s), u"/cd/x.mp3"_s);
    EXPECT_EQ(redraws_, 2);
    database_.SetModernMedia(true);
    EXPECT_EQ(Found(u":00000009:\\x.mp3"_s), u"/dvd/x.mp3"_s);
    EXPECT_EQ(redraws_, 2);
}

TEST_F(MediaTest, WhatIsNoSerialNumberIsFoundNowhere) {
    database_.SetModernMedia(true);
    volumes_.Mount(u"/cd"_s, kSerial, {}, 0);
    volumes_.Now.push_back({.MountPoint = u"/ohne"_s, .Optical = true});
    volumes_.Mount(u"/null"_s, 0, {}, 0);
    database_.SetCDNames({{u"Rock"_s, kSerial}});
    for (const QString& path : {u":1A2B3C4:\\a.mp3"_s, u":+1A2B3C4:\\a.mp3"_s, u":00000000:\\a.mp3"_s,
                                u":1A2B3CXD:\\a.mp3"_s, u":"_s}) {
        EXPECT_EQ(Found(path), QString()) << qPrintable(path);
        EXPECT_EQ(database_.CDNameOf(path), path);
    }
    EXPECT_EQ(Found(u":1a2b3c4d:\\..\\b\\..\\a.mp3"_s), u"/cd/b/a.mp3"_s);
    EXPECT_EQ(Found(QString()), QString());
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
    volumes_.Unmount();
    EXPECT_EQ(Found(kSong), QString());
    volumes_.Mount(u"/media/b"_s, kSerial);  // the drive stays known
    EXPECT_EQ(Found(kSong), u"/media/b/a/Band - Lied.wav"_s);
}

TEST_F(MediaTest, AnIntakeKnowsTheSongsOfAMediumWhereverItIs) {
    TakeInStick({u"a/Band - Lied.wav"_s, u"Band - Zwei.wav"_s});
    EXPECT_TRUE(database_.Contains(kSong));
    EXPECT_EQ(database_.CDNames().front().Name, u"STICK"_s);
    EXPECT_EQ(database_.Song(0).Artist, u"Band"_s);
    EXPECT_EQ(AddPaths(database_, {stick_.Path()}, true).Known, 2);
    QFile::link(stick_.Path(), disk_.Path(u"link"_s));
    EXPECT_EQ(AddPaths(database_, {disk_.Path(u"link/a/Band - Lied.wav"_s)}, true).Known, 1);

    // Mounted elsewhere, and without its name it is the same disk.
    database_.SetCDNames({});
    const SongFolder elsewhere;
    elsewhere.Add({u"a/Band - Lied.wav"_s, u"Band - Neu.wav"_s});
    volumes_.Unmount();
    volumes_.Mount(elsewhere.Path(), kSerial);
    EXPECT_EQ(AddPaths(database_, {elsewhere.Path()}, true).NewFiles,
              QStringList{u":1A2B3C4D:\\Band - Neu.wav"_s});

    // Away, it loses nothing.
    volumes_.Unmount();
    database_.SetUpdateFolders({elsewhere.Path(u"fort"_s)});
    EXPECT_TRUE(UpdateDatabase(database_, UpdateTags::Reread).Removed.isEmpty());
    EXPECT_EQ(database_.Count(), 3);
}

TEST_F(MediaTest, AMediumIsAskedAboutOnce) {
    database_.SetModernMedia(true);
    stick_.Add(u"Band - Lied.wav"_s);
    volumes_.Mount(stick_.Path(), kSerial, u"STICK"_s);
    EXPECT_THROW(AddFolder(database_, stick_.Path(), true), EAbort);
    EXPECT_EQ(database_.Count(), 0);

    dialogs_.Answers = {1};
    EXPECT_EQ(AddFolder(database_, stick_.Path(), true).NewFiles, stick_.Paths({u"Band - Lied.wav"_s}));
    EXPECT_EQ(AddFolder(database_, stick_.Path(), true).Known, 1);
    EXPECT_EQ(dialogs_.Asked.size(), 2U);

    database_.Clear();
    dialogs_.Answers = {0};
    dialogs_.Inputs = {u"Urlaub"_s};
    EXPECT_EQ(AddFolder(database_, stick_.Path(), true).NewFiles,
              QStringList{u":1A2B3C4D:\\Band - Lied.wav"_s});
    EXPECT_EQ(AddFolder(database_, stick_.Path(), true).Known, 1);
    EXPECT_EQ(database_.CDNameOf(database_.Song(0).FileName), u"Urlaub"_s);
    EXPECT_EQ(dialogs_.Asked.size(), 3U);
}

TEST_F(MediaTest, PathsAreComparedWithoutDriveAndMedium) {
    volumes_.Mount(u"/media/x"_s, 1);
    const auto isSame = &TMusicDatabase::SameFileIgnoringMedium;
    EXPECT_TRUE(isSame(kSong, u"D:\\a\\Band - Lied.wav"_s));
    EXPECT_TRUE(isSame(u"/media/x/a/Band - Lied.wav"_s, kSong));
    EXPECT_FALSE(isSame(kSong, u"D:\\b\\Band - Lied.wav"_s));
    EXPECT_FALSE(isSame(kSong, kSong));
    EXPECT_FALSE(isSame(u"/media/x/a"_s, u"/media/x/a"_s));
}

TEST_F(MediaTest, TheOrderByCacheTypeFollowsWhatIsPluggedIn) {
    TakeInStick({u"B - B.wav"_s});
    volumes_.Mount(u"/cd"_s, 5);
    database_.SetOrder({.SortType = stCacheType});
    TID3Tag song;
    for (const QString& path : {u":00000005:\\x"_s, u":00000006:\\x"_s, u"/x"_s}) {
        song.FileName = path;
        database_.AddEntry(path, song, AddAs::Returning);
    }
    const auto order = [this] {
        QString kinds;
        for (const auto& each : database_.Songs())
            kinds += IsCdPath(each->FileName) ? each->FileName[8] : u'-';
        return kinds;
    };
    EXPECT_EQ(order().left(1) + order().right(1), u"-6"_s);
    volumes_.Unmount();
    volumes_.Mount(u"/cd"_s, 6);
    database_.EnsureSorted();
    EXPECT_EQ(order().left(2), u"-6"_s);
}

TEST_F(MediaTest, NotesFollowTheSongsAndStayWithTheDatabase) {
    TID3Tag song;
    song.FileName = u"/alt\t\\ü.mp3"_s;
    database_.AddEntry(song.FileName, song, AddAs::Returning);
    const QString file = disk_.Path(u"x.tsdb"_s);
    database_.Side().Add(u"pairs"_s, {song.FileName, u"/b.mp3"_s});
    database_.Side().Add(u"pairs"_s, {u"/b.mp3"_s, song.FileName});
    CollectionEdit edit(database_);
    edit.Rename(database_.Songs().HandleOf(0), u"/neu\n.mp3"_s);
    edit.Commit();
    database_.SaveDatabase(file);

    TMusicDatabase loaded;
    loaded.OpenDatabase(file);
    EXPECT_TRUE(loaded.Side().Contains(u"pairs"_s, {u"/neu\n.mp3"_s, u"/b.mp3"_s}));
    EXPECT_TRUE(loaded.Side().Contains(u"pairs"_s, {u"/b.mp3"_s, u"/neu\n.mp3"_s}));
    EXPECT_EQ(loaded.Side().Rows(u"pairs"_s).size(), 2U);

    // What cannot be read is told, holds up nothing, and is not lost.
    disk_.Put(u"x.tsdb.side"_s, QByteArray("Notizen eines Fremden\n"));
    loaded.OpenDatabase(file);
    EXPECT_EQ(loaded.Count(), 1);
    loaded.Side().Add(u"pairs"_s, {u"/a"_s, u"/b"_s});
    loaded.SaveDatabase();
    EXPECT_EQ(dialogs_.Messages.size(), 2);
    EXPECT_EQ(disk_.Get(u"x.tsdb.side"_s), "Notizen eines Fremden\n");
}
