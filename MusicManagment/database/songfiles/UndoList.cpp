#include "MusicManagment/database/songfiles/UndoList.h"

#include "MusicManagment/database/MusicManagment.h"

UndoList::UndoList(TMusicDatabase& database, Journal& journal) : database_(database), journal_(journal) {
    const auto tell = [this] { Changed.Tell(); };
    subscriptions_ += journal.Changed.Subscribe(tell);
    subscriptions_ += database.Events().Cleared.Subscribe(tell);
    subscriptions_ += database.Events().Replaced.Subscribe(tell);
}

QString UndoList::CaptionOf(const std::optional<BatchInfo>& batch) const {
    return batch && batch->IsFor(database_) ? batch->Caption : QString();
}
