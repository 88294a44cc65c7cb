#include "MusicManagment/database/songfiles/UndoList.h"

#include "MusicManagment/database/MusicManagment.h"

UndoList::UndoList(TMusicDatabase& database) {
    ends_ = database.Events().Cleared.Subscribe([this] { Clear(); });
}

void UndoList::Add(UndoStep step) {
    steps_.push_back(std::move(step));
    Changed.Tell();
}

QStringList UndoList::TakeBack() {
    if (steps_.empty()) return {};
    QStringList songs = steps_.back().TakeBack();
    steps_.pop_back();
    Changed.Tell();
    return songs;
}

void UndoList::Clear() {
    if (steps_.empty()) return;
    steps_.clear();
    Changed.Tell();
}
