#include "CommonRUKTools/BufferedSource.h"

#include <algorithm>
#include <cstring>

std::size_t BufferedSource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    if (position < 0 || position >= Size()) return 0;
    const auto count = static_cast<std::size_t>(
        std::min<std::int64_t>(Size() - position, static_cast<std::int64_t>(target.size())));
    if (count > chunk_) return source_.ReadAt(position, target.first(count));
    const Window& window = Fetch(position, count);
    if (position >= window.start + static_cast<std::int64_t>(window.bytes.size())) return 0;
    const auto offset = static_cast<std::size_t>(position - window.start);
    const auto held = std::min(count, window.bytes.size() - offset);
    if (held > 0) std::memcpy(target.data(), window.bytes.data() + offset, held);
    return held;
}

const BufferedSource::Window& BufferedSource::Fetch(std::int64_t position, std::size_t count) {
    for (std::size_t i = 0; i < windows_.size(); ++i) {
        if (!windows_[i].Holds(position, count)) continue;
        newest_ = i;
        return windows_[i];
    }
    newest_ = 1 - newest_;
    Window& window = windows_[newest_];
    window.start = position;
    const auto size = std::min<std::int64_t>(Size() - position, static_cast<std::int64_t>(chunk_));
    window.bytes.resize(static_cast<std::size_t>(size));
    window.bytes.resize(source_.ReadAt(position, window.bytes));
    return window;
}
