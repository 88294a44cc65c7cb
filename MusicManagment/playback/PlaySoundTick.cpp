#include <QScopedValueRollback>
#include <limits>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/PlaySound.h"

// What happens while a song plays: the ticks, its end, and what comes after it.

namespace {

constexpr quint32 kEndZone = 1000;  // ms

// A song shorter than the zone is in it from its beginning: short songs end, and are faded, at once.
bool IsInLast(quint32 zone, quint32 position, quint32 length) {
    return qint64{length} - zone < position;
}

}  // namespace

void TPlaySound::Tick() {
    GuardOutput(true, [this] { RunTick(TickKind::Running); });
}

// Whoever is told in between may change the song, so that each step looks whether there still is one.
void TPlaySound::RunTick(TickKind kind) {
    if (!engines_.IsOpen()) return;
    const quint32 position = engines_.Song().GetPosition();
    const quint32 length = engines_.Song().GetLength();
    ReportPosition(position, length);
    if (kind == TickKind::Running && engines_.IsOpen()) {
        if (engines_.Fades().FadeStep()) {
            StopTimers();
            engines_.Stop(StopMode::AtOnce);
            return FinishStop();
        }
        CheckEnd(position, length);
        CheckCrossFade(position, length);
        outputTold_ = false;  // it sounds
    }
    CountSongWhenDue();
}

void TPlaySound::ReportPosition(quint32 position, quint32 length) {
    events_.Playing.Tell(position);
    Feedback(fbPlaying, position);
    if (panel_ != nullptr) panel_->ShowPosition(position, length);
    Feedback(fbPosition, position);
}

bool TPlaySound::HasEnded(quint32 position, quint32 length) {
    const TPSStatus status = engines_.Song().GetStatus();
    if (length == 0 && status == psPlaying) return false;  // not known yet
    // Damaged files end before their time. Only this engine's status is sure enough to go by.
    const bool endedEarly = status == psStopped && engines_.CanFade();
    return endedEarly || IsInLast(kEndZone, position, length);
}

// No other song follows one that was asked to stop and still fades.
void TPlaySound::CheckEnd(quint32 position, quint32 length) {
    if (!engines_.IsOpen()) return;
    if (endReached_ && !timers_.EndPending()) return RestWhenOver();
    if (endReached_ || engines_.Fades().IsStopping() || !HasEnded(position, length)) return;
    endReached_ = true;
    timers_.StartEnd();
}

void TPlaySound::CheckCrossFade(quint32 position, quint32 length) {
    if (!engines_.IsOpen() || crossFadeStarted_ || engines_.Fades().IsStopping() || length == 0) return;
    const unsigned before = engines_.Generation();
    if (!IsInLast(settings_.FMODCrossoverTime, position, length) || Crossover() == coNone) return;
    if (engines_.Generation() != before) return;  // another song came while the mode was asked for
    crossFadeStarted_ = true;
    events_.Crossover.Tell();
    if (engines_.CanFade() && settings_.FMODCrossoverTime >= kShortestFade)
        AskForNextSong(SongChange::CrossFadeOnly);
    Feedback(fbCrossover);
}

void TPlaySound::HandleEndOfSong() {
    timers_.StopEnd();
    events_.ReachedEnd.Tell();
    AskForNextSong(SongChange::Hard);
    Feedback(fbEndOfSong);
    RestWhenOver();
}

// After a song that nothing has followed. One whose length was told too short plays on for a while.
void TPlaySound::RestWhenOver() {
    if (!engines_.IsOpen() || GetStatus() != psStopped) return;
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
    const bool atEnd = change == SongChange::CrossFadeOnly;
    const QScopedValueRollback ending(ending_, keepAlbums_ && atEnd ? RecordOf(fileName_) : std::nullopt);
    if (!playList_) return PlayNextOfDatabase(change);
    // Where nothing follows the user is told at the end of the song, not when it would be faded.
    if (atEnd && !playList_->HasNext()) return;
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
