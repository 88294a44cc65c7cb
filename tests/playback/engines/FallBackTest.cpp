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

    // "reason>engine tried next" of what the user was shown, each reason cut to its first words.
    QStringList Told() const {
        QStringList told;
        for (const QString& message : dialogs_.Messages) {
            const QStringList parts = message.split(u"\r\nVersuche "_s);
            told << parts.first().section(u' ', 0, 2) + u'>' + parts.value(1);
        }
        return told;
    }
    static inline PrivateBus* bus_ = nullptr;
    QTemporaryDir folder_;
    const QString song_ = folder_.filePath(u"a.wav"_s);
    ScriptedDialogs dialogs_;
    std::shared_ptr<SoundLibrary> library_ = std::make_shared<SoundLibrary>();
    std::shared_ptr<GstMci> mci_ = std::make_shared<GstMci>(MciSound::Silent);
    std::unique_ptr<TPlaySound> player_ = std::make_unique<TPlaySound>(MakeEngines(library_, mci_));
};

TEST_F(FallBackTest, WithAllEnginesAnotherPlayerHasTheSongAfterThreeMessages) {
    OtherProgram<OtherPlayer> other(bus_);
    EngineSettings settings;
    settings.FMODMixRate = 1;  // FMOD refuses, with any file
    player_->SetEngines(settings);
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

}  // namespace
