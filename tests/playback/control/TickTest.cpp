#include <QScopeGuard>

#include "tests/playback/control/PlayerRig.h"

// The end of a song, the time limit, and counting.

using namespace Qt::StringLiterals;

namespace {

class TickTest : public ListedSongsTest {
 protected:
    TickTest() {
        player_.SetMusicDatabase(&database_);
        player_.OnReachedEndOfSong = [this](TPlaySound&) { ++ends_; };
        player_.OnCrossover = [this](TPlaySound&) { ++crossovers_; };
    }
    // Fades nothing.
    void HardChanges() {
        Change([](EngineSettings& s) { s.FMODCrossoverTime = 2999; });
    }

    TMusicDatabase database_;
    int ends_ = 0;
    int crossovers_ = 0;
};

TEST_F(TickTest, NextSongFollowsAMomentAfterTheEnd) {
    HardChanges();
    length_ = 5000;
    List({u"a.mp3"_s, u"b.mp3"_s});
    list_.PlayNext();
    Pass(4000);
    EXPECT_FALSE(player_.Timers().EndPending());
    Pass(250);
    EXPECT_TRUE(player_.Timers().EndPending());
    Pass(1150);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    Pass(50);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_EQ(ends_, 1);
}

// The system's player goes on from where it is sent.
TEST_F(TickTest, ASongThatASeekWakesIsFollowedByTheNext) {
    HardChanges();
    length_ = 5000;
    List({u"a.mp3"_s, u"b.mp3"_s});
    list_.PlayNext();
    player_.PauseResume();
    Any(u"a"_s).SeekPlays = true;
    player_.SetPosition(4500);
    Pass(1700);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
}

TEST_F(TickTest, ShortSongsEndAtOnce) {
    HardChanges();
    length_ = 900;
    List({u"a.mp3"_s});
    list_.PlayNext();
    Pass(250);
    EXPECT_TRUE(player_.Timers().EndPending());
    EXPECT_EQ(crossovers_, 1);
}

TEST_F(TickTest, UnknownLengthIsNoEndWhileTheSongPlays) {
    length_ = 0;
    List({u"a.mp3"_s});
    list_.PlayNext();
    Any(u"a"_s).OnPositionAsked = [] {};
    Pass(60'000);
    EXPECT_EQ(ends_ + crossovers_, 0);
}

TEST_F(TickTest, AfterTheLastSongTheTimersRest) {
    HardChanges();
    length_ = 5000;
    List({u"a.mp3"_s});
    list_.PlayNext();
    Any(u"a"_s).OnPositionAsked = [this] {
        if (clock_.Milliseconds > 1'005'000) Any(u"a"_s).Status = psStopped;
    };
    Pass(6000);
    EXPECT_EQ(ends_, 1);
    EXPECT_FALSE(player_.Timers().Ticking());
    EXPECT_EQ(Messages(), QStringList{u"Es wurden alle in der PlayList enthaltenen Lieder abgespielt."_s});
}

TEST_F(TickTest, SongWhoseEngineFailsIsAsGoodAsClosedForThoseWhoAsk) {
    HardChanges();
    List({u"a.cda"_s});
    list_.PlayNext();
    ScriptedBackend& song = Any(u"a"_s);
    song.OnPositionAsked = song.OnStatusAsked = [] { throw EMCIException(u"weg"_s); };
    EXPECT_EQ(player_.GetPosition(), 0U);
    EXPECT_EQ(player_.GetStatus(), psClosed);
    EXPECT_THROW(player_.PauseResume(), EMCIException);
    Pass(3000);
    EXPECT_EQ(Messages(), (QStringList{u"weg"_s,
                                       u"Es wurden alle in der PlayList enthaltenen Lieder "
                                       "abgespielt."_s}));
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(TickTest, AutoStopFadesAndPlaysTheNextSong) {
    List({u"a.mp3"_s, u"b.mp3"_s});
    list_.SetScan(true);
    list_.PlayNext();
    Pass(9950);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    Pass(50);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(ends_, 1);
    Pass(10'000);  // the limit holds for every song; this was the last
    EXPECT_EQ(ends_, 2);
}

TEST_F(TickTest, NewLimitCountsFromTheStartOfTheSong) {
    List({u"a.mp3"_s, u"b.mp3"_s});
    list_.PlayNext();
    Pass(5000);
    player_.SetAutoStop(6001);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    player_.SetAutoStop(0);
    Pass(2000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    player_.SetAutoStop(7999);  // within the last second: at once
    EXPECT_EQ(Open(), u"FMOD:b"_s);
}

TEST_F(TickTest, SongCountsOnceAfterThirtySeconds) {
    database_.AddSong(Add(u"a.wav"_s));
    database_.SetModified(false);
    const auto count = [this] { return database_.Song(0).PlayCount; };
    ScriptedController controller;
    player_.SetFileName(folder_.Path(u"a.wav"_s));
    player_.Play();
    Pass(29'750);
    player_.Stop();
    player_.Play();
    player_.SetController(&controller);
    Pass(29'750);
    EXPECT_EQ(count(), 0U);
    EXPECT_FALSE(database_.Modified());
    Pass(250);
    EXPECT_EQ(count(), 1U);
    EXPECT_TRUE(database_.Modified());
    EXPECT_EQ(controller.Log, QStringList{u"7 1"_s});
    Pass(60'000);
    player_.SetFileName(folder_.Path(u"a.wav"_s));  // the same song again
    player_.Play();
    Pass(40'000);
    EXPECT_EQ(count(), 1U);
}

TEST_F(TickTest, PauseBeginsTheThirtySecondsAnew) {
    database_.AddSong(Add(u"a.wav"_s));
    player_.SetFileName(folder_.Path(u"a.wav"_s));
    player_.Play();
    Pass(20'000);
    player_.PauseResume();
    Pass(20'000);
    player_.PauseResume();
    Pass(20'000);
    EXPECT_EQ(database_.Song(0).PlayCount, 0U);
    Pass(10'000);
    EXPECT_EQ(database_.Song(0).PlayCount, 1U);
}

TEST_F(TickTest, CopyOfAListedSongCountsForTheSong) {
    // The folder for copies belongs to this test, not to all that run.
    const QByteArray former = qgetenv("TMPDIR");
    const auto restore =
        qScopeGuard([&] { former.isNull() ? qunsetenv("TMPDIR") : qputenv("TMPDIR", former); });
    qputenv("TMPDIR", QFile::encodeName(QFileInfo(folder_.Path(u"a.wav"_s)).path()));
    database_.AddSong(Add(u"a.wav"_s));
    list_.Insert(0, {.Name = folder_.Path(u"a.wav"_s)});
    list_.SetCopyMp3sBeforePlay(true);
    list_.PlayNext();
    ASSERT_NE(player_.FileName(), folder_.Path(u"a.wav"_s));
    Pass(30'000);
    EXPECT_EQ(database_.Song(0).PlayCount, 1U);
}

TEST_F(TickTest, WithoutAPlaylistTheCollectionIsPlayedInItsOrder) {
    HardChanges();
    database_.SetSortType(stPath);
    for (const QString& song : {u"a.wav"_s, u"b.wav"_s})
        database_.AddSong(Add(song));
    player_.SetPlayList(nullptr);
    length_ = 3000;
    player_.SetFileName(folder_.Path(u"a.wav"_s));
    player_.Play();
    Pass(3500);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    Pass(3500);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(ends_, 2);
}

}  // namespace
