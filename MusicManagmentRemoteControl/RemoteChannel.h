#pragma once

#include <QByteArray>
#include <optional>

#include "CommonRUKTools/Errors.h"

class ERemoteControlException : public ERukException {
 public:
    using ERukException::ERukException;
};

// Who answers what comes in. Nothing is thrown.
class RemoteReceiver {
 public:
    virtual ~RemoteReceiver() = default;
    // Nothing: the answer comes later, by RemoteChannel::AnswerWaiting.
    virtual std::optional<qint32> Receive(quint32 message, quint32 p, quint32 l) = 0;
    virtual qint32 ReceiveCopyData(quint32 code, const QByteArray& bytes) = 0;
};

// The way on which other programs of this user reach the remote control.
class RemoteChannel {
 public:
    virtual ~RemoteChannel() = default;

    // From now on messages go to the receiver. Throws ERemoteControlException.
    virtual void Open(RemoteReceiver& receiver) = 0;
    // Nobody reaches it any more; those who wait are told so. May be called while a message is received.
    virtual void Close() = 0;
    // Sends bytes to a program that has registered; false when it has not, or has gone.
    virtual bool SendCopyData(quint32 window, quint32 code, const QByteArray& bytes) = 0;
    // Answers all messages whose answer was to come later.
    virtual void AnswerWaiting(qint32 answer) = 0;
};
