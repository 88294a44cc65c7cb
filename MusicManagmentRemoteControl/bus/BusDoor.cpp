#include "MusicManagmentRemoteControl/bus/BusDoor.h"

#include <QDBusPendingCallWatcher>
#include <QDBusVirtualObject>
#include <QScopedValueRollback>
#include <utility>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kSlice = 5;  // ms in which calls are handled one after the other
constexpr int kRest = 5;      // ms in which everything else has its turn
// A call may wait in an event loop of its own, for an answer of the user for example. Others are handled
// meanwhile, so that questions have their answers, but not so many that each could open a message.
constexpr int kDeepest = 3;
// Then the bus is asked whether it has taken them. Refusals beyond are not told: who sends so much does not
// wait for each.
constexpr int kMostSent = 64;
constexpr int kMostRefused = 256;

// What the toolkit answers by itself.
bool IsOfToolkit(const QString& interface) {
    return interface == u"org.freedesktop.DBus.Introspectable"_s ||
           interface == u"org.freedesktop.DBus.Peer"_s;
}

}  // namespace

// The object that the bus sees, in a thread of its own.
class BusDoor::Porter : public QDBusVirtualObject {
 public:
    Porter(BusDoor& door, const QString& interfaces) : door_(door), interfaces_(interfaces) {}

    bool handleMessage(const QDBusMessage& call, const QDBusConnection& bus) override {
        if (call.type() != QDBusMessage::MethodCallMessage || IsOfToolkit(call.interface())) return false;
        switch (door_.queue_.Add(call)) {
            case CallQueue::Put::First:
                InDoorsThread([](BusDoor& door) { door.serveTimer_.start(0); });
                break;
            case CallQueue::Put::Behind:
                break;
            case CallQueue::Put::Refused:
                RefuseMore(call, bus);
        }
        return true;
    }
    QString introspect(const QString&) const override { return interfaces_; }

 private:
    void InDoorsThread(void (*action)(BusDoor&)) {
        QMetaObject::invokeMethod(
            &door_.serveTimer_, [action, door = &door_] { action(*door); }, Qt::QueuedConnection);
    }
    void RefuseMore(const QDBusMessage& call, const QDBusConnection& bus) {
        const int before = door_.refused_++;
        if (before >= kMostRefused) return;
        Refuse(bus, call, QDBusError::LimitsExceeded, u"too much at a time"_s);
        if (before == 0) InDoorsThread([](BusDoor& door) { door.WaitForBus(); });
    }

    BusDoor& door_;
    const QString interfaces_;
};

BusDoor::BusDoor(Handler handler, const QString& interfaces)
    : handler_(std::move(handler)), bus_(QString()), porter_(std::make_unique<Porter>(*this, interfaces)) {
    serveTimer_.setSingleShot(true);
    QObject::connect(&serveTimer_, &QTimer::timeout, &serveTimer_, Guarded([this] { Serve(); }));
    thread_.setObjectName(u"BusDoor"_s);
    porter_->moveToThread(&thread_);
}

BusDoor::~BusDoor() {
    Close();
    thread_.quit();
    thread_.wait();
}

bool BusDoor::Open(const QDBusConnection& bus, const QString& path) {
    bus_ = bus;
    if (!bus_.isConnected() || !bus_.registerVirtualObject(path, porter_.get())) return false;
    path_ = path;
    thread_.start();
    return true;
}

void BusDoor::Close() {
    if (path_.isEmpty()) return;
    bus_.unregisterObject(std::exchange(path_, {}));
    while (const auto call = queue_.Take())
        Handle(*call);
}

void BusDoor::Serve() {
    if (depth_ >= kDeepest) return;  // whoever is being served goes on here
    const QScopedValueRollback deeper(depth_, depth_ + 1);
    const qint64 begin = CurrentClock().Ticks();
    while (sent_ < kMostSent) {
        const auto call = queue_.Take();
        if (!call) return;
        Handle(*call);
        ++sent_;
        if (CurrentClock().Ticks() - begin >= kSlice) return serveTimer_.start(kRest);
    }
    WaitForBus();
}

// It answers when it has taken what was sent before.
void BusDoor::WaitForBus() {
    if (std::exchange(waitsForBus_, true)) return;
    auto* answer = new QDBusPendingCallWatcher(
        bus_.asyncCall(QDBusMessage::createMethodCall(u"org.freedesktop.DBus"_s, u"/org/freedesktop/DBus"_s,
                                                      u"org.freedesktop.DBus.Peer"_s, u"Ping"_s)),
        &serveTimer_);
    QObject::connect(answer, &QDBusPendingCallWatcher::finished, &serveTimer_, [this, answer] {
        answer->deleteLater();
        waitsForBus_ = false;
        sent_ = 0;
        refused_ = 0;
        serveTimer_.start(0);
    });
}

// Some may come even after it was closed: they were on their way through the other thread.
void BusDoor::Handle(const QDBusMessage& call) {
    if (path_.isEmpty()) return Refuse(bus_, call, QDBusError::UnknownObject, call.path());
    bool known = true;
    RunCommand([&] { known = handler_(call, bus_); });
    if (!known) Refuse(bus_, call, QDBusError::UnknownMethod, call.member());
}

void Reply(const QDBusConnection& bus, const QDBusMessage& call, const QVariantList& values) {
    if (call.isReplyRequired()) bus.send(call.createReply(values));
}

void Refuse(const QDBusConnection& bus, const QDBusMessage& call, QDBusError::ErrorType type,
            const QString& text) {
    if (call.isReplyRequired()) bus.send(call.createErrorReply(type, text));
}
