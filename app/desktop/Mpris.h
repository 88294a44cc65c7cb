#pragma once

#include <QDBusConnection>
#include <QDBusVirtualObject>
#include <QTimer>
#include <QVariantMap>
#include <functional>

#include "CommonRUKTools/Listeners.h"
#include "app/models/PlayingSong.h"

class TPlayList;
class TPlaySound;

// Lets the desktop drive the player: media keys, the volume applet, the lock screen. Speaks MPRIS 2, see
// https://specifications.freedesktop.org/mpris-spec/latest/.
class Mpris : public QDBusVirtualObject {
 public:
    // What other parts of the program do for the desktop.
    struct Hooks {
        std::function<void(const QString& path)> OpenSong;
        std::function<void()> Raise;
        std::function<void()> Quit;
        std::function<double()> Volume = [] { return 1.0; };  // 0 to 1, as on a slider
        std::function<void(double volume)> SetVolume;
    };

    Mpris(TPlaySound& player, TPlayList& list, Hooks hooks);
    ~Mpris() override;

    // Takes the name "org.mpris.MediaPlayer2.tunestead", or one of its own where that is taken. False without
    // a bus, which is no error: there is nobody then who would want to know.
    bool Register(QDBusConnection bus);
    // The name that was taken; empty for none.
    const QString& ServiceName() const { return serviceName_; }

    // Something that the bus shows has changed that neither player nor list tell: the volume. Told to the
    // bus as soon as the program comes to it.
    void Update() { updateTimer_.start(); }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override;
    QString introspect(const QString& path) const override;

 private:
    struct Interface;

    bool HandleCall(const QDBusMessage& message, const QDBusConnection& connection);
    bool HandleProperties(const QDBusMessage& message, const QDBusConnection& connection);
    void SetProperty(const QString& name, const QVariant& value);
    QVariantMap PropertiesOf(const QString& interface) const;
    QVariantMap RootProperties() const;
    QVariantMap PlayerProperties() const;
    QVariantMap Metadata() const;
    QString TrackId() const;
    bool CallRoot(const QString& method);
    bool CallPlayer(const QString& method, const QVariantList& arguments);
    void Seek(qint64 microseconds);
    void TellChanges();
    void TellSeeked(quint32 position);
    void Signal(const QString& interface, const QString& name, const QVariantList& arguments) const;

    TPlaySound& player_;
    TPlayList& list_;
    Hooks hooks_;
    QDBusConnection bus_;
    QString serviceName_;
    QTimer updateTimer_;
    QVariantMap told_;  // what the bus knows of the player
    PlayingSong song_;
    int track_ = 0;  // counts the songs
    Subscriptions subscriptions_;
};
