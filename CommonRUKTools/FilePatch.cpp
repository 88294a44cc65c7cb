#include "CommonRUKTools/FilePatch.h"

#include <algorithm>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

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

bool FilePatch::IsFor(std::int64_t oldSize) const {
    return std::ranges::all_of(pieces_, [oldSize](const Piece& piece) {
        return !piece.IsKept() ||
               (piece.From >= 0 && piece.Length <= oldSize && piece.From <= oldSize - piece.Length);
    });
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

void RefuseUnlessFor(const FilePatch& patch, const ByteSource& old) {
    if (!patch.IsFor(old.Size())) throw EStreamError(u"Unerwartetes Ende der Datei"_s);
}

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
    RefuseUnlessFor(*this, old);
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

FilePatch FilePatch::Whole(ByteSource& old) const {
    RefuseUnlessFor(*this, old);
    FilePatch whole;
    for (const Piece& piece : pieces_)
        whole.Insert(piece.IsKept() ? old.ReadExactly(piece.From, static_cast<std::size_t>(piece.Length))
                                    : piece.Bytes);
    return whole;
}

// --- As bytes ---

namespace {

enum : std::uint8_t { kKept = 0, kInserted = 1 };

// No file is longer; sums of two lengths below it do not overflow.
constexpr std::uint64_t kLongest = std::uint64_t{1} << 60;

}  // namespace

void FilePatch::Write(ByteWriter& writer) const {
    writer.U32Le(static_cast<std::uint32_t>(pieces_.size()));
    for (const Piece& piece : pieces_) {
        writer.U8(piece.IsKept() ? kKept : kInserted);
        if (piece.IsKept()) writer.U64Le(static_cast<std::uint64_t>(piece.From));
        writer.U64Le(static_cast<std::uint64_t>(piece.Length));
        writer.Raw(piece.Bytes);
    }
}

std::optional<FilePatch> FilePatch::Read(ByteReader& reader) {
    FilePatch patch;
    const std::uint32_t count = reader.U32Le();
    for (std::uint32_t i = 0; i < count && !reader.Failed(); ++i) {
        const std::uint8_t kind = reader.U8();
        const std::uint64_t from = kind == kKept ? reader.U64Le() : 0;
        const std::uint64_t length = reader.U64Le();
        const auto before = static_cast<std::uint64_t>(patch.newSize_);
        if (kind > kInserted || from > kLongest || length > kLongest || before > kLongest)
            return std::nullopt;
        if (kind == kKept)
            patch.Keep(static_cast<std::int64_t>(from), static_cast<std::int64_t>(length));
        else
            patch.Insert(reader.Take(static_cast<std::size_t>(length)));
    }
    if (reader.Failed()) return std::nullopt;
    return patch;
}
