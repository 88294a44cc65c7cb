#include "MusicManagment/playback/PlaySound.h"

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "tests/playback/control/PlayerRig.h"

using namespace Qt::StringLiterals;

namespace {

using PlaySoundTest = PlayerTest;

TEST_F(PlaySoundTest, StartTellsEventsPanelAndController) {
    ScriptedPanel panel;
    ScriptedController controller;
    player_.SetPanel(&panel);
    player_.SetController(&controller);
    QStringList events;
    player_.OnPlayingStarted = [&](TPlaySound&) { events << u"started"_s; };
    PlaySong(u"a.mp3"_s);
    EXPECT_EQ(events, QStringList{u"started"_s});
    EXPECT_EQ(panel.Log, (QStringList{u"a"_s, u"redraw"_s}));
    EXPECT_EQ(controller.Log, (QStringList{u"8 0"_s, u"11 a"_s, u"5 1"_s}));
}

TEST_F(PlaySoundTest, TickTellsPositionAndLength) {
    ScriptedPanel panel;
    ScriptedController controller;
    quint32 heard = 0;
    player_.OnPlaying = [&](TPlaySound&, quint32 position) { heard = position; };
    PlaySong(u"a.mp3"_s);
    player_.SetPanel(&panel);
    player_.SetController(&controller);
    controller.WithTicks = true;
    Pass(250);
    EXPECT_EQ(heard, 250U);
    EXPECT_EQ(panel.Position, 250U);
    EXPECT_EQ(panel.Length, 180'000U);
    EXPECT_EQ(controller.Log, (QStringList{u"2 250"_s, u"4 250"_s}));
}

TEST_F(PlaySoundTest, StopShowsThePositionOnceMore) {
    PlaySong(u"a.mp3"_s);
    Pass(5000);
    ScriptedPanel panel;
    ScriptedController controller;
    player_.SetPanel(&panel);
    player_.SetController(&controller);
    panel.Position = 5000;
    player_.Stop();
    EXPECT_EQ(player_.GetStatus(), psStopped);
    EXPECT_EQ(panel.Position, 0U);
    EXPECT_EQ(panel.Log, QStringList{u"redraw"_s});
    EXPECT_EQ(controller.Log, (QStringList{u"3 0"_s, u"5 1"_s}));
    EXPECT_FALSE(player_.Timers().Ticking());
}

TEST_F(PlaySoundTest, PauseRestsTheTimersAndResumeWakesThem) {
    ScriptedController controller;
    PlaySong(u"a.mp3"_s);
    player_.SetController(&controller);
    Pass(1000);
    player_.PauseResume();
    EXPECT_EQ(player_.GetStatus(), psPaused);
    EXPECT_FALSE(player_.Timers().Ticking());
    player_.SetStatus(psPaused);  // pauses or resumes
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    EXPECT_TRUE(player_.Timers().Ticking());
    EXPECT_EQ(controller.Log, (QStringList{u"9 0"_s, u"5 1"_s, u"10 0"_s, u"5 1"_s}));
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

TEST_F(PlaySoundTest, StatusesNobodyCanSetAreIgnored) {
    PlaySong(u"a.mp3"_s);
    player_.SetStatus(psOpening);
    player_.SetStatus(psSeeking);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    player_.SetStatus(psStopped);
    EXPECT_EQ(player_.GetStatus(), psStopped);
    player_.WaitForEnd(TPlaySound::WaitMode::Block);
    player_.SetStatus(psPlaying);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
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

TEST_F(PlaySoundTest, MenuHasItsCommands) {
    QStringList rows;
    for (const auto& item : player_.Menu().Items())
        rows << item->Caption() + u'|' + QString::number(item->Id()) + u'|' + item->Shortcut() + u'|' +
                    QString::number(item->ImageIndex());
    EXPECT_EQ(player_.Menu().Caption(), u"Player"_s);
    EXPECT_EQ(rows, (QStringList{u"Play|101|F5|69"_s, u"Pause|102|F6|70"_s, u"Stop|103|F7|71"_s, u"|0||-1"_s,
                                 u"Vorheriges|111|F9|72"_s, u"Nächstes|112|F10|73"_s, u"|0||-1"_s,
                                 u"10 Sek zurück|121|Alt+Left|74"_s, u"10 Sek vor|122|Alt+Right|75"_s,
                                 u"|0||-1"_s, u"Aktuelles Lied markieren|131||76"_s}));
    EXPECT_FALSE(player_.ClickMenuItem(999));
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

TEST_F(PlaySoundTest, MenuStopsWithAFadeOnlyWhenItIsAlwaysWanted) {
    ScriptedPanel panel;
    player_.SetPanel(&panel);
    panel.Mode = coAllChanges;
    PlaySong(u"a.mp3"_s);
    player_.ClickMenuItem(plStop);
    EXPECT_EQ(player_.GetStatus(), psStopped);
    panel.Mode = coAlways;
    player_.ClickMenuItem(plPlay);
    player_.ClickMenuItem(plStop);
    EXPECT_EQ(player_.GetStatus(), psPlaying);
    Pass(10'250);
    EXPECT_EQ(player_.GetStatus(), psStopped);
}

TEST_F(PlaySoundTest, SettingsComeBackAndDamagedOnesAreLeftOut) {
    const QString file = folder_.Path(u"settings.conf"_s);
    ScriptedPanel panel;
    player_.SetPanel(&panel);
    TMusicDatabase database;
    player_.SetMusicDatabase(&database);
    {
        TRWReg settings(u"\\Software\\RUK\\Tunestead3"_s, file);
        settings.WriteBool(u"UseWinamp"_s, false);
        settings.WriteBool(u"PSAutoPlay"_s, true);
        settings.WriteInteger(u"PSTimerInterval"_s, 100);
        settings.WriteInteger(u"CrossoverTime"_s, 4000);
        settings.WriteInteger(u"FMODSoundOutput"_s, 99);
        settings.WriteInteger(u"FMODMixRate"_s, -1);
        settings.WriteInteger(u"FMODSoftChannels"_s, 1025);
        settings.WriteString(u"WinAmpFileName"_s, u"mpv"_s);
        settings.WriteInteger(u"Crossover"_s, coAlways);
        LoadDatabaseSettings(database, settings);
    }
    EngineSettings expected;
    expected.UseWinAmp = false;
    expected.FMODCrossoverTime = 4000;
    expected.WinAmpFile = u"mpv"_s;
    EXPECT_EQ(player_.Engines(), expected);
    EXPECT_TRUE(player_.AutoPlay());
    EXPECT_EQ(player_.TimerInterval(), 100);
    EXPECT_EQ(panel.Mode, coAlways);

    TRWReg settings(u"\\Software\\RUK\\Tunestead3"_s, file);
    expected.EldoSBufferCount = 7;
    expected.FMODSoundOutputTypes = FSOUND_OUTPUT_ALSA;
    player_.SetEngines(expected);
    SaveDatabaseSettings(database, settings);
    player_.SetEngines({});
    panel.Mode = coNone;
    LoadDatabaseSettings(database, settings);
    EXPECT_EQ(player_.Engines(), expected);
    EXPECT_EQ(panel.Mode, coAlways);
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
