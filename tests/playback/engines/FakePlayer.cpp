#include "tests/playback/engines/FakePlayer.h"

#include <QDBusArgument>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QUrl>
#include <stdexcept>

using namespace Qt::StringLiterals;

FakePlayer::FakePlayer(const QDBusConnection& bus, const QString& name)
    : bus_(bus), name_(u"org.mpris.MediaPlayer2."_s + name) {
    if (!bus_.registerVirtualObject(u"/org/mpris/MediaPlayer2"_s, this, QDBusConnection::SingleNode))
        throw std::runtime_error("the fake player cannot be on the bus");
}

FakePlayer::~FakePlayer() {
    Vanish();
    bus_.unregisterObject(u"/org/mpris/MediaPlayer2"_s);
}

void FakePlayer::Appear() {
    if (!bus_.registerService(name_)) throw std::runtime_error("the fake player's name is taken");
}

void FakePlayer::Vanish() {
    bus_.unregisterService(name_);
}

void FakePlayer::Load(const QString& path) {
    File = path;
    Position = 0;
    Status = StatusLags ? u"Stopped"_s : u"Playing"_s;
}

bool FakePlayer::handleMessage(const QDBusMessage& message, const QDBusConnection& connection) {
    if (Answers) connection.send(Answer(message));
    return true;
}

QDBusMessage FakePlayer::Answer(const QDBusMessage& message) {
    if (message.interface() == "org.mpris.MediaPlayer2.Player"_L1) return AnswerPlayer(message);
    if (message.member() == "GetAll"_L1) {
        ++StatesTold;
        return message.createReply(State());
    }
    if (message.member() == "Set"_L1 && message.arguments().value(1) == u"Volume"_s) {
        Volume = message.arguments().value(2).value<QDBusVariant>().variant().toDouble();
        return message.createReply();
    }
    return message.createReply(QVariant::fromValue(QDBusVariant(Schemes)));
}

QDBusMessage FakePlayer::AnswerPlayer(const QDBusMessage& message) {
    const QString method = message.member();
    Calls << method;
    if (method == "OpenUri"_L1) {
        if (!HasOpenUri) return message.createErrorReply(QDBusError::UnknownMethod, u"no such method"_s);
        if (!OpensNothing) Load(QUrl(message.arguments().value(0).toString()).toLocalFile());
    } else if (method == "SetPosition"_L1) {
        if (SeekFails) return message.createErrorReply(QDBusError::Failed, u"no"_s);
        Position = message.arguments().value(1).toLongLong();
    } else if (method == "Play"_L1) {
        if (!StatusLags) Status = u"Playing"_s;
    } else if (method == "Pause"_L1) {
        StatusLags = false;
        Status = u"Paused"_s;
    } else if (method == "Stop"_L1) {
        Status = u"Stopped"_s;
    }
    return message.createReply();
}

QVariantMap FakePlayer::State() const {
    QVariantMap metadata;
    if (!File.isEmpty()) {
        metadata[u"xesam:url"_s] = QString::fromUtf8(QUrl::fromLocalFile(File).toEncoded());
        metadata[u"mpris:length"_s] = Length;
        if (HasTrackId) metadata[u"mpris:trackid"_s] = QVariant::fromValue(QDBusObjectPath(u"/track/1"_s));
    }
    return {{u"PlaybackStatus"_s, Status}, {u"Position"_s, Position}, {u"Metadata"_s, metadata}};
}

PlayerScript::PlayerScript(const QString& path, std::function<void(const QString&)> started)
    : path_(path), started_(std::move(started)) {
    QFile script(path_);
    if (!script.open(QIODevice::WriteOnly)) throw std::runtime_error("cannot write the script");
    script.write("#!/bin/sh\nprintf '%s\\n' \"$1\" >> \"$0.starts\"\n");
    script.close();
    script.setPermissions(QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { Look(); });
    timer_.start(10);
}

void PlayerScript::Look() {
    QFile starts(path_ + u".starts"_s);
    if (!starts.open(QIODevice::ReadOnly) || !starts.seek(seen_)) return;
    const QByteArray line = starts.readLine();
    if (!line.endsWith('\n')) return;
    seen_ += line.size();
    started_(QString::fromUtf8(line.chopped(1)));
}
