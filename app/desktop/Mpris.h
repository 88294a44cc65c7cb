#pragma once

#include <QDBusConnection>
#include <QTimer>
#include <QVariantMap>
#include <functional>
#include <optional>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagmentRemoteControl/bus/BusDoor.h"
#include "app/desktop/CoverFile.h"
#include "app/desktop/MprisPlaylists.h"
#include "app/desktop/MprisTrackList.h"
#include "app/models/PlayingSong.h"

class TPlayList;
class TPlaySound;

// Lets the desktop drive the player: media keys, the volume applet, the lock screen. Speaks MPRIS 2, see
// https://specifications.freedesktop.org/mpris-spec/latest/.
class Mpris : public QObject {
 public:
    // What other parts of the program do for the desktop.
    struct Hooks {
        // Plays a song, a list or the songs of a folder. Throws when it cannot.
        std::function<void(const QString& path)> OpenFile;
        std::function<void()> Raise;
        std::function<void()> Quit;
        // What the user is told of a call, for a place that needs no answer; may be unset.
        std::function<void(const QString& text)> Tell{};
        std::function<double()> Volume = [] { return 1.0; };  // 0 to 1, as on a slider
        std::function<void(double volume)> SetVolume;
        std::function<QString()> MusicFolder{};  // whose playlists are offered; may be unset
        QString StandardList{};                  // is no playlist to choose
    };

    Mpris(TPlaySound& player, TPlayList& list, Hooks hooks);
    ~Mpris() override;

    // Takes the name "org.mpris.MediaPlayer2.tunestead", or one of its own where that is taken. False without
    // a bus, which is no error: there is nobody then who would want to know.
    bool Register(const QDBusConnection& bus);
    // The name that was taken; empty for none.
    const QString& ServiceName() const { return serviceName_; }

    // Something that the bus shows has changed that neither player nor list tell: the volume. Told to the
    // bus as soon as the program comes to it.
    void Update() {
        if (!updateTimer_.isActive()) updateTimer_.start();
    }

 private:
    struct Interface;

    bool Handle(const QDBusMessage& message, const QDBusConnection& connection);
    bool HandleCall(const QDBusMessage& message, const QDBusConnection& connection);
    bool SetProperty(const QString& name, const QVariant& value);
    QVariantMap PropertiesOf(const QString& interface) const;
    QVariantMap RootProperties() const;
    QVariantMap PlayerProperties() const;
    QVariantMap Metadata() const;
    QDBusObjectPath Track() const;
    // The answer; nothing when there is no such method.
    std::optional<QVariantList> Call(const QDBusMessage& message);
    bool CallRoot(const QString& method);
    bool CallPlayer(const QString& method, const QVariantList& arguments);
    void Open(const QString& uri);
    void Seek(qint64 microseconds);
    void Follow();
    void TellChanges();
    void TellProperties(const QString& interface, const QVariantMap& changed, const QStringList& others = {});
    void TellSeeked(quint32 position);
    void Signal(const QString& interface, const QString& name, const QVariantList& arguments) const;

    TPlaySound& player_;
    TPlayList& list_;
    Hooks hooks_;
    QDBusConnection bus_;
    BusDoor door_;
    QString serviceName_;
    QTimer updateTimer_;
    QVariantMap told_;  // what the bus knows of the player
    QString toldList_;  // and of the playlist: its file
    PlayingSong song_;
    int track_ = 0;  // counts the songs
    MprisTrackList tracks_;
    MprisPlaylists playlists_;
    CoverFile cover_;
    Subscriptions subscriptions_;
};
