#include "MusicManagment/playback/PlaySound.h"

#include "MusicManagment/playback/PlaySoundMenu.h"
#include "tests/playback/control/PlayerRig.h"

using namespace Qt::StringLiterals;

namespace {

using PlaySoundTest = PlayerTest;

TEST_F(PlaySoundTest, EverybodyIsToldWhatASongDoes) {
    ScriptedPanel panel;
    ScriptedController controller;
    player_.SetPanel(&panel);
    player_.SetController(&controller);
    int started = 0;
    player_.OnPlayingStarted = [&](TPlaySound&) { ++started; };
    PlaySong(u"a.mp3"_s);
    EXPECT_EQ(started, 1);
    EXPECT_EQ(std::exchange(panel.Log, {}), (QStringList{u"a"_s, u"redraw"_s}));
    EXPECT_EQ(std::exchange(controller.Log, {}), (QStringList{u"8 0"_s, u"11 a"_s, u"5 1"_s}));
    controller.WithTicks = true;
    Pass(250);
    EXPECT_EQ(panel.Position, 250U);
    EXPECT_EQ(panel.Length, 180'000U);
    EXPECT_EQ(std::exchange(controller.Log, {}), (QStringList{u"2 250"_s, u"4 250"_s}));

    player_.SetStatus(psPaused);
    EXPECT_EQ(player_.GetStatus(), psPaused);
    EXPECT_FALSE(player_.Timers().Ticking());
    player_.SetStatus(psPaused);  // pauses or resumes
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(player_.Timers().Ticking());
    EXPECT_EQ(std::exchange(controller.Log, {}), (QStringList{u"9 0"_s, u"5 1"_s, u"10 0"_s, u"5 1"_s}));

    controller.WithTicks = false;
    player_.SetStatus(psStopped);
    EXPECT_EQ(player_.GetStatus(), psStopped);
    EXPECT_EQ(panel.Position, 0U);  // shown once more
    EXPECT_EQ(controller.Log, (QStringList{u"3 0"_s, u"5 1"_s}));
    EXPECT_FALSE(player_.Timers().Ticking());
    player_.WaitForEnd(TPlaySound::WaitMode::Block);
}

TEST_F(PlaySoundTest, HandlerMayStartAnotherSongWhenOneIsStopped) {
    PlaySong(u"a.mp3"_s);
    player_.OnPlayingStopped = [this](TPlaySound&) {
        player_.OnPlayingStopped = nullptr;
        PlaySong(u"b.mp3"_s);
    };
    player_.Stop();
    EXPECT_EQ(Open(), u"FMOD:b"_s);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(player_.Timers().Ticking());
}

TEST_F(PlaySoundTest, HandlerMayCloseTheSongInTheMiddleOfATick) {
    PlaySong(u"a.mp3"_s);
    player_.OnPlaying = [](TPlaySound& player, quint32) { player.SetFileName(QString()); };
    Pass(250);
    EXPECT_EQ(Open(), QString());
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(PlaySoundTest, LoudnessHoldsForTheSongAndThoseAfterIt) {
    PlaySong(u"a.mp3"_s);
    EXPECT_EQ(Any(u"a"_s).Gain, -1);  // another program keeps its own
    player_.SetGain(0.5F);
    EXPECT_EQ(Any(u"a"_s).Gain, 0.5F);
    EXPECT_EQ(sharedGain_, 0.5F);
    PlaySong(u"b.mp3"_s);
    EXPECT_EQ(Any(u"b"_s).Gain, 0.5F);
    player_.SetGain(7);
    EXPECT_EQ(Any(u"b"_s).Gain, 1);
}

TEST_F(PlaySoundTest, MenuMovesThePositionWithinTheSong) {
    PlaySong(u"a.mp3"_s);
    const auto positionAfter = [this](quint32 from, int command) {
        player_.SetPosition(from);
        player_.ClickMenuItem(command);
        return player_.GetPosition();
    };
    EXPECT_EQ(positionAfter(25'000, plBack), 15'000U);
    EXPECT_EQ(positionAfter(4000, plBack), 0U);
    EXPECT_EQ(positionAfter(25'000, plForward), 35'000U);
    EXPECT_EQ(positionAfter(175'000, plForward), 180'000U);
}

TEST_F(PlaySoundTest, ReferencesClearThemselvesOnBothSides) {
    TMusicDatabase database;
    auto list = std::make_unique<TPlayList>();
    {
        TPlaySound player{EngineTable()};
        player.SetMusicDatabase(&database);
        player.SetPlayList(list.get());
        EXPECT_EQ(database.PlaySound(), &player);
        EXPECT_EQ(list->PlaySound(), static_cast<SongPlayer*>(&player));
    }
    EXPECT_EQ(database.PlaySound(), nullptr);
    EXPECT_EQ(list->PlaySound(), nullptr);
    player_.SetPlayList(list.get());
    list.reset();
    EXPECT_EQ(player_.PlayList(), nullptr);
}

}  // namespace
