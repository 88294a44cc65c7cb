#include "MusicManagment/database/intake/Update.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>

#include "MusicManagment/database/songfiles/CopySongs.h"
#include "MusicManagment/database/songfiles/Removal.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
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
    QStringList Titles() const {
        QStringList titles;
        for (const auto& song : database_.Songs())
            titles << song->Title;
        return titles;
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
    EXPECT_EQ(Titles(), (QStringList{u"three"_s, u"two"_s}));
    ASSERT_FALSE(dialogs_.Questions.empty());
    EXPECT_TRUE(dialogs_.Questions[0].contains(songs_.Path(u"music/A - one.wav"_s)));
    EXPECT_EQ(database_.Artists().At(0).Number, 2);
}

TEST_F(UpdateTest, GoneSongsStayWhenTheUserSaysSo) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s});
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    dialogs_.Answers = {1, 0};
    EXPECT_TRUE(UpdateDatabase(database_, UpdateTags::Keep).Removed.isEmpty());
    EXPECT_EQ(database_.Count(), 2);
}

TEST_F(UpdateTest, AnUnpluggedDiskNeverEmptiesTheCollection) {
    TakeIn({u"music/A - one.wav"_s, u"music/sub/A - two.wav"_s});
    // The mount point stays behind, empty.
    QDir(songs_.Path(u"music"_s)).removeRecursively();
    QDir().mkpath(songs_.Path(u"music"_s));
    UpdateResult result = UpdateDatabase(database_, UpdateTags::Reread);
    EXPECT_EQ(result.MissingFolders, songs_.Paths({u"music"_s}));
    EXPECT_EQ(database_.Count(), 2);
    // The mount point is gone as well.
    QDir(songs_.Path(u"music"_s)).removeRecursively();
    result = UpdateDatabase(database_, UpdateTags::Keep);
    EXPECT_EQ(database_.Count(), 2);
    for (const Question& question : dialogs_.Asked)
        EXPECT_FALSE(question.Buttons.contains(u"Entfernen"_s));
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

TEST_F(UpdateTest, WithoutFoldersThereIsAMessage) {
    EXPECT_THROW(UpdateDatabase(database_, UpdateTags::Keep), EMusicDatabaseException);
    EXPECT_THROW(SearchNewSongs(database_), EMusicDatabaseException);
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
    const RemovedSongs removed = RemoveSongs(database_, std::vector<SongIndex>{2, 0, 99});
    EXPECT_EQ(removed.size(), 2u);
    EXPECT_EQ(Titles(), QStringList{u"three"_s});
    EXPECT_EQ(database_.Artists().Count(), 1);
    QFile::remove(songs_.Path(u"music/A - one.wav"_s));
    EXPECT_EQ(RestoreSongs(database_, removed), 2);
    EXPECT_EQ(RestoreSongs(database_, removed), 0);
    EXPECT_EQ(Titles(), (QStringList{u"one"_s, u"three"_s, u"two"_s}));
    EXPECT_EQ(database_.Artists().At(1).Number, 2);
}

TEST_F(UpdateTest, CopyingAsksBeforeItReplaces) {
    TakeIn({u"music/A - one.wav"_s, u"music/A - two.wav"_s});
    songs_.Add(u"target/A - one.wav"_s, 5);
    const qint64 before = QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size();
    dialogs_.Answers = {2};  // leave it
    CopyResult result = CopySongs(database_, {0, 1}, songs_.Path(u"target"_s));
    EXPECT_EQ(result.Copied, 1);
    EXPECT_EQ(QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size(), before);
    dialogs_.Answers = {1};  // replace all
    result = CopySongs(database_, {0, 1}, songs_.Path(u"target"_s));
    EXPECT_EQ(result.Copied, 2);
    EXPECT_NE(QFileInfo(songs_.Path(u"target/A - one.wav"_s)).size(), before);
    // Onto itself, and from a file that is gone.
    QFile::remove(songs_.Path(u"music/A - two.wav"_s));
    result = CopySongs(database_, {0, 1}, songs_.Path(u"music"_s));
    EXPECT_EQ(result.Copied, 0);
    EXPECT_EQ(result.Failed.size(), 2);
    EXPECT_TRUE(QFile::exists(songs_.Path(u"music/A - one.wav"_s)));
}

TEST_F(UpdateTest, AStoppedCopyLeavesNothingBehind) {
    TakeIn({u"music/A - one.wav"_s});
    QDir().mkpath(songs_.Path(u"target"_s));
    database_.OnProgress = [](TMusicDatabase& database, const ProgressPoint&) { database.RequestAbort(); };
    EXPECT_TRUE(CopySongs(database_, {0}, songs_.Path(u"target"_s)).Stopped);
    EXPECT_TRUE(QDir(songs_.Path(u"target"_s)).isEmpty());
}
