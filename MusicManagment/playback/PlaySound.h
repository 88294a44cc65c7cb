#pragma once

#include <QPointer>
#include <functional>
#include <memory>
#include <optional>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/OwnEngines.h"
#include "MusicManagment/playback/PlayController.h"
#include "MusicManagment/playback/PlayCountClock.h"
#include "MusicManagment/playback/PlaySoundSettings.h"
#include "MusicManagment/playback/PlayTimers.h"
#include "MusicManagment/playback/PlayerEvents.h"
#include "MusicManagment/playback/PlayerPanel.h"
#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/SongPlayer.h"

class CommandDispatcher;
class ExternalTarget;
class TMenuExItem;

// Through this one component the whole program plays a song. It chooses an engine for the file, falls back to
// others, fades from song to song, notices the end of a song, counts songs as played. Single-threaded.
class TPlaySound : public TPlaySoundContainer,
                   public SongPlayer,
                   public SettingsClient,
                   private FeedbackReceiver {
 public:
    // The engines are those of the table; Engines.h has the real ones.
    explicit TPlaySound(EngineTable engines, QObject* parent = nullptr);
    ~TPlaySound() override;

    // --- The song (PlaySoundOpen.cpp) ---
    const QString& FileName() const { return fileName_; }
    // Closes the former song and opens this one, and plays it with AutoPlay. An empty name only closes. A
    // missing file opens nothing. Throws EPlaySoundException when no engine is allowed for the file, and what
    // the last engine throws; nothing is open then. Throws EAbort when another song was opened, or this one
    // closed, while it was being opened: engines and messages may let the event loop run. Where the way to
    // the loudspeaker fails, here or later, nothing is thrown: the user is told once, and the song waits.
    void SetFileName(const QString& path) override;
    void Open() override;
    void Close() override;
    // The engine that has the song, be it after others refused; nothing when none has it or it is the
    // external player's.
    std::optional<TEngine> CurrentEngine() const { return engines_.Engine(); }
    // Whether the song goes on by itself as soon as there is an output again; it counts as paused until then.
    bool AwaitsOutput() const { return timers_.OutputPending(); }

    // --- Playing. Without a song they do nothing. They throw what the engine throws, but for the Get
    // questions, which windows and the desktop ask at any time: a song whose engine fails is as good as
    // closed, and the next tick or command tells why. ---
    void Play() override;
    void Stop() override { Stop(StopMode::AtOnce); }
    void Stop(StopMode mode);
    void PauseResume() override;
    quint32 GetPosition() override;
    void SetPosition(quint32 milliseconds) override;
    // Forwards or, below 0, backwards within the song.
    void MoveBy(qint64 milliseconds);
    quint32 GetLength() override;
    TPSStatus GetStatus() override;
    // Does what leads to this status; psOpening and psSeeking are ignored.
    void SetStatus(TPSStatus status);
    // The song that plays; -1 when the collection does not have it.
    SongIndex SongInDatabase() const;
    // Has the database mark it.
    void MarkSong();
    // Returns when the song has ended or was stopped.
    enum class WaitMode { Block, KeepInterfaceAlive };
    void WaitForEnd(WaitMode mode);

    // --- Fading (PlaySoundFades.cpp) ---
    // Plays this file while the current song fades out. False when that is not possible; the current song
    // goes on then as if nothing had been asked.
    bool PlayWithCrossFade(const QString& path) override;
    // A song that sounds, fading out, while the current one keeps playing; empty when there is none.
    QString COFileName();
    void SetCOFileName(const QString& path);
    // As the controller or else the panel wants it; asked anew for every decision.
    TCrossover Crossover() const;
    // What it means for a user who wants another song, or wants to stop.
    SongChange ChangeOnDemand() const;
    StopMode StopOnDemand() const;

    // --- Properties ---
    bool AutoPlay() const override { return autoPlay_; }
    void SetAutoPlay(bool value) { autoPlay_ = value; }
    int TimerInterval() const { return timerInterval_; }
    void SetTimerInterval(int milliseconds);  // at least 1
    // How loud songs play here, 0 to 1 of the amplitude: now and from now on.
    void SetGain(float gain);
    // The longest time a song plays, in milliseconds; 0 is no limit.
    int AutoStop() const { return autoStop_; }
    void SetAutoStop(int milliseconds) override;
    const EngineSettings& Engines() const { return settings_; }
    // They hold from the next song on. A reachable external player is told of each change.
    void SetEngines(const EngineSettings& settings);
    // Modern rules, off by default. Songs that follow one another on an album (track n + 1, same album, and
    // same artist or folder) are not faded into each other at their end.
    bool KeepAlbums() const { return keepAlbums_; }
    void SetKeepAlbums(bool value) { keepAlbums_ = value; }
    // Songs that are passed over are told in one line each (Events().Notice), not in boxes. Who asks for one
    // song gets its exception either way.
    bool QuietFailures() const { return quietFailures_; }
    void SetQuietFailures(bool value) { quietFailures_ = value; }
    bool PlayExtern() const { return playExtern_; }
    // Closes the song here and opens it there, or the other way round. Without a way to external players
    // nothing changes.
    void SetPlayExtern(bool value);

    // --- Wiring ---
    TMusicDatabase* MusicDatabase() const { return database_; }
    // The database gets its reference to this player, and keeps its settings. The player follows its songs to
    // other paths, lets go of a file that it moves or removes (OnReleaseFile), and asks the WinAmp engine for
    // the lengths of songs (OnMeasureLength).
    void SetMusicDatabase(TMusicDatabase* database);
    TPlayList* PlayList() const { return playList_; }
    // The playlist gets its reference to this player.
    void SetPlayList(TPlayList* playList);
    QObject* RemoteControl() const { return remoteControl_; }
    void SetRemoteControl(QObject* component) { remoteControl_ = component; }
    QObject* DSPDraw() const { return dspDraw_; }
    void SetDSPDraw(QObject* component) { dspDraw_ = component; }
    PlayerPanel* Panel() const { return panel_; }
    // A panel tells when it goes: SetPanel(nullptr).
    void SetPanel(PlayerPanel* panel) { panel_ = panel; }
    PlayController* Controller() const { return controller_; }
    // A controller tells when it goes: SetController(nullptr).
    void SetController(PlayController* controller) { controller_ = controller; }
    // The way to a separate player program; nullptr: there is none.
    void SetExternalPlayer(std::unique_ptr<ExternalPlayer> player);
    bool TellQuietly(const QString& text) override;
    void RedrawPanel() override;

    // --- Handlers of the timers (PlaySoundTick.cpp, PlaySoundOutput.cpp); they throw what playing throws ---
    void Tick();
    void HandleEndOfSong();
    void HandleAutoStop();
    void LookForOutput();
    // Runs the handlers whose time has come by the engine's clock, for those who have no event loop.
    void RunDueTimers() { timers_.RunDue(); }
    const PlayTimers& Timers() const { return timers_; }

    // --- Command menu (PlaySoundMenu.h) ---
    CommandDispatcher& Commands();
    // Built at the first call.
    TMenuExItem& Menu();
    // Runs the operation behind an item; false when it can do nothing. Throws what it throws.
    bool ClickMenuItem(int id);

    // --- Settings ---
    void UseRules(Rules rules) override;
    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

    // --- Events. The members called On... are told first, all others are listeners. ---
    PlayerEvents& Events() { return events_; }
    using TNotifyEvent = std::function<void(TPlaySound&)>;
    TNotifyEvent OnPlayingStarted;
    TNotifyEvent OnPlayingStopped;
    TNotifyEvent OnPlayingPaused;
    TNotifyEvent OnPlayingResumed;
    TNotifyEvent OnReachedEndOfSong;
    TNotifyEvent OnCrossover;
    std::function<void(TPlaySound&, quint32 position)> OnPlaying;  // ms

 private:
    enum class TickKind { Running, Last };
    // The song that waits for an output.
    struct Waiting {
        quint32 Position;  // ms
        quint32 Length;    // ms
        bool Begun;        // it has been heard before
        bool Plays;        // it goes on by itself
        int Looks;         // for the output, in vain
    };
    // What the song did when its file was let go of.
    struct Released {
        TPSStatus Status;
        quint32 Position;  // ms
        quint32 Length;    // ms
        bool Stops;        // it was fading to its stop
        bool Ends;         // the next song was about to follow
        std::optional<Waiting> Output;
    };

    // PlaySoundOpen.cpp
    PlayTarget& Chosen();
    PlayTarget& Reached(const QString& song);
    void PlayInternally();
    void ClearPanel();

    // PlaySound.cpp
    void ForwardEvents();
    void AnnounceSong();
    void ShowSong();
    void FinishStop();
    void NoticeResumed();
    void StartTimers();
    void StopTimers();
    void RestartAutoStop();
    quint32 MeasureLength(const QString& path) const;

    // PlaySoundFades.cpp
    bool FadesWanted() const;
    std::optional<TID3Tag> RecordOf(const QString& path) const;
    bool ContinuesAlbum(const QString& path) const;

    // PlaySoundOutput.cpp
    void GuardOutput(bool begun, const std::function<void()>& action);
    void WaitForOutput(const QString& reason, bool begun);
    void GoOn();
    void OpenAtPosition(quint32 position);

    // PlaySoundRelease.cpp
    void FollowRenamed(const PathChanges& renamed);
    std::function<void(const QString& path)> ReleaseFile(const QString& path);
    bool LetGo();
    void TakeUp(const QString& from, const QString& path);
    void GoBack(const Released& song);
    void PlayFrom(const Released& song);
    void WaitAgain(const Waiting& song);

    // PlaySoundTick.cpp
    void RunTick(TickKind kind);
    void ReportPosition(quint32 position, quint32 length);
    bool HasEnded(quint32 position, quint32 length);
    void CheckEnd(quint32 position, quint32 length);
    void RestWhenOver();
    void CheckCrossFade(quint32 position, quint32 length);
    void CountSongWhenDue();
    void CountSong();
    void AskForNextSong(SongChange change);
    void PlayNextOfDatabase(SongChange change);

    // PlaySoundFeedback.cpp
    void RunHandler(void (TPlaySound::*handler)());
    void RunGuarded(const std::function<void()>& action, const std::function<void()>& onFailure);
    void TellFailure(const QString& text);
    void TellRefusal(const QString& text);
    void TellWhileOpening(MessageKind kind, const QString& text);
    void Feedback(FeedbackCode code, quint32 parameter = 0);
    void StateChanged();
    void TakeFeedback(int code, quint32 parameter);
    qint64 HandleFeedback(int code, quint32 parameter) override;
    void HandleFeedbackText(int code, const QString& text) override;

    PlayerEvents events_;
    Subscriptions forwarding_;  // from the events to the members called On...
    Subscription renaming_;     // of the database
    EngineSettings settings_;
    OwnEngines engines_;
    std::unique_ptr<ExternalTarget> external_;
    QString fileName_;
    QString coFileName_;
    PlayTimers timers_;
    PlayCountClock playCount_;
    std::optional<Waiting> waiting_;
    std::optional<Released> released_;
    bool outputTold_ = false;  // of the failure that goes on
    QStringList untold_;       // failures, while a message about another one stands
    bool telling_ = false;
    int timerInterval_ = 250;  // ms
    int autoStop_ = 0;         // ms
    bool autoPlay_ = false;
    bool playExtern_ = false;
    bool keepAlbums_ = false;
    bool quietFailures_ = false;
    std::optional<TID3Tag> ending_;  // whose album is kept together, while the song after it is asked for
    bool endReached_ = false;
    bool crossFadeStarted_ = false;

    QPointer<TMusicDatabase> database_;
    QPointer<TPlayList> playList_;
    QPointer<QObject> remoteControl_;
    QPointer<QObject> dspDraw_;
    PlayerPanel* panel_ = nullptr;
    PlayController* controller_ = nullptr;
    std::unique_ptr<CommandDispatcher> commands_;
};
