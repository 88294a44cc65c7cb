#include "MusicManagment/database/intake/Update.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>

#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/database/songfiles/CopySongs.h"
#include "MusicManagment/database/songfiles/Removal.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/Listing.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class UpdateTest : public testing::Test {
 protected:
    // A collection of what lies in the folder "music".
    void TakeIn(const QStringList& names) {
        songs_.Add(names);
        AddPaths(database_, {songs_.Path(u"music"_s)}, true);
        database_.SetUpdateFolders({songs_.Path(u"music"_s)});
        database_.SetModified(false);
    }

    SongFolder songs_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
};

}  // namespace

TEST_F(UpdateTest, NewSongsComeInAndGoneOnesLeaveAfterTheQuestion) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s});
    songs_.Add(u"music/A - three.wav"_s);
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    dialogs_.Answers = {0, 0};  // remove; close the report
    const UpdateResult result = UpdateDatabase(database_, UpdateTags::Keep);
    EXPECT_EQ(result.Intake.Added, 1);
    EXPECT_EQ(result.Removed, songs_.Paths({u"music/A - one.wav"_s}));
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"three"_s, u"two"_s}));
    ASSERT_FALSE(dialogs_.Questions.empty());
    EXPECT_TRUE(dialogs_.Questions[0].contains(songs_.Path(u"music/A - one.wav"_s)));
    EXPECT_EQ(database_.Artists().At(0).Number, 2);
}

TEST_F(UpdateTest, AnUnpluggedDiskNeverEmptiesTheCollection) {
    TakeIn({u"music/A - one.wav"_s, u"music/usb/A - two.wav"_s, u"music/usb/sub/A - three.wav"_s});
    QFile::link(songs_.Path(u"gone"_s), songs_.Path(u"music/link"_s));
    TID3Tag song = database_.Song(0);
    database_.AddEntry(songs_.Path(u"music/link/A - four.wav"_s), song, AddAs::Returning);
    // Below an update folder, and then the update folder itself: the mount point stays behind, empty, or goes
    // as well.
    for (const QString& disk : songs_.Paths({u"music/usb"_s, u"music"_s})) {
        QDir(disk).removeRecursively();
        QDir().mkpath(disk);
        const UpdateResult result = UpdateDatabase(database_, UpdateTags::Reread);
        EXPECT_TRUE(result.MissingFolders.contains(disk));
        EXPECT_EQ(database_.Count(), 4);
    }
    QDir(songs_.Path(u"music"_s)).removeRecursively();
    EXPECT_EQ(UpdateDatabase(database_, UpdateTags::Keep).MissingFolders, songs_.Paths({u"music"_s}));
    EXPECT_EQ(database_.Count(), 4);
    for (const Question& question : dialogs_.Asked)
        EXPECT_FALSE(question.Buttons.contains(u"Entfernen"_s));
}

TEST_F(UpdateTest, AFolderThatLostAllItsSongsIsAskedForInOtherWords) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s, u"music/disk/x/A - 1.wav"_s,
            u"music/disk/y/A - 2.wav"_s, u"music/kept/cover/A - 3.wav"_s});
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    QDir(songs_.Path(u"music/disk"_s)).removeRecursively();
    QFile::rename(songs_.Path(u"music/kept/cover/A - 3.wav"_s), songs_.Path(u"music/kept/cover/cover.jpg"_s));
    dialogs_.Answers = {0, 1, 0};  // the one song, not the folders; close the report
    EXPECT_EQ(UpdateDatabase(database_, UpdateTags::Keep).Removed, songs_.Paths({u"music/A - one.wav"_s}));
    ASSERT_GE(dialogs_.Questions.size(), 2);
    EXPECT_FALSE(dialogs_.Questions[0].contains(u"disk"_s));
    EXPECT_TRUE(dialogs_.Questions[1].contains(songs_.Path(u"music/disk"_s) + u" (2)\n"_s +
                                               songs_.Path(u"music/kept/cover"_s) + u" (1)"_s))
        << dialogs_.Questions[1].toStdString();
    dialogs_.Answers = {0, 0};
    EXPECT_EQ(UpdateDatabase(database_, UpdateTags::Keep).Removed.size(), 3);
    EXPECT_EQ(TitlesOf(database_), QStringList{u"two"_s});
}

TEST_F(UpdateTest, ChangedTagsAreTakenOverAndTheCollectionsFieldsStay) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s});
    TID3Tag song = database_.Song(0);
    song.PlayCount = 7;
    song.Flags = sfBurned | sfLengthCorrect;
    song.Length = 77;
    song.MainGenre = 5;
    song.Title = u"an older title"_s;
    database_.UpdateEntry(0, song);
    const UpdateResult result = UpdateDatabase(database_, UpdateTags::Reread);
    EXPECT_EQ(result.Changed.size(), 1);
    const TID3Tag* updated = database_.Songs().Find(song.FileName);
    EXPECT_EQ(updated->Title, u"one"_s);
    EXPECT_EQ(updated->PlayCount, 7u);
    EXPECT_EQ(updated->Flags, song.Flags);
    EXPECT_EQ(updated->Length, 77);
    EXPECT_EQ(updated->MainGenre, 5);
    EXPECT_TRUE(UpdateDatabase(database_, UpdateTags::Reread).Changed.isEmpty());
}

TEST_F(UpdateTest, StoppingKeepsEverything) {
    TakeIn({u"music/A - one.wav"_s});
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    songs_.Add(u"music/A - two.wav"_s);
    database_.OnProgress = [](TMusicDatabase& database, const ProgressPoint&) { database.RequestAbort(); };
    const UpdateResult result = UpdateDatabase(database_, UpdateTags::Keep);
    EXPECT_TRUE(result.Stopped);
    EXPECT_EQ(database_.Count(), 1);
}

TEST_F(UpdateTest, RemovedSongsComeBackEvenWithoutTheirFiles) {
    TakeIn({u"music/A - one.wav"_s, u"music/B - two.wav"_s, u"music/B - three.wav"_s});
    Journal journal(songs_.Path(u"journal"_s));
    const SongList& songs = database_.Songs();
    EXPECT_EQ(RemoveSongs(journal, database_, {songs.HandleOf(2), songs.HandleOf(0), SongHandle()}, u"x"_s),
              2);
    EXPECT_EQ(TitlesOf(database_), QStringList{u"three"_s});
    EXPECT_EQ(database_.Artists().Count(), 1);
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    EXPECT_EQ(journal.Undo(&database_).Songs.size(), 2);
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"one"_s, u"three"_s, u"two"_s}));
    EXPECT_EQ(database_.Artists().At(1).Number, 2);
}

TEST_F(UpdateTest, CopyingAsksBeforeItReplaces) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s});
    songs_.Add(u"target/A - one.wav"_s, 5);
    const qint64 before = QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size();
    const QStringList both{songs_.Path(u"music/A - one.wav"_s), songs_.Path(u"music/A - two.wav"_s)};
    dialogs_.Answers = {2};  // leave it
    CopyResult result = CopySongs(database_, both, songs_.Path(u"target"_s));
    EXPECT_EQ(result.Copied, 1);
    EXPECT_EQ(QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size(), before);
    dialogs_.Answers = {1};  // replace all
    result = CopySongs(database_, both, songs_.Path(u"target"_s));
    EXPECT_EQ(result.Copied, 2);
    EXPECT_NE(QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size(), before);
    // Onto itself, and from a file that is gone.
    QFile::remove(songs_.Path(u"music/A - two.wav"_s));
    result = CopySongs(database_, both, songs_.Path(u"music"_s));
    EXPECT_EQ(result.Copied, 0);
    EXPECT_EQ(result.Failed.size(), 2);
    EXPECT_TRUE(QFile::exists(songs_.Path(u"music/A - one.wav"_s)));
}

TEST_F(UpdateTest, AStoppedCopyLeavesNothingBehind) {
    TakeIn({u"music/A - one.wav"_s});
    QDir().mkpath(songs_.Path(u"target"_s));
    database_.OnProgress = [](TMusicDatabase& database, const ProgressPoint&) { database.RequestAbort(); };
    EXPECT_TRUE(
        CopySongs(database_, {songs_.Path(u"music/A - one.wav"_s)}, songs_.Path(u"target"_s)).Stopped);
    EXPECT_TRUE(QDir(songs_.Path(u"target"_s)).isEmpty());
}
