#include "MusicManagment/database/songfiles/UndoList.h"

#include "MusicManagment/database/MusicManagment.h"

UndoList::UndoList(TMusicDatabase& database, Journal& journal) : database_(database), journal_(journal) {
    const auto tell = [this] { Changed.Tell(); };
    subscriptions_ += journal.Changed.Subscribe(tell);
    subscriptions_ += database.Events().Cleared.Subscribe(tell);
    subscriptions_ += database.Events().Replaced.Subscribe(tell);
}

UndoStep UndoList::StepOf(const std::optional<BatchInfo>& batch) const {
    if (!batch) return {};
    if (batch->IsFor(database_)) return {.Caption = batch->Caption};
    // The songs of a collection that was never saved are gone with it.
    if (batch->Database.isEmpty()) return {};
    return {.Caption = batch->Caption, .Elsewhere = batch->Database};
}
