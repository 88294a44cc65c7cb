#include "app/desktop/StayAwake.h"

#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QVariantMap>

using namespace Qt::StringLiterals;

namespace {

constexpr uint kSuspend = 4;  // what is not to happen; dimming the screen may

const QString kPortal = u"org.freedesktop.portal.Desktop"_s;

}  // namespace

StayAwake::~StayAwake() {
    Release();
}

// Whoever pauses and goes on at once need not ask twice: an answer that comes meanwhile is kept or given
// back.
void StayAwake::SetPlaying(bool playing) {
    if (playing == playing_) return;
    playing_ = playing;
    playing ? Ask() : Release();
}

void StayAwake::Ask() {
    if (asking_ || !bus_.isConnected()) return;
    asking_ = true;
    QDBusMessage call = QDBusMessage::createMethodCall(kPortal, u"/org/freedesktop/portal/desktop"_s,
                                                       u"org.freedesktop.portal.Inhibit"_s, u"Inhibit"_s);
    call.setArguments({QString(), kSuspend, QVariantMap{{u"reason"_s, u"Musik wird abgespielt"_s}}});
    auto* watcher = new QDBusPendingCallWatcher(bus_.asyncCall(call), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this, watcher] {
        const QDBusPendingReply<QDBusObjectPath> reply = *watcher;
        watcher->deleteLater();
        asking_ = false;
        if (reply.isError()) return;  // a desktop without a portal
        request_ = reply.value();
        if (!playing_) Release();
    });
}

void StayAwake::Release() {
    if (request_.path().isEmpty()) return;
    bus_.send(QDBusMessage::createMethodCall(kPortal, request_.path(), u"org.freedesktop.portal.Request"_s,
                                             u"Close"_s));
    request_ = QDBusObjectPath();
}
