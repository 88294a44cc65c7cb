#include "MusicManagment/playlist/PlayOrder.h"

#include <algorithm>
#include <numeric>

std::vector<int> SequenceAfter(TPlayOrder order, int count, int current, std::mt19937& random) {
    if (order == poStopAfterPlay || count == 0) return {};
    std::vector<int> sequence(static_cast<std::size_t>(count));
    std::iota(sequence.begin(), sequence.end(), 0);
    if (order == poRandom) {
        std::ranges::shuffle(sequence, random);
        return sequence;
    }
    // As if read from a ring behind the current entry. Without one: from the top down, from the end up.
    std::rotate(sequence.begin(), sequence.begin() + (current + 1) % count, sequence.end());
    if (order == poUpwards) std::reverse(sequence.begin(), current < 0 ? sequence.end() : sequence.end() - 1);
    return sequence;
}
