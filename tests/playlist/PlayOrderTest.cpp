#include "MusicManagment/playlist/PlayOrder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>

using Sequence = std::vector<int>;

TEST(PlayOrder, DownAndUpGoRoundAndComeBackToTheCurrentEntry) {
    std::mt19937 random;
    EXPECT_EQ(SequenceAfter(poDownwards, 4, 1, random), (Sequence{2, 3, 0, 1}));
    EXPECT_EQ(SequenceAfter(poDownwards, 4, 3, random), (Sequence{0, 1, 2, 3}));
    EXPECT_EQ(SequenceAfter(poDownwards, 4, -1, random), (Sequence{0, 1, 2, 3}));
    EXPECT_EQ(SequenceAfter(poUpwards, 4, 1, random), (Sequence{0, 3, 2, 1}));
    EXPECT_EQ(SequenceAfter(poUpwards, 4, 0, random), (Sequence{3, 2, 1, 0}));
    EXPECT_EQ(SequenceAfter(poUpwards, 4, -1, random), (Sequence{3, 2, 1, 0}));
    EXPECT_EQ(SequenceAfter(poUpwards, 1, 0, random), Sequence{0});
    for (const TPlayOrder order : {poDownwards, poUpwards, poRandom})
        EXPECT_TRUE(SequenceAfter(order, 0, -1, random).empty());
    EXPECT_TRUE(SequenceAfter(poStopAfterPlay, 4, 1, random).empty());
}

TEST(PlayOrder, EveryRandomSequenceIsAsLikelyAsAnother) {
    std::mt19937 random(4711);
    constexpr int kRounds = 24'000;
    std::map<Sequence, int> seen;
    for (int round = 0; round < kRounds; ++round)
        ++seen[SequenceAfter(poRandom, 4, 2, random)];
    ASSERT_EQ(seen.size(), 24u);
    // Chi-square with 23 degrees of freedom: above 49.7 once in a thousand seeds, and this seed is fixed.
    double chiSquare = 0;
    for (const auto& [sequence, count] : seen)
        chiSquare += (count - 1000.0) * (count - 1000.0) / 1000.0;
    EXPECT_LT(chiSquare, 49.7);
}
