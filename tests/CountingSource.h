#pragma once

#include "CommonRUKTools/FileSource.h"

// Counts what is read of the bytes behind it.
class CountingSource : public MemorySource {
 public:
    using MemorySource::MemorySource;
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override {
        ++Reads;
        Bytes += target.size();
        return MemorySource::ReadAt(position, target);
    }
    int Reads = 0;
    std::size_t Bytes = 0;
};
