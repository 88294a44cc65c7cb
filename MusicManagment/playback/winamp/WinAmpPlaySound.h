#pragma once

#include <QDBusConnection>
#include <QDBusPendingCall>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/GainBackend.h"
#include "MusicManagment/playback/winamp/MprisPlayer.h"
#include "MusicManagment/playback/winamp/PlayerProgram.h"

// How a running player is found, copied when a back end is made.
struct TWinAmpSettings {
    // The player's name on the bus. With the default any running player serves.
    QString ClassName = QStringLiteral("WinAmp v1.x");
    // The program that is started when no such player runs. With the default it is the one that ClassName
    // names, or else the first installed of those that are known to work.
    QString File = QStringLiteral("WinAmp.exe");
    QDBusConnection Bus = QDBusConnection::sessionBus();
    // Milliseconds: for a started player to be on the bus, for a file to be open there, for an answer.
    int StartTimeout = 10000;
    int FileTimeout = 5000;
    int AnswerTimeout = 2000;
};

// A song in another music player of the desktop. What waits for that player keeps the interface alive and may
// be overtaken by another song, or by the end of this object: it then throws EAbort.
class TWinAmpPlaySound : public TPlaySoundContainer, public GainBackend {
 public:
    explicit TWinAmpPlaySound(const TWinAmpSettings& settings = {}, QObject* parent = nullptr);
    ~TWinAmpPlaySound() override;

    // These throw EWinAmpException, EWinAmpMissing where there is no player.
    void Open() override;
    void Play() override;
    void Stop() override;
    void PauseResume() override;
    void SetPosition(quint32 milliseconds) override;

    void Close() override;
    // What the player has told last, and time since; asking it anew is left running meanwhile.
    quint32 GetPosition() override;
    quint32 GetLength() override;
    TPSStatus GetStatus() override;
    // The length of a song that was opened, in milliseconds; waits for a player that does not know it at
    // once. Throws EWinAmpException when it does not tell.
    quint32 AskLength();
    void SetGain(float gain) override;

 private:
    using Player = std::shared_ptr<const MprisPlayer>;

    // What the song is meant to be doing.
    enum class Wish { Nothing, Stopped, Playing, Paused };

    std::function<bool()> Disturbance() const;
    template <typename Waiting>
    auto Undisturbed(Waiting waiting);

    void Load();
    Player FindPlayer();
    Player StartAndWait();
    PlayerProgram ProgramToStart() const;
    bool HandFileOver(const Player& player);
    void StartAgainWithFile(const MprisPlayer& player);
    void WaitForFile(const Player& player);
    void CallOrThrow(const QString& method);
    bool TrySetPosition(qint64 microseconds);
    void Hold();

    void Follow();
    void Take(const MprisState& state);
    void TakeNew(const MprisState& state);
    void EndSong();
    void Assume(Wish wish);
    void AssumePosition(qint64 microseconds);
    bool IsAssumed() const;
    bool IsPlaying() const;
    qint64 PositionNow() const;

    const TWinAmpSettings settings_;
    Player player_;
    Wish wish_ = Wish::Nothing;
    int generation_ = 0;  // counts what makes a wait pointless
    QTimer holdTimer_;

    MprisState state_;
    std::optional<QDBusPendingCall> asked_;
    // Ticks of the clock.
    qint64 stateTime_ = 0;
    qint64 assumedUntil_ = 0;  // until then the player is taken to do what it was told
    qint64 soughtUntil_ = 0;   // until then it is taken to be on its way to the position it was told
    qint64 movingUntil_ = 0;   // until then its position is taken to move, whatever its status says
    bool over_ = false;        // the song has ended, or the player has left it
};
