#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "MusicManagment/playlist/PlayListTypes.h"

// The most that the entries of a file may be: enough for every collection, and little enough for memory when
// the file is hostile.
inline constexpr std::size_t kMostListEntries = 2'000'000;
inline constexpr std::uint64_t kMostListMemory = std::uint64_t{3} << 29;  // bytes

// Gathers the entries that a file has.
class ListBuilder {
 public:
    // Throws EPlayListException when they become too many, or take too much memory.
    void Add(PlayListEntry entry);
    std::size_t Count() const { return entries_.size(); }
    std::vector<PlayListEntry> Take() { return std::move(entries_); }

 private:
    std::vector<PlayListEntry> entries_;
    std::uint64_t memory_ = 0;  // bytes, estimated
};

[[noreturn]] void ThrowListTooLarge();
