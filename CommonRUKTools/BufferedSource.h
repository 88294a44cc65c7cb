#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "CommonRUKTools/FileSource.h"

// Lets parsers read in small pieces while the source beneath is asked for large ones. Two windows are kept,
// so that looks at the end of a file do not throw away its head.
class BufferedSource : public ByteSource {
 public:
    // `chunk`: bytes fetched at once, also the largest read that is served from a window. `source` must live
    // longer.
    explicit BufferedSource(ByteSource& source, std::size_t chunk = 8192) : source_(source), chunk_(chunk) {}

    std::int64_t Size() const override { return source_.Size(); }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override;

 private:
    struct Window {
        std::int64_t start = 0;
        std::vector<std::uint8_t> bytes;
        bool Holds(std::int64_t position, std::size_t count) const {
            return position >= start && position + static_cast<std::int64_t>(count) <=
                                            start + static_cast<std::int64_t>(bytes.size());
        }
    };
    const Window& Fetch(std::int64_t position, std::size_t count);

    ByteSource& source_;
    std::size_t chunk_;
    std::array<Window, 2> windows_;
    std::size_t newest_ = 0;
};
