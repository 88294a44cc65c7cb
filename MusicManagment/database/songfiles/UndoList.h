#pragma once

#include <QString>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/journal/Journal.h"

class TMusicDatabase;

// A step that can be taken back, or done again.
struct UndoStep {
    QString Caption{};  // as a menu names it; empty when there is no step
    // Path of the database that has to be opened before; empty when it is, or none is needed.
    QString Elsewhere{};
};

// What the journal has to take back: the last batch, for the collection that is open or another one.
class UndoList {
 public:
    UndoList(TMusicDatabase& database, Journal& journal);

    UndoStep ToUndo() const { return StepOf(journal_.ToUndo()); }
    UndoStep ToRedo() const { return StepOf(journal_.ToRedo()); }
    // Throw what the journal throws.
    UndoResult TakeBack() { return journal_.Undo(&database_); }
    UndoResult DoAgain() { return journal_.Redo(&database_); }

    Listeners<> Changed;

 private:
    UndoStep StepOf(const std::optional<BatchInfo>& batch) const;

    TMusicDatabase& database_;
    Journal& journal_;
    Subscriptions subscriptions_;
};
