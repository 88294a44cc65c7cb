#pragma once

#include <cstdint>
#include <vector>

#include "CommonRUKTools/FileSource.h"

// Bytes of a source that are looked through from front to back, read in pieces that grow: most searches end
// within the first block, and one that does not shall not cost a system call a block.
class SearchRange {
 public:
    explicit SearchRange(ByteSource& source) : source_(source) {}

    // Everything that is loaded from `position` on, at least `count` bytes unless the source ends before.
    // Valid until the next call. Throws EMediumError.
    ByteSpan From(std::int64_t position, std::size_t count);

 private:
    ByteSource& source_;
    std::int64_t start_ = 0;
    std::vector<std::uint8_t> piece_;
    std::size_t next_ = 512;
};
