#pragma once

#include <QPointer>
#include <functional>
#include <memory>

#include "CommonRUKTools/MenuItem.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/Settings.h"
#include "MusicManagment/playback/EngineChoice.h"
#include "MusicManagment/playback/EngineErrors.h"
#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/PlayController.h"
#include "MusicManagment/playback/PlayCountClock.h"
#include "MusicManagment/playback/PlaySoundContainer.h"
#include "MusicManagment/playback/PlaySoundSettings.h"
#include "MusicManagment/playback/PlayTimers.h"
#include "MusicManagment/playback/PlayerPanel.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/SongPlayer.h"

class ExternalLink;
class FadingBackend;

enum class StopMode {
    AtOnce,
    Fade,  // at once where fading is not possible
};

// Through this one component the whole program plays a song. It chooses an engine for the file, falls back to
// others, fades from song to song, notices the end of a song, counts songs as played. Single-threaded.
class TPlaySound : public TPlaySoundContainer,
                   public SongPlayer,
                   public SettingsClient,
                   private FeedbackReceiver {
 public:
    // The engines are those of the table; see Engines.h for the real ones.
    explicit TPlaySound(EngineTable engines, QObject* parent = nullptr);
    ~TPlaySound() override;

    // --- The song (PlaySoundOpen.cpp) ---
    const QString& FileName() const { return fileName_; }
    // Closes the former song and opens this one, and plays it with AutoPlay. An empty name closes. A missing
    // file opens nothing. Throws EPlaySoundException when no engine is allowed for the file, and what the
    // last engine throws.
    void SetFileName(const QString& path) override;
    void Open() override;
    void Close() override;

    // --- Playing. Without a song they do nothing; they throw what the engine throws ---
    void Play() override;
    void Stop() override { Stop(StopMode::AtOnce); }
    void Stop(StopMode mode);
    void PauseResume() override;
    quint32 GetPosition() override;
    void SetPosition(quint32 milliseconds) override;
    quint32 GetLength() override;
    TPSStatus GetStatus() override;
    // Does what leads to this status; psOpening and psSeeking are ignored.
    void SetStatus(TPSStatus status);
    // Returns when the song has ended or was stopped.
    enum class WaitMode { Block, KeepInterfaceAlive };
    void WaitForEnd(WaitMode mode);

    // --- Fading (PlaySoundFades.cpp) ---
    bool PlayWithCrossFade(const QString& path) override;
    // A song that sounds while the current one keeps playing; empty when there is none.
    QString COFileName();
    void SetCOFileName(const QString& path);
    // As the controller or else the panel wants it; asked anew for every decision.
    TCrossover Crossover() const;

    // --- Properties ---
    bool AutoPlay() const override { return autoPlay_; }
    void SetAutoPlay(bool value) { autoPlay_ = value; }
    int TimerInterval() const { return timerInterval_; }
    void SetTimerInterval(int milliseconds);  // at least 1
    int AutoStop() const { return autoStop_; }
    void SetAutoStop(int milliseconds) override;
    const EngineSettings& Engines() const { return settings_; }
    // Hold for the next song; a reachable external player is told of each change.
    void SetEngines(const EngineSettings& settings);
    bool PlayExtern() const { return playExtern_; }
    // Closes the song here and opens it there. Without a channel to external players nothing changes.
    void SetPlayExtern(bool value);

    // --- Wiring ---
    TMusicDatabase* MusicDatabase() const { return database_; }
    // The database gets its reference to this player, and keeps its settings.
    void SetMusicDatabase(TMusicDatabase* database);
    TPlayList* PlayList() const { return playList_; }
    // The playlist gets its reference to this player.
    void SetPlayList(TPlayList* playList);
    QObject* RemoteControl() const { return remoteControl_; }
    void SetRemoteControl(QObject* component) { remoteControl_ = component; }
    QObject* DSPDraw() const { return dspDraw_; }
    void SetDSPDraw(QObject* component) { dspDraw_ = component; }
    PlayerPanel* Panel() const { return panel_; }
    void SetPanel(PlayerPanel* panel) { panel_ = panel; }
    PlayController* Controller() const { return controller_; }
    // The controller tells when it goes: SetController(nullptr).
    void SetController(PlayController* controller) { controller_ = controller; }
    // The way to a separate player program; nullptr: there is none.
    void SetExternalPlayer(std::unique_ptr<ExternalPlayer> player);
    void RedrawPanel() override;

    // --- Handlers of the timers; they throw what playing throws ---
    void Tick();
    void HandleEndOfSong();
    void HandleAutoStop();
    // Runs the handlers that are due by the clock, for those who have no event loop.
    void RunDueTimers();
    const PlayTimers& Timers() const { return timers_; }

    // --- Command menu (PlaySoundMenu.h) ---
    // Built at the first call.
    TMenuExItem& Menu();
    // Runs the operation behind an item; false when nobody knows the command. Throws what it throws.
    bool ClickMenuItem(int id);

    // --- Settings ---
    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

    // --- Events ---
    using TNotifyEvent = std::function<void(TPlaySound&)>;
    TNotifyEvent OnPlayingStarted;
    TNotifyEvent OnPlayingStopped;
    TNotifyEvent OnPlayingPaused;
    TNotifyEvent OnPlayingResumed;
    TNotifyEvent OnReachedEndOfSong;
    TNotifyEvent OnCrossover;
    std::function<void(TPlaySound&, quint32 position)> OnPlaying;

 private:
    using Backend = std::unique_ptr<TPlaySoundContainer>;

    // PlaySoundOpen.cpp
    Backend MakeBackend(TEngine engine, const QString& path);
    void CreateBackend(TEngine engine, const QString& message);
    void CreateBackendsAfter(TEngine failed, const ERukException& error);
    void OpenExternally();
    void CloseBackends();

    // PlaySoundTick.cpp
    enum class TickKind { Running, Last };
    void RunTick(TickKind kind);
    void ReportPosition(quint32 position, quint32 length);
    bool FinishFades();
    void CheckEnd(quint32 position, quint32 length);
    void CheckCrossFade(quint32 position, quint32 length);
    void CountSong();
    void CountSongWhenDue();
    void AskForNextSong(SongChange change);
    void PlayNextOfDatabase(SongChange change);
    void RunHandler(void (TPlaySound::*handler)());
    void StartTimers();
    void StopTimers();

    void FinishStop();
    void StateChanged();
    void Raise(const TNotifyEvent& event);
    void Feedback(FeedbackCode code, quint32 parameter = 0);
    qint64 HandleFeedback(int code, quint32 parameter) override;
    void HandleFeedbackText(int code, const QString& text) override;
    // True when the song plays in the external player. Falls back to playing here when there is none.
    bool UseExternal();
    bool CanFade() const;
    static FadingBackend* AsFading(const Backend& backend);

    EngineTable engineTable_;
    EngineSettings settings_;
    QString fileName_;
    QString coFileName_;
    Backend current_;
    Backend fading_;  // the song that fades out, or the one of COFileName
    PlayTimers timers_;
    PlayCountClock playCount_;
    std::unique_ptr<ExternalLink> external_;
    int timerInterval_ = 250;  // ms
    int autoStop_ = 0;         // ms; 0 off
    bool autoPlay_ = false;
    bool playExtern_ = false;
    bool endReached_ = false;
    bool crossFadeStarted_ = false;

    QPointer<TMusicDatabase> database_;
    QPointer<TPlayList> playList_;
    QPointer<QObject> remoteControl_;
    QPointer<QObject> dspDraw_;
    PlayerPanel* panel_ = nullptr;
    PlayController* controller_ = nullptr;
    std::unique_ptr<TMenuExItem> menu_;
};
