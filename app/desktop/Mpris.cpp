#include "app/desktop/Mpris.h"

#include <QCoreApplication>
#include <QDBusConnectionInterface>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QUrl>
#include <algorithm>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "app/desktop/MprisInterfaces.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kMicroseconds = 1000;  // in a millisecond

const QString kPath = u"/org/mpris/MediaPlayer2"_s;
const QString kService = u"org.mpris.MediaPlayer2.tunestead"_s;
const QString kRoot = u"org.mpris.MediaPlayer2"_s;
const QString kPlayer = u"org.mpris.MediaPlayer2.Player"_s;
const QString kProperties = u"org.freedesktop.DBus.Properties"_s;

QString StatusText(TPSStatus status) {
    if (status == psPlaying) return u"Playing"_s;
    return status == psPaused ? u"Paused"_s : u"Stopped"_s;
}

struct PlayerCall {
    QStringView Method;
    int Command;
};

constexpr PlayerCall kCalls[] = {
    {u"Next", plNext}, {u"Previous", plPrevious}, {u"Stop", plStop}, {u"Play", plPlay}};

}  // namespace

Mpris::Mpris(TPlaySound& player, TPlayList& list, Hooks hooks)
    : player_(player), list_(list), hooks_(std::move(hooks)), bus_(QString()) {
    updateTimer_.setSingleShot(true);
    updateTimer_.setInterval(0);
    connect(&updateTimer_, &QTimer::timeout, this, [this] { RunCommand([this] { TellChanges(); }); });
    PlayerEvents& events = player_.Events();
    PlayListEvents& listEvents = list_.Events();
    const auto update = [this] { Update(); };
    subscriptions_ += events.Changed.Subscribe(update);
    for (Listeners<int>* changed : {&listEvents.Inserted, &listEvents.Removed})
        subscriptions_ += changed->Subscribe([this](int) { Update(); });
    for (Listeners<>* changed :
         {&listEvents.Cleared, &listEvents.Loaded, &listEvents.CurrentChanged, &listEvents.OptionsChanged})
        subscriptions_ += changed->Subscribe(update);
    subscriptions_ += events.Seeked.Subscribe([this](quint32 position) { TellSeeked(position); });
}

Mpris::~Mpris() {
    if (serviceName_.isEmpty()) return;
    bus_.unregisterService(serviceName_);
    bus_.unregisterObject(kPath);
}

bool Mpris::Register(QDBusConnection bus) {
    if (!bus.isConnected() || !bus.registerVirtualObject(kPath, this)) return false;
    bus_ = bus;
    for (const QString& name :
         {kService, kService + u".instance%1"_s.arg(QCoreApplication::applicationPid())}) {
        if (!bus_.registerService(name)) continue;
        serviceName_ = name;
        told_ = PlayerProperties();
        return true;
    }
    bus_.unregisterObject(kPath);
    return false;
}

// --- What the bus asks ---

QString Mpris::introspect(const QString&) const {
    return MprisInterfaces();
}

bool Mpris::handleMessage(const QDBusMessage& message, const QDBusConnection& connection) {
    if (message.type() != QDBusMessage::MethodCallMessage) return false;
    if (message.interface() == kProperties) return HandleProperties(message, connection);
    return HandleCall(message, connection);
}

// A command that fails is known as well: the user is told, not the bus.
bool Mpris::HandleCall(const QDBusMessage& message, const QDBusConnection& connection) {
    bool known = true;
    RunCommand([&] {
        known = (message.interface() == kRoot && CallRoot(message.member())) ||
                (message.interface() == kPlayer && CallPlayer(message.member(), message.arguments()));
    });
    return known && (!message.isReplyRequired() || connection.send(message.createReply()));
}

bool Mpris::HandleProperties(const QDBusMessage& message, const QDBusConnection& connection) {
    const QVariantList arguments = message.arguments();
    const QVariantMap properties = PropertiesOf(arguments.value(0).toString());
    const QString name = arguments.value(1).toString();
    if (message.member() == u"GetAll"_s) return connection.send(message.createReply(properties));
    if (!properties.contains(name))
        return connection.send(message.createErrorReply(QDBusError::UnknownProperty, name));
    if (message.member() == u"Get"_s)
        return connection.send(
            message.createReply(QVariant::fromValue(QDBusVariant(properties.value(name)))));
    if (message.member() != u"Set"_s) return false;
    RunCommand([&] { SetProperty(name, arguments.value(2).value<QDBusVariant>().variant()); });
    return connection.send(message.createReply());
}

// The rate can be set only to what it is.
void Mpris::SetProperty(const QString& name, const QVariant& value) {
    if (name == u"Shuffle"_s)
        list_.SetPlayOrder(value.toBool() ? poRandom : poDownwards);
    else if (name == u"LoopStatus"_s)
        list_.SetRepeatAll(value.toString() != u"None"_s);
    else if (name == u"Volume"_s)
        hooks_.SetVolume(std::clamp(value.toDouble(), 0.0, 1.0));
    list_.RedrawView();
    Update();
}

bool Mpris::CallRoot(const QString& method) {
    if (method == u"Raise"_s) return hooks_.Raise(), true;
    if (method != u"Quit"_s) return false;
    // The answer goes first.
    QTimer::singleShot(0, this, [this] { RunCommand(hooks_.Quit); });
    return true;
}

bool Mpris::CallPlayer(const QString& method, const QVariantList& arguments) {
    const auto* call = std::ranges::find(kCalls, QStringView(method), &PlayerCall::Method);
    const TPSStatus status = player_.GetStatus();
    if (call != std::end(kCalls))
        player_.ClickMenuItem(call->Command == plPlay && status == psPaused ? static_cast<int>(plPause)
                                                                            : call->Command);
    else if (method == u"PlayPause"_s)
        player_.ClickMenuItem(status == psPlaying || status == psPaused ? plPause : plPlay);
    else if (method == u"Pause"_s) {
        if (status == psPlaying) player_.ClickMenuItem(plPause);
    } else if (method == u"Seek"_s)
        Seek(player_.GetPosition() * kMicroseconds + arguments.value(0).toLongLong());
    else if (method == u"SetPosition"_s) {
        const qint64 place = arguments.value(1).toLongLong();
        const bool isThere = place >= 0 && place <= player_.GetLength() * kMicroseconds;
        if (isThere && arguments.value(0).value<QDBusObjectPath>().path() == TrackId()) Seek(place);
    } else if (method == u"OpenUri"_s)
        hooks_.OpenSong(QUrl(arguments.value(0).toString()).toLocalFile());
    else
        return false;
    return true;
}

// Behind the end the next song begins.
void Mpris::Seek(qint64 microseconds) {
    if (player_.GetStatus() == psClosed) return;
    const qint64 position = std::max(microseconds, qint64{0}) / kMicroseconds;
    if (position > player_.GetLength())
        player_.ClickMenuItem(plNext);
    else
        player_.SetPosition(static_cast<quint32>(position));
}

// --- Properties ---

QVariantMap Mpris::PropertiesOf(const QString& interface) const {
    if (interface == kRoot) return RootProperties();
    if (interface != kPlayer) return {};
    QVariantMap properties = PlayerProperties();
    properties[u"Position"_s] = qint64{const_cast<TPlaySound&>(player_).GetPosition()} * kMicroseconds;
    return properties;
}

QVariantMap Mpris::RootProperties() const {
    return {
        {u"CanQuit"_s, true},
        {u"CanRaise"_s, true},
        {u"HasTrackList"_s, false},
        {u"Identity"_s, u"Tunestead"_s},
        {u"DesktopEntry"_s, u"tunestead"_s},
        {u"SupportedUriSchemes"_s, QStringList(u"file"_s)},
        {u"SupportedMimeTypes"_s, QStringList({u"audio/mpeg"_s, u"audio/x-wav"_s, u"audio/x-ms-wma"_s})},
    };
}

// Without the position, whose changes the bus is not told: it runs by itself.
QVariantMap Mpris::PlayerProperties() const {
    TPlaySound& player = const_cast<TPlaySound&>(player_);
    const TPSStatus status = player.GetStatus();
    const bool hasSong = status != psClosed;
    return {
        {u"PlaybackStatus"_s, StatusText(status)},
        {u"LoopStatus"_s, list_.RepeatAll() ? u"Playlist"_s : u"None"_s},
        {u"Shuffle"_s, list_.PlayOrder() == poRandom},
        {u"Rate"_s, 1.0},
        {u"MinimumRate"_s, 1.0},
        {u"MaximumRate"_s, 1.0},
        {u"Volume"_s, hooks_.Volume()},
        {u"Metadata"_s, Metadata()},
        {u"CanGoNext"_s, list_.Count() > 0},
        {u"CanGoPrevious"_s, list_.HasPrevious()},
        {u"CanPlay"_s, hasSong || list_.Count() > 0},
        {u"CanPause"_s, hasSong},
        {u"CanSeek"_s, hasSong},
        {u"CanControl"_s, true},
    };
}

QString Mpris::TrackId() const {
    if (song_.FileName.isEmpty()) return u"/org/mpris/MediaPlayer2/TrackList/NoTrack"_s;
    return u"/tunestead/track/%1"_s.arg(track_);
}

QVariantMap Mpris::Metadata() const {
    QVariantMap data{{u"mpris:trackid"_s, QVariant::fromValue(QDBusObjectPath(TrackId()))}};
    if (song_.FileName.isEmpty()) return data;
    data[u"xesam:title"_s] = song_.Title;
    if (!song_.Artist.isEmpty()) data[u"xesam:artist"_s] = QStringList(song_.Artist);
    if (!song_.Album.isEmpty()) data[u"xesam:album"_s] = song_.Album;
    if (song_.Track > 0) data[u"xesam:trackNumber"_s] = song_.Track;
    if (const quint32 length = const_cast<TPlaySound&>(player_).GetLength(); length > 0)
        data[u"mpris:length"_s] = qint64{length} * kMicroseconds;
    data[u"xesam:url"_s] = QString::fromLatin1(QUrl::fromLocalFile(song_.FileName).toEncoded());
    return data;
}

// --- What the bus is told ---

void Mpris::TellChanges() {
    PlayingSong song = player_.GetStatus() == psClosed ? PlayingSong() : SongOf(player_, list_);
    if (song != song_) ++track_;
    song_ = std::move(song);
    if (serviceName_.isEmpty()) return;
    const QVariantMap now = PlayerProperties();
    QVariantMap changed;
    for (auto property = now.cbegin(); property != now.cend(); ++property)
        if (told_.value(property.key()) != property.value()) changed.insert(property.key(), property.value());
    told_ = now;
    if (!changed.isEmpty()) Signal(kProperties, u"PropertiesChanged"_s, {kPlayer, changed, QStringList()});
}

void Mpris::TellSeeked(quint32 position) {
    Signal(kPlayer, u"Seeked"_s, {qint64{position} * kMicroseconds});
}

void Mpris::Signal(const QString& interface, const QString& name, const QVariantList& arguments) const {
    if (serviceName_.isEmpty()) return;
    QDBusMessage message = QDBusMessage::createSignal(kPath, interface, name);
    message.setArguments(arguments);
    bus_.send(message);
}
