#include "CommonRUKTools/FilePatch.h"

#include <algorithm>

void FilePatch::Keep(std::int64_t from, std::int64_t length) {
    if (length <= 0) return;
    newSize_ += length;
    if (!pieces_.empty() && pieces_.back().IsKept() && pieces_.back().From + pieces_.back().Length == from) {
        pieces_.back().Length += length;
    } else {
        pieces_.push_back({.From = from, .Length = length});
    }
}

void FilePatch::Insert(ByteSpan bytes) {
    if (bytes.empty()) return;
    const auto length = static_cast<std::int64_t>(bytes.size());
    newSize_ += length;
    insertedBytes_ += length;
    if (pieces_.empty() || pieces_.back().IsKept()) pieces_.emplace_back();
    Piece& piece = pieces_.back();
    piece.Bytes.insert(piece.Bytes.end(), bytes.begin(), bytes.end());
    piece.Length += length;
}

bool FilePatch::ChangesNothing(std::int64_t oldSize) const {
    if (newSize_ != oldSize) return false;
    return pieces_.empty() || (pieces_.size() == 1 && pieces_[0].IsKept() && pieces_[0].From == 0);
}

bool FilePatch::FitsInPlace() const {
    std::int64_t at = 0;
    for (const Piece& piece : pieces_) {
        if (piece.IsKept() && piece.From != at) return false;
        at += piece.Length;
    }
    return true;
}

namespace {

// A range of the old file and where it lies in the new one.
struct Kept {
    std::int64_t From;
    std::int64_t Length;
    std::int64_t At;
};

std::vector<Kept> KeptInOldOrder(const FilePatch& patch) {
    std::vector<Kept> kept;
    std::int64_t at = 0;
    for (const FilePatch::Piece& piece : patch.Pieces()) {
        if (piece.IsKept()) kept.push_back({piece.From, piece.Length, at});
        at += piece.Length;
    }
    std::ranges::stable_sort(kept, {}, &Kept::From);
    return kept;
}

}  // namespace

FilePatch FilePatch::Inverse(ByteSource& old) const {
    FilePatch back;
    std::int64_t done = 0;
    const auto takeOld = [&](std::int64_t end) {
        if (end > done) back.Insert(old.ReadExactly(done, static_cast<std::size_t>(end - done)));
    };
    for (const Kept& range : KeptInOldOrder(*this)) {
        takeOld(range.From);
        // A range that is kept twice is taken once.
        const std::int64_t skipped = std::max<std::int64_t>(0, done - range.From);
        if (skipped >= range.Length) continue;
        back.Keep(range.At + skipped, range.Length - skipped);
        done = range.From + range.Length;
    }
    takeOld(old.Size());
    return back;
}
