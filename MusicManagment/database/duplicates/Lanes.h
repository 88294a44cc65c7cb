#pragma once

#include <array>
#include <cstdint>
#include <vector>

// One text compared with 64 others of one length at once, each in a lane of the processor's vectors. Letters
// go by classes: different letters may share one, so that what is told is never more than the distance.
// The kernels are built for processors that the program may not run on, so their object files must hold no
// function that other files have too: the linker might take theirs for all. Of the standard library they call
// data() of an array only, which is gone when they are optimized, as they are in every build.

constexpr int kLanes = 64;
constexpr int kLetterClasses = 32;

// The letters of two neighbouring columns of 64 texts: the first in the low byte. Lanes without a text hold
// anything.
struct alignas(64) LaneColumns {
    std::array<std::uint16_t, kLanes> Letters;
};

// Where the reference has each class of letters, as the band of the distance matrix sees it that lies between
// two diagonals: the row r is about its places from r - bits + 1 on (the first place of the text is 1), and
// the lowest bit is the first of them.
template <typename Word>
struct alignas(64) LaneRow {
    std::array<Word, kLetterClasses> Places;
};

// A comparison. The band is as wide as any way of at most Limit edits needs; see LaneBand.
struct LaneTask {
    const LaneColumns* Columns = nullptr;
    int Count = 0;   // of the texts
    int Length = 0;  // of each
    int ReferenceLength = 0;
    int Limit = 0;
    std::uint16_t* Distances = nullptr;  // kLanes; written for lanes within the limit
};

// The diagonals that a way of at most `Limit` edits can take, counted from the lowest one.
struct LaneBand {
    int Above = 0;   // diagonals below the one through the start
    int Target = 0;  // the one through the end
    int Width = 0;
};

constexpr LaneBand BandOf(const LaneTask& task) {
    const int difference = task.ReferenceLength - task.Length;
    const int apart = difference < 0 ? -difference : difference;
    const int spare = (task.Limit - apart) / 2;
    const int above = spare + (difference < 0 ? apart : 0);
    return {.Above = above, .Target = above + difference, .Width = apart + 2 * spare + 1};
}

// A bit a lane: whether the distance of the classes is within the limit; then it is in Distances. The rows
// are those of the reference, at least Length + bits of a word of them; the band must fit into a word.
struct LaneKernels {
    std::uint64_t (*Short)(const LaneTask& task, const LaneRow<std::uint16_t>* rows) = nullptr;
    std::uint64_t (*Long)(const LaneTask& task, const LaneRow<std::uint32_t>* rows) = nullptr;
};
// One lane after the other, on any processor.
std::uint64_t WideLanes(const LaneTask& task, const LaneRow<std::uint64_t>* rows);

// Those that this processor can run, the fastest first; the last one is empty. All find the same.
const std::vector<LaneKernels>& ProcessorLanes();

// For ProcessorLanes.
extern const LaneKernels kAvx512Lanes;
extern const LaneKernels kAvx2Lanes;
