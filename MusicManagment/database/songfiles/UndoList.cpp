#include "MusicManagment/database/songfiles/UndoList.h"

#include "MusicManagment/database/MusicManagment.h"

UndoList::UndoList(TMusicDatabase& database) : database_(database) {
    database_.OnClear = [this](TMusicDatabase&) { Clear(); };
}

UndoList::~UndoList() {
    database_.OnClear = nullptr;
}

void UndoList::Add(UndoStep step) {
    steps_.push_back(std::move(step));
    Changed.Tell();
}

QStringList UndoList::TakeBack() {
    if (steps_.empty()) return {};
    const QStringList songs = steps_.back().TakeBack();
    steps_.pop_back();
    Changed.Tell();
    return songs;
}

void UndoList::Clear() {
    if (steps_.empty()) return;
    steps_.clear();
    Changed.Tell();
}
