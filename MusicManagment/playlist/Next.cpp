#include <QScopedValueRollback>
#include <algorithm>
#include <utility>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayOrder.h"
#include "MusicManagment/playlist/SongCopies.h"
#include "MusicManagment/playlist/SongPlayer.h"

// Playing an entry, and which one is played next.

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype kMostReasons = 5;  // in one message

}  // namespace

// --- One entry ---

bool TPlayList::PlayEntry(int index, const PlayOptions& options) {
    if (index < 0 || index >= Count()) return false;
    // A song that the user chooses after the last of a round begins the next one.
    if (roundIsOver_) StartNewRound();
    return Play(index, options) != Outcome::Failed;
}

TPlayList::Outcome TPlayList::Play(int index, const PlayOptions& options) {
    RequirePlayer();
    const QString song = NameAt(index);
    if (database_) RefreshRecord(index, options.DatabaseHint);
    const QString path = PlayablePath(song);
    if (path.isEmpty()) return Outcome::Failed;

    const QString formerSong = std::exchange(currentSong_, song);
    const QString formerFile = std::exchange(currentFile_, copyMp3sBeforePlay_ ? CopyForPlaying(path) : path);
    const bool started = StartPlayer(options.Change);
    if (!started) {
        currentSong_ = formerSong;
        currentFile_ = formerFile;
        return Outcome::CurrentGoesOn;
    }
    if (options.Record) history_.prepend(song);
    player_->RedrawPanel();
    RedrawView();
    return Outcome::Playing;
}

bool TPlayList::StartPlayer(SongChange change) {
    if (change != SongChange::Hard && player_->PlayWithCrossFade(currentFile_)) return true;
    if (change == SongChange::CrossFadeOnly) return false;
    player_->SetFileName(currentFile_);
    if (!player_->AutoPlay()) player_->Play();
    return true;
}

// --- The next entry ---

// One search for an entry that can be played: tries none twice, and keeps the reasons of those that failed
// until it is over. A message box in between would hold up the music, and let its user change the list.
class TPlayList::Search {
 public:
    Search(TPlayList& list, SongChange change) : list_(list), change_(change) {}

    bool ServeQueue() {
        while (!list_.queue_.isEmpty()) {
            const QString head = list_.queue_.takeFirst();
            if (!Try(list_.entries_.Find(head), true)) continue;
            if (CurrentGoesOn()) list_.queue_.prepend(head);
            return true;
        }
        return false;
    }

    bool TryEach(const std::vector<int>& sequence) {
        return std::ranges::any_of(sequence, [this](int index) { return Try(index, true); });
    }

    // The list can be another one than when the search began: while a file is opened the player or the
    // database may have asked the user something.
    bool Try(int index, bool record) {
        if (index < 0 || index >= list_.Count()) return false;
        const QString song = list_.NameAt(index);
        if (tried_.contains(song)) return false;
        tried_.insert(song);
        outcome_ = Play(index, song, record);
        if (outcome_ == Outcome::Playing) list_.roundIsOver_ = false;
        return outcome_ != Outcome::Failed;
    }

    bool CurrentGoesOn() const { return outcome_ == Outcome::CurrentGoesOn; }

    // What the user must be told when the search is over; empty for nothing.
    QString Report(bool found) const {
        QStringList parts = reasons_.first(std::min(reasons_.size(), kMostReasons));
        if (reasons_.size() > kMostReasons) parts << u"und %1 weitere"_s.arg(reasons_.size() - kMostReasons);
        // Without a round that ends there is no other word on it.
        if (!found && list_.repeatAll_)
            parts.prepend(u"Keines der Lieder in der PlayList konnte abgespielt werden."_s);
        return parts.join(u"\r\n\r\n"_s);
    }

 private:
    Outcome Play(int index, const QString& song, bool record) {
        const QScopedValueRollback<bool> searching(list_.searching_, true);
        try {
            return list_.Play(index, {.Change = change_, .Record = record});
        } catch (const EAbort&) {
            throw;
        } catch (const ERukException& error) {
            if (!list_.told_.contains(song)) reasons_ << error.Message() + u"\r\n"_s + song;
            list_.told_.insert(song);
            return Outcome::Failed;
        }
    }

    TPlayList& list_;
    SongChange change_;
    QSet<QString> tried_;
    QStringList reasons_;
    Outcome outcome_ = Outcome::Failed;
};

bool TPlayList::PlayNext(SongChange change) {
    if (searching_) return false;  // a message box lets the player's timers run
    if (Count() == 0) {
        UserDialogs().ShowMessage(MessageKind::Information, u"Keine Lieder in der PlayList zum Abspielen"_s);
        return false;
    }
    if (playOrder_ == poStopAfterPlay) return false;
    RequirePlayer();

    Search search(*this, change);
    bool found = search.ServeQueue();
    if (!found) {
        const int current = IndexOf();
        found = search.TryEach(RestOfRound(current));
        if (!found) HandleAllPlayed();
        if (!found && repeatAll_ && current >= 0)
            found =
                search.TryEach(SequenceAfter(playOrder_, Count(), std::min(current, Count() - 1), random_));
    }
    Tell(search.Report(found));
    return found;
}

bool TPlayList::HasNext() const {
    if (Count() == 0 || playOrder_ == poStopAfterPlay) return false;
    if (std::ranges::any_of(queue_, [this](const QString& name) { return entries_.Find(name) >= 0; }))
        return true;
    const int current = IndexOf();
    if (current < 0 || repeatAll_) return true;
    const QSet<QString> played(history_.begin(), history_.end());
    for (int index = 0; index < Count(); ++index)
        if (IsOpen(index, current, played)) return true;
    return false;
}

// Whether an entry is still to be played in this round. Downwards and upwards the round is over when it comes
// back to the current song, however that was started.
bool TPlayList::IsOpen(int index, int current, const QSet<QString>& played) const {
    return !played.contains(NameAt(index)) && (index != current || playOrder_ == poRandom);
}

std::vector<int> TPlayList::RestOfRound(int current) {
    std::vector<int> sequence = SequenceAfter(playOrder_, Count(), current, random_);
    if (current < 0) return sequence;
    const QSet<QString> played(history_.begin(), history_.end());
    std::erase_if(sequence, [&](int index) { return !IsOpen(index, current, played); });
    return sequence;
}

void TPlayList::HandleAllPlayed() {
    bool showException = true;
    if (OnAllFilesPlayed) {
        showException = false;
        OnAllFilesPlayed(*this, showException);
    }
    if (database_ && database_->OnAllFilesPlayed) database_->OnAllFilesPlayed(*database_, showException);
    if (repeatAll_) return StartNewRound();
    roundIsOver_ = true;
    if (showException)
        UserDialogs().ShowMessage(MessageKind::Information,
                                  u"Es wurden alle in der PlayList enthaltenen Lieder abgespielt."_s);
}

// --- The previous entry ---

bool TPlayList::PlayPrevious(SongChange change) {
    if (searching_ || !HasPrevious()) return false;
    RequirePlayer();
    const QStringList history = history_;
    Search search(*this, change);
    bool found = false;
    while (!found && HasPrevious()) {
        history_.removeFirst();
        found = search.Try(entries_.Find(history_.first()), false);
    }
    if (!found || search.CurrentGoesOn())
        history_ = history;
    else
        ReturnTo(history.first());
    Tell(search.Report(true));
    return found;
}

// Makes the song that was left the next one.
void TPlayList::ReturnTo(const QString& song) {
    if (entries_.Find(song) < 0) return;
    queue_.removeAll(song);
    queue_.prepend(song);
    RedrawView();
}

void TPlayList::RequirePlayer() const {
    if (player_ == nullptr)
        throw EPlayListException(u"Keine PlaySound-Komponente zum Abspielen vorhanden."_s);
}

void TPlayList::Tell(const QString& report) {
    if (!report.isEmpty()) UserDialogs().ShowMessage(MessageKind::Error, report);
}
