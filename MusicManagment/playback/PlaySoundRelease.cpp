#include <utility>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/playback/PlaySound.h"

// The file of a song is moved or removed: the player lets go of it, and takes it up again where it was.

namespace {

bool IsSamePath(const QString& a, const QString& b) {
    return !a.isEmpty() && a.compare(b, Qt::CaseInsensitive) == 0;
}

}  // namespace

// --- Another path ---

// A file that was not asked for is open still and sounds on.
void TPlaySound::FollowRenamed(const PathChanges& renamed) {
    coFileName_ = renamed.value(coFileName_, coFileName_);
    const auto now = renamed.constFind(fileName_);
    if (now == renamed.constEnd()) return;
    fileName_ = *now;
    engines_.FollowRenamed(fileName_);
    if (!released_) ShowSong();
}

// --- Letting go ---

// Whoever opens or closes a song before the file is given back has the last word.
std::function<void(const QString&)> TPlaySound::ReleaseFile(const QString& path) {
    if (IsSamePath(coFileName_, path)) SetCOFileName(QString());
    if (IsSamePath(engines_.FileBeside(), path)) engines_.CloseBeside();
    if (!IsSamePath(fileName_, path) || !LetGo()) return {};
    return [player = QPointer(this), path](const QString& now) {
        if (player) player->TakeUp(path, now);
    };
}

// False when it holds nothing. It tells until it is taken up what it did before.
bool TPlaySound::LetGo() {
    if (released_) return true;
    const Released song{.Status = GetStatus(),
                        .Position = GetPosition(),
                        .Length = GetLength(),
                        .Stops = engines_.IsOpen() && engines_.Fades().IsStopping(),
                        .Ends = timers_.EndPending(),
                        .Output = waiting_};
    if (song.Status == psClosed && !engines_.IsOpen()) return false;
    Close();
    released_ = song;
    return true;
}

// --- Taking up ---

void TPlaySound::TakeUp(const QString& from, const QString& path) {
    if (!released_) return;
    const Released song = *std::exchange(released_, std::nullopt);
    if (path != from) fileName_ = path;
    RunGuarded([&] { GoBack(song); }, [this] { StateChanged(); });
}

void TPlaySound::GoBack(const Released& song) {
    const bool isThere = FileSource::Exists(fileName_);
    if (song.Output && isThere) {
        WaitAgain(*song.Output);
        return ShowSong();
    }
    if (isThere) Open();
    const bool sounded = song.Status == psPlaying || song.Status == psPaused;
    if (isThere && sounded && !song.Stops) {
        PlayFrom(song);
        return ShowSong();
    }
    if (sounded)
        FinishStop();
    else if (song.Ends)
        timers_.StartEnd();
    isThere ? ShowSong() : ClearPanel();
}

void TPlaySound::PlayFrom(const Released& song) {
    const bool plays = song.Status == psPlaying;
    GuardOutput(true, [&] {
        if (waiting_) return;
        PlayTarget& target = Chosen();
        target.Play();
        if (song.Position > 0) target.SetPosition(song.Position);
        if (!plays) target.PauseResume();
        if (plays) playExtern_ ? RestartAutoStop() : StartTimers();
    });
    // Where the output has gone meanwhile.
    if (waiting_)
        WaitAgain(
            {.Position = song.Position, .Length = song.Length, .Begun = true, .Plays = plays, .Looks = 0});
}

// An engine that has opened it would begin at its start.
void TPlaySound::WaitAgain(const Waiting& song) {
    engines_.Close();
    timers_.StopAll();
    waiting_ = song;
    if (song.Plays) timers_.StartOutput();
}
