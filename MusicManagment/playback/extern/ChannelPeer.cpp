#include "MusicManagment/playback/extern/ChannelPeer.h"

#include <QDeadlineTimer>
#include <QPointer>
#include <QTimer>
#include <utility>

namespace {

// What is more, of frames that wait here or of bytes that wait for the other end, is not taken any more.
constexpr std::size_t kMostPosted = 10000;
constexpr qint64 kMostWaiting = 1 << 20;  // bytes

}  // namespace

ChannelPeer::ChannelPeer(std::unique_ptr<QLocalSocket> socket, qint64 ownNumber)
    : socket_(std::move(socket)) {
    socket_->setReadBufferSize(kMostWaiting);
    connect(socket_.get(), &QLocalSocket::readyRead, this, &ChannelPeer::ReadSocket);
    connect(socket_.get(), &QLocalSocket::disconnected, this, &ChannelPeer::NoticeEnd);
    Post({.Kind = FrameKind::Greeting, .Number = ownNumber});
    // What came before anybody listened, once the handlers are set.
    QTimer::singleShot(0, this, &ChannelPeer::ReadSocket);
}

ChannelPeer::~ChannelPeer() {
    socket_->disconnect(this);
}

bool ChannelPeer::IsConnected() const {
    return !gone_ && socket_->state() == QLocalSocket::ConnectedState;
}

bool ChannelPeer::WaitForGreeting(int timeout) {
    return WaitFor([this] { return number_.has_value(); }, timeout);
}

std::optional<qint64> ChannelPeer::Ask(Frame question, int timeout) {
    if (!IsConnected()) return std::nullopt;
    question.Id = ++lastId_;
    const auto place = open_.emplace(question.Id, std::nullopt).first;
    Post(question);
    const QPointer<ChannelPeer> self(this);
    const bool answered = WaitFor([place] { return place->second.has_value(); }, timeout);
    if (self.isNull()) return std::nullopt;
    const std::optional<qint64> answer = answered ? place->second : std::nullopt;
    open_.erase(place);
    return answer;
}

void ChannelPeer::Post(const Frame& frame) {
    if (!IsConnected()) return;
    socket_->write(Encode(frame));
    socket_->flush();
    if (socket_->bytesToWrite() > kMostWaiting) socket_->abort();
}

void ChannelPeer::Abandon() {
    ending_ = true;
    gone_ = true;
    posted_.clear();
    socket_->abort();
}

// Waits on the socket only: no timer runs and no input is taken meanwhile.
template <typename Condition>
bool ChannelPeer::WaitFor(Condition condition, int timeout) {
    const QDeadlineTimer deadline(timeout);
    const QPointer<ChannelPeer> self(this);
    ReadSocket();
    while (!self.isNull() && !condition()) {
        if (!IsConnected() || deadline.hasExpired()) return false;
        socket_->waitForReadyRead(static_cast<int>(deadline.remainingTime()));
        if (!self.isNull()) ReadSocket();
    }
    return !self.isNull();
}

// What has come while a frame was being handled, as well: the socket does not tell of that.
void ChannelPeer::ReadSocket() {
    const QPointer<ChannelPeer> self(this);
    while (!self.isNull() && !gone_) {
        if (socket_->bytesAvailable() > 0) reader_.Append(socket_->readAll());
        const std::optional<Frame> frame = reader_.Next();
        if (!frame) break;
        Take(*frame);
    }
    // There is nothing to talk about with an end that does not speak the language.
    if (!self.isNull() && reader_.Broken()) socket_->abort();
}

void ChannelPeer::Take(const Frame& frame) {
    switch (frame.Kind) {
        case FrameKind::Greeting:
            if (number_) return;
            number_ = frame.Number;
            if (OnGreeted) OnGreeted();
            return;
        case FrameKind::Answer: {
            const auto place = open_.find(frame.Id);
            if (place != open_.end()) place->second = frame.Number;
            return;
        }
        case FrameKind::Command:
        case FrameKind::Text:
        case FrameKind::Question:
            return AnswerTo(frame);
        case FrameKind::Feedback:
        case FrameKind::FeedbackText:
            return KeepPosted(frame);
    }
}

void ChannelPeer::KeepPosted(const Frame& frame) {
    if (posted_.size() >= kMostPosted || postedText_ > kMostWaiting) return socket_->abort();
    if (posted_.empty()) QTimer::singleShot(0, this, &ChannelPeer::HandOverPosted);
    postedText_ += frame.Text.size();
    posted_.push_back(frame);
}

void ChannelPeer::AnswerTo(const Frame& frame) {
    const QPointer<ChannelPeer> self(this);
    const qint64 answer = OnAsked ? OnAsked(frame) : 0;
    if (!self.isNull()) Post({.Kind = FrameKind::Answer, .Id = frame.Id, .Number = answer});
}

// One a time, and the rest after the event loop has run: what a handler asks may take long.
void ChannelPeer::HandOverPosted() {
    if (posted_.empty()) return;
    const Frame frame = std::move(posted_.front());
    posted_.pop_front();
    postedText_ -= frame.Text.size();
    if (!posted_.empty()) QTimer::singleShot(0, this, &ChannelPeer::HandOverPosted);
    if (OnPosted) OnPosted(frame);
}

// The last words come first.
void ChannelPeer::NoticeEnd() {
    if (std::exchange(ending_, true)) return;
    const QPointer<ChannelPeer> self(this);
    ReadSocket();
    if (self.isNull()) return;
    gone_ = true;
    if (OnGone) OnGone();
}
