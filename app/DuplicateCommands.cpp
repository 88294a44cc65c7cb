#include "app/DuplicateCommands.h"

#include <QMenu>
#include <QSet>
#include <algorithm>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/duplicates/KeptPairs.h"
#include "MusicManagment/database/duplicates/SongQuality.h"
#include "app/Playing.h"
#include "app/ShellCommands.h"
#include "app/dialogs/SuggestionDialog.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

namespace {

QString EntryCount(std::size_t count) {
    return count == 1 ? u"1 doppelter Eintrag"_s : u"%1 doppelte Einträge"_s.arg(count);
}

// Each once: one song may be in many pairs.
std::vector<SongHandle> SongsIn(const std::vector<DuplicatePair>& pairs) {
    std::vector<SongHandle> songs;
    QSet<quint32> seen;
    for (const DuplicatePair& pair : pairs)
        for (const SongHandle song : {pair.First, pair.Second})
            if (const auto before = seen.size(); seen.insert(song.Slot), seen.size() > before)
                songs.push_back(song);
    return songs;
}

}  // namespace

DuplicateCommands::DuplicateCommands(TMusicDatabase& database, SongListWidget& list, Playing& playing)
    : database_(database),
      list_(list),
      playing_(playing),
      form_(new DuplicatesForm(database, list.window())) {
    SetUpForm();
    HandleCommands();
    database_.JoinSettings(*form_);
}

// The main window would let it live longer than what it shows.
DuplicateCommands::~DuplicateCommands() {
    database_.LeaveSettings(*form_);
    delete form_;
}

void DuplicateCommands::HandleCommands() {
    const auto handle = [this](int id, std::function<void()> run) {
        handlers_ += database_.Commands().Handle(id, {.Run = std::move(run)});
    };
    handle(mcFindDuplicates, [this] { Search({}); });
    handle(mcFindDuplicatesOfArtists, [this] { Search({.SameArtistOnly = true}); });
    handle(mcFindDuplicatesOfMarked, [this] {
        const std::vector<SongHandle> marked = list_.ChosenHandles();
        if (!marked.empty()) Search({.References = marked});
    });
}

void DuplicateCommands::SetUpForm() {
    form_->OnDecision = [this](PairDecision decision, const std::vector<DuplicatePair>& pairs) {
        Decide(decision, pairs);
    };
    form_->OnSuggest = [this](const std::vector<DuplicatePair>& pairs) { Suggest(pairs); };
    form_->OnListen = [this](SongHandle song, SongHandle instead) { Listen(song, instead); };
    form_->OnSearchAgain = [this] { SearchAgain(); };
    form_->OnUndo = [this] {
        if (database_.ClickMenuItem(scUndo)) form_->Tell(u"Rückgängig gemacht."_s);
    };
    form_->OnRedo = [this] {
        if (database_.ClickMenuItem(scRedo)) form_->Tell(u"Wiederhergestellt."_s);
    };
}

void DuplicateCommands::AddTo(QMenu& menu) {
    menu.addAction(form_->windowTitle(), form_, Guarded([this] {
                       form_->show();
                       form_->raise();
                       form_->activateWindow();
                   }));
}

// --- Searching ---

void DuplicateCommands::Search(DuplicateQuery query) {
    query_ = std::move(query);
    SearchDuplicates(database_, query_, list_.ChosenHandles(), *form_);
}

void DuplicateCommands::SearchAgain() {
    if (database_.ProgressRunning()) return;
    DuplicateQuery query = query_;
    query.LeastPercent = form_->LeastPercent();
    SearchDuplicates(database_, std::move(query), list_.ChosenHandles(), *form_);
}

// --- Decisions ---

void DuplicateCommands::Decide(PairDecision decision, const std::vector<DuplicatePair>& pairs) {
    if (decision == PairDecision::KeepBoth) return KeepBoth(pairs);
    if (decision == PairDecision::Ban) return Ban(pairs);
    std::vector<SongReplacement> replacements;
    replacements.reserve(pairs.size());
    for (const DuplicatePair& pair : pairs)
        replacements.push_back(decision == PairDecision::KeepFirst
                                   ? SongReplacement{.Kept = pair.First, .Dropped = pair.Second}
                                   : SongReplacement{.Kept = pair.Second, .Dropped = pair.First});
    const QString question =
        u"Sollen die anderen Songs von %1 Paaren in den Papierkorb gelegt werden?"_s.arg(pairs.size());
    // One key is meant for one pair.
    if (pairs.size() > 1 && !UserDialogs().Confirm(question, u"In den Papierkorb"_s)) return;
    Replace(replacements);
}

void DuplicateCommands::Replace(const std::vector<SongReplacement>& replacements) {
    Tell(ReplaceSongs(database_, EntryCount(replacements.size()), replacements));
}

void DuplicateCommands::Tell(const BatchResult& result) {
    form_->Tell(SongCountText(static_cast<std::size_t>(result.Changed)) +
                u" in den Papierkorb gelegt. Strg+Z macht das rückgängig."_s);
    if (!result.Failed.isEmpty() || result.Stopped) ReportBatch(result);
}

// A pair that is kept already is forgotten.
void DuplicateCommands::KeepBoth(const std::vector<DuplicatePair>& pairs) {
    const auto kept = KeptPairs(database_);
    bool isForgotten = false;
    for (const DuplicatePair& pair : pairs) {
        const TID3Tag* first = database_.Songs().Find(pair.First);
        const TID3Tag* second = database_.Songs().Find(pair.Second);
        if (first == nullptr || second == nullptr) continue;
        const bool isKept =
            std::ranges::find(kept, std::pair(first->FileName, second->FileName)) != kept.end() ||
            std::ranges::find(kept, std::pair(second->FileName, first->FileName)) != kept.end();
        isForgotten |= isKept;
        SetKeptPair(database_, *first, *second, !isKept);
    }
    form_->Pairs().NotePairs();
    form_->Tell(isForgotten ? u"Das Paar wird wieder gezeigt."_s
                            : u"Beide bleiben und werden nicht mehr gezeigt, außer mit „Auch behaltene“."_s);
}

void DuplicateCommands::Ban(const std::vector<DuplicatePair>& pairs) {
    const std::vector<SongHandle> songs = SongsIn(pairs);
    const QString question =
        u"Sollen %1 in die Bann-Liste aufgenommen, aus der Datenbank entfernt und in den Papierkorb gelegt "
        "werden? Verbannte Songs werden nicht wieder aufgenommen."_s.arg(SongCountText(songs.size()));
    if (!UserDialogs().Confirm(question, u"Verbannen"_s)) return;
    Tell(DiscardSongs(database_, SongCountText(songs.size()) + u" verbannen"_s, songs, Banning::Banned));
}

void DuplicateCommands::Suggest(const std::vector<DuplicatePair>& pairs) {
    std::vector<KeepSuggestion> suggestions = SuggestKept(database_, pairs);
    if (suggestions.empty())
        return form_->Tell(
            u"Es gibt keinen Vorschlag: Die Längen aller gezeigten Paare unterscheiden sich."_s);
    SuggestionDialog dialog(database_, std::move(suggestions), form_);
    dialog.exec();
    const std::vector<SongReplacement> agreed = dialog.Agreed();
    if (!agreed.empty()) Replace(agreed);
}

void DuplicateCommands::Listen(SongHandle song, SongHandle instead) {
    const TID3Tag* played = database_.Songs().Find(song);
    const TID3Tag* other = database_.Songs().Find(instead);
    if (played == nullptr || other == nullptr) return;
    const QString otherPath = database_.ResolveSongPath(other->FileName, {.Ask = false});
    const QString path = database_.ResolveSongPath(played->FileName);
    if (!path.isEmpty()) playing_.OpenSongInstead(path, otherPath);
}
