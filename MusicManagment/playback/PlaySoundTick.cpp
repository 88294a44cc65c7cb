#include <limits>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/backend/FadingBackend.h"

// What happens while a song plays: the ticks, its end, and what comes after it.

namespace {

constexpr quint32 kEndZone = 1000;  // ms

// A song shorter than the zone is in it from its beginning: short songs end, and are faded, at once.
bool IsInLast(quint32 zone, quint32 position, quint32 length) {
    return qint64{length} - zone < position;
}

}  // namespace

// A timer's handler has nobody above it who could tell the user.
void TPlaySound::RunHandler(void (TPlaySound::*handler)()) {
    RunGuarded([this, handler] { (this->*handler)(); },
               [this, handler] {
                   // What a tick throws the next one throws again: the song is over. The message box lets
                   // timers run, so that the next song need not wait for the user.
                   timers_.StopTicks();
                   if (handler == &TPlaySound::Tick) timers_.StartEnd();
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
        UserDialogs().ShowMessage(MessageKind::Error, error.Message());
    }
}

void TPlaySound::Tick() {
    RunTick(TickKind::Running);
}

// Whoever is told in between may change the song, so that each step looks whether there still is one.
void TPlaySound::RunTick(TickKind kind) {
    if (!current_) return;
    const quint32 position = current_->GetPosition();
    const quint32 length = current_->GetLength();
    ReportPosition(position, length);
    if (kind == TickKind::Running) {
        if (FinishFades()) return;
        CheckEnd(position, length);
        CheckCrossFade(position, length);
    }
    CountSongWhenDue();
}

void TPlaySound::ReportPosition(quint32 position, quint32 length) {
    if (OnPlaying) OnPlaying(*this, position);
    Feedback(fbPlaying, position);
    if (panel_ != nullptr) panel_->ShowPosition(position, length);
    Feedback(fbPosition, position);
}

// True when a fading stop has come to its end.
bool TPlaySound::FinishFades() {
    FadingBackend* current = AsFading(current_.get());
    if (current != nullptr && current->FadeStep()) {
        FinishStop();
        return true;
    }
    FadingBackend* fading = AsFading(fading_.get());
    if (fading != nullptr && fading->FadeStep()) fading_.reset();
    return false;
}

// The current song fades out only when it was asked to stop; no other song may follow it then.
bool TPlaySound::IsStopping() const {
    const FadingBackend* fading = AsFading(current_.get());
    return fading != nullptr && fading->IsFadingOut();
}

bool TPlaySound::HasEnded(quint32 position, quint32 length) {
    const TPSStatus status = current_->GetStatus();
    if (length == 0 && status == psPlaying) return false;  // not known yet
    // Damaged files end before their time. Only this engine's status is sure enough to go by.
    const bool endedEarly = status == psStopped && AsFading(current_.get()) != nullptr;
    return endedEarly || IsInLast(kEndZone, position, length);
}

void TPlaySound::CheckEnd(quint32 position, quint32 length) {
    if (!current_) return;
    if (endReached_ && !timers_.EndPending()) return RestWhenOver();
    if (endReached_ || IsStopping() || !HasEnded(position, length)) return;
    endReached_ = true;
    timers_.StartEnd();
}

void TPlaySound::CheckCrossFade(quint32 position, quint32 length) {
    if (!current_ || crossFadeStarted_ || IsStopping() || length == 0) return;
    const unsigned before = generation_;
    if (!IsInLast(settings_.FMODCrossoverTime, position, length) || Crossover() == coNone) return;
    if (generation_ != before) return;  // another song came while the mode was asked for
    crossFadeStarted_ = true;
    Raise(OnCrossover);
    if (AsFading(current_.get()) != nullptr && settings_.FMODCrossoverTime >= kShortestFade)
        AskForNextSong(SongChange::CrossFadeOnly);
    Feedback(fbCrossover);
}

void TPlaySound::HandleEndOfSong() {
    timers_.StopEnd();
    Raise(OnReachedEndOfSong);
    AskForNextSong(SongChange::Hard);
    Feedback(fbEndOfSong);
    RestWhenOver();
}

// After a song that nothing has followed. One whose length was told too short plays on for a while.
void TPlaySound::RestWhenOver() {
    if (!current_ || GetStatus() != psStopped) return;
    StopTimers();
    StateChanged();
}

void TPlaySound::HandleAutoStop() {
    timers_.StopAutoStop();
    const TPSStatus status = GetStatus();
    if (status != psPaused && status != psPlaying) return;
    Stop(StopMode::Fade);
    HandleEndOfSong();
}

// --- Counting ---

void TPlaySound::CountSongWhenDue() {
    if (database_ && database_->Busy()) return;  // a later tick counts
    if (!playCount_.Due(CurrentClock().Ticks())) return;
    CountSong();
    Feedback(fbSongCounted, 1);
}

void TPlaySound::CountSong() {
    if (!database_ || database_->Busy()) return;
    database_->EnsureSorted();
    const SongIndex song = SongInDatabase();
    if (song < 0) return;
    TID3Tag record = database_->Song(song);
    if (record.PlayCount < std::numeric_limits<quint32>::max()) ++record.PlayCount;
    database_->UpdateEntry(song, record);
}

// --- The next song ---

void TPlaySound::AskForNextSong(SongChange change) {
    if (!playList_) return PlayNextOfDatabase(change);
    // Where nothing follows the user is told at the end of the song, not when it would be faded.
    if (change == SongChange::CrossFadeOnly && !playList_->HasNext()) return;
    playList_->PlayNext(change);
}

// Without a playlist the collection is played in its order, up to its last song.
void TPlaySound::PlayNextOfDatabase(SongChange change) {
    const SongIndex song = SongInDatabase();
    if (song < 0 || song + 1 >= database_->Count()) return;
    const QString path = database_->ResolveSongPath(database_->Song(song + 1).FileName);
    if (path.isEmpty()) return;
    if (change != SongChange::Hard && PlayWithCrossFade(path)) return;
    if (change == SongChange::CrossFadeOnly) return;
    SetFileName(path);
    if (!autoPlay_) Play();
}
