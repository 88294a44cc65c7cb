#pragma once

#include <cstdint>
#include <functional>
#include <span>
#include <vector>

#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/duplicates/TextBlocks.h"

// Finds all pairs of texts that are alike. The texts are numbered from 0 on.
struct PairQuery {
    const ComparedTexts* Texts = nullptr;
    // Only texts of the same group are compared; empty: all are of one group.
    std::vector<std::uint32_t> Groups{};
    // The texts that are compared with all others, in ascending order.
    std::vector<std::uint32_t> References{};
    int Percent = kAlikePercent;  // 1 to 100
    int Threads = 0;              // 0: as many as the processor runs at once
};

// What was found for one reference: of a pair of references it is with the one that comes first.
using PairsFound = std::function<bool(std::uint32_t reference, std::span<const TextBlocks::Match> matches)>;

// Tells `found`, on the calling thread and in the order of the references, what each is like, by number;
// false from it ends the search. `goOn` is asked every few hundredths of a second while nothing is there.
// False when the search was ended.
bool SearchPairs(const PairQuery& query, const PairsFound& found, const std::function<bool()>& goOn);
