#include "tests/playback/engines/EngineRigs.h"

#include <QTemporaryDir>
#include <QThread>

#include "MusicManagment/playback/eldos/EldoSPlaySound.h"
#include "MusicManagment/playback/eldos/NullPush.h"
#include "MusicManagment/playback/eldos/SdlPush.h"
#include "MusicManagment/playback/fmod/FMODPlaySound.h"
#include "MusicManagment/playback/fmod/SinkOutput.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "MusicManagment/playback/mci/MCIPlaySound.h"
#include "MusicManagment/playback/winamp/Waiting.h"
#include "MusicManagment/playback/winamp/WinAmpPlaySound.h"
#include "tests/PrivateBus.h"
#include "tests/playback/control/PlayerRig.h"
#include "tests/playback/engines/FakePlayer.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kStep = 20;  // ms

template <typename Exception>
QString OpenErrorOf(TPlaySoundContainer& sound) {
    try {
        sound.Open();
    } catch (const Exception& error) {
        return error.Message();
    } catch (const EOutputException& error) {
        return u"output: "_s + error.Message();
    }
    return {};
}

OutputChoice UnpacedOr(bool hasOutput) {
    if (hasOutput) return {.kind = OutputChoice::Kind::Null, .unpaced = true};
    return {.kind = OutputChoice::Kind::Sdl, .name = u"no such driver"_s};
}

class FmodRig : public EngineRig {
 public:
    explicit FmodRig(bool hasOutput) : library_(OutputsFor(UnpacedOr(hasOutput))) {}

    std::unique_ptr<TPlaySoundContainer> Make() override {
        return std::make_unique<TFMODPlaySound>(library_, TFMODSettings{});
    }
    QString OpenError(TPlaySoundContainer& sound) override { return OpenErrorOf<EFMODException>(sound); }
    void Pass(TPlaySoundContainer&, int milliseconds) override {
        library_.Advance(static_cast<std::size_t>(44100 * milliseconds / 1000));
    }

 private:
    SoundLibrary library_;
};

class EldoSRig : public EngineRig {
 public:
    explicit EldoSRig(bool hasOutput) {
        settings_.MakeOutput = [hasOutput]() -> std::unique_ptr<PushOutput> {
            if (hasOutput) return std::make_unique<NullPush>();
            return std::make_unique<SdlPush>(QStringList{u"no such driver"_s});
        };
    }

    std::unique_ptr<TPlaySoundContainer> Make() override {
        return std::make_unique<TEldoSPlaySound>(settings_);
    }
    QString OpenError(TPlaySoundContainer& sound) override { return OpenErrorOf<EEldoSException>(sound); }
    void Pass(TPlaySoundContainer& sound, int milliseconds) override {
        clock_.Milliseconds += milliseconds;
        dynamic_cast<TEldoSPlaySound&>(sound).TopUp();
    }

 private:
    HandClock clock_;
    TEldoSSettings settings_;
};

// Real time: the player of the system has no other.
class MciRig : public EngineRig {
 public:
    explicit MciRig(bool hasOutput) : mci_(hasOutput ? MciSound::Silent : MciSound::Audible) {
        if (hasOutput) return;
        // Neither a sound server nor a card is found with these.
        qputenv("PULSE_SERVER", "/dev/null");
        qputenv("PIPEWIRE_REMOTE", "none");
        qputenv("ALSA_CONFIG_PATH", "/dev/null");
    }

    std::unique_ptr<TPlaySoundContainer> Make() override {
        return std::make_unique<TMCIPlaySound>(mci_, folder_.filePath(u"settings.conf"_s));
    }
    QString OpenError(TPlaySoundContainer& sound) override { return OpenErrorOf<EMCIException>(sound); }
    void Pass(TPlaySoundContainer&, int milliseconds) override {
        QThread::msleep(static_cast<unsigned long>(milliseconds));
    }

 private:
    QTemporaryDir folder_;
    GstMci mci_;
};

// The other player goes with the clock of the test, and tells what it does whenever it is asked.
class WinAmpRig : public EngineRig {
 public:
    WinAmpRig() {
        settings_.Bus = bus_.Connect(u"rig"_s);
        player_.Length = 2'000'000;
        player_.Appear();
    }
    ~WinAmpRig() override {
        QDBusConnection::disconnectFromBus(u"rig"_s);
        QDBusConnection::disconnectFromBus(u"rig's player"_s);
    }

    std::unique_ptr<TPlaySoundContainer> Make() override {
        return std::make_unique<TWinAmpPlaySound>(settings_);
    }
    QString OpenError(TPlaySoundContainer& sound) override { return OpenErrorOf<EWinAmpException>(sound); }
    void Pass(TPlaySoundContainer& sound, int milliseconds) override {
        clock_.Milliseconds += milliseconds;
        if (player_.Status == u"Playing"_s) player_.Position += 1000 * milliseconds;
        if (player_.Position >= player_.Length) {
            player_.Status = u"Stopped"_s;
            player_.Position = 0;
        }
        const int told = player_.StatesTold;
        sound.GetStatus();
        WaitUntil([&] { return player_.StatesTold > told; }, 100);
        // A question of our own comes after that of the back end, and so does its answer.
        MprisState state;
        MprisPlayer(settings_.Bus, u"org.mpris.MediaPlayer2.rig"_s, 1000).ReadState(state);
    }

 private:
    HandClock clock_;
    PrivateBus bus_;
    FakePlayer player_{bus_.Connect(u"rig's player"_s), u"rig"_s};
    TWinAmpSettings settings_;
};

}  // namespace

bool EngineRig::Await(TPlaySoundContainer& sound, const std::function<bool()>& condition) {
    for (int passed = 0; passed < kPatience; passed += kStep) {
        if (condition()) return true;
        Pass(sound, kStep);
    }
    return condition();
}

std::unique_ptr<TPlaySoundContainer> EngineRig::Open(const QString& path) {
    auto sound = Make();
    sound->SetBackendFile(path);
    sound->Open();
    return sound;
}

QString EngineRig::Refusal(const QString& path) {
    const auto sound = Make();
    sound->SetBackendFile(path);
    const QString error = OpenError(*sound);
    EXPECT_EQ(sound->GetStatus(), error.isEmpty() ? psStopped : psClosed);
    return error;
}

std::unique_ptr<EngineRig> MakeRig(TEngine engine, bool hasOutput) {
    switch (engine) {
        case TEngine::FMOD:
            return std::make_unique<FmodRig>(hasOutput);
        case TEngine::EldoS:
            return std::make_unique<EldoSRig>(hasOutput);
        case TEngine::MCI:
            return std::make_unique<MciRig>(hasOutput);
        case TEngine::WinAmp:
            return std::make_unique<WinAmpRig>();
    }
    throw std::runtime_error("no rig for this engine");
}

EngineSettings Only(TEngine engine) {
    EngineSettings settings;
    settings.UseFMOD = engine == TEngine::FMOD;
    settings.UseEldoS = engine == TEngine::EldoS;
    settings.UseMCI = engine == TEngine::MCI;
    settings.UseWinAmp = engine == TEngine::WinAmp;
    return settings;
}
