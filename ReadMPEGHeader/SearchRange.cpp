#include "ReadMPEGHeader/SearchRange.h"

#include <algorithm>

namespace {

constexpr std::size_t kGrowth = 8;
constexpr std::size_t kLargestPiece = 128 * 1024;

}  // namespace

ByteSpan SearchRange::From(std::int64_t position, std::size_t count) {
    const std::int64_t left = std::max<std::int64_t>(0, source_.Size() - position);
    const auto wanted = std::min<std::int64_t>(left, static_cast<std::int64_t>(count));
    const auto end = start_ + static_cast<std::int64_t>(piece_.size());
    if (position >= start_ && position + wanted <= end)
        return ByteSpan(piece_).subspan(static_cast<std::size_t>(position - start_));
    const auto size = std::min<std::int64_t>(left, static_cast<std::int64_t>(std::max(count, next_)));
    piece_.resize(static_cast<std::size_t>(size));
    start_ = position;
    piece_.resize(source_.ReadAt(position, piece_));
    next_ = std::min(next_ * kGrowth, kLargestPiece);
    return piece_;
}
