#include "app/models/RowJournal.h"

#include <algorithm>

void RowJournal::Start(int rowCount) {
    pieces_.clear();
    if (rowCount > 0) pieces_.push_back({0, rowCount});
    placesCurrent_ = false;
    oldCount_ = newCount_ = rowCount;
    changed_ = false;
}

RowJournal::Position RowJournal::Find(int row) const {
    std::size_t i = 0;
    while (i < pieces_.size() && row >= pieces_[i].Count)
        row -= pieces_[i++].Count;
    return {i, row};
}

std::size_t RowJournal::CutAt(int row) {
    const auto [i, offset] = Find(row);
    if (offset == 0) return i;
    const Piece whole = pieces_[i];
    pieces_[i].Count = offset;
    const Piece rest{whole.IsNew() ? -1 : whole.OldRow + offset, whole.Count - offset};
    pieces_.insert(pieces_.begin() + static_cast<std::ptrdiff_t>(i) + 1, rest);
    return i + 1;
}

void RowJournal::Insert(int row) {
    NoteChange(1);
    // The songs of one folder mostly come side by side: they share a piece.
    const auto [i, offset] = Find(row);
    if (i < pieces_.size() && pieces_[i].IsNew()) {
        ++pieces_[i].Count;
    } else if (offset == 0 && i > 0 && pieces_[i - 1].IsNew()) {
        ++pieces_[i - 1].Count;
    } else {
        const std::size_t at = CutAt(row);
        pieces_.insert(pieces_.begin() + static_cast<std::ptrdiff_t>(at), {-1, 1});
    }
}

void RowJournal::Remove(int row) {
    NoteChange(-1);
    const std::size_t found = Find(row).Piece;
    const std::size_t at = pieces_[found].IsNew() ? found : CutAt(row);
    Piece& piece = pieces_[at];
    if (!piece.IsNew()) ++piece.OldRow;
    if (--piece.Count == 0) pieces_.erase(pieces_.begin() + static_cast<std::ptrdiff_t>(at));
}

void RowJournal::NoteChange(int rows) {
    newCount_ += rows;
    changed_ = true;
    placesCurrent_ = false;
}

void RowJournal::Move(int from, int to) {
    const auto [i, offset] = Find(from);
    const int oldRow = pieces_[i].IsNew() ? -1 : pieces_[i].OldRow + offset;
    Remove(from);
    if (oldRow < 0) return Insert(to);
    NoteChange(1);
    const std::size_t at = CutAt(to);
    pieces_.insert(pieces_.begin() + static_cast<std::ptrdiff_t>(at), {oldRow, 1});
}

const std::vector<RowJournal::Place>& RowJournal::Places() const {
    if (placesCurrent_) return places_;
    places_.clear();
    int newRow = 0;
    for (const Piece& piece : pieces_) {
        if (!piece.IsNew()) places_.push_back({piece.OldRow, piece.Count, newRow});
        newRow += piece.Count;
    }
    std::ranges::sort(places_, {}, &Place::OldRow);
    placesCurrent_ = true;
    return places_;
}

int RowJournal::NewRowOf(int oldRow) const {
    const auto& places = Places();
    const auto next = std::ranges::upper_bound(places, oldRow, {}, &Place::OldRow);
    if (next == places.begin()) return -1;
    const Place& place = *(next - 1);
    const int offset = oldRow - place.OldRow;
    return offset < place.Count ? place.NewRow + offset : -1;
}

bool RowJournal::OldRowsStay() const {
    const auto& places = Places();
    const auto moved = [](const Place& place) { return place.NewRow != place.OldRow; };
    int kept = 0;
    for (const Place& place : places)
        kept += place.Count;
    return kept == oldCount_ && std::ranges::none_of(places, moved);
}
