#include "MusicManagmentRemoteControl/bus/BusDoor.h"

#include <QDBusVirtualObject>
#include <QScopedValueRollback>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kSlice = 5;  // ms in which calls are handled one after the other
constexpr int kRest = 5;      // ms in which everything else has its turn
// A call may wait in an event loop of its own, for an answer of the user for example. Others are handled
// meanwhile, so that questions have their answers, but not so many that each could open a message.
constexpr int kDeepest = 3;

// What the toolkit answers by itself.
bool IsOfToolkit(const QString& interface) {
    return interface == u"org.freedesktop.DBus.Introspectable"_s ||
           interface == u"org.freedesktop.DBus.Peer"_s;
}

}  // namespace

// The object that the bus sees, in a thread of its own.
class BusDoor::Porter : public QDBusVirtualObject {
 public:
    Porter(CallQueue& queue, QTimer& wake, const QString& interfaces)
        : queue_(queue), wake_(wake), interfaces_(interfaces) {}

    bool handleMessage(const QDBusMessage& call, const QDBusConnection& bus) override {
        if (call.type() != QDBusMessage::MethodCallMessage || IsOfToolkit(call.interface())) return false;
        switch (queue_.Add(call)) {
            case CallQueue::Put::First:
                QMetaObject::invokeMethod(
                    &wake_, [wake = &wake_] { wake->start(0); }, Qt::QueuedConnection);
                break;
            case CallQueue::Put::Behind:
                break;
            case CallQueue::Put::Refused:
                Refuse(bus, call, QDBusError::LimitsExceeded, u"too much at a time"_s);
        }
        return true;
    }
    QString introspect(const QString&) const override { return interfaces_; }

 private:
    CallQueue& queue_;
    QTimer& wake_;
    const QString interfaces_;
};

BusDoor::BusDoor(Handler handler, const QString& interfaces)
    : handler_(std::move(handler)),
      bus_(QString()),
      porter_(std::make_unique<Porter>(queue_, serveTimer_, interfaces)) {
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
    while (const auto call = queue_.Take()) {
        Handle(*call);
        if (CurrentClock().Ticks() - begin < kSlice) continue;
        serveTimer_.start(kRest);
        return;
    }
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
