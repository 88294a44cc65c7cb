#include "tsplayer/PlayerService.h"

#include <QTemporaryDir>
#include <atomic>

#include "MusicManagment/playback/extern/LocalExternalPlayer.h"
#include "MusicManagment/playback/winamp/Waiting.h"
#include "tests/playback/control/PlayerRig.h"
#include "tests/playback/engines/OtherProgram.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

// The player program with scripted engines.
struct PlayerProgram {
    explicit PlayerProgram(const QString& path) : player(Table()), server(77), service(player, server) {
        server.Listen(path);
        service.OnFailure = [this](const QString& message) { failures << message; };
        service.OnControllerGone = [this] { ++controllersGone; };
    }
    EngineTable Table() {
        EngineTable table;
        table.Register(TEngine::FMOD, [this](const EngineSettings&) {
            return std::make_unique<ScriptedFadingBackend>(stage, u"FMOD"_s);
        });
        return table;
    }

    Stage stage;
    TPlaySound player;
    ChannelServer server;
    PlayerService service;
    QStringList failures;
    int controllersGone = 0;
};

class PlayerServiceTest : public testing::Test {
 protected:
    // The player here, which has the songs played there.
    std::unique_ptr<TPlaySound> Controller() const {
        auto controller = std::make_unique<TPlaySound>(EngineTable());
        controller->SetExternalPlayer(std::make_unique<LocalExternalPlayer>(path_));
        controller->SetPlayExtern(true);
        return controller;
    }
    QStringList Log() {
        QStringList log;
        other_.Do([&](PlayerProgram& program) { log = program.stage.Log; });
        return log;
    }
    // This side goes on working meanwhile: it may be asked something.
    void PassThere(qint64 milliseconds) {
        std::atomic<bool> passed = false;
        other_.Begin([&](PlayerProgram& program) {
            clock_.Milliseconds += milliseconds;
            program.player.RunDueTimers();
            passed = true;
        });
        EXPECT_TRUE(WaitUntil([&] { return passed.load(); }, kPatience));
    }

    HandClock clock_;
    SongFolder folder_;
    QTemporaryDir socketFolder_;
    const QString path_ = socketFolder_.filePath(u"kanal"_s);
    OtherProgram<PlayerProgram> other_{path_};
};

TEST_F(PlayerServiceTest, ASongIsPlayedThereAsIfItWereHere) {
    const auto controller = Controller();
    QStringList events;
    controller->OnPlayingStarted = [&](TPlaySound&) { events << u"started"_s; };
    controller->OnPlayingPaused = [&](TPlaySound&) { events << u"paused"_s; };
    controller->OnPlayingResumed = [&](TPlaySound&) { events << u"resumed"_s; };
    controller->OnPlayingStopped = [&](TPlaySound&) { events << u"stopped"_s; };
    controller->OnPlaying = [&](TPlaySound&, quint32 position) { events << QString::number(position); };
    controller->SetFileName(folder_.Add(u"eins.mp3"_s));
    EXPECT_EQ(controller->GetStatus(), psStopped);
    EXPECT_EQ(controller->GetLength(), 180000U);
    controller->Play();
    EXPECT_EQ(controller->GetStatus(), psPlaying);
    PassThere(300);
    controller->SetPosition(5000);
    EXPECT_EQ(controller->GetPosition(), 5000U);
    controller->PauseResume();
    EXPECT_EQ(controller->GetStatus(), psPaused);
    controller->PauseResume();
    controller->Stop(StopMode::AtOnce);
    EXPECT_EQ(controller->GetStatus(), psStopped);
    controller->Close();
    EXPECT_EQ(controller->GetStatus(), psClosed);
    EXPECT_EQ(Log(), (QStringList{u"FMOD:eins open"_s, u"FMOD:eins play"_s, u"FMOD:eins pause"_s,
                                  u"FMOD:eins play"_s, u"FMOD:eins stop"_s, u"FMOD:eins gone"_s}));
    EXPECT_TRUE(WaitUntil([&] { return events.contains(u"stopped"_s); }, kPatience));
    EXPECT_TRUE(events.contains(u"300"_s));
    // How many ticks there were is the timer's business.
    events.removeIf([](const QString& event) { return event.at(0).isDigit(); });
    EXPECT_EQ(events, (QStringList{u"started"_s, u"paused"_s, u"resumed"_s, u"stopped"_s}));
}

TEST_F(PlayerServiceTest, EverySettingArrives) {
    EngineSettings settings;
    settings.UseMCI = settings.UseEldoS = settings.UseWinAmp = false;
    settings.FMODCrossoverTime = 40'000;
    settings.FMODSoundOutputTypes = FSOUND_OUTPUT_ALSA;
    settings.FMODMixRate = 48000;
    settings.FMODSoftChannels = 8;
    settings.FMODBufferSize = 200;
    settings.EldoSBufferCount = 6;
    settings.EldoSBufferSize = 4096;
    settings.WinAmpClassName = u"vlc"_s;
    settings.WinAmpFile = u"/opt/Spieler ä"_s;
    const auto controller = Controller();
    controller->SetEngines(settings);
    controller->SetFileName(folder_.Add(u"eins.mp3"_s));
    other_.Do([&](PlayerProgram& program) { EXPECT_EQ(program.player.Engines(), settings); });
    settings.UseFMOD = false;
    settings.FMODMixRate = 22050;
    controller->SetEngines(settings);
    other_.Do([&](PlayerProgram& program) { EXPECT_EQ(program.player.Engines(), settings); });
    // Nonsense from a stranger.
    LocalExternalPlayer stranger(path_);
    ASSERT_TRUE(stranger.Find());
    stranger.SendCommand(ecMixRate, -5'000'000'000);
    stranger.SendCommand(ecSoundOutputTypes, 8);
    stranger.SendCommand(ecOpenFile, 1);  // it must be a text
    stranger.SendText(ecPlay, u"x"_s);    // and this a number
    EXPECT_EQ(stranger.SendCommand(static_cast<ExternalCommand>(99), 1), 0);
    other_.Do([&](PlayerProgram& program) {
        EXPECT_EQ(program.player.Engines().FMODMixRate, 22050);
        EXPECT_EQ(program.player.Engines().FMODSoundOutputTypes, FSOUND_OUTPUT_ALSA);
        EXPECT_EQ(program.player.FileName(), controller->FileName());
    });
}

TEST_F(PlayerServiceTest, TheControllerDecidesAboutFadesWhileItWaits) {
    const auto controller = Controller();
    ScriptedPanel panel;
    controller->SetPanel(&panel);
    controller->SetFileName(folder_.Add(u"eins.mp3"_s));
    controller->Play();
    panel.Mode = coNone;
    EXPECT_FALSE(controller->PlayWithCrossFade(folder_.Add(u"zwei.mp3"_s)));
    panel.Mode = coAllChanges;
    EXPECT_TRUE(controller->PlayWithCrossFade(folder_.Add(u"zwei.mp3"_s)));
    other_.Do([](PlayerProgram& program) { EXPECT_EQ(program.stage.Alive.size(), 2U); });
    // The song that plays now is shown here.
    EXPECT_TRUE(WaitUntil([&] { return panel.Log.contains(u"zwei"_s); }, kPatience));

    // A song that sounds besides.
    controller->SetCOFileName(folder_.Add(u"drei.mp3"_s));
    EXPECT_EQ(Log().last(), u"FMOD:drei play"_s);
    controller->SetCOFileName(QString());
    EXPECT_EQ(Log().last(), u"FMOD:drei gone"_s);
    controller->Stop(StopMode::Fade);
    EXPECT_EQ(controller->GetStatus(), psPlaying);
    controller->SetPanel(nullptr);
}

TEST_F(PlayerServiceTest, FailuresStayThereAndTheSongEndsWithItsController) {
    auto controller = Controller();
    EngineSettings settings;
    settings.UseFMOD = settings.UseMCI = settings.UseEldoS = settings.UseWinAmp = false;
    const EngineSettings usual = controller->Engines();
    controller->SetFileName(folder_.Add(u"eins.mp3"_s));
    controller->SetEngines(settings);
    LocalExternalPlayer stranger(path_);
    ASSERT_TRUE(stranger.Find());
    stranger.SendText(ecOpenFile, folder_.Add(u"zwei.mp3"_s));
    other_.Do([&](PlayerProgram& program) {
        EXPECT_EQ(
            program.failures,
            QStringList{
                u"Keine Engine zum Verwenden freigegeben (UseFMOD, UseMCI, UseEldoS, UseWinAmp, ...)"_s});
    });
    controller->SetEngines(usual);
    controller->SetFileName(folder_.Add(u"drei.mp3"_s));
    controller->Play();
    controller.reset();
    int gone = 0;
    EXPECT_TRUE(WaitUntil(
        [&] {
            other_.Do([&](PlayerProgram& program) { gone = program.controllersGone; });
            return gone == 1;
        },
        kPatience));
    EXPECT_EQ(Log().last(), u"FMOD:drei gone"_s);
}

}  // namespace
