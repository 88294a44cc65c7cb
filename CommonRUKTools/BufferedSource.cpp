#include "CommonRUKTools/BufferedSource.h"

#include <algorithm>
#include <cstring>

namespace {

// Holds an ID3v1 tag and a trailer behind it.
constexpr std::size_t kTailSize = 256;

}  // namespace

std::size_t BufferedSource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    if (position < 0 || position >= size_ || target.empty()) return 0;
    const auto count = static_cast<std::size_t>(
        std::min<std::int64_t>(size_ - position, static_cast<std::int64_t>(target.size())));
    if (count > chunk_) return source_.ReadAt(position, target.first(count));
    const Window& window = Fetch(position, count);
    const auto offset = static_cast<std::size_t>(position - window.start);
    if (offset >= window.size) return 0;
    const auto held = std::min(count, window.size - offset);
    std::memcpy(target.data(), window.bytes.get() + offset, held);
    return held;
}

const BufferedSource::Window& BufferedSource::Fetch(std::int64_t position, std::size_t count) {
    for (std::size_t i = 0; i < windows_.size(); ++i) {
        if (!windows_[i].Holds(position, count)) continue;
        newest_ = i;
        return windows_[i];
    }
    if (tail_.Holds(position, count)) return tail_;
    const auto left =
        static_cast<std::size_t>(std::min<std::int64_t>(size_ - position, static_cast<std::int64_t>(chunk_)));
    if (left <= kTailSize && kTailSize <= chunk_) {
        const auto size = std::min<std::int64_t>(size_, kTailSize);
        Fill(tail_, size_ - size, static_cast<std::size_t>(size));
        return tail_;
    }
    newest_ = 1 - newest_;
    Fill(windows_[newest_], position, left);
    return windows_[newest_];
}

void BufferedSource::Fill(Window& window, std::int64_t start, std::size_t count) {
    const auto capacity = &window == &tail_ ? kTailSize : chunk_;
    if (!window.bytes) window.bytes = std::make_unique_for_overwrite<std::uint8_t[]>(capacity);
    window.size = 0;  // stays so when the medium fails
    window.size = source_.ReadAt(start, {window.bytes.get(), count});
    window.start = start;
}
