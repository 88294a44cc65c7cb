#pragma once

#include <QObject>
#include <QPointer>
#include <functional>
#include <memory>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagmentRemoteControl/RemoteChannel.h"

class TPlayList;
class TPlaySound;

// Lets other programs drive the player and the playlist and ask for songs, by the messages of
// RemoteMessages.h.
class TRemoteControl : public QObject, public SettingsClient, private RemoteReceiver {
 public:
    // Opens the channel; throws ERemoteControlException when that fails.
    explicit TRemoteControl(std::unique_ptr<RemoteChannel> channel, QObject* parent = nullptr);
    ~TRemoteControl() override;

    // While it is off messages do nothing and are answered with 0, but a close message takes the remote
    // control away from other programs.
    bool Enabled() const { return enabled_; }
    void SetEnabled(bool value) { enabled_ = value; }

    // --- Wiring: each component gets its reference to this one. The database keeps the setting. ---
    TMusicDatabase* MusicDatabase() const { return database_; }
    void SetMusicDatabase(TMusicDatabase* database);
    TPlayList* PlayList() const { return playList_; }
    void SetPlayList(TPlayList* playList);
    TPlaySound* PlaySound() const { return playSound_; }
    void SetPlaySound(TPlaySound* player);

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

    // A message was carried out.
    std::function<void(TRemoteControl&)> OnEventFired;
    // Closes the program; the answer to who asked for it is still to be sent.
    std::function<void()> OnCloseProgram;
    // What the user is told of a message, for a place that needs no answer. Unset: message boxes.
    std::function<void(const QString& text)> OnTell;

 private:
    std::optional<qint32> Receive(quint32 message, quint32 p, quint32 l) override;
    qint32 ReceiveCopyData(quint32 code, const QByteArray& bytes) override;
    qint32 HandleByDefault(quint32 message);
    std::optional<qint32> Handle(quint32 message, quint32 p, quint32 l);
    std::optional<qint32> WaitForEnd();
    bool SongIsOver() const;
    void LookAtSong();
    void EndWaiting(qint32 answer);
    template <typename Action>
    void Carry(Action&& action);

    std::unique_ptr<RemoteChannel> channel_;
    bool enabled_ = true;
    QPointer<TMusicDatabase> database_;
    QPointer<TPlayList> playList_;
    QPointer<TPlaySound> playSound_;
    Subscriptions player_;  // while there is one
    QString awaited_;       // the song whose end somebody waits for; empty: nobody does
};
