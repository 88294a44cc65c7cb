#include "app/SongCommands.h"

#include <QDir>
#include <QFileInfo>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/songfiles/CopySongs.h"
#include "MusicManagment/database/songfiles/Removal.h"
#include "MusicManagment/database/sorting/OrderCommands.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "app/ShellCommands.h"
#include "app/models/CollectionTotals.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

namespace {

// Of those that are still there.
QStringList PathsOf(const TMusicDatabase& database, const std::vector<SongHandle>& songs) {
    QStringList paths;
    for (const SongHandle song : songs)
        if (const TID3Tag* record = database.Songs().Find(song)) paths << record->FileName;
    return paths;
}

QString StepCaption(const QString& name, const UndoStep& step) {
    if (step.Caption.isEmpty()) return name;
    const QString caption = name + u": "_s + step.Caption;
    return step.Elsewhere.isEmpty() ? caption
                                    : caption + u" (in "_s + QFileInfo(step.Elsewhere).fileName() + u')';
}

}  // namespace

SongCommands::SongCommands(TMusicDatabase& database, SongListWidget& list, Journal& journal)
    : database_(database), list_(list), journal_(journal), undo_(database, journal) {
    HandleCommands();
    AddUndo();
}

void SongCommands::HandleCommands() {
    const auto handle = [this](int id, std::function<void()> run) {
        handlers_ += database_.Commands().Handle(id, {.Run = std::move(run)});
    };
    // Through the list, which keeps the focused song in sight.
    const auto handleOrder = [&](int id) {
        handle(id, [this, id] { list_.SetOrder(OrderAfter(database_.Order(), id)); });
    };
    for (int id = mcSortFirst; id <= mcSortLast; ++id)
        handleOrder(id);
    for (int id = mcSubSortFirst; id <= mcSubSortLast; ++id)
        handleOrder(id);
    handleOrder(mcReverse);
    handle(mcMarkAll, [this] { list_.MarkAll(); });
    handle(mcInvertMarks, [this] { list_.InvertMarks(); });
    handle(mcMarkByFilter, [this] { list_.MarkByFilter(); });
    handle(mcRemoveFromDatabase, [this] { RemoveChosen(); });
    handle(mcCopyTo, [this] { CopyChosen(); });
}

// --- Undo ---

// The later added one comes to stand first.
void SongCommands::AddUndo() {
    AddStep(
        {.Id = scRedo, .Letter = u'w', .Keys = u"Ctrl+Shift+Z"_s, .Icon = u"edit-redo"_s},
        u"Wiederherstellen"_s, [this] { return undo_.ToRedo(); },
        [this] { Show(undo_.DoAgain(), u"Wiederhergestellt: "_s); });
    AddStep(
        {.Id = scUndo, .Letter = u'r', .Keys = u"Ctrl+Z"_s, .Icon = u"edit-undo"_s, .BehindLine = false},
        u"Rückgängig"_s, [this] { return undo_.ToUndo(); },
        [this] { Show(undo_.TakeBack(), u"Rückgängig gemacht: "_s); });
    undoChanges_ = undo_.Changed.Subscribe([this] { database_.Commands().Changed.Tell(); });
}

void SongCommands::AddStep(ShellCommand command, const QString& name, const std::function<UndoStep()>& last,
                           const std::function<void()>& run) {
    const auto caption = [name, last] { return StepCaption(name, last()); };
    const auto isEnabled = [this, last] {
        const UndoStep step = last();
        return !step.Caption.isEmpty() && (!step.Elsewhere.isEmpty() || !database_.ReadOnly());
    };
    const auto openAndRun = [this, last, run] {
        OfferToOpen(last());
        if (last().Elsewhere.isEmpty()) run();
    };
    command.Caption = caption();
    command.Menu = u"Bearbeiten";
    command.Where = ShellCommand::Place::First;
    handlers_ +=
        database_.Commands().Add(command, {.Run = openAndRun, .IsEnabled = isEnabled, .Caption = caption});
}

void SongCommands::OfferToOpen(const UndoStep& step) const {
    if (step.Elsewhere.isEmpty() || !OnOpenDatabase) return;
    const QString question = u'"' + step.Caption + u"\" gehört zu einer anderen Datenbank:\n"_s +
                             QDir::toNativeSeparators(step.Elsewhere) +
                             u"\n\nSoll sie dafür geöffnet werden?"_s;
    if (UserDialogs().Confirm(question, u"Öffnen"_s)) OnOpenDatabase(step.Elsewhere);
}

void SongCommands::Show(const UndoResult& result, const QString& done) {
    const std::size_t shown = list_.MarkSongs(result.Songs);
    const bool showsAll = shown == static_cast<std::size_t>(result.Songs.size());
    Tell(done + result.Caption + u'.' +
         (showsAll ? QString() : u" Der Filter zeigt nicht alle Songs davon."_s));
    database_.SaveAfterCommand();
    if (!result.Problems.isEmpty())
        UserDialogs().ShowMessage(MessageKind::Warning, u"Nicht alles konnte zurückgenommen werden:\n"_s +
                                                            result.Problems.join(u'\n'));
}

// --- The songs of the list ---

QString SongCommands::RemovalQuestion(const std::vector<SongHandle>& songs) const {
    if (songs.size() > 1)
        return u"Sollen "_s + SongCountText(songs.size()) +
               u" aus der Datenbank entfernt werden? Die Dateien bleiben erhalten."_s;
    const TID3Tag& song = *database_.Songs().Find(songs.front());
    return u"Soll \""_s + ArtistAndTitle(song) +
           u"\" aus der Datenbank entfernt werden? Die Datei bleibt erhalten."_s;
}

void SongCommands::RemoveChosen() {
    const std::vector<SongHandle> songs = list_.ChosenHandles();
    if (songs.empty()) return;
    if (!UserDialogs().Confirm(RemovalQuestion(songs), u"Entfernen"_s)) return;
    const SongHandle next = list_.NextAfter(songs);
    const int removed =
        RemoveSongs(journal_, database_, songs, SongCountText(songs.size()) + u" entfernen"_s);
    if (removed == 0) return;
    list_.FocusSong(database_.Songs().PositionOf(next), QAbstractItemView::EnsureVisible);
    Tell(SongCountText(static_cast<std::size_t>(removed)) +
         u" aus der Datenbank entfernt. Strg+Z macht das rückgängig."_s);
    database_.SaveAfterCommand();
}

void SongCommands::CopyChosen() {
    const std::vector<SongHandle> songs = list_.ChosenHandles();
    if (songs.empty()) return;
    const auto folder =
        UserDialogs().ChooseFolder(u"Ordner auswählen, in den die Songs kopiert werden sollen:"_s);
    if (!folder) return;
    const CopyResult result = CopySongs(database_, PathsOf(database_, songs), *folder);
    Tell(SongCountText(static_cast<std::size_t>(result.Copied)) + u" kopiert."_s);
    if (!result.Failed.isEmpty())
        UserDialogs().ShowMessage(MessageKind::Warning, u"Diese Dateien konnten nicht kopiert werden:\n"_s +
                                                            result.Failed.join(u'\n'));
}

void SongCommands::Tell(const QString& sentence) const {
    if (OnDone) OnDone(sentence);
}
