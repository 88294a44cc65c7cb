#include "tests/playback/control/PlayerRig.h"

// Fading stops and cross-fades.

using namespace Qt::StringLiterals;

namespace {

class FadesTest : public ListedSongsTest {
 protected:
    FadesTest() { player_.SetPanel(&panel_); }

    ScriptedPanel panel_;
};

TEST_F(FadesTest, FadingStopEndsWhenTheFadeHasRunOut) {
    ScriptedController controller;
    PlaySong(u"a.mp3"_s);
    player_.SetController(&controller);
    player_.Stop(StopMode::Fade);
    EXPECT_TRUE(controller.Log.isEmpty());
    Pass(5000);
    EXPECT_EQ(Fading(u"a"_s).Volume, 50);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    Pass(5250);
    EXPECT_EQ(player_.GetStatus(), psStopped);
    EXPECT_EQ(controller.Log, (QStringList{u"3 0"_s, u"5 1"_s}));
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(FadesTest, StopIsHardWhereAFadeIsNotPossible) {
    PlaySong(u"a.mp3"_s);
    player_.Stop(StopMode::Fade);
    player_.Stop(StopMode::Fade);  // the second wish is an urgent one
    EXPECT_EQ(player_.GetStatus(), psStopped);

    player_.Play();
    player_.PauseResume();
    player_.Stop(StopMode::Fade);
    EXPECT_EQ(player_.GetStatus(), psStopped);

    player_.Play();
    Change([](EngineSettings& s) { s.FMODCrossoverTime = 2999; });
    player_.Stop(StopMode::Fade);
    EXPECT_EQ(player_.GetStatus(), psStopped);

    PlaySong(u"track.cda"_s);
    Change([](EngineSettings& s) { s.FMODCrossoverTime = 3000; });
    player_.Stop(StopMode::Fade);
    EXPECT_EQ(player_.GetStatus(), psStopped);
}

TEST_F(FadesTest, PlayDuringAFadingStopBringsTheVolumeBack) {
    PlaySong(u"a.mp3"_s);
    player_.Stop(StopMode::Fade);
    Pass(5000);
    stage_.Log.clear();
    player_.Play();
    EXPECT_EQ(Fading(u"a"_s).Volume, 100);
    Pass(20'000);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(stage_.Log.isEmpty());
}

TEST_F(FadesTest, NoSongFollowsAStopThatFadesAtTheEnd) {
    length_ = 30'000;
    List({u"a.mp3"_s, u"b.mp3"_s});
    list_.PlayNext();
    Pass(19'000);
    player_.Stop(StopMode::Fade);
    Pass(13'000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    EXPECT_EQ(player_.GetStatus(), psStopped);
}

TEST_F(FadesTest, SongsCrossBeforeTheEnd) {
    length_ = 60'000;
    List({u"a.mp3"_s, u"b.mp3"_s});
    ScriptedController controller;
    controller.Mode = coAutoChange;
    player_.SetController(&controller);
    list_.PlayNext();
    Pass(50'000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    controller.Log.clear();
    Pass(250);
    EXPECT_EQ(Open(), u"FMOD:a FMOD:b"_s);
    EXPECT_EQ(controller.Log, (QStringList{u"8 0"_s, u"11 b"_s, u"5 1"_s, u"6 0"_s}));
    EXPECT_EQ(Fading(u"b"_s).Volume, 0);
    Pass(2500);
    EXPECT_EQ(Fading(u"a"_s).Volume, 75);
    EXPECT_EQ(Fading(u"b"_s).Volume, 25);
    Pass(7750);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(Fading(u"b"_s).Volume, 100);
    EXPECT_EQ(list_.CurrentSong(), folder_.Path(u"b.mp3"_s));
    EXPECT_EQ(list_.History().size(), 2);
}

TEST_F(FadesTest, ModeIsAskedAnewForEachDecision) {
    panel_.Mode = coNone;
    length_ = 20'000;
    List({u"a.mp3"_s, u"b.mp3"_s, u"c.mp3"_s});
    list_.PlayNext();
    Pass(15'000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    panel_.Mode = coAutoChange;
    Pass(250);
    EXPECT_EQ(Open(), u"FMOD:a FMOD:b"_s);
    player_.ClickMenuItem(112);  // the user's change is hard in this mode
    EXPECT_EQ(Open(), u"FMOD:c"_s);
    panel_.Mode = coAllChanges;
    player_.ClickMenuItem(111);
    EXPECT_EQ(Open(), u"FMOD:c FMOD:b"_s);
    ScriptedController controller;  // knows better than the panel
    player_.SetController(&controller);
    EXPECT_EQ(player_.Crossover(), coNone);
}

TEST_F(FadesTest, PlayDuringACrossFadeCutsTheOldSongShort) {
    PlaySong(u"a.mp3"_s);
    player_.PlayWithCrossFade(Add(u"b.mp3"_s));
    Pass(1000);
    player_.Play();
    EXPECT_EQ(Fading(u"b"_s).Volume, 100);
    Pass(250);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
}

TEST_F(FadesTest, BothSongsPauseAndGoOn) {
    PlaySong(u"a.mp3"_s);
    player_.PlayWithCrossFade(Add(u"b.mp3"_s));
    player_.PauseResume();
    EXPECT_EQ(Any(u"a"_s).Status, psPaused);
    EXPECT_EQ(Any(u"b"_s).Status, psPaused);
    player_.PauseResume();
    EXPECT_EQ(Any(u"a"_s).Status, psPlaying);
    EXPECT_EQ(Any(u"b"_s).Status, psPlaying);
    player_.Stop();
    EXPECT_EQ(Open(), u"FMOD:b"_s);
}

TEST_F(FadesTest, SongThatDoesNotSoundIsNotHeardAgainAfterAPause) {
    // The song before has come to its end, a moment before its fade would.
    PlaySong(u"a.mp3"_s);
    player_.PlayWithCrossFade(Add(u"b.mp3"_s));
    Any(u"a"_s).Status = psStopped;
    player_.PauseResume();
    player_.PauseResume();
    EXPECT_EQ(Any(u"a"_s).Status, psStopped);
    player_.PauseResume();
    player_.Play();
    EXPECT_EQ(Any(u"a"_s).Status, psStopped);
    EXPECT_EQ(Any(u"b"_s).Status, psPlaying);

    // It was paused, or stopped, when the next one was asked for.
    player_.PauseResume();
    EXPECT_TRUE(player_.PlayWithCrossFade(Add(u"c.mp3"_s)));
    EXPECT_EQ(Open(), u"FMOD:c"_s);
    player_.Stop();
    EXPECT_TRUE(player_.PlayWithCrossFade(Add(u"d.mp3"_s)));
    EXPECT_EQ(Open(), u"FMOD:d"_s);
    EXPECT_TRUE(Fading(u"d"_s).IsFadingIn());
}

TEST_F(FadesTest, WhateverPreventsACrossFadeLeavesTheSongAlone) {
    PlaySong(u"a.mp3"_s);
    const auto refuses = [this](const QString& path) {
        const bool done = player_.PlayWithCrossFade(path);
        EXPECT_EQ(Open(), u"FMOD:a"_s) << path.toStdString();
        EXPECT_EQ(player_.GetStatus(), psPlaying);
        EXPECT_EQ(player_.FileName(), folder_.Path(u"a.mp3"_s));
        EXPECT_TRUE(player_.Timers().Ticking());
        EXPECT_TRUE(Messages().isEmpty());
        return !done;
    };
    EXPECT_TRUE(refuses(folder_.Path(u"missing.mp3"_s)));
    EXPECT_TRUE(refuses(Add(u"track.cda"_s)));  // another engine's
    onCreate_[TEngine::FMOD] = Refuse<EFMODException>(u"kaputt"_s);
    EXPECT_TRUE(refuses(Add(u"b.mp3"_s)));
    onCreate_.clear();
    panel_.Mode = coNone;
    EXPECT_TRUE(refuses(Add(u"b.mp3"_s)));
    panel_.Mode = coAutoChange;
    Change([](EngineSettings& s) { s.FMODCrossoverTime = 2999; });
    EXPECT_TRUE(refuses(Add(u"b.mp3"_s)));
}

// A controller is another program: while it is asked it may go, which closes the song, or send commands.
TEST_F(FadesTest, SongMayChangeWhileTheModeIsAskedFor) {
    ScriptedController controller;
    controller.Mode = coAutoChange;
    length_ = 20'000;
    PlaySong(u"a.mp3"_s);
    player_.SetController(&controller);
    controller.OnAsked = [this] { player_.Close(); };
    EXPECT_FALSE(player_.PlayWithCrossFade(Add(u"b.mp3"_s)));
    EXPECT_EQ(Open(), QString());

    int crossovers = 0;
    player_.OnCrossover = [&](TPlaySound&) { ++crossovers; };
    controller.OnAsked = nullptr;
    PlaySong(u"c.mp3"_s);
    controller.OnAsked = [this] { player_.SetFileName(Add(u"d.mp3"_s)); };
    Pass(12'000);
    EXPECT_EQ(Open(), u"FMOD:d"_s);
    EXPECT_EQ(crossovers, 0);
}

TEST_F(FadesTest, NeighboursOnAnAlbumFollowWithoutAFade) {
    length_ = 20'000;
    const auto list = [this](const QString& song, const QString& album, quint8 track) {
        TID3Tag record;
        record.Artist = u"Band"_s;
        record.Album = album;
        record.Track = track;
        record.FileName = Add(song);
        list_.Insert(list_.Count(), {.Name = record.FileName, .Record = record});
    };
    list(u"a.mp3"_s, u"Platte"_s, 1);
    list(u"b.mp3"_s, u"Platte"_s, 2);
    list(u"c.mp3"_s, u"Platte"_s, 4);
    player_.SetKeepAlbums(true);
    list_.PlayNext();
    Pass(15'000);
    EXPECT_EQ(Open(), u"FMOD:a"_s);
    Pass(5500);
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    Pass(11'000);
    EXPECT_EQ(Open(), u"FMOD:b FMOD:c"_s);

    // What the user asks for is faded.
    panel_.Mode = coAllChanges;
    list_.PlayEntry(0);
    list_.PlayEntry(1, {.Change = player_.ChangeOnDemand()});
    EXPECT_EQ(Open(), u"FMOD:a FMOD:b"_s);
}

TEST_F(FadesTest, SongThatWasFadedInCountsToo) {
    TMusicDatabase database;
    player_.SetMusicDatabase(&database);
    database.AddSong(Add(u"a.wav"_s));
    database.AddSong(Add(u"b.wav"_s));
    player_.SetFileName(folder_.Path(u"a.wav"_s));
    player_.Play();
    Pass(30'000);
    player_.PlayWithCrossFade(folder_.Path(u"b.wav"_s));
    Pass(29'750);
    EXPECT_EQ(database.Song(database.IndexOf(folder_.Path(u"b.wav"_s))).PlayCount, 0U);
    Pass(250);
    EXPECT_EQ(database.Song(database.IndexOf(folder_.Path(u"a.wav"_s))).PlayCount, 1U);
    EXPECT_EQ(database.Song(database.IndexOf(folder_.Path(u"b.wav"_s))).PlayCount, 1U);
}

}  // namespace
