#pragma once

#include <gtest/gtest.h>

#include <QPointer>
#include <algorithm>
#include <map>

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/backend/FadingBackend.h"
#include "MusicManagment/playback/backend/GainBackend.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

class ScriptedBackend;

// What all back ends of a test write into, by "engine:song what".
struct Stage {
    QStringList Log;
    std::vector<ScriptedBackend*> Alive;
};

// A song that plays as far as the test's clock has gone.
class ScriptedBackend : public TPlaySoundContainer, public GainBackend {
 public:
    ScriptedBackend(Stage& stage, QString engine) : stage_(stage), engine_(std::move(engine)) {
        stage_.Alive.push_back(this);
    }
    ~ScriptedBackend() override {
        Note("gone");
        std::erase(stage_.Alive, this);
    }

    TPSStatus Status = psClosed;
    quint32 Length = 180'000;
    float Gain = -1;  // until one is set
    bool SeekPlays = false;
    std::function<void()> OnPositionAsked;
    std::function<void()> OnStatusAsked;
    std::function<void()> OnOpening;  // what happens while the engine waits

    QString Song() const { return QFileInfo(BackendFile()).completeBaseName(); }
    const QString& Engine() const { return engine_; }

    void Open() override {
        Note("open");
        const QPointer<ScriptedBackend> self(this);
        if (const auto happens = std::exchange(OnOpening, nullptr)) happens();
        if (self.isNull()) throw EAbort();
        Status = psStopped;
    }
    void Close() override { Status = psClosed; }
    void Play() override {
        Note("play");
        if (Status != psPlaying) started_ = CurrentClock().Ticks();
        Status = psPlaying;
    }
    void Stop() override {
        Note("stop");
        Status = psStopped;
        passed_ = 0;
    }
    void PauseResume() override {
        Note("pause");
        if (Status != psPlaying) return;
        passed_ = GetPosition();
        Status = psPaused;
    }
    quint32 GetPosition() override {
        if (OnPositionAsked) OnPositionAsked();
        const qint64 now = Status == psPlaying ? CurrentClock().Ticks() - started_ : 0;
        return static_cast<quint32>(std::min<qint64>(passed_ + now, Length));
    }
    void SetPosition(quint32 milliseconds) override {
        passed_ = milliseconds;
        started_ = CurrentClock().Ticks();
        if (SeekPlays) Status = psPlaying;
    }
    quint32 GetLength() override { return Length; }
    TPSStatus GetStatus() override {
        if (OnStatusAsked) OnStatusAsked();
        return Status;
    }
    void SetGain(float gain) override { Gain = gain; }

 protected:
    void Note(const char* what) {
        stage_.Log << engine_ + QLatin1Char(':') + Song() + QLatin1Char(' ') + QLatin1String(what);
    }

 private:
    Stage& stage_;
    QString engine_;
    qint64 passed_ = 0;
    qint64 started_ = 0;
};

class ScriptedFadingBackend : public ScriptedBackend, public FadingBackend {
 public:
    using ScriptedBackend::ScriptedBackend;

    int Volume = -1;
    quint32 FadeTime = 0;

    void SetVolume(int percent) override { Volume = percent; }
    void SetFadeTime(quint32 milliseconds) override { FadeTime = milliseconds; }
    void StartFadeIn() override { fadeInEnd_ = CurrentClock().Ticks() + FadeTime; }
    void StartFadeOut() override { fadeOutEnd_ = CurrentClock().Ticks() + FadeTime; }
    bool FadeStep() override {
        const qint64 now = CurrentClock().Ticks();
        if (fadeInEnd_ > 0)
            Volume = static_cast<int>(100 - std::max<qint64>(fadeInEnd_ - now, 0) * 100 / FadeTime);
        if (now > fadeInEnd_) fadeInEnd_ = 0;
        if (fadeOutEnd_ == 0) return false;
        Volume = static_cast<int>((fadeOutEnd_ - now) * 100 / FadeTime);
        if (now <= fadeOutEnd_) return false;
        fadeOutEnd_ = 0;
        Stop();
        return true;
    }
    bool IsFadingIn() const override { return fadeInEnd_ > 0; }
    bool IsFadingOut() const override { return fadeOutEnd_ > 0; }
    void CancelFades() override { fadeInEnd_ = fadeOutEnd_ = 0; }
    void CutFadeOut() override { fadeOutEnd_ = 1; }

 private:
    qint64 fadeInEnd_ = 0;
    qint64 fadeOutEnd_ = 0;
};

class ScriptedPanel : public PlayerPanel {
 public:
    TCrossover Mode = coAutoChange;
    QStringList Log;
    quint32 Position = 0, Length = 0;

    void ShowSong(const QString& fileName) override { Log << QFileInfo(fileName).completeBaseName(); }
    void Clear() override { Log << QStringLiteral("clear"); }
    void ShowPosition(quint32 position, quint32 length) override {
        Position = position;
        Length = length;
    }
    void Redraw() override { Log << QStringLiteral("redraw"); }
    TCrossover Crossover() const override { return Mode; }
    void SetCrossover(TCrossover mode) override { Mode = mode; }
};

class ScriptedController : public PlayController {
 public:
    TCrossover Mode = coNone;
    QStringList Log;  // "code parameter"; the ticks' only when they are wanted
    bool WithTicks = false;

    void Feedback(FeedbackCode code, quint32 parameter) override {
        if (!WithTicks && (code == fbPlaying || code == fbPosition)) return;
        Log << QStringLiteral("%1 %2").arg(code).arg(parameter);
    }
    void FeedbackFileName(const QString& fileName) override {
        Log << QStringLiteral("11 ") + QFileInfo(fileName).completeBaseName();
    }
    TCrossover AskCrossover() override {
        if (OnAsked) OnAsked();
        return Mode;
    }
    std::function<void()> OnAsked;
};

// Something happens while a message stands.
class InterruptingDialogs : public ScriptedDialogs {
 public:
    std::function<void()> OnMessage;
    void ShowMessage(MessageKind kind, const QString& text) override {
        ScriptedDialogs::ShowMessage(kind, text);
        OnMessage();
    }
};

// A player over scripted engines, and a folder with songs.
class PlayerTest : public testing::Test {
 protected:
    PlayerTest() : player_(Table()) {}

    QString Add(const QString& song) { return folder_.Add(song); }
    void PlaySong(const QString& song) {
        player_.SetFileName(Add(song));
        player_.Play();
    }
    // The player's timers run on the way.
    void Pass(qint64 milliseconds) {
        const qint64 end = clock_.Milliseconds + milliseconds;
        while (clock_.Milliseconds < end) {
            clock_.Milliseconds += std::min<qint64>(50, end - clock_.Milliseconds);
            player_.RunDueTimers();
        }
    }
    // The back end of a song; a failure when there is none.
    ScriptedFadingBackend& Fading(const QString& song) {
        return dynamic_cast<ScriptedFadingBackend&>(Any(song));
    }
    ScriptedBackend& Any(const QString& song) {
        for (ScriptedBackend* backend : stage_.Alive)
            if (backend->Song() == song) return *backend;
        throw std::runtime_error("no such song is open: " + song.toStdString());
    }
    // "engine:song" of all that are open.
    QString Open() const {
        QStringList names;
        for (const ScriptedBackend* backend : stage_.Alive)
            names << backend->Engine() + QLatin1Char(':') + backend->Song();
        return names.join(QLatin1Char(' '));
    }
    const QStringList& Messages() const { return dialogs_.Messages; }
    void Change(const std::function<void(EngineSettings&)>& change) {
        EngineSettings settings = player_.Engines();
        change(settings);
        player_.SetEngines(settings);
    }

    HandClock clock_;
    ScriptedDialogs dialogs_;
    SongFolder folder_;
    Stage stage_;
    // What an engine does before it makes a back end: throw, when it is to fail.
    std::map<TEngine, std::function<void()>> onCreate_;
    quint32 length_ = 180'000;                        // of the songs opened from now on
    float sharedGain_ = -1;                           // until one is set
    std::function<void()> onOpening_;                 // what happens while the next song is being opened
    std::function<void(ScriptedBackend&)> onOpened_;  // what is special about every song
    TPlaySound player_;

 private:
    EngineTable Table() {
        EngineTable table;
        table.SetSharedGain = [this](float gain) { sharedGain_ = gain; };
        for (const TEngine engine : {TEngine::FMOD, TEngine::EldoS, TEngine::MCI, TEngine::WinAmp})
            table.Register(engine, [this, engine](const EngineSettings&) { return Make(engine); });
        return table;
    }
    std::unique_ptr<TPlaySoundContainer> Make(TEngine engine) {
        if (onCreate_[engine]) onCreate_[engine]();
        std::unique_ptr<ScriptedBackend> backend;
        if (engine == TEngine::FMOD)
            backend = std::make_unique<ScriptedFadingBackend>(stage_, EngineName(engine));
        else
            backend = std::make_unique<ScriptedBackend>(stage_, EngineName(engine));
        backend->Length = length_;
        backend->OnOpening = std::exchange(onOpening_, nullptr);
        if (onOpened_) onOpened_(*backend);
        return backend;
    }
};

// The same with a playlist.
class ListedSongsTest : public PlayerTest {
 protected:
    ListedSongsTest() { player_.SetPlayList(&list_); }
    void List(const QStringList& songs) {
        for (const QString& song : songs)
            list_.Insert(list_.Count(), {.Name = Add(song)});
    }

    TPlayList list_;
};

// Has an engine refuse every song.
template <typename Exception>
std::function<void()> Refuse(const QString& message) {
    return [message] { throw Exception(message); };
}
