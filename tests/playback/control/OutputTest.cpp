#include "tests/playback/control/PlayerRig.h"

// Songs while the way to the loudspeaker fails, and failures that come while the user reads of another one.

using namespace Qt::StringLiterals;

namespace {

class OutputTest : public ListedSongsTest {
 protected:
    OutputTest() {
        Change([](EngineSettings& s) { s.FMODCrossoverTime = 0; });
        List({u"a.mp3"_s, u"b.mp3"_s, u"c.mp3"_s});
    }
    void LoseOutputOf(const QString& song) {
        Any(song).OnStatusAsked = [] { throw EOutputException(u"weg"_s); };
    }
};

TEST_F(OutputTest, WithoutADeviceTheFirstSongWaitsForIt) {
    onCreate_[TEngine::FMOD] = Refuse<EOutputException>(u"kein Gerät"_s);
    list_.PlayNext();
    EXPECT_TRUE(player_.AwaitsOutput());
    Pass(60'000);
    EXPECT_EQ(
        Messages(),
        QStringList{u"Die Tonausgabe ist nicht verfügbar. Das Lied spielt weiter, sobald sie wieder da ist."
                    "\r\nkein Gerät"_s});
    EXPECT_EQ(Open(), QString());
    EXPECT_EQ(list_.CurrentSong(), folder_.Path(u"a.mp3"_s));
    EXPECT_EQ(player_.GetStatus(), psPaused);

    list_.PlayNext();  // another song waits as well, and says no more
    EXPECT_EQ(Messages().size(), 1);
    onCreate_.clear();
    Pass(5000);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(player_.Timers().Ticking());

    onCreate_[TEngine::FMOD] = Refuse<EOutputException>(u"wieder weg"_s);
    Pass(250);
    list_.PlayNext();
    EXPECT_EQ(Messages().size(), 2);
    player_.Stop();
    EXPECT_EQ(player_.GetStatus(), psStopped);
    onCreate_.clear();
    Pass(60'000);
    EXPECT_EQ(Open(), QString());
    player_.Play();
    Pass(5000);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
}

TEST_F(OutputTest, LostOutputLetsTheSongGoOnWhereItWas) {
    list_.PlayNext();
    Pass(20'000);
    LoseOutputOf(u"a"_s);
    Pass(250);
    EXPECT_EQ(player_.GetStatus(), psPaused);
    EXPECT_EQ(player_.GetPosition(), 20'250U);
    Pass(300'000);
    EXPECT_EQ(Messages().size(), 1);
    EXPECT_EQ(Open(), u"FMOD:a"_s);

    // An engine that has given up the song gets it anew.
    Any(u"a"_s).OnStatusAsked = [] { throw EFMODException(u"vergessen"_s); };
    Pass(5000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_EQ(player_.GetPosition(), 20'250U);

    // One that has kept it plays on.
    LoseOutputOf(u"a"_s);
    Pass(250);
    Any(u"a"_s).OnStatusAsked = nullptr;
    stage_.Log.clear();
    player_.PauseResume();
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(stage_.Log.isEmpty());
    EXPECT_TRUE(player_.Timers().Ticking());
}

TEST_F(OutputTest, AnotherOutputIsNoPlaceToFadeTo) {
    Change([](EngineSettings& s) { s.FMODCrossoverTime = 10'000; });
    list_.PlayNext();
    Change([](EngineSettings& s) { s.FMODMixRate = 48'000; });
    list_.PlayNext(SongChange::CrossFadeOnly);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    list_.PlayNext(SongChange::CrossFade);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    list_.PlayNext(SongChange::CrossFade);
    EXPECT_EQ(Open(), u"FMOD:b FMOD:c"_s);
}

TEST_F(OutputTest, SongsThatFailWhileAMessageStandsOpenNoOtherOne) {
    InterruptingDialogs dialogs;
    list_.OnAllFilesPlayed = [](TPlayList&, bool&) {};
    int standing = 0, most = 0;
    dialogs.OnMessage = [&] {
        most = std::max(most, ++standing);
        if (player_.Timers().EndPending()) Pass(3000);
        --standing;
    };
    onOpened_ = [](ScriptedBackend& song) {
        song.OnPositionAsked = [&song] { throw EMCIException(u"kaputt "_s + song.Song()); };
    };
    list_.PlayNext();
    Pass(20'000);
    EXPECT_EQ(most, 1);
    QStringList texts;
    for (const QString& message : dialogs.Messages)
        texts << message.split(u"\r\n\r\n"_s);
    EXPECT_EQ(texts, (QStringList{u"kaputt a"_s, u"kaputt b"_s, u"kaputt c"_s}));

    // With the modern rule there is a line for each, and no box.
    QStringList lines;
    const Subscription notices =
        player_.Events().Notice.Subscribe([&](const QString& line) { lines << line; });
    player_.SetQuietFailures(true);
    dialogs.Messages.clear();
    list_.StartNewRound();
    list_.PlayEntry(1);
    Pass(20'000);
    EXPECT_EQ(lines.first(), u"kaputt b"_s);
    EXPECT_TRUE(dialogs.Messages.empty());
}

TEST_F(OutputTest, AfterASongThatFailedThePanelShowsIt) {
    ScriptedPanel panel;
    PlaySong(u"a.mp3"_s);
    player_.SetPanel(&panel);
    onCreate_[TEngine::FMOD] = Refuse<EWinAmpException>(u"kaputt"_s);
    EXPECT_THROW(player_.SetFileName(Add(u"b.mp3"_s)), EWinAmpException);
    EXPECT_EQ(player_.GetStatus(), psClosed);
    EXPECT_EQ(panel.Log, QStringList{u"redraw"_s});
}

}  // namespace
