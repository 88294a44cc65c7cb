#include "MusicManagment/playback/PlaySound.h"

#include <QScopedValueRollback>
#include <algorithm>
#include <utility>

// What the player tells: the user, the panel, a program that drives it. And what the external player tells.

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kModeMask = 0x7F;
constexpr qsizetype kMostFailures = 5;  // in one message

}  // namespace

// --- The user ---

// A timer's handler has nobody above it who could tell the user.
void TPlaySound::RunHandler(void (TPlaySound::*handler)()) {
    RunGuarded([this, handler] { (this->*handler)(); },
               [this, handler] {
                   // What a tick throws the next one throws again: the song is over. A message box lets
                   // timers run, so that the next song need not wait for the user.
                   timers_.StopTicks();
                   if (handler == &TPlaySound::Tick) timers_.StartEnd();
                   StateChanged();
               });
}

// `onFailure` runs before the user is told.
void TPlaySound::RunGuarded(const std::function<void()>& action, const std::function<void()>& onFailure) {
    try {
        action();
    } catch (const EAbort&) {
        return;  // the user has been told
    } catch (const ERukException& error) {
        if (onFailure) onFailure();
        TellFailure(error.Message());
    }
}

// A message box lets timers run, and songs fail on: what they say waits until the user has closed the first
// box.
void TPlaySound::TellFailure(const QString& text) {
    if (TellQuietly(text)) return;
    if (!untold_.contains(text)) untold_ << text;  // a list that is repeated fails for ever
    if (telling_) return;
    const QScopedValueRollback<bool> telling(telling_, true);
    while (!untold_.isEmpty()) {
        const QStringList failures = std::exchange(untold_, {});
        QStringList parts = failures.first(std::min(failures.size(), kMostFailures));
        if (failures.size() > kMostFailures)
            parts << u"und %1 weitere"_s.arg(failures.size() - kMostFailures);
        UserDialogs().ShowMessage(MessageKind::Error, parts.join(u"\r\n\r\n"_s));
    }
}

bool TPlaySound::TellQuietly(const QString& text) {
    if (quietFailures_) events_.Notice.Tell(text);
    return quietFailures_;
}

// An engine has refused a song, and another one is tried.
void TPlaySound::TellRefusal(const QString& text) {
    if (!TellQuietly(text)) TellWhileOpening(MessageKind::Warning, text);
}

// Whoever opens or closes a song while the message stands has the last word.
void TPlaySound::TellWhileOpening(MessageKind kind, const QString& text) {
    const unsigned before = engines_.Generation();
    UserDialogs().ShowMessage(kind, text);
    if (engines_.Generation() != before) throw EAbort();
}

// --- A program that drives the player ---

void TPlaySound::Feedback(FeedbackCode code, quint32 parameter) {
    if (controller_ != nullptr) controller_->Feedback(code, parameter);
}

void TPlaySound::StateChanged() {
    RedrawPanel();
    Feedback(fbStateChanged, 1);
}

// --- What the external player tells ---

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
            events_.Playing.Tell(parameter);
            break;
        case fbStopped:
            events_.Stopped.Tell();
            break;
        case fbPosition:
            if (panel_ != nullptr) panel_->ShowPosition(parameter, GetLength());
            break;
        case fbStateChanged:
            RedrawPanel();
            break;
        case fbCrossover:
            events_.Crossover.Tell();
            AskForNextSong(SongChange::CrossFadeOnly);
            break;
        case fbSongCounted:
            if (controller_ == nullptr) CountSong();
            break;
        case fbStarted:
            events_.Started.Tell();
            break;
        case fbPaused:
            events_.Paused.Tell();
            break;
        case fbResumed:
            events_.Resumed.Tell();
            break;
        default:
            break;
    }
}

void TPlaySound::HandleFeedbackText(int code, const QString& text) {
    if (code == fbFileName && playExtern_ && panel_ != nullptr) panel_->ShowSong(text);
}
