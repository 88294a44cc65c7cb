#include "MusicManagment/database/CollectionEdit.h"
#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "tests/database/RecordingTrash.h"
#include "tests/playback/control/PlayerRig.h"

// The files of songs that play are moved and removed.

using namespace Qt::StringLiterals;

namespace {

class ReleaseTest : public ListedSongsTest {
 protected:
    ReleaseTest() {
        SetJournal(&journal_);
        database_.SetAsynchronous(false);
        list_.SetMusicDatabase(&database_);
        player_.SetMusicDatabase(&database_);
        List({u"a.mp3"_s, u"b.mp3"_s});
        song_ = database_.Songs().HandleOf(database_.AddEntry(folder_.Path(u"a.mp3"_s), TID3Tag()));
    }
    ~ReleaseTest() override { SetJournal(nullptr); }
    void Move() {
        const BatchResult result =
            MoveSongs(database_, u"1 Song"_s, {{.Song = song_, .Target = folder_.Path(u"new/x.mp3"_s)}});
        EXPECT_EQ(result.Renamed, 1);
    }
    // The song that is open, with what it does and where.
    QString State() {
        EXPECT_EQ(list_.CurrentFile(), player_.FileName());
        EXPECT_EQ(player_.Timers().Ticking(), player_.GetStatus() == psPlaying);
        return Open() + u" %1 %2"_s.arg(player_.GetStatus()).arg(player_.GetPosition());
    }
    static QString StateOf(const QString& song, TPSStatus status, int position) {
        return song + u" %1 %2"_s.arg(status).arg(position);
    }

    Journal journal_{folder_.Path(u"journal.tsj"_s)};
    TMusicDatabase database_;
    SongHandle song_;
};

TEST_F(ReleaseTest, ASongComesBackWhereItWasUnderItsNewName) {
    QStringList openAtMove;
    const Subscription watching =
        database_.Events().Renamed.Subscribe([&](const PathChanges&) { openAtMove << Open(); });
    int begun = 0;
    player_.OnPlayingStarted = [&](TPlaySound&) { ++begun; };
    list_.PlayEntry(0);
    Pass(20'000);
    Move();
    EXPECT_EQ(openAtMove, QStringList{QString()});
    EXPECT_EQ(State(), StateOf(u"FMOD:x"_s, psPlaying, 20'000));
    player_.PauseResume();
    journal_.Undo(&database_);
    EXPECT_EQ(State(), StateOf(u"FMOD:a"_s, psPaused, 20'000));
    player_.Stop();
    int stopped = 0;
    player_.OnPlayingStopped = [&](TPlaySound&) { ++stopped; };
    journal_.Redo(&database_);
    EXPECT_EQ(State(), StateOf(u"FMOD:x"_s, psStopped, 0));
    EXPECT_EQ(begun, 1);
    EXPECT_EQ(stopped, 0);
    EXPECT_EQ(Messages(), QStringList());
}

TEST_F(ReleaseTest, ASongInTheBinStaysStopped) {
    const RecordingTrash trash;
    list_.PlayEntry(0);
    int stopped = 0;
    player_.OnPlayingStopped = [&](TPlaySound&) { ++stopped; };
    const BatchResult result = DiscardSongs(database_, u"1 Song"_s, {song_}, Banning::NotBanned);
    EXPECT_EQ(result.Failed, QStringList());
    EXPECT_EQ(State(), StateOf(QString(), psClosed, 0));
    EXPECT_EQ(stopped, 1);
    Pass(300'000);
    EXPECT_EQ(Open(), QString());
}

TEST_F(ReleaseTest, WhoeverOpensASongMeanwhileHasTheLastWordAndFailuresAreTold) {
    const QString path = folder_.Path(u"a.mp3"_s);
    list_.PlayEntry(0);
    EXPECT_FALSE(database_.OnReleaseFile(folder_.Path(u"b.mp3"_s)));
    auto takeUp = database_.OnReleaseFile(path.toUpper());
    ASSERT_TRUE(takeUp);
    list_.PlayEntry(1);
    takeUp(path);
    EXPECT_EQ(State(), StateOf(u"FMOD:b"_s, psPlaying, 0));

    player_.SetCOFileName(path);
    EXPECT_EQ(Open(), u"FMOD:b FMOD:a"_s);
    EXPECT_FALSE(database_.OnReleaseFile(path));
    EXPECT_EQ(Open(), u"FMOD:b"_s);

    Change([](EngineSettings& s) { s.UseEldoS = s.UseMCI = s.UseWinAmp = false; });
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"kaputt"_s);
    takeUp = database_.OnReleaseFile(player_.FileName());
    takeUp(player_.FileName());
    EXPECT_EQ(Messages(), QStringList{u"kaputt"_s});
    EXPECT_EQ(State(), StateOf(QString(), psClosed, 0));
}

TEST_F(ReleaseTest, ASongThatWaitsForAnOutputWaitsOn) {
    onCreate_[TEngine::FMOD] = Refuse<EOutputException>(u"kein Gerät"_s);
    list_.PlayEntry(0);
    Move();
    EXPECT_TRUE(player_.AwaitsOutput());
    onCreate_.clear();
    Pass(5000);
    EXPECT_EQ(State(), StateOf(u"FMOD:x"_s, psPlaying, 0));
}

TEST_F(ReleaseTest, AFileThatWasMovedWithoutAWordPlaysOnUnderItsNewName) {
    ScriptedPanel panel;
    player_.SetPanel(&panel);
    list_.PlayEntry(0);
    Pass(20'000);
    stage_.Log.clear();
    panel.Log.clear();
    const QString path = folder_.Path(u"x.mp3"_s);
    ASSERT_TRUE(QFile::rename(player_.FileName(), path));
    TID3Tag renamed = *database_.Songs().Find(song_);
    renamed.FileName = path;
    CollectionEdit edit(database_);
    edit.Change(song_, renamed);
    edit.Commit();
    EXPECT_EQ(stage_.Log, QStringList());
    EXPECT_TRUE(panel.Log.contains(u"x"_s));
    EXPECT_EQ(State(), StateOf(u"FMOD:x"_s, psPlaying, 20'000));
    player_.Stop();
    player_.Play();
    EXPECT_EQ(player_.GetStatus(), psPlaying);
}

}  // namespace
