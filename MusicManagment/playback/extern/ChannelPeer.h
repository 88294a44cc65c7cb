#pragma once

#include <QLocalSocket>
#include <QObject>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <optional>

#include "MusicManagment/playback/extern/Frame.h"

// One end of a channel. While it waits for an answer it still answers what the other end asks, so that two
// ends which ask each other do not wait for ever; what needs no answer is handed over later, from the event
// loop. An end that does not read, or says more than can be heard, loses the connection.
class ChannelPeer : public QObject {
 public:
    // Of a socket that is connected. `ownNumber` is what the other end is to know this one by.
    ChannelPeer(std::unique_ptr<QLocalSocket> socket, qint64 ownNumber);
    ~ChannelPeer() override;

    bool IsConnected() const;
    // Of the other end; nothing before its greeting has come.
    std::optional<qint64> Number() const { return number_; }
    // False when the other end does not greet in time (milliseconds).
    bool WaitForGreeting(int timeout);

    // The answer; nothing when the other end has gone, or does not answer in time (milliseconds).
    std::optional<qint64> Ask(Frame question, int timeout);
    void Post(const Frame& frame);
    // Ends the connection; no handler is called any more.
    void Abandon();

    // Answers a command, a text or a question of the other end.
    std::function<qint64(const Frame&)> OnAsked;
    // Takes feedback.
    std::function<void(const Frame&)> OnPosted;
    // The other end has greeted, or gone. Handlers must not destroy this object but by deleteLater().
    std::function<void()> OnGreeted;
    std::function<void()> OnGone;

 private:
    template <typename Condition>
    bool WaitFor(Condition condition, int timeout);
    void ReadSocket();
    void Take(const Frame& frame);
    void AnswerTo(const Frame& frame);
    void KeepPosted(const Frame& frame);
    void HandOverPosted();
    void NoticeEnd();

    std::unique_ptr<QLocalSocket> socket_;
    FrameReader reader_;
    std::optional<qint64> number_;
    quint32 lastId_ = 0;
    std::map<quint32, std::optional<qint64>> open_;  // questions, and the answers that have come
    std::deque<Frame> posted_;
    qint64 postedText_ = 0;  // characters in these
    bool ending_ = false;
    bool gone_ = false;
};
