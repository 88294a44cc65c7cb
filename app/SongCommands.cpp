#include "app/SongCommands.h"

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Shell.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Menu.h"
#include "MusicManagment/database/songfiles/CopySongs.h"
#include "app/models/CollectionTotals.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

SongCommands::SongCommands(TMusicDatabase& database, SongListWidget& list)
    : database_(database), list_(list) {}

bool SongCommands::Run(int id) {
    if ((id >= mcSortFirst && id <= mcSortLast) || (id >= mcSubSortFirst && id <= mcSubSortLast) ||
        id == mcReverse)
        return SetOrder(id), true;
    switch (id) {
        case mcFind:
            if (OnFind) OnFind();
            return true;
        case mcFindNext:
            if (OnFindNext) OnFindNext();
            return true;
        case mcMarkAll:
            list_.MarkAll();
            return true;
        case mcInvertMarks:
            list_.InvertMarks();
            return true;
        case mcMarkByFilter:
            list_.MarkByFilter();
            return true;
        case mcRemoveFromDatabase:
            RemoveChosen();
            return true;
        case mcCopyTo:
            CopyChosen();
            return true;
        case mcOpenExternally:
            OpenExternally();
            return true;
        default:
            return false;
    }
}

void SongCommands::UndoRemoval() {
    if (removals_.empty()) return;
    const int restored = RestoreSongs(database_, removals_.back());
    removals_.pop_back();
    Tell(SongCountText(static_cast<std::size_t>(restored)) + u" wieder in die Datenbank aufgenommen."_s);
    if (OnUndoChanged) OnUndoChanged(!removals_.empty());
    database_.SaveAfterCommand();
}

// Through the list, which keeps the focused song in sight.
void SongCommands::SetOrder(int id) {
    SongOrder order = database_.Order();
    if (id == mcReverse)
        order.Backwards = !order.Backwards;
    else if (id >= mcSubSortFirst)
        order.SubSortType = static_cast<TSubSortType>(id - mcSubSortFirst);
    else
        order.SortType = static_cast<TSortType>(id - mcSortFirst);
    list_.SetOrder(order);
}

void SongCommands::RemoveChosen() {
    const auto songs = list_.ChosenSongs();
    if (songs.empty()) return;
    const QString question = songs.size() == 1
                                 ? u"Soll \""_s + database_.Song(songs[0]).Artist + u" - "_s +
                                       database_.Song(songs[0]).Title +
                                       u"\" aus der Datenbank entfernt werden? Die Datei bleibt erhalten."_s
                                 : u"Sollen "_s + SongCountText(songs.size()) +
                                       u" aus der Datenbank entfernt werden? Die Dateien bleiben erhalten."_s;
    if (UserDialogs().Ask({.Text = question, .Buttons = {u"Entfernen"_s, u"Abbrechen"_s}, .Cancel = 1}) != 0)
        return;
    RemovedSongs removed = RemoveSongs(database_, songs);
    if (removed.empty()) return;
    Tell(SongCountText(removed.size()) + u" aus der Datenbank entfernt."_s);
    removals_.push_back(std::move(removed));
    if (OnUndoChanged) OnUndoChanged(true);
    database_.SaveAfterCommand();
}

void SongCommands::CopyChosen() {
    const auto songs = list_.ChosenSongs();
    if (songs.empty()) return;
    const auto folder =
        UserDialogs().ChooseFolder(u"Ordner auswählen, in den die Songs kopiert werden sollen:"_s);
    if (!folder) return;
    const CopyResult result = CopySongs(database_, songs, *folder);
    Tell(SongCountText(static_cast<std::size_t>(result.Copied)) + u" kopiert."_s);
    if (!result.Failed.isEmpty())
        UserDialogs().ShowMessage(MessageKind::Warning, u"Diese Dateien konnten nicht kopiert werden:\n"_s +
                                                            result.Failed.join(u'\n'));
}

void SongCommands::OpenExternally() {
    const SongIndex song = list_.FocusedSong();
    if (song < 0) return;
    const QString path = database_.Song(song).FileName;
    if (!CurrentShell().OpenWithDefaultProgram(path))
        throw EMusicDatabaseException(u"Kann kein Programm für diese Datei starten: "_s + path);
}

void SongCommands::Tell(const QString& sentence) const {
    if (OnDone) OnDone(sentence);
}
