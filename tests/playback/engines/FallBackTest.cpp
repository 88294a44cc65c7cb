// The player over the engines of this build, and what remains when they really fail.

#include <gtest/gtest.h>

#include <QDir>

#include "MusicManagment/playback/Engines.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "tests/PrintQt.h"
#include "tests/PrivateBus.h"
#include "tests/ScriptedDialogs.h"
#include "tests/playback/SoundFiles.h"
#include "tests/playback/engines/FakePlayer.h"
#include "tests/playback/engines/OtherProgram.h"

using namespace Qt::StringLiterals;

namespace {

// Another player of the desktop, in a thread of its own.
class OtherPlayer {
 public:
    explicit OtherPlayer(const PrivateBus* bus) : player_(bus->Connect(u"other player"_s), u"fake"_s) {
        player_.Appear();
    }
    ~OtherPlayer() { QDBusConnection::disconnectFromBus(u"other player"_s); }
    QString File() const { return player_.File; }

 private:
    FakePlayer player_;
};

class FallBackTest : public testing::Test {
 protected:
    // The user's own session, with its players, is none of our business.
    static void SetUpTestSuite() {
        bus_ = new PrivateBus;
        qputenv("DBUS_SESSION_BUS_ADDRESS", bus_->Address().toLatin1());
        qputenv("TUNESTEAD_AUDIO", "null");
    }
    static void TearDownTestSuite() {
        QDBusConnection::disconnectFromBus(u"qt_default_session_bus"_s);
        delete bus_;
        qunsetenv("TUNESTEAD_AUDIO");
    }

    FallBackTest() { WriteWav(song_, Sine({}, 2)); }
    ~FallBackTest() override { qputenv("PATH", path_); }

    // FMOD finds no device there, with any file.
    void LoseDevice() {
        player_.reset();
        library_ = std::make_shared<SoundLibrary>([](TFSoundOutputTypes) { return nullptr; });
        player_ = std::make_unique<TPlaySound>(MakeEngines(library_, mci_));
    }
    void UninstallPlayers() const { qputenv("PATH", folder_.path().toLocal8Bit()); }
    void Allow(const QString& letters) {
        EngineSettings settings = player_->Engines();
        settings.UseFMOD = letters.contains(u'F');
        settings.UseEldoS = letters.contains(u'E');
        settings.UseMCI = letters.contains(u'M');
        settings.UseWinAmp = letters.contains(u'W');
        player_->SetEngines(settings);
    }
    // "reason>engine tried next" of what the user was shown, each reason cut to its first words.
    QStringList Told() const {
        QStringList told;
        for (const QString& message : dialogs_.Messages) {
            const QStringList parts = message.split(u"\r\nVersuche "_s);
            told << parts.first().section(u' ', 0, 2) + u'>' + parts.value(1);
        }
        return told;
    }
    QString Junk() const {
        const QString path = folder_.filePath(u"kaputt.mp3"_s);
        WriteBytes(path, QByteArray("nothing that anybody could play ").repeated(400));
        return path;
    }

    static inline PrivateBus* bus_ = nullptr;
    const QByteArray path_ = qgetenv("PATH");
    QTemporaryDir folder_;
    const QString song_ = folder_.filePath(u"a.wav"_s);
    ScriptedDialogs dialogs_;
    std::shared_ptr<SoundLibrary> library_ = std::make_shared<SoundLibrary>();
    std::shared_ptr<GstMci> mci_ = std::make_shared<GstMci>(MciSound::Silent);
    std::unique_ptr<TPlaySound> player_ = std::make_unique<TPlaySound>(MakeEngines(library_, mci_));
};

TEST_F(FallBackTest, EnginesThatAreSwitchedOffArePassedOver) {
    UninstallPlayers();
    for (const auto& [allowed, engine] :
         {std::pair(u"FEM"_s, TEngine::FMOD), std::pair(u"EM"_s, TEngine::EldoS),
          std::pair(u"M"_s, TEngine::MCI)}) {
        player_->SetFileName({});
        Allow(allowed);
        player_->SetFileName(song_);
        player_->Play();
        EXPECT_EQ(player_->CurrentEngine(), engine);
        EXPECT_EQ(player_->GetStatus(), psPlaying);
    }
    EXPECT_EQ(Told(), QStringList());
    player_->SetFileName({});
    Allow(QString());
    EXPECT_THROW(player_->SetFileName(song_), EPlaySoundException);
}

TEST_F(FallBackTest, WithoutADeviceTheLastEngineThatIsAllowedPlays) {
    LoseDevice();
    Allow(u"FEM"_s);
    player_->SetFileName(song_);
    EXPECT_EQ(Told(),
              (QStringList{u"Fehler beim Initialisieren>EldoS"_s, u"Fehler beim Initialisieren>MCI"_s}));
    EXPECT_EQ(player_->CurrentEngine(), TEngine::MCI);
    player_->Play();
    EXPECT_EQ(player_->GetStatus(), psPlaying);
    EXPECT_EQ(player_->GetLength(), 2000U);

    dialogs_.Messages.clear();
    Allow(u"FE"_s);
    player_->Open();
    EXPECT_EQ(Told(), QStringList{u"Fehler beim Initialisieren>EldoS"_s});
    EXPECT_EQ(player_->CurrentEngine(), TEngine::EldoS);
    player_->Play();
    EXPECT_EQ(player_->GetStatus(), psPlaying);
}

TEST_F(FallBackTest, WithAllEnginesAnotherPlayerHasTheSongAfterThreeMessages) {
    OtherProgram<OtherPlayer> other(bus_);
    LoseDevice();
    player_->SetFileName(song_);
    const QString why = u"Fehler beim Initialisieren>"_s;
    EXPECT_EQ(Told(), (QStringList{why + u"EldoS"_s, why + u"MCI"_s, why + u"WinAmp"_s}));
    EXPECT_EQ(player_->CurrentEngine(), TEngine::WinAmp);
    QString handedOver;
    other.Do([&](const OtherPlayer& player) { handedOver = player.File(); });
    EXPECT_EQ(handedOver, song_);
    player_->Play();
    EXPECT_EQ(player_->GetStatus(), psPlaying);
}

TEST_F(FallBackTest, ADamagedSongGoesThroughAllEnginesToTheErrorOfTheLast) {
    UninstallPlayers();
    try {
        player_->SetFileName(Junk());
        ADD_FAILURE() << "opened";
    } catch (const EWinAmpException& error) {
        EXPECT_EQ(error.Message(),
                  u"Es läuft kein Player, und keiner von diesen ist installiert: audacious, vlc, mpv."_s);
    }
    EXPECT_EQ(Told(), (QStringList{u"Fehler beim Öffnen>EldoS"_s, u"Kann die Datei>MCI"_s,
                                   u"Fehler bei mciSendCommand>WinAmp"_s}));
    EXPECT_EQ(player_->CurrentEngine(), std::nullopt);
    EXPECT_EQ(player_->GetStatus(), psClosed);
}

TEST_F(FallBackTest, AMissingSongIsNoFailure) {
    player_->SetFileName(folder_.filePath(u"fehlt.mp3"_s));
    player_->Play();
    EXPECT_EQ(Told(), QStringList());
    EXPECT_EQ(player_->GetStatus(), psClosed);
}

}  // namespace
