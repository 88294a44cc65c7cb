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
    const RememberedEntry entry = Remember(index);
    if (database_) RefreshRecord(index, options.DatabaseHint);
    QString file = PlayablePath(entry.Name);
    if (file.isEmpty()) return Outcome::Failed;
    // The song that plays is heard until a fade is over, or goes on when there is none.
    const bool formerIsHeard = options.Change != SongChange::Hard;
    if (copyMp3sBeforePlay_) file = CopyForPlaying(file, formerIsHeard ? currentFile_ : QString());

    if (options.Change == SongChange::Hard || !FadeInto(entry, file)) {
        if (options.Change == SongChange::CrossFadeOnly) return Outcome::CurrentGoesOn;
        ChangeTo(entry, file);
    }
    if (options.Record) history_.push_front(entry);
    player_->RedrawPanel();
    events_.CurrentChanged.Tell();
    return Outcome::Playing;
}

// Whoever shows the song asks for it while the player begins it; where it does not begin the former goes on.
bool TPlayList::FadeInto(const RememberedEntry& entry, const QString& file) {
    QScopedValueRollback<RememberedEntry> song(current_, entry);
    QScopedValueRollback<QString> path(currentFile_, file);
    if (!player_->PlayWithCrossFade(file)) return false;
    song.commit();
    path.commit();
    return true;
}

// It is the current song from now on, also when no engine can play it: the order goes on from there.
void TPlayList::ChangeTo(const RememberedEntry& entry, const QString& file) {
    current_ = entry;
    currentFile_ = file;
    events_.CurrentChanged.Tell();
    player_->SetFileName(file);
    if (!player_->AutoPlay()) player_->Play();
}

// --- The next entry ---

// One search for an entry that can be played: tries none twice, and keeps the reasons of those that failed
// until it is over. A message box in between would hold up the music, and let its user change the list.
class TPlayList::Search {
 public:
    Search(TPlayList& list, SongChange change) : list_(list), change_(change) {}

    bool ServeQueue() {
        while (!list_.queue_.isEmpty()) {
            const EntryId head = list_.queue_.takeFirst();
            const bool found = Try(list_.entries_.Find(head), true);
            if (CurrentGoesOn()) list_.queue_.prepend(head);
            list_.events_.QueueChanged.Tell();
            if (found) return true;
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
        if (tried_.contains(song)) return false;  // listed twice it would fail twice
        tried_.insert(song);
        if (refused_.contains(SerialOfCdPath(song)) && IsAway(song)) return false;
        outcome_ = Play(index, song, record);
        if (outcome_ == Outcome::Failed && IsAway(song)) refused_.insert(SerialOfCdPath(song));
        if (outcome_ == Outcome::Playing) list_.roundIsOver_ = false;
        return outcome_ != Outcome::Failed;
    }

    bool CurrentGoesOn() const { return outcome_ == Outcome::CurrentGoesOn; }

 private:
    bool IsAway(const QString& song) const {
        return IsCdPath(song) && list_.ResolvedPath(song, {.Ask = false}).isEmpty();
    }

    Outcome Play(int index, const QString& song, bool record) {
        const QScopedValueRollback<bool> searching(list_.searching_, true);
        try {
            return list_.Play(index, {.Change = change_, .Record = record});
        } catch (const EAbort&) {
            throw;
        } catch (const ERukException& error) {
            if (!list_.told_.contains(song)) list_.reasons_ << error.Message() + u"\r\n"_s + song;
            list_.told_.insert(song);
            return Outcome::Failed;
        }
    }

    TPlayList& list_;
    SongChange change_;
    QSet<QString> tried_;
    QSet<quint32> refused_;  // serial numbers of media that the user has not put in
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
        // At the cross-fade point the last song still plays: its end will be the end of the round.
        if (!found && change == SongChange::CrossFadeOnly && !repeatAll_) return false;
        if (!found) HandleAllPlayed();
        if (!found && repeatAll_ && current >= 0)
            found =
                search.TryEach(SequenceAfter(playOrder_, Count(), std::min(current, Count() - 1), random_));
    }
    TellReasons(found);
    return found;
}

bool TPlayList::HasNext() const {
    if (Count() == 0 || playOrder_ == poStopAfterPlay) return false;
    if (!queue_.isEmpty()) return true;
    const int current = IndexOf();
    if (current < 0 || repeatAll_) return true;
    const QSet<QString> played = PlayedNames();
    for (int index = 0; index < Count(); ++index)
        if (IsOpen(index, current, played)) return true;
    return false;
}

// A round plays no song twice, so that one that is listed twice counts as played with either entry.
QSet<QString> TPlayList::PlayedNames() const {
    QSet<QString> names;
    for (const RememberedEntry& entry : history_)
        names.insert(entry.Name);
    return names;
}

// Whether an entry is still to be played in this round. Downwards and upwards the round is over when it comes
// back to the current song, however that was started.
bool TPlayList::IsOpen(int index, int current, const QSet<QString>& played) const {
    return !played.contains(NameAt(index)) && (index != current || playOrder_ == poRandom);
}

std::vector<int> TPlayList::RestOfRound(int current) {
    std::vector<int> sequence = SequenceAfter(playOrder_, Count(), current, random_);
    if (current < 0) return sequence;
    const QSet<QString> played = PlayedNames();
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
    const auto history = history_;
    Search search(*this, change);
    bool found = false;
    while (!found && HasPrevious()) {
        history_.pop_front();
        found = search.Try(entries_.Find(history_.front()), false);
    }
    if (!found || search.CurrentGoesOn())
        history_ = history;
    else
        ReturnTo(history.front());
    TellReasons(true);
    return found;
}

// Makes the song that was left the next one.
void TPlayList::ReturnTo(const RememberedEntry& entry) {
    const int index = entries_.Find(entry);
    if (index < 0) return;
    queue_.removeOne(entries_.IdAt(index));
    queue_.prepend(entries_.IdAt(index));
    events_.QueueChanged.Tell();
}

void TPlayList::RequirePlayer() const {
    if (player_ == nullptr)
        throw EPlayListException(u"Keine PlaySound-Komponente zum Abspielen vorhanden."_s);
}

// Tells the user, in one message, why entries failed in the search that is over.
void TPlayList::TellReasons(bool found) {
    const QStringList reasons = std::exchange(reasons_, {});
    QStringList parts = reasons.first(std::min(reasons.size(), kMostReasons));
    if (reasons.size() > kMostReasons) parts << u"und %1 weitere"_s.arg(reasons.size() - kMostReasons);
    // Without a round that ends there is no other word on it.
    if (!found && repeatAll_) parts.prepend(u"Keines der Lieder in der PlayList konnte abgespielt werden."_s);
    const QString text = parts.join(u"\r\n\r\n"_s);
    if (!text.isEmpty() && !player_->TellQuietly(text)) UserDialogs().ShowMessage(MessageKind::Error, text);
}
