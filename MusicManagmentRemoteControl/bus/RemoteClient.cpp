#include "MusicManagmentRemoteControl/bus/RemoteClient.h"

#include <QCoreApplication>
#include <QDBusMessage>
#include <limits>

#include "CommonRUKTools/ByteReader.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"
#include "MusicManagmentRemoteControl/RemoteMessages.h"
#include "MusicManagmentRemoteControl/bus/RemoteNames.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWithoutLimit = std::numeric_limits<int>::max();  // else the bus waits for 25 seconds

QString ReasonOf(const QDBusError& error) {
    switch (error.type()) {
        case QDBusError::ServiceUnknown:
        case QDBusError::UnknownObject:
            return u"Tunestead läuft nicht."_s;
        case QDBusError::NoReply:
        case QDBusError::Disconnected:
            return u"Tunestead wurde beendet, bevor es geantwortet hat."_s;
        case QDBusError::LimitsExceeded:
            return u"Tunestead hat gerade zu viel zu tun."_s;
        default:
            return u"Tunestead antwortet nicht: "_s + error.message();
    }
}

}  // namespace

RemoteClient::RemoteClient(const QDBusConnection& bus) : bus_(bus), copied_(bus) {
    if (!bus.isConnected())
        throw ERemoteControlException(
            u"Tunestead ist nicht erreichbar: Es gibt hier keinen Nachrichten-Bus der Sitzung (D-Bus)."_s);
    // Until the event loop has run once the bus hands nothing over but answers.
    QCoreApplication::processEvents();
}

qint32 RemoteClient::Send(quint32 message, quint32 p, quint32 l) {
    return Call(u"Send"_s, {message, static_cast<qint32>(p), static_cast<qint32>(l)}).toInt();
}

qint32 RemoteClient::OpenFile(const QString& path) {
    return Call(u"SendCopyData"_s, {0u, kRemoteOpenFile, path.toUtf8()}).toInt();
}

QVariant RemoteClient::Call(const QString& method, const QVariantList& arguments) {
    QDBusMessage call = QDBusMessage::createMethodCall(kRemoteService, kRemotePath, kRemoteInterface, method);
    call.setArguments(arguments);
    const QDBusMessage reply = bus_.call(call, QDBus::Block, kWithoutLimit);
    if (reply.type() != QDBusMessage::ReplyMessage)
        throw ERemoteControlException(ReasonOf(QDBusError(reply)));
    return reply.arguments().value(0);
}

std::optional<QByteArray> RemoteClient::AskAboutSong(quint32 message, qint32 index, quint32 code) {
    Send(message, static_cast<quint32>(index), window_ | kUtf8Window);
    return copied_.Take(code);
}

std::optional<TID3Tag> RemoteClient::Song(qint32 index) {
    if (window_ == 0) window_ = Call(u"Register"_s, {}).toUInt();
    const auto record = AskAboutSong(rmSongRecord, index, rmSongRecord);
    if (!record || record->size() != kPackedRecordSize) return std::nullopt;
    TID3Tag song;
    ByteReader numbers({reinterpret_cast<const std::uint8_t*>(record->constData()), kPackedRecordSize});
    const quint16 year = ReadPackedRecord(numbers, song);
    if (year != 0) song.Year = QString::number(year);
    constexpr std::pair<quint32, QString TID3Tag::*> kTexts[] = {{rmSongFileName, &TID3Tag::FileName},
                                                                 {rmSongTitle, &TID3Tag::Title},
                                                                 {rmSongArtist, &TID3Tag::Artist},
                                                                 {rmSongAlbum, &TID3Tag::Album},
                                                                 {rmSongComment, &TID3Tag::Comment}};
    for (const auto& [message, text] : kTexts) {
        const auto bytes = AskAboutSong(message, index, message + kUtf8Code);
        if (!bytes) return std::nullopt;
        song.*text = QString::fromUtf8(*bytes);
    }
    return song;
}
