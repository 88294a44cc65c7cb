#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

#include "MusicManagment/database/duplicates/ComparedTexts.h"
#include "MusicManagment/database/duplicates/Lanes.h"

// Finds among many texts those that are like a given one.
class TextBlocks {
 public:
    // A text that is alike enough, and its distance from the reference.
    struct Match {
        std::uint32_t Number = 0;
        std::uint32_t Distance = 0;

        bool operator==(const Match&) const = default;
    };
    // What one thread needs for its references; used again so that the search allocates nothing.
    struct Workspace {
        std::vector<LaneRow<std::uint16_t>> ShortRows;
        std::vector<LaneRow<std::uint32_t>> LongRows;
        std::vector<LaneRow<std::uint64_t>> WideRows;
        std::array<std::uint16_t, kLanes> Distances{};  // of the block just compared
    };

    // The texts with these numbers, in the order of OrderForBlocks; alike means `percent` (1 to 100) or more.
    // `texts` must outlive the object.
    TextBlocks(const ComparedTexts& texts, std::vector<std::uint32_t> numbers, int percent,
               const LaneKernels& kernels = ProcessorLanes().front());

    // By length, and texts that begin alike side by side: they leave the comparison at about the same column.
    static void OrderForBlocks(const ComparedTexts& texts, std::vector<std::uint32_t>& numbers);

    // Those like the text with the number `reference`, itself among them when it is one; by number.
    std::vector<Match> MatchesOf(std::uint32_t reference, Workspace& workspace) const;

    // The most edits by which two texts, the longer of which has `length` letters, are still alike.
    static std::size_t MostEdits(std::size_t length, int percent) {
        return length * static_cast<std::size_t>(100 - percent) / 100;
    }

 private:
    // Texts of one length, at most kLanes.
    struct Block {
        std::size_t Length = 0;
        std::size_t First = 0;  // in numbers_
        std::size_t Count = 0;
        std::size_t Columns = 0;  // in columns_
    };

    void Pack(Block& block);
    void Prepare(std::uint32_t reference, Workspace& workspace) const;
    void CompareBlock(const Block& block, std::uint32_t reference, Workspace& workspace,
                      std::vector<Match>& matches) const;
    std::optional<std::uint64_t> LanesAlike(const Block& block, std::size_t referenceLength,
                                            Workspace& workspace) const;
    bool MayBeAlike(std::size_t lengthA, std::size_t lengthB) const;

    const ComparedTexts& texts_;
    std::vector<std::uint32_t> numbers_;  // by length and text
    int percent_;
    const LaneKernels& kernels_;
    std::vector<Block> blocks_;  // by length
    std::vector<LaneColumns> columns_;
    std::size_t longest_ = 0;
};
