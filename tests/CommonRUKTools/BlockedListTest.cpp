#include "CommonRUKTools/BlockedList.h"

#include <gtest/gtest.h>

#include <random>

namespace {

std::vector<int> Contents(const BlockedList<int>& list) {
    return {list.begin(), list.end()};
}

}  // namespace

// Thousands of random insertions and removals, enough to split and empty blocks, against a plain vector.
TEST(BlockedList, BehavesLikeAVectorUnderRandomEdits) {
    std::mt19937 random(42);
    std::vector<int> model(1'500, -1);
    BlockedList<int> list;
    list.assign(model);
    for (int i = 0; i < 20'000; ++i) {
        const bool remove = !model.empty() && random() % 4 == 0;
        const auto at = random() % (model.size() + (remove ? 0 : 1));
        if (remove) {
            list.removeAt(at);
            model.erase(model.begin() + static_cast<std::ptrdiff_t>(at));
        } else {
            list.insert(at, i);
            model.insert(model.begin() + static_cast<std::ptrdiff_t>(at), i);
        }
    }
    EXPECT_EQ(Contents(list), model);
    for (std::size_t i = 0; i < model.size(); i += 37)
        EXPECT_EQ(list[i], model[i]);
    while (!list.empty())
        list.removeAt(list.size() / 2);
    EXPECT_EQ(list.begin(), list.end());
}
