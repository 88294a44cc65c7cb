#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QString>
#include <QStringList>
#include <QVariantMap>

// What a player tells about itself.
struct MprisState {
    QString Status;       // "Playing", "Paused" or "Stopped"
    QString File;         // path of the current song; empty when there is none, or it is no file
    qint64 Position = 0;  // microseconds
    qint64 Length = 0;    // microseconds; 0 when not known
    QString TrackId;      // empty when there is none
    bool CanSeek = true;
};

// A running player with the media player interface of the desktop (MPRIS 2), under its name on the bus.
// https://specifications.freedesktop.org/mpris-spec/latest/
class MprisPlayer {
 public:
    enum class Answer {
        Done,
        NotSupported,  // the player does not have this
        Gone,          // there is no such player any more
        Failed,
    };

    // `answerTimeout` in milliseconds.
    MprisPlayer(QDBusConnection bus, QString name, int answerTimeout);

    const QString& Name() const { return name_; }
    // The name as a person knows the player: without the prefix of all players and the number of the
    // instance.
    QString PlainName() const;

    // These wait (Waiting.h).
    Answer Call(const QString& method, const QVariantList& arguments = {}) const;
    Answer ReadState(MprisState& state) const;
    // False when the player says that it takes no files.
    bool TakesFiles() const;

    // These do not.
    void Send(const QString& method, const QVariantList& arguments = {}) const;
    void SendVolume(double volume) const;  // 1 is the player's usual loudest
    QDBusPendingCall AskState() const;
    static Answer TakeState(const QDBusMessage& answer, MprisState& state);

 private:
    QDBusMessage PlayerMessage(const QString& method, const QVariantList& arguments) const;

    QDBusConnection bus_;
    QString name_;
    int answerTimeout_;
};

// The names of all players on the bus but our own, sorted.
QStringList RunningPlayers(const QDBusConnection& bus, int answerTimeout);
// Whether a name on the bus is that of a player: "vlc" fits "org.mpris.MediaPlayer2.vlc" and
// "org.mpris.MediaPlayer2.vlc.instance7", in upper and lower case.
bool IsPlayerNamed(const QString& busName, const QString& player);
