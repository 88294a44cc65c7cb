#pragma once

#include <QDBusMessage>
#include <QHash>
#include <QMutex>
#include <deque>
#include <optional>

// Calls that wait to be handled, as many as a program can do with. Put in one thread, taken in another.
class CallQueue {
 public:
    static constexpr int kMost = 256;              // calls
    static constexpr int kMostOfOne = 64;          // of one client
    static constexpr qint64 kLargest = 64 * 1024;  // bytes of the texts and byte arrays of a call
    static constexpr qint64 kMostBytes = 1 << 20;  // of all that wait

    enum class Put { First, Behind, Refused };
    // First: the queue was empty.
    Put Add(const QDBusMessage& call);
    std::optional<QDBusMessage> Take();

 private:
    struct Waiting {
        QDBusMessage Call;
        qint64 Bytes;
    };

    QMutex mutex_;
    std::deque<Waiting> calls_;
    QHash<QString, int> clients_;  // how many calls of each wait
    qint64 bytes_ = 0;
};
