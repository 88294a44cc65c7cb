#include "MusicManagment/playback/extern/LocalExternalPlayer.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <QRandomGenerator>
#include <QThread>

namespace {

constexpr int kConnectTimeout = 200;    // ms; the kernel answers at once
constexpr int kGreetingTimeout = 1000;  // ms

}  // namespace

LocalExternalPlayer::LocalExternalPlayer(QString path, int answerTimeout)
    : path_(std::move(path)),
      answerTimeout_(answerTimeout),
      ownNumber_(qint64{QRandomGenerator::global()->generate()} + 1) {}

LocalExternalPlayer::~LocalExternalPlayer() = default;

std::optional<qint64> LocalExternalPlayer::Find() {
    if (!peer_ || !peer_->IsConnected()) {
        Disconnect();
        hangs_ = Connect() && hangs_;
    }
    if (!peer_) return std::nullopt;
    const bool greeted = peer_->WaitForGreeting(hangs_ ? 0 : kGreetingTimeout);
    hangs_ = !greeted && peer_ && peer_->IsConnected();
    return greeted && peer_ ? peer_->Number() : std::nullopt;
}

bool LocalExternalPlayer::Connect() {
    if (path_.isEmpty()) return false;
    auto socket = std::make_unique<QLocalSocket>();
    socket->connectToServer(path_);
    if (!socket->waitForConnected(kConnectTimeout)) return false;
    peer_ = std::make_unique<ChannelPeer>(std::move(socket), ownNumber_);
    peer_->OnAsked = [this](const Frame& frame) {
        const bool isQuestion = receiver_ != nullptr && frame.Kind == FrameKind::Question;
        return isQuestion ? receiver_->HandleFeedback(frame.Code, static_cast<quint32>(frame.Number)) : 0;
    };
    peer_->OnPosted = [this](const Frame& frame) {
        if (receiver_ == nullptr) return;
        if (frame.Kind == FrameKind::FeedbackText)
            receiver_->HandleFeedbackText(frame.Code, frame.Text);
        else
            receiver_->HandleFeedback(frame.Code, static_cast<quint32>(frame.Number));
    };
    return true;
}

// Destroyed later: feedback of this peer may be what has led here.
void LocalExternalPlayer::Disconnect() {
    if (!peer_) return;
    peer_->Abandon();
    peer_.release()->deleteLater();
}

bool LocalExternalPlayer::Start(const QString& program, const QString& argument) {
    if (hangs_) return false;
    const QFileInfo file(QDir(QCoreApplication::applicationDirPath()).absoluteFilePath(program));
    return file.isFile() && file.isExecutable() &&
           QProcess::startDetached(file.absoluteFilePath(), {argument});
}

void LocalExternalPlayer::Wait(int milliseconds) {
    QThread::msleep(static_cast<unsigned long>(std::max(milliseconds, 0)));
}

qint64 LocalExternalPlayer::SendCommand(ExternalCommand command, qint64 parameter) {
    return Ask({.Kind = FrameKind::Command, .Code = command, .Number = parameter});
}

qint64 LocalExternalPlayer::SendText(ExternalCommand command, const QString& text) {
    return Ask({.Kind = FrameKind::Text, .Code = command, .Text = text});
}

qint64 LocalExternalPlayer::Ask(const Frame& frame) {
    if (!peer_) return 0;
    const std::optional<qint64> answer = peer_->Ask(frame, answerTimeout_);
    if (!answer) {
        hangs_ = peer_ && peer_->IsConnected();
        Disconnect();
    }
    return answer.value_or(0);
}

std::optional<qint64> LocalExternalPlayer::CreateFeedback(FeedbackReceiver& receiver) {
    receiver_ = &receiver;
    return ownNumber_;
}
