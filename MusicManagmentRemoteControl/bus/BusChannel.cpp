#include "MusicManagmentRemoteControl/bus/BusChannel.h"

#include <QCoreApplication>
#include <QDBusConnectionInterface>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusReply>
#include <algorithm>
#include <limits>

#include "MusicManagmentRemoteControl/RemoteMessages.h"
#include "MusicManagmentRemoteControl/bus/BusProperties.h"
#include "MusicManagmentRemoteControl/bus/RemoteNames.h"

using namespace Qt::StringLiterals;

namespace {

constexpr quint32 kOwnWindow = 1;         // the handle of the remote control itself
constexpr qsizetype kMostClients = 64;    // that may have registered
constexpr std::size_t kMostWaiting = 64;  // messages whose answer comes later
constexpr std::ptrdiff_t kMostOfOne = 4;  // of these, of one client

QString Interfaces() {
    return QStringLiteral(R"(
<interface name="%1">
  <method name="Send">
    <arg direction="in" name="Message" type="u"/>
    <arg direction="in" name="P" type="i"/>
    <arg direction="in" name="L" type="i"/>
    <arg direction="out" name="Answer" type="i"/>
  </method>
  <method name="SendCopyData">
    <arg direction="in" name="Window" type="u"/>
    <arg direction="in" name="Code" type="u"/>
    <arg direction="in" name="Bytes" type="ay"/>
    <arg direction="out" name="Answer" type="i"/>
  </method>
  <method name="Register"><arg direction="out" name="Window" type="u"/></method>
  <signal name="CopyData">
    <arg name="Window" type="u"/>
    <arg name="Code" type="u"/>
    <arg name="Bytes" type="ay"/>
  </signal>
  <property name="Title" type="s" access="read"/>
  <property name="Window" type="u" access="read"/>
</interface>
)")
        .arg(kRemoteInterface);
}

QVariantMap Properties(const QString& interface) {
    if (interface != kRemoteInterface) return {};
    return {{u"Title"_s, QCoreApplication::applicationFilePath()}, {u"Window"_s, kOwnWindow}};
}

// Programs differ in what they take a number for; what counts are its 32 bits.
std::optional<quint32> NumberOf(const QVariant& argument) {
    if (argument.userType() >= QMetaType::User || !argument.canConvert<qint64>()) return std::nullopt;
    bool isNumber = false;
    const qint64 number = argument.toLongLong(&isNumber);
    if (!isNumber || number < std::numeric_limits<qint32>::min() ||
        number > std::numeric_limits<quint32>::max())
        return std::nullopt;
    return static_cast<quint32>(number);
}

}  // namespace

BusChannel::BusChannel(const QDBusConnection& bus)
    : bus_(bus),
      door_([this](const QDBusMessage& call, const QDBusConnection& from) { return Handle(call, from); },
            Interfaces()),
      lastHandle_(kOwnWindow) {
    watcher_.setConnection(bus_);
    watcher_.setWatchMode(QDBusServiceWatcher::WatchForUnregistration);
    QObject::connect(&watcher_, &QDBusServiceWatcher::serviceUnregistered, &watcher_,
                     [this](const QString& client) { Forget(client); });
}

BusChannel::~BusChannel() {
    Close();
}

// A second program of the same user stands beside the first, and takes its place when it has gone.
void BusChannel::Open(RemoteReceiver& receiver) {
    receiver_ = &receiver;
    if (!door_.Open(bus_, kRemotePath))
        throw ERemoteControlException(
            u"Fehler beim Erstellen eines Hilfs-Fensters für TRemoteControl (CreateWindow fehlgeschlagen)"_s);
    const QString own = kRemoteService + u".instance%1"_s.arg(QCoreApplication::applicationPid());
    const QDBusConnectionInterface::RegisterServiceReply place =
        bus_.interface()->registerService(kRemoteService, QDBusConnectionInterface::QueueService);
    if (place != QDBusConnectionInterface::ServiceNotRegistered) serviceNames_ << kRemoteService;
    if (place == QDBusConnectionInterface::ServiceRegistered) return;
    if (bus_.registerService(own)) serviceNames_ << own;
    if (!serviceNames_.isEmpty()) return;
    door_.Close();
    throw ERemoteControlException(
        u"Fehler beim Erstellen eines Hilfs-Fensters für TRemoteControl (RegisterClass fehlgeschlagen)"_s);
}

void BusChannel::Close() {
    if (serviceNames_.isEmpty()) return;
    AnswerWaiting(0);
    for (const QString& name : std::exchange(serviceNames_, {}))
        bus_.unregisterService(name);
    door_.Close();
    clients_.clear();
    watcher_.setWatchedServices({});
}

// --- What comes in ---

bool BusChannel::Handle(const QDBusMessage& call, const QDBusConnection& bus) {
    if (call.interface() == PropertiesInterface()) return AnswerProperties({.Of = &Properties}, call, bus);
    if (call.interface() != kRemoteInterface) return false;
    if (call.member() == u"Send"_s)
        Send(call);
    else if (call.member() == u"SendCopyData"_s)
        ReceiveCopyData(call);
    else if (call.member() == u"Register"_s)
        Register(call);
    else
        return false;
    return true;
}

void BusChannel::Send(const QDBusMessage& call) {
    const QVariantList arguments = call.arguments();
    const auto message = NumberOf(arguments.value(0));
    const auto p = NumberOf(arguments.value(1));
    const auto l = NumberOf(arguments.value(2));
    if (!message || !p || !l || arguments.size() != 3)
        return Refuse(bus_, call, QDBusError::InvalidArgs, u"three numbers of 32 bits"_s);
    const auto answer = receiver_->Receive(*message, *p, *l);
    if (answer)
        Reply(bus_, call, {*answer});
    else
        Wait(call);
}

void BusChannel::ReceiveCopyData(const QDBusMessage& call) {
    const QVariantList arguments = call.arguments();
    const auto code = NumberOf(arguments.value(1));
    if (!code || arguments.size() != 3 || arguments[2].userType() != QMetaType::QByteArray)
        return Refuse(bus_, call, QDBusError::InvalidArgs, u"a window, a code and bytes"_s);
    Reply(bus_, call, {receiver_->ReceiveCopyData(*code, arguments[2].toByteArray())});
}

void BusChannel::Wait(const QDBusMessage& call) {
    if (!call.isReplyRequired()) return;
    const auto own = std::ranges::count(waiting_, call.service(), &QDBusMessage::service);
    if (waiting_.size() >= kMostWaiting || own >= kMostOfOne)
        return Refuse(bus_, call, QDBusError::LimitsExceeded, u"too many wait"_s);
    waiting_.push_back(call);
    Watch(call.service());
}

void BusChannel::AnswerWaiting(qint32 answer) {
    for (const QDBusMessage& call : std::exchange(waiting_, {}))
        Reply(bus_, call, {answer});
}

// --- Those who want to be told ---

void BusChannel::Register(const QDBusMessage& call) {
    quint32 handle = clients_.key(call.service());
    if (handle == 0) {
        if (clients_.size() >= kMostClients)
            return Refuse(bus_, call, QDBusError::LimitsExceeded, u"too many have registered"_s);
        handle = FreeHandle();
        clients_[handle] = call.service();
        Watch(call.service());
    }
    Reply(bus_, call, {handle});
}

quint32 BusChannel::FreeHandle() {
    do
        lastHandle_ = lastHandle_ == kWindowMask ? kOwnWindow + 1 : lastHandle_ + 1;
    while (clients_.contains(lastHandle_));
    return lastHandle_;
}

bool BusChannel::SendCopyData(quint32 window, quint32 code, const QByteArray& bytes) {
    const QString client = clients_.value(window);
    if (client.isEmpty()) return false;
    QDBusMessage signal =
        QDBusMessage::createTargetedSignal(client, kRemotePath, kRemoteInterface, u"CopyData"_s);
    signal.setArguments({kOwnWindow, code, bytes});
    return bus_.send(signal);
}

// A client may have gone before it was watched: the bus is asked once.
void BusChannel::Watch(const QString& client) {
    if (watcher_.watchedServices().contains(client)) return;
    watcher_.addWatchedService(client);
    QDBusMessage question = QDBusMessage::createMethodCall(u"org.freedesktop.DBus"_s, u"/"_s,
                                                           u"org.freedesktop.DBus"_s, u"NameHasOwner"_s);
    question.setArguments({client});
    auto* answer = new QDBusPendingCallWatcher(bus_.asyncCall(question), &watcher_);
    QObject::connect(answer, &QDBusPendingCallWatcher::finished, &watcher_, [this, answer, client] {
        answer->deleteLater();
        const QDBusPendingReply<bool> reply = *answer;
        if (!reply.isError() && !reply.value()) Forget(client);
    });
}

void BusChannel::Forget(const QString& client) {
    watcher_.removeWatchedService(client);
    clients_.removeIf([&](const auto& each) { return each.value() == client; });
    std::erase_if(waiting_, [&](const QDBusMessage& call) { return call.service() == client; });
}
