#include "tests/playback/control/PlayerRig.h"

// Choosing an engine and falling back.

using namespace Qt::StringLiterals;

namespace {

using OpeningTest = PlayerTest;

TEST_F(OpeningTest, SongIsOpenedAndWaitsForPlay) {
    player_.SetFileName(Add(u"a.mp3"_s));
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    EXPECT_EQ(player_.GetStatus(), psStopped);
    player_.SetAutoPlay(true);
    player_.SetFileName(Add(u"b.mp3"_s));
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    player_.SetStatus(psClosed);
    EXPECT_EQ(player_.FileName(), QString());
    EXPECT_EQ(player_.GetStatus(), psClosed);
    EXPECT_EQ(player_.GetPosition() + player_.GetLength(), 0U);
}

TEST_F(OpeningTest, MissingFileOpensNothingAndClearsThePanel) {
    ScriptedPanel panel;
    player_.SetPanel(&panel);
    player_.SetFileName(folder_.Path(u"missing.mp3"_s));
    player_.Play();
    EXPECT_EQ(Open(), QString());
    EXPECT_EQ(panel.Log, (QStringList{u"clear"_s, u"redraw"_s}));
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(OpeningTest, AfterTheFirstEngineTheLastAllowedOneStays) {
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"FMOD kaputt"_s);
    player_.SetFileName(Add(u"a.mp3"_s));
    EXPECT_EQ(Messages(), (QStringList{u"FMOD kaputt\r\nVersuche EldoS"_s, u"FMOD kaputt\r\nVersuche MCI"_s,
                                       u"FMOD kaputt\r\nVersuche WinAmp"_s}));
    EXPECT_EQ(Open(), u"WinAmp:a"_s);
    EXPECT_EQ(player_.CurrentEngine(), TEngine::WinAmp);

    dialogs_.Messages.clear();
    Change([](EngineSettings& s) { s.UseWinAmp = false; });
    player_.Open();
    EXPECT_EQ(Messages().size(), 2);
    EXPECT_EQ(Open(), u"MCI:a"_s);
}

TEST_F(OpeningTest, EnginesThatFailInTheFallBackHandOverThemselves) {
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"f"_s);
    onCreate_[TEngine::EldoS] = Refuse<EEldoSException>(u"e"_s);
    onCreate_[TEngine::MCI] = Refuse<EMCIException>(u"m"_s);
    player_.SetFileName(Add(u"a.mp3"_s));
    QStringList shortMessages = Messages();
    shortMessages.replaceInStrings(u"\r\nVersuche "_s, u">"_s);
    EXPECT_EQ(shortMessages, (QStringList{u"f>EldoS"_s, u"e>MCI"_s, u"m>WinAmp"_s, u"e>WinAmp"_s, u"f>MCI"_s,
                                          u"m>WinAmp"_s, u"f>WinAmp"_s}));
    EXPECT_EQ(Open(), u"WinAmp:a"_s);
}

TEST_F(OpeningTest, ErrorOfTheLastEngineReachesTheCaller) {
    Change([](EngineSettings& s) { s.UseEldoS = s.UseMCI = s.UseWinAmp = false; });
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"f"_s);
    EXPECT_THROW(player_.SetFileName(Add(u"a.mp3"_s)), EFMODException);
    EXPECT_TRUE(Messages().isEmpty());

    Change([](EngineSettings& s) { s.UseWinAmp = true; });
    onCreate_[TEngine::WinAmp] = Refuse<EWinAmpException>(u"w"_s);
    EXPECT_THROW(player_.Open(), EWinAmpException);
    EXPECT_EQ(Open(), QString());
    player_.Play();
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(OpeningTest, WhoOpensAnotherSongWhileOneIsBeingOpenedHasTheLastWord) {
    onOpening_ = [this] { PlaySong(u"b.mp3"_s); };
    EXPECT_THROW(player_.SetFileName(Add(u"a.mp3"_s)), EAbort);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.FileName(), folder_.Path(u"b.mp3"_s));
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(player_.Timers().Ticking());

    onOpening_ = [this] {
        player_.Play();  // there is nothing to play yet
        EXPECT_FALSE(player_.Timers().Ticking());
        player_.SetFileName(QString());
    };
    EXPECT_THROW(player_.SetFileName(Add(u"c.mp3"_s)), EAbort);
    EXPECT_EQ(Open(), QString());
}

TEST_F(OpeningTest, WhoOpensAnotherSongWhileAMessageStandsHasTheLastWord) {
    InterruptingDialogs dialogs;
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"f"_s);
    dialogs.OnMessage = [this] {
        onCreate_.clear();
        PlaySong(u"b.mp3"_s);
    };
    EXPECT_THROW(player_.SetFileName(Add(u"a.mp3"_s)), EAbort);
    EXPECT_EQ(dialogs.Messages.size(), 1);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
}

TEST_F(OpeningTest, ClosingRestsTheTimers) {
    player_.SetAutoStop(5000);
    PlaySong(u"a.mp3"_s);
    EXPECT_TRUE(player_.Timers().Ticking() && player_.Timers().AutoStopPending());
    player_.SetFileName(Add(u"b.mp3"_s));
    EXPECT_FALSE(player_.Timers().Ticking() || player_.Timers().AutoStopPending());
}

}  // namespace
