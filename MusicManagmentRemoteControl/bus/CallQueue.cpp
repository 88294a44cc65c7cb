#include "MusicManagmentRemoteControl/bus/CallQueue.h"

#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QMutexLocker>

namespace {

// Lists and records come as a reference to the message, of which nothing tells the size: such a call is as
// large as all that may wait.
qint64 BytesOf(const QVariant& argument) {
    if (argument.userType() == qMetaTypeId<QDBusVariant>())
        return BytesOf(argument.value<QDBusVariant>().variant());
    if (argument.userType() == qMetaTypeId<QDBusObjectPath>())
        return BytesOf(argument.value<QDBusObjectPath>().path());
    switch (argument.userType()) {
        case QMetaType::QString:
            return argument.toString().size() * qint64{sizeof(QChar)};
        case QMetaType::QByteArray:
            return argument.toByteArray().size();
        case QMetaType::QVariantList:
        case QMetaType::QStringList:
            return CallQueue::kMostBytes;
        default:
            return argument.userType() < QMetaType::User ? qint64{sizeof(qint64)} : CallQueue::kMostBytes;
    }
}

// Nothing for a call that is larger than any that is meant.
std::optional<qint64> BytesOf(const QDBusMessage& call) {
    qint64 bytes = 0;
    for (const QVariant& argument : call.arguments()) {
        const qint64 more = BytesOf(argument);
        if (more > CallQueue::kLargest && more != CallQueue::kMostBytes) return std::nullopt;
        bytes += more;
    }
    return bytes;
}

}  // namespace

CallQueue::Put CallQueue::Add(const QDBusMessage& call) {
    const auto bytes = BytesOf(call);
    const QMutexLocker lock(&mutex_);
    if (!bytes || calls_.size() >= kMost || clients_.value(call.service()) >= kMostOfOne) return Put::Refused;
    if (!calls_.empty() && bytes_ + *bytes > kMostBytes) return Put::Refused;
    calls_.push_back({call, *bytes});
    bytes_ += *bytes;
    ++clients_[call.service()];
    return calls_.size() == 1 ? Put::First : Put::Behind;
}

std::optional<QDBusMessage> CallQueue::Take() {
    const QMutexLocker lock(&mutex_);
    if (calls_.empty()) return std::nullopt;
    const Waiting next = std::move(calls_.front());
    calls_.pop_front();
    bytes_ -= next.Bytes;
    const auto client = clients_.find(next.Call.service());
    if (--*client == 0) clients_.erase(client);
    return next.Call;
}
