#pragma once

#include <QDBusConnection>
#include <QDBusError>
#include <QDBusMessage>
#include <QObject>
#include <QThread>
#include <QTimer>
#include <atomic>
#include <functional>
#include <memory>

#include "MusicManagmentRemoteControl/bus/CallQueue.h"

// An object on the message bus. Its calls are handled in the thread that made it, in their order and in turn
// with everything else that goes on there: the toolkit alone would hand over whatever comes, before anything
// else and without bounds, so that a client that never stops could take the program from its user. What is
// too much or too large is refused in a thread that does nothing else. What is sent is bounded too: it piles
// up in the program while the bus is slow to take it.
class BusDoor {
 public:
    // Handles a call and sends the reply itself; false: there is no such method. May run an event loop.
    using Handler = std::function<bool(const QDBusMessage& call, const QDBusConnection& bus)>;

    // `interfaces` describes the object in the notation of the bus, but for what each object there has.
    BusDoor(Handler handler, const QString& interfaces);
    ~BusDoor();
    BusDoor(const BusDoor&) = delete;
    BusDoor& operator=(const BusDoor&) = delete;

    // False when the path is taken or there is no bus.
    bool Open(const QDBusConnection& bus, const QString& path);
    // What still waits is answered as if there was no such object. A handler may call it.
    void Close();

 private:
    class Porter;

    void Serve();
    void WaitForBus();
    void Handle(const QDBusMessage& call);

    Handler handler_;
    CallQueue queue_;
    QDBusConnection bus_;
    QString path_;  // empty while it is closed
    QTimer serveTimer_;
    int depth_ = 0;                 // of calls that are being handled
    int sent_ = 0;                  // answers that the bus may not have taken yet
    std::atomic<int> refused_ = 0;  // the same of refusals
    bool waitsForBus_ = false;
    QThread thread_;
    std::unique_ptr<Porter> porter_;
};

// Each answers a call, where the caller wants an answer.
void Reply(const QDBusConnection& bus, const QDBusMessage& call, const QVariantList& values = {});
void Refuse(const QDBusConnection& bus, const QDBusMessage& call, QDBusError::ErrorType type,
            const QString& text);
