#include "MusicManagment/playback/winamp/WinAmpPlaySound.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "MusicManagment/playback/winamp/Waiting.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/PrivateBus.h"
#include "tests/playback/control/PlayerRig.h"
#include "tests/playback/engines/FakePlayer.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

class WinAmpTest : public testing::Test {
 protected:
    WinAmpTest() {
        settings_.Bus = client_;
        settings_.FileTimeout = kPatience;
        settings_.StartTimeout = kPatience;
        QFile file(song_);
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
    }
    ~WinAmpTest() override {
        QDBusConnection::disconnectFromBus(u"client"_s);
        QDBusConnection::disconnectFromBus(u"player"_s);
    }

    std::unique_ptr<TWinAmpPlaySound> Sound() const {
        auto sound = std::make_unique<TWinAmpPlaySound>(settings_);
        sound->SetBackendFile(song_);
        return sound;
    }
    std::unique_ptr<TWinAmpPlaySound> Playing() {
        player_.Appear();
        auto sound = Sound();
        sound->Open();
        sound->Play();
        return sound;
    }
    // Lets time pass, and the back end ask the player once and take the answer.
    int StatusAfter(TWinAmpPlaySound& sound, int milliseconds) {
        clock_.Milliseconds += milliseconds;
        const int told = player_.StatesTold;
        sound.GetStatus();
        // A question of our own comes after that of the back end, and so does its answer.
        MprisState state;
        const MprisPlayer same(client_, u"org.mpris.MediaPlayer2.fake"_s, 1000);
        WaitUntil([&] { return player_.StatesTold > told; }, 1000);
        same.ReadState(state);
        return sound.GetStatus();
    }
    // The player ends, and the back end comes to notice it.
    void Vanish(TWinAmpPlaySound& sound) {
        player_.Vanish();
        EXPECT_TRUE(WaitUntil(
            [&] {
                clock_.Milliseconds += 100;
                return sound.GetStatus() == psStopped;
            },
            kPatience));
    }

    HandClock clock_;
    QTemporaryDir folder_;
    const QString song_ = folder_.filePath(u"Ärger & 100 % Spaß #1.mp3"_s);
    PrivateBus bus_;
    QDBusConnection client_ = bus_.Connect(u"client"_s);
    FakePlayer player_{bus_.Connect(u"player"_s), u"fake"_s};
    TWinAmpSettings settings_;
};

TEST_F(WinAmpTest, AnOpenedSongIsHeldAtItsStartUntilItIsPlayed) {
    player_.Appear();
    const auto sound = Sound();
    EXPECT_EQ(sound->GetStatus(), psClosed);
    sound->Open();
    EXPECT_EQ(player_.File, song_);
    EXPECT_EQ(sound->GetStatus(), psStopped);
    EXPECT_EQ(sound->GetLength(), 180000U);
    player_.Position = 70000;
    EXPECT_TRUE(WaitUntil([this] { return player_.Calls.contains(u"SetPosition"_s); }, kPatience));
    EXPECT_EQ(player_.Status, u"Paused"_s);
    EXPECT_EQ(player_.Position, 0);
    clock_.Milliseconds += 5000;
    EXPECT_EQ(sound->GetPosition(), 0U);

    sound->Play();
    EXPECT_EQ(player_.Status, u"Playing"_s);
    EXPECT_EQ(sound->GetStatus(), psPlaying);
    sound->Close();
    EXPECT_TRUE(WaitUntil([this] { return player_.Status == "Stopped"_L1; }, kPatience));
    EXPECT_EQ(sound->GetStatus(), psClosed);
}

TEST_F(WinAmpTest, PositionFollowsThePlayerAndTheTimeBetween) {
    const auto sound = Playing();
    StatusAfter(*sound, 100);
    EXPECT_EQ(player_.Calls, QStringList{u"OpenUri"_s});  // played at once, and not interrupted
    player_.Position = 30'000'000;
    StatusAfter(*sound, 100);
    EXPECT_EQ(sound->GetPosition(), 30000U);
    clock_.Milliseconds += 40;
    EXPECT_EQ(sound->GetPosition(), 30040U);

    sound->PauseResume();
    EXPECT_EQ(player_.Status, u"Paused"_s);
    EXPECT_EQ(StatusAfter(*sound, 2000), psPaused);
    EXPECT_EQ(sound->GetPosition(), 30000U);
    sound->PauseResume();

    sound->SetPosition(90000);
    EXPECT_EQ(player_.Position, 90'000'000);
    EXPECT_EQ(sound->GetPosition(), 90000U);
    // It takes a while to get there.
    player_.Position = 30'000'000;
    StatusAfter(*sound, 100);
    EXPECT_EQ(sound->GetPosition(), 90100U);
    StatusAfter(*sound, 2000);
    EXPECT_EQ(sound->GetPosition(), 30000U);
    sound->SetPosition(999999);
    EXPECT_EQ(player_.Position, player_.Length);
    // Nonsense is no more than the end.
    player_.Position = std::numeric_limits<qint64>::max();
    StatusAfter(*sound, 2000);
    clock_.Milliseconds += 40;
    EXPECT_EQ(sound->GetPosition(), sound->GetLength());

    sound->Stop();
    EXPECT_EQ(sound->GetStatus(), psStopped);
    clock_.Milliseconds += 5000;
    EXPECT_EQ(sound->GetPosition(), 0U);
    EXPECT_EQ(player_.Position, 0);
    EXPECT_FALSE(player_.Calls.contains(u"Stop"_s));
    sound->Play();
    EXPECT_EQ(player_.Status, u"Playing"_s);
}

TEST_F(WinAmpTest, WhatTheUserDoesInThePlayerIsNoticed) {
    const auto sound = Playing();
    player_.Status = u"Paused"_s;
    EXPECT_EQ(StatusAfter(*sound, 2000), psPaused);
    sound->PauseResume();
    EXPECT_EQ(player_.Status, u"Playing"_s);
    // Another song: this one is over, where it was.
    player_.Position = 20'000'000;
    StatusAfter(*sound, 2000);
    player_.Load(u"/other.mp3"_s);
    EXPECT_EQ(StatusAfter(*sound, 100), psStopped);
    EXPECT_EQ(sound->GetPosition(), 20100U);
    // Closing does not disturb the other one, playing takes the player back.
    sound->Play();
    EXPECT_EQ(player_.File, song_);
    EXPECT_EQ(sound->GetStatus(), psPlaying);
}

TEST_F(WinAmpTest, ALengthThatThePlayerLearnsLaterIsWaitedFor) {
    player_.Appear();
    player_.Length = 0;
    const auto sound = Sound();
    sound->Open();
    QTimer::singleShot(0, sound.get(), [this] { player_.Length = 61'000'000; });
    EXPECT_EQ(sound->AskLength(), 61000U);
    player_.Vanish();
    settings_.File = folder_.filePath(u"none"_s);
    EXPECT_THROW(Sound()->Open(), EWinAmpMissing);
}

TEST_F(WinAmpTest, LoudnessIsThatOfTheOtherPlayersSlider) {
    const auto sound = Playing();
    sound->SetGain(0.25F);
    EXPECT_TRUE(WaitUntil([this] { return player_.Volume == 0.5; }, kPatience));
    sound->Close();
    sound->SetGain(1);  // no longer ours
    MprisState state;
    MprisPlayer(client_, u"org.mpris.MediaPlayer2.fake"_s, 1000).ReadState(state);
    EXPECT_EQ(player_.Volume, 0.5);
}

TEST_F(WinAmpTest, APlayerWithoutOpenUriIsStartedAgainWithTheFile) {
    PlayerScript script(folder_.filePath(u"fake"_s), [this](const QString& file) { player_.Load(file); });
    settings_.File = script.Path();
    player_.HasOpenUri = false;
    const auto sound = Playing();
    EXPECT_EQ(player_.File, song_);
    EXPECT_EQ(sound->GetStatus(), psPlaying);
}

TEST_F(WinAmpTest, APlayerThatDoesNotRunIsStartedAndWaitedFor) {
    int rounds = 0;
    QTimer late;
    QObject::connect(&late, &QTimer::timeout, &late, [&] {
        if (++rounds < 10) return;
        late.stop();
        player_.Appear();
    });
    PlayerScript script(folder_.filePath(u"fake"_s), [&](const QString& file) {
        player_.Load(file);
        late.start(10);
    });
    settings_.ClassName = u"FAKE"_s;
    settings_.File = script.Path();
    const auto sound = Sound();
    sound->Open();
    sound->Play();
    EXPECT_EQ(sound->GetStatus(), psPlaying);
    EXPECT_FALSE(player_.Calls.contains(u"OpenUri"_s));
    EXPECT_EQ(rounds, 10);

    // It ends in the middle of a song; the next one starts it again.
    Vanish(*sound);
    rounds = 0;
    sound->Play();
    EXPECT_EQ(rounds, 10);
    EXPECT_EQ(sound->GetStatus(), psPlaying);
}

TEST_F(WinAmpTest, APlayerThatIsGoneForGoodIsAnErrorEachTime) {
    settings_.ClassName = u"fake"_s;
    const auto sound = Playing();
    Vanish(*sound);
    for (int i = 0; i < 2; ++i) {
        EXPECT_EQ(ErrorOf<EWinAmpException>([&] { sound->Play(); }), u"Kann den Player fake nicht finden."_s);
        clock_.Milliseconds += 5000;
        EXPECT_EQ(sound->GetStatus(), psStopped);
    }
}

TEST_F(WinAmpTest, AMovingPositionIsPlayingWhateverTheStatusSays) {
    player_.StatusLags = true;
    const auto sound = Playing();
    for (int i = 0; i < 20; ++i) {
        player_.Position += 250'000;
        EXPECT_EQ(StatusAfter(*sound, 250), psPlaying);
    }
    // It stands still now.
    StatusAfter(*sound, 900);
    EXPECT_EQ(StatusAfter(*sound, 900), psStopped);
}

TEST_F(WinAmpTest, APositionThatCannotBeSetIsAnError) {
    const QString message = u"Fehler beim Setzen der neuen Position."_s;
    const auto sound = Playing();
    player_.SeekFails = true;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { sound->SetPosition(1000); }), message);
    player_.SeekFails = false;
    player_.HasTrackId = false;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { sound->SetPosition(1000); }), message);
    // Stopping then falls back to the player's own stop.
    sound->Stop();
    EXPECT_EQ(player_.Calls.last(), u"Stop"_s);
    player_.HasTrackId = true;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { sound->SetPosition(1000); }), QString());
}

TEST_F(WinAmpTest, OnlyAFittingPlayerIsTaken) {
    FakePlayer ourselves(bus_.Connect(u"ourselves"_s), u"tunestead.instance5"_s);
    FakePlayer browser(bus_.Connect(u"browser"_s), u"browser"_s);
    browser.Schemes.clear();
    FakePlayer vlc(bus_.Connect(u"vlc"_s), u"vlc.instance7"_s);
    vlc.Schemes = QStringList(u"http"_s);  // known to take files all the same
    ourselves.Appear();
    browser.Appear();
    player_.Appear();
    Sound()->Open();
    EXPECT_EQ(player_.File, song_);
    player_.File.clear();
    // One that is known to work comes first.
    vlc.Appear();
    Sound()->Open();
    EXPECT_EQ(vlc.File, song_);
    EXPECT_EQ(player_.File, QString());
    vlc.File.clear();
    settings_.ClassName = u"fake"_s;
    Sound()->Open();
    EXPECT_EQ(player_.File, song_);
    settings_.ClassName = u"VLC"_s;
    Sound()->Open();
    EXPECT_EQ(vlc.File, song_);
    EXPECT_EQ(browser.Calls + ourselves.Calls, QStringList());
    for (const QString& name : {u"ourselves"_s, u"browser"_s, u"vlc"_s})
        QDBusConnection::disconnectFromBus(name);
}

TEST_F(WinAmpTest, WhatDoesNotComeInTimeIsAnError) {
    settings_.StartTimeout = 100;
    settings_.FileTimeout = 100;
    settings_.AnswerTimeout = 100;
    settings_.ClassName = u"nobody"_s;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { Sound()->Open(); }), u"Kann den Player nobody nicht finden."_s);
    settings_.File = u"/bin/true"_s;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { Sound()->Open(); }),
              u"Der Player /bin/true hat sich nicht innerhalb von 1 Sekunden gemeldet."_s);

    settings_.ClassName = u"fake"_s;
    player_.Appear();
    player_.OpensNothing = true;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { Sound()->Open(); }),
              u"Der Player fake hat die Datei "_s + song_ + u" nicht innerhalb von 1 Sekunden geöffnet."_s);
    player_.Answers = false;
    EXPECT_EQ(ErrorOf<EWinAmpException>([&] { Sound()->Open(); }),
              u"Der Player fake nimmt die Datei "_s + song_ + u" nicht an."_s);
}

TEST_F(WinAmpTest, ASongThatGoesWhileItWaitsEndsTheCommandSilently) {
    player_.Appear();
    player_.OpensNothing = true;
    auto sound = Sound();
    QTimer look;
    QObject::connect(&look, &QTimer::timeout, &look, [&] {
        if (player_.Calls.contains(u"OpenUri"_s)) sound.reset();
    });
    look.start(10);
    EXPECT_THROW(sound->Open(), EAbort);
    EXPECT_EQ(sound, nullptr);
    // The player is not left alone with what it was handed.
    EXPECT_TRUE(WaitUntil([this] { return player_.Calls.contains(u"Stop"_s); }, kPatience));

    look.stop();
    sound = Sound();
    QTimer::singleShot(50, [&] { sound->Close(); });
    EXPECT_THROW(sound->Open(), EAbort);
    EXPECT_EQ(sound->GetStatus(), psClosed);
}

}  // namespace
