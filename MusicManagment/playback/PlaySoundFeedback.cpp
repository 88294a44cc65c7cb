#include "MusicManagment/playback/PlaySound.h"

// What the player tells: its events, the panel, a program that drives it. And what the external player tells.

namespace {

constexpr qint64 kModeMask = 0x7F;

}  // namespace

void TPlaySound::Raise(const TNotifyEvent& event) {
    if (event) event(*this);
}

void TPlaySound::Feedback(FeedbackCode code, quint32 parameter) {
    if (controller_ != nullptr) controller_->Feedback(code, parameter);
}

void TPlaySound::StateChanged() {
    RedrawPanel();
    Feedback(fbStateChanged, 1);
}

// It comes from the event loop, where nobody could tell the user. What an external player has said last may
// come when songs play here again, and is not about them.
qint64 TPlaySound::HandleFeedback(int code, quint32 parameter) {
    if (code == fbCrossoverQuery) return controller_ != nullptr ? 1 : Crossover() & kModeMask;
    if (playExtern_) RunGuarded([&] { TakeFeedback(code, parameter); }, nullptr);
    return 0;
}

// With a controller of its own this program only sits in between: the end of a song and the counting are the
// controller's then.
void TPlaySound::TakeFeedback(int code, quint32 parameter) {
    switch (code) {
        case fbEndOfSong:
            if (controller_ == nullptr) HandleEndOfSong();
            break;
        case fbPlaying:
            if (OnPlaying) OnPlaying(*this, parameter);
            break;
        case fbStopped:
            Raise(OnPlayingStopped);
            break;
        case fbPosition:
            if (panel_ != nullptr) panel_->ShowPosition(parameter, GetLength());
            break;
        case fbStateChanged:
            RedrawPanel();
            break;
        case fbCrossover:
            Raise(OnCrossover);
            AskForNextSong(SongChange::CrossFadeOnly);
            break;
        case fbSongCounted:
            if (controller_ == nullptr) CountSong();
            break;
        case fbStarted:
            Raise(OnPlayingStarted);
            break;
        case fbPaused:
            Raise(OnPlayingPaused);
            break;
        case fbResumed:
            Raise(OnPlayingResumed);
            break;
        default:
            break;
    }
}

void TPlaySound::HandleFeedbackText(int code, const QString& text) {
    if (code == fbFileName && playExtern_ && panel_ != nullptr) panel_->ShowSong(text);
}
