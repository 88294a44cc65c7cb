#pragma once

#include <array>
#include <cstdint>
#include <memory>

#include "CommonRUKTools/FileSource.h"

// Lets parsers read in small pieces while the source beneath is asked for large ones. Two windows follow the
// reader, and a small one holds the end of the source, where trailers and tags lie: looks there throw nothing
// away.
class BufferedSource : public ByteSource {
 public:
    // `chunk`: bytes fetched at once, also the largest read that is served from a window. `source` must live
    // longer.
    explicit BufferedSource(ByteSource& source, std::size_t chunk = 8192)
        : source_(source), size_(source.Size()), chunk_(chunk) {}

    std::int64_t Size() const override { return size_; }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override;

 private:
    struct Window {
        std::int64_t start = 0;
        std::size_t size = 0;
        std::unique_ptr<std::uint8_t[]> bytes;
        bool Holds(std::int64_t position, std::size_t count) const {
            return position >= start &&
                   position + static_cast<std::int64_t>(count) <= start + static_cast<std::int64_t>(size);
        }
    };
    const Window& Fetch(std::int64_t position, std::size_t count);
    void Fill(Window& window, std::int64_t start, std::size_t count);

    ByteSource& source_;
    std::int64_t size_;
    std::size_t chunk_;
    std::array<Window, 2> windows_;
    Window tail_;
    std::size_t newest_ = 0;
};
