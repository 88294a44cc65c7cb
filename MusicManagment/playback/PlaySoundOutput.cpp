#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/PlaySound.h"

// A song whose way to the loudspeaker fails stays the current one and waits, until there is an output again.

using namespace Qt::StringLiterals;

namespace {

constexpr int kMostLooks = 720;  // one hour; then the song waits for the user

}  // namespace

// `begun`: the song has been heard.
void TPlaySound::GuardOutput(bool begun, const std::function<void()>& action) {
    try {
        action();
    } catch (const EOutputException& error) {
        WaitForOutput(error.Message(), begun);
    }
}

// The engine may keep the song, and plays it on then.
void TPlaySound::WaitForOutput(const QString& reason, bool begun) {
    const bool plays = engines_.IsOpen() || (waiting_ && waiting_->Plays);
    const int looks = waiting_ ? waiting_->Looks : 0;
    StopTimers();
    if (!waiting_)
        waiting_ = {.Position = engines_.Position(),
                    .Length = engines_.Length(),
                    .Begun = begun,
                    .Plays = plays,
                    .Looks = looks};
    if (waiting_->Plays) timers_.StartOutput();
    StateChanged();
    if (std::exchange(outputTold_, true)) return;
    const QString text =
        u"Die Tonausgabe ist nicht verfügbar. Das Lied spielt weiter, sobald sie wieder da ist."_s;
    events_.Notice.Tell(text);
    TellWhileOpening(MessageKind::Error, text + u"\r\n"_s + reason);
}

// What the user or the playlist wants of a song that waits.
void TPlaySound::GoOn() {
    waiting_->Looks = 0;
    if (std::exchange(waiting_->Plays, true)) return LookForOutput();
    timers_.StartOutput();
    StateChanged();
}

void TPlaySound::LookForOutput() {
    if (!waiting_) return;
    const Waiting song = *waiting_;
    try {
        OpenAtPosition(song.Position);
    } catch (const EOutputException&) {
        if (waiting_ && ++waiting_->Looks < kMostLooks) timers_.StartOutput();
        return;
    } catch (const EAbort&) {
        throw;
    } catch (const ERukException&) {
        waiting_.reset();
        engines_.Close();
        timers_.StartEnd();  // the next song
        throw;
    }
    waiting_.reset();
    if (!engines_.IsOpen()) return ClearPanel();  // its file has gone
    StartTimers();
    events_.Notice.Tell(u"Die Tonausgabe ist wieder da."_s);
    if (!song.Begun) return AnnounceSong();
    events_.Resumed.Tell();
    Feedback(fbResumed);
    StateChanged();
}

// An engine that has kept the song knows where it was; one that has lost it begins anew.
void TPlaySound::OpenAtPosition(quint32 position) {
    if (engines_.IsOpen()) {
        try {
            engines_.Play();
            return;
        } catch (const EOutputException&) {
            throw;
        } catch (const ERukException&) {
            engines_.Close();
        }
    }
    if (!FileSource::Exists(fileName_)) return;
    engines_.Open(fileName_);
    engines_.Play();
    if (position > 0) engines_.SetPosition(position);
}
