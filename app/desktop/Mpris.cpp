#include "app/desktop/Mpris.h"

#include <QCoreApplication>
#include <QDBusConnectionInterface>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <algorithm>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagmentRemoteControl/LineDialogs.h"
#include "MusicManagmentRemoteControl/bus/BusProperties.h"
#include "app/desktop/MimeTypes.h"
#include "app/desktop/MprisInterfaces.h"
#include "app/desktop/MprisMetadata.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kMicroseconds = 1000;  // in a millisecond

const QString kPath = u"/org/mpris/MediaPlayer2"_s;
const QString kService = u"org.mpris.MediaPlayer2.tunestead"_s;
const QString kRoot = u"org.mpris.MediaPlayer2"_s;
const QString kPlayer = u"org.mpris.MediaPlayer2.Player"_s;
const QString kTrackList = u"org.mpris.MediaPlayer2.TrackList"_s;
const QString kPlaylists = u"org.mpris.MediaPlayer2.Playlists"_s;

QString StatusText(TPSStatus status) {
    if (status == psPlaying) return u"Playing"_s;
    return status == psPaused ? u"Paused"_s : u"Stopped"_s;
}

struct PlayerCall {
    QStringView Method;
    int Command;
};

QStringList MimeTypesToPlay() {
    QStringList types{u"audio/mpeg"_s,     u"audio/mp2"_s,       u"video/mpeg"_s,   u"audio/x-wav"_s,
                      u"audio/x-ms-wma"_s, u"audio/x-mpegurl"_s, u"audio/x-scpls"_s};
    for (const FileType& type : OwnFileTypes())
        if (type.Kind == FileKind::PlayList) types << type.MimeType.toString();
    return types;
}

constexpr PlayerCall kCalls[] = {
    {u"Next", plNext}, {u"Previous", plPrevious}, {u"Stop", plStop}, {u"Play", plPlay}};

}  // namespace

Mpris::Mpris(TPlaySound& player, TPlayList& list, Hooks hooks)
    : player_(player),
      list_(list),
      hooks_(std::move(hooks)),
      bus_(QString()),
      door_([this](const QDBusMessage& call, const QDBusConnection& from) { return Handle(call, from); },
            MprisInterfaces()),
      tracks_(player, list),
      playlists_(list, {hooks_.MusicFolder, hooks_.StandardList, hooks_.OpenFile}) {
    updateTimer_.setSingleShot(true);
    updateTimer_.setInterval(0);
    connect(&updateTimer_, &QTimer::timeout, this, [this] { RunCommand([this] { TellChanges(); }); });
    cover_.OnFound = [this] { Update(); };
    Follow();
}

void Mpris::Follow() {
    PlayerEvents& events = player_.Events();
    PlayListEvents& listEvents = list_.Events();
    const auto update = [this] { Update(); };
    subscriptions_ += events.Changed.Subscribe(update);
    for (Listeners<int>* changed : {&listEvents.Inserted, &listEvents.Removed, &listEvents.Changed})
        subscriptions_ += changed->Subscribe([this](int) { Update(); });
    subscriptions_ += listEvents.Moved.Subscribe([this](const std::vector<int>&) { Update(); });
    for (Listeners<>* changed : {&listEvents.Cleared, &listEvents.Loaded, &listEvents.CurrentChanged,
                                 &listEvents.NameChanged, &listEvents.OptionsChanged})
        subscriptions_ += changed->Subscribe(update);
    subscriptions_ += events.Seeked.Subscribe([this](quint32 position) { TellSeeked(position); });
    if (TMusicDatabase* database = list_.MusicDatabase())
        subscriptions_ += database->Events().Changed.Subscribe(
            [this](SongIndex, const TID3Tag&, const TID3Tag&) { Update(); });
}

Mpris::~Mpris() {
    if (serviceName_.isEmpty()) return;
    bus_.unregisterService(serviceName_);
    door_.Close();
}

bool Mpris::Register(const QDBusConnection& bus) {
    if (!door_.Open(bus, kPath)) return false;
    bus_ = bus;
    for (const QString& name :
         {kService, kService + u".instance%1"_s.arg(QCoreApplication::applicationPid())}) {
        if (!bus_.registerService(name)) continue;
        serviceName_ = name;
        told_ = PlayerProperties();
        return true;
    }
    door_.Close();
    return false;
}

// --- What the bus asks ---

bool Mpris::Handle(const QDBusMessage& message, const QDBusConnection& connection) {
    if (message.interface() != PropertiesInterface()) return HandleCall(message, connection);
    return AnswerProperties(
        {.Of = [this](const QString& interface) { return PropertiesOf(interface); },
         .Set = [this](const QString& name, const QVariant& value) { return SetProperty(name, value); }},
        message, connection);
}

// Why a call has failed is told to the caller, and to the user in a place that needs no answer: the caller
// waits.
bool Mpris::HandleCall(const QDBusMessage& message, const QDBusConnection& connection) {
    std::optional<QVariantList> answer = QVariantList();
    QString told;
    bool failed = true;
    const std::function<void(const QString&)> tell = [&](const QString& text) {
        told = text.simplified();
        if (hooks_.Tell) hooks_.Tell(told);
    };
    const LineDialogs lines(tell);
    RunCommand([&] {
        answer = Call(message);
        failed = false;
    });
    if (failed && !told.isEmpty()) return Refuse(connection, message, QDBusError::Failed, told), true;
    if (answer) Reply(connection, message, *answer);
    return answer.has_value();
}

std::optional<QVariantList> Mpris::Call(const QDBusMessage& message) {
    const QString interface = message.interface();
    if (interface == kTrackList) return tracks_.Call(message.member(), message.arguments());
    if (interface == kPlaylists) return playlists_.Call(message.member(), message.arguments());
    const bool known = interface == kRoot
                           ? CallRoot(message.member())
                           : interface == kPlayer && CallPlayer(message.member(), message.arguments());
    return known ? std::optional(QVariantList()) : std::nullopt;
}

// The rate can be set only to what it is.
bool Mpris::SetProperty(const QString& name, const QVariant& value) {
    if (name == u"Shuffle"_s)
        list_.SetPlayOrder(value.toBool() ? poRandom : poDownwards);
    else if (name == u"LoopStatus"_s)
        list_.SetRepeatAll(value.toString() == u"Playlist"_s || value.toString() == u"Track"_s);
    else if (name == u"Volume"_s)
        hooks_.SetVolume(std::clamp(value.toDouble(), 0.0, 1.0));
    else if (name != u"Rate"_s)
        return false;
    list_.RedrawView();
    Update();
    return true;
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
        if (isThere && arguments.value(0).value<QDBusObjectPath>() == Track()) Seek(place);
    } else if (method == u"OpenUri"_s)
        Open(arguments.value(0).toString());
    else
        return false;
    return true;
}

// Nothing is fetched from elsewhere.
void Mpris::Open(const QString& uri) {
    const QString path = LocalPath(uri);
    if (path.isEmpty()) throw ERukException(u"Nur Dateien können geöffnet werden: "_s + uri);
    hooks_.OpenFile(path);
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
    if (interface == kTrackList) return tracks_.Properties();
    if (interface == kPlaylists) return playlists_.Properties();
    if (interface != kPlayer) return {};
    QVariantMap properties = PlayerProperties();
    properties[u"Position"_s] = qint64{const_cast<TPlaySound&>(player_).GetPosition()} * kMicroseconds;
    return properties;
}

QVariantMap Mpris::RootProperties() const {
    return {
        {u"CanQuit"_s, true},
        {u"CanRaise"_s, true},
        {u"HasTrackList"_s, true},
        {u"Identity"_s, u"Tunestead"_s},
        {u"DesktopEntry"_s, u"tunestead"_s},
        {u"SupportedUriSchemes"_s, QStringList(u"file"_s)},
        {u"SupportedMimeTypes"_s, MimeTypesToPlay()},
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

// A song that plays without being in the list has a number of its own.
QDBusObjectPath Mpris::Track() const {
    if (song_.FileName.isEmpty()) return TrackOfEntry(0);
    const int entry = player_.FileName() == list_.CurrentFile() ? list_.IndexOf() : -1;
    return entry >= 0 ? TrackOfEntry(list_.IdAt(entry))
                      : QDBusObjectPath(u"/tunestead/track/%1"_s.arg(track_));
}

QVariantMap Mpris::Metadata() const {
    return MprisMetadata(Track(), song_, const_cast<TPlaySound&>(player_).GetLength(), cover_.Url());
}

// --- What the bus is told ---

void Mpris::TellChanges() {
    PlayingSong song = player_.GetStatus() == psClosed ? PlayingSong() : SongOf(player_, list_);
    if (song.FileName != song_.FileName) ++track_;
    song_ = std::move(song);
    if (serviceName_.isEmpty()) return;
    cover_.Show(song_.FileName.isEmpty() ? QString() : player_.FileName());
    const QVariantMap now = PlayerProperties();
    QVariantMap changed;
    for (auto property = now.cbegin(); property != now.cend(); ++property)
        if (told_.value(property.key()) != property.value()) changed.insert(property.key(), property.value());
    told_ = now;
    if (!changed.isEmpty()) TellProperties(kPlayer, changed);
    if (tracks_.TellChanges([this](const QString& name, const QVariantList& arguments) {
            Signal(kTrackList, name, arguments);
        }))
        TellProperties(kTrackList, {}, {u"Tracks"_s});
    if (const QString file = list_.PlayListFileName(); std::exchange(toldList_, file) != file)
        TellProperties(kPlaylists, {{u"ActivePlaylist"_s, playlists_.Active()}}, {u"PlaylistCount"_s});
}

// `others` have changed as well; who wants to know asks.
void Mpris::TellProperties(const QString& interface, const QVariantMap& changed, const QStringList& others) {
    Signal(PropertiesInterface(), u"PropertiesChanged"_s, {interface, changed, others});
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
