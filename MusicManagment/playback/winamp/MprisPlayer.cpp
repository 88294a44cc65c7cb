#include "MusicManagment/playback/winamp/MprisPlayer.h"

#include <QDBusArgument>
#include <QDBusError>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QUrl>
#include <limits>

#include "MusicManagment/playback/winamp/Waiting.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QLatin1StringView kPrefix("org.mpris.MediaPlayer2.");
constexpr QLatin1StringView kInstance(".instance");
constexpr QLatin1StringView kOwnName("tunestead");
const QString kPlayerInterface = u"org.mpris.MediaPlayer2.Player"_s;
constexpr qint64 kLongest = qint64{std::numeric_limits<quint32>::max()} * 1000;  // microseconds

QDBusMessage Message(const QString& name, const QString& interface, const QString& method,
                     const QVariantList& arguments) {
    QDBusMessage message =
        QDBusMessage::createMethodCall(name, u"/org/mpris/MediaPlayer2"_s, interface, method);
    message.setArguments(arguments);
    message.setAutoStartService(false);
    return message;
}

QDBusMessage PropertiesMessage(const QString& name, const QString& method, const QVariantList& arguments) {
    return Message(name, u"org.freedesktop.DBus.Properties"_s, method, arguments);
}

MprisPlayer::Answer KindOf(const QDBusMessage& answer) {
    if (answer.type() == QDBusMessage::ReplyMessage) return MprisPlayer::Answer::Done;
    // The bus says so of a name that it is not to start a program for.
    if (answer.errorName() == "org.freedesktop.DBus.Error.NameHasNoOwner"_L1)
        return MprisPlayer::Answer::Gone;
    switch (QDBusError(answer).type()) {
        case QDBusError::UnknownMethod:
        case QDBusError::UnknownInterface:
        case QDBusError::NotSupported:
            return MprisPlayer::Answer::NotSupported;
        case QDBusError::ServiceUnknown:
            return MprisPlayer::Answer::Gone;
        default:
            return MprisPlayer::Answer::Failed;
    }
}

// The identifier is an object path; some players send it as a text.
QString TrackIdOf(const QVariant& value) {
    if (value.metaType() == QMetaType::fromType<QDBusObjectPath>())
        return qvariant_cast<QDBusObjectPath>(value).path();
    return value.toString();
}

// Within what is counted with, whatever the player says.
qint64 TimeOf(const QVariant& microseconds) {
    return qBound(qint64{0}, microseconds.toLongLong(), kLongest);
}

void TakeMetadata(const QVariantMap& metadata, MprisState& state) {
    const QUrl url(metadata.value(u"xesam:url"_s).toString());
    if (url.isLocalFile()) state.File = url.toLocalFile();
    state.Length = TimeOf(metadata.value(u"mpris:length"_s));
    state.TrackId = TrackIdOf(metadata.value(u"mpris:trackid"_s));
}

}  // namespace

MprisPlayer::MprisPlayer(QDBusConnection bus, QString name, int answerTimeout)
    : bus_(std::move(bus)), name_(std::move(name)), answerTimeout_(answerTimeout) {}

QString MprisPlayer::PlainName() const {
    const QString name = name_.mid(kPrefix.size());
    return name.left(name.indexOf(kInstance));
}

QDBusMessage MprisPlayer::PlayerMessage(const QString& method, const QVariantList& arguments) const {
    return Message(name_, kPlayerInterface, method, arguments);
}

MprisPlayer::Answer MprisPlayer::Call(const QString& method, const QVariantList& arguments) const {
    return KindOf(
        WaitForAnswer(bus_.asyncCall(PlayerMessage(method, arguments), answerTimeout_), answerTimeout_));
}

void MprisPlayer::Send(const QString& method, const QVariantList& arguments) const {
    bus_.send(PlayerMessage(method, arguments));
}

void MprisPlayer::SendVolume(double volume) const {
    bus_.send(PropertiesMessage(name_, u"Set"_s,
                                {kPlayerInterface, u"Volume"_s, QVariant::fromValue(QDBusVariant(volume))}));
}

QDBusPendingCall MprisPlayer::AskState() const {
    return bus_.asyncCall(PropertiesMessage(name_, u"GetAll"_s, {kPlayerInterface}), answerTimeout_);
}

MprisPlayer::Answer MprisPlayer::ReadState(MprisState& state) const {
    return TakeState(WaitForAnswer(AskState(), answerTimeout_), state);
}

MprisPlayer::Answer MprisPlayer::TakeState(const QDBusMessage& answer, MprisState& state) {
    const Answer kind = KindOf(answer);
    if (kind != Answer::Done) return kind;
    if (answer.arguments().isEmpty()) return Answer::Failed;
    const auto properties = qdbus_cast<QVariantMap>(answer.arguments().constFirst());
    state = {};
    state.Status = properties.value(u"PlaybackStatus"_s).toString();
    state.Position = TimeOf(properties.value(u"Position"_s));
    state.CanSeek = properties.value(u"CanSeek"_s, true).toBool();
    TakeMetadata(qdbus_cast<QVariantMap>(properties.value(u"Metadata"_s)), state);
    return Answer::Done;
}

bool MprisPlayer::TakesFiles() const {
    const QDBusMessage answer = WaitForAnswer(
        bus_.asyncCall(
            PropertiesMessage(name_, u"Get"_s, {u"org.mpris.MediaPlayer2"_s, u"SupportedUriSchemes"_s}),
            answerTimeout_),
        answerTimeout_);
    if (answer.type() != QDBusMessage::ReplyMessage || answer.arguments().isEmpty()) return true;
    const auto schemes = qvariant_cast<QDBusVariant>(answer.arguments().constFirst()).variant();
    return schemes.toStringList().contains(u"file"_s);
}

QStringList RunningPlayers(const QDBusConnection& bus, int answerTimeout) {
    const QDBusMessage question = QDBusMessage::createMethodCall(
        u"org.freedesktop.DBus"_s, u"/org/freedesktop/DBus"_s, u"org.freedesktop.DBus"_s, u"ListNames"_s);
    const QDBusMessage answer = WaitForAnswer(bus.asyncCall(question, answerTimeout), answerTimeout);
    if (answer.type() != QDBusMessage::ReplyMessage || answer.arguments().isEmpty()) return {};
    QStringList names = answer.arguments().constFirst().toStringList().filter(kPrefix);
    names.removeIf(
        [](const QString& name) { return !name.startsWith(kPrefix) || IsPlayerNamed(name, kOwnName); });
    names.sort();
    return names;
}

bool IsPlayerNamed(const QString& busName, const QString& player) {
    const QString full = kPrefix + player;
    if (!busName.startsWith(full, Qt::CaseInsensitive)) return false;
    const QStringView rest = QStringView(busName).mid(full.size());
    return rest.isEmpty() || rest.startsWith(kInstance);
}
