#include "tsplayer/PlayerService.h"

#include <algorithm>
#include <limits>

namespace {

constexpr int kQuestionTimeout = 2000;  // ms

template <typename T>
T Bounded(qint64 value) {
    return static_cast<T>(std::clamp(value, qint64{std::numeric_limits<T>::min()},
                                     static_cast<qint64>(std::numeric_limits<T>::max())));
}

constexpr bool IsText(int code) {
    return code == ecFadingFileName || code == ecOpenFile || code == ecPlayWithCrossFade ||
           code == ecWinAmpClassName || code == ecWinAmpFile;
}

}  // namespace

PlayerService::PlayerService(TPlaySound& player, ChannelServer& server) : player_(player), server_(server) {
    server_.OnAsked = [this](ChannelPeer&, const Frame& frame) { return Serve(frame); };
    server_.OnPeerGone = [this](const ChannelPeer& peer) { LoseController(peer); };
}

PlayerService::~PlayerService() {
    server_.OnAsked = nullptr;
    server_.OnPeerGone = nullptr;
    player_.SetController(nullptr);
}

qint64 PlayerService::Serve(const Frame& frame) {
    const bool isText = frame.Kind == FrameKind::Text;
    if ((!isText && frame.Kind != FrameKind::Command) || isText != IsText(frame.Code)) return 0;
    try {
        return CarryOutSetting(frame) ? 0 : CarryOut(frame);
    } catch (const EAbort&) {
        // The user has been told.
    } catch (const ERukException& error) {
        if (OnFailure) OnFailure(error.Message());
    }
    return 0;
}

bool PlayerService::CarryOutSetting(const Frame& frame) {
    EngineSettings settings = player_.Engines();
    // The time of a fade is a setting under another number.
    const int command = frame.Code == ecFadingTime ? ecCrossoverTime : static_cast<int>(frame.Code);
    if (!TakeEngineSetting(settings, command, frame.Number, frame.Text)) return false;
    player_.SetEngines(settings);
    return true;
}

qint64 PlayerService::CarryOut(const Frame& frame) {
    switch (frame.Code) {
        case ecGetPosition:
            return player_.GetPosition();
        case ecSetPosition:
            player_.SetPosition(Bounded<quint32>(frame.Number));
            return 0;
        case ecGetLength:
            return player_.GetLength();
        case ecGetStatus:
            return player_.GetStatus();
        case ecClose:
            player_.Close();
            return 0;
        case ecPlay:
            player_.Play();
            return 0;
        case ecOpenFile:
            player_.SetFileName(frame.Text);
            return 0;
        case ecStop:
            player_.Stop(frame.Number == 1 ? StopMode::Fade : StopMode::AtOnce);
            return 0;
        case ecPauseResume:
            player_.PauseResume();
            return 0;
        case ecPlayWithCrossFade:
            return player_.PlayWithCrossFade(frame.Text) ? 1 : 0;
        case ecFeedbackHandle:
            TakeController(frame.Number);
            return 0;
        // The steps towards a song that is faded in: the player takes them all at once, with the last one.
        case ecNewFading:
        case ecCloseFading:
            fadingFile_.clear();
            player_.SetCOFileName({});
            return 0;
        case ecFadingFileName:
            fadingFile_ = frame.Text;
            return 0;
        case ecPlayFading:
            player_.SetCOFileName(fadingFile_);
            return 0;
        case ecOpenFading:
        case ecStartFading:
        default:
            return 0;
    }
}

void PlayerService::TakeController(qint64 number) {
    controller_ = server_.FindPeer(number);
    player_.SetController(controller_.isNull() ? nullptr : this);
}

void PlayerService::LoseController(const ChannelPeer& peer) {
    if (controller_ != &peer) return;
    controller_.clear();
    player_.SetController(nullptr);
    player_.Close();
    if (OnControllerGone) OnControllerGone();
}

void PlayerService::Feedback(FeedbackCode code, quint32 parameter) {
    if (controller_) controller_->Post({.Kind = FrameKind::Feedback, .Code = code, .Number = parameter});
}

void PlayerService::FeedbackFileName(const QString& fileName) {
    if (controller_)
        controller_->Post({.Kind = FrameKind::FeedbackText, .Code = fbFileName, .Text = fileName});
}

TCrossover PlayerService::AskCrossover() {
    if (!controller_) return coAutoChange;
    const auto answer =
        controller_->Ask({.Kind = FrameKind::Question, .Code = fbCrossoverQuery}, kQuestionTimeout);
    return answer && *answer >= coNone && *answer <= coAlways ? static_cast<TCrossover>(*answer)
                                                              : coAutoChange;
}
