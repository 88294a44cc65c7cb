#include "MusicManagment/playback/winamp/Waiting.h"

#include <QDBusError>
#include <QDBusPendingCallWatcher>
#include <QDeadlineTimer>
#include <QEventLoop>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace {

constexpr int kLookAgain = 30;  // ms

}  // namespace

bool WaitUntil(const std::function<bool()>& condition, int milliseconds) {
    const QDeadlineTimer deadline(milliseconds);
    while (!condition()) {
        if (deadline.hasExpired()) return false;
        QEventLoop loop;
        QTimer::singleShot(kLookAgain, &loop, &QEventLoop::quit);
        loop.exec(QEventLoop::ExcludeUserInputEvents);
    }
    return true;
}

QDBusMessage WaitForAnswer(const QDBusPendingCall& call, int milliseconds) {
    QEventLoop loop;
    const QDBusPendingCallWatcher watcher(call);
    QObject::connect(&watcher, &QDBusPendingCallWatcher::finished, &loop, &QEventLoop::quit);
    QTimer::singleShot(milliseconds, &loop, &QEventLoop::quit);
    if (!watcher.isFinished()) loop.exec(QEventLoop::ExcludeUserInputEvents);
    if (!watcher.isFinished()) return QDBusMessage::createError(QDBusError::NoReply, u"no answer in time"_s);
    return watcher.reply();
}
