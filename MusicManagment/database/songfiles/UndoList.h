#pragma once

#include <QString>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/journal/Journal.h"

class TMusicDatabase;

// What the journal has to take back for the collection that is open: the last batch, where it is about songs
// of this one or about files alone.
class UndoList {
 public:
    UndoList(TMusicDatabase& database, Journal& journal);

    // What would be taken back, and done again, as a menu names it; empty when there is nothing.
    QString Caption() const { return CaptionOf(journal_.ToUndo()); }
    QString RedoCaption() const { return CaptionOf(journal_.ToRedo()); }
    // Throws what the journal throws.
    UndoResult TakeBack() { return journal_.Undo(&database_); }
    UndoResult DoAgain() { return journal_.Redo(&database_); }

    Listeners<> Changed;

 private:
    QString CaptionOf(const std::optional<BatchInfo>& batch) const;

    TMusicDatabase& database_;
    Journal& journal_;
    Subscriptions subscriptions_;
};
