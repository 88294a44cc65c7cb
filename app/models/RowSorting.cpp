#include "app/models/RowSorting.h"

#include <algorithm>
#include <numeric>

namespace {

constexpr unsigned kHalfBits = 16;
constexpr std::size_t kHalfValues = std::size_t{1} << kHalfBits;

std::size_t HalfOf(std::uint32_t key, unsigned shift) {
    return (key >> shift) & (kHalfValues - 1);
}

}  // namespace

RowSorting::RowSorting(RowOrder order) : order_(std::move(order)) {
    if (!order_.InGroups) return;
    parents_.resize(order_.SongCount);
    std::iota(parents_.begin(), parents_.end(), 0);
    groupOfSong_.assign(order_.SongCount, kNoGroup);
}

std::size_t RowSorting::RowsIn(Phase phase) const {
    if (phase == Phase::Prepare) return order_.Prepare ? order_.SongCount : 0;
    return phase == Phase::Choose ? order_.Rows : rows_.size();
}

bool RowSorting::Work(std::size_t steps) {
    while (phase_ != Phase::Done) {
        const std::size_t end = std::min(place_ + steps, RowsIn(phase_));
        steps -= end - place_;
        for (; place_ < end; ++place_)
            Take(place_);
        if (place_ < RowsIn(phase_)) return true;
        place_ = 0;
        EndPhase();
    }
    return false;
}

void RowSorting::Take(std::size_t place) {
    const auto number = static_cast<std::uint32_t>(place);
    switch (phase_) {
        case Phase::Prepare:
            return order_.Prepare(number);
        case Phase::Choose:
            if (!order_.Passes(number)) return;
            rows_.push_back(number);
            if (order_.InGroups) Join(number);
            return;
        case Phase::Count: {
            const std::uint32_t key = key_(rows_[place]);
            ++low_[HalfOf(key, 0)];
            ++high_[HalfOf(key, kHalfBits)];
            return;
        }
        case Phase::ByLowHalf:
            return Scatter(place, low_, 0);
        case Phase::ByHighHalf:
            return Scatter(place, high_, kHalfBits);
        case Phase::Group:
            return NumberGroup(rows_[place]);
        case Phase::Done:
            return;
    }
}

void RowSorting::EndPhase() {
    switch (phase_) {
        case Phase::Prepare:
            phase_ = Phase::Choose;
            return;
        case Phase::Choose:
            return order_.Key ? BeginSort(order_.Key) : EndSort();
        case Phase::Count:
            phase_ = Phase::ByLowHalf;
            return BeginScatter(low_);
        case Phase::ByLowHalf:
            rows_.swap(sorted_);
            phase_ = Phase::ByHighHalf;
            return BeginScatter(high_);
        case Phase::ByHighHalf:
            rows_.swap(sorted_);
            return EndSort();
        case Phase::Group:
            sortsByGroup_ = true;
            return BeginSort([this](std::uint32_t row) { return GroupOf(row); });
        case Phase::Done:
            return;
    }
}

// --- Sorting ---

void RowSorting::BeginSort(Key key) {
    key_ = std::move(key);
    low_.assign(kHalfValues, 0);
    high_.assign(kHalfValues, 0);
    phase_ = Phase::Count;
}

void RowSorting::BeginScatter(std::vector<std::uint32_t>& places) {
    sorted_.resize(rows_.size());
    std::exclusive_scan(places.begin(), places.end(), places.begin(), std::uint32_t{0});
}

void RowSorting::Scatter(std::size_t place, std::vector<std::uint32_t>& places, unsigned shift) {
    const std::uint32_t row = rows_[place];
    sorted_[places[HalfOf(key_(row), shift)]++] = row;
}

void RowSorting::EndSort() {
    if (order_.InGroups && !sortsByGroup_) {
        phase_ = Phase::Group;
        return;
    }
    if (order_.InGroups)
        for (std::uint32_t song = 0; song < order_.SongCount; ++song)
            groupOfSong_[song] = groupOfSong_[RootOf(song)];
    sorted_ = {};
    phase_ = Phase::Done;
}

// --- Groups ---

std::uint32_t RowSorting::RootOf(std::uint32_t song) {
    while (parents_[song] != song) {
        parents_[song] = parents_[parents_[song]];
        song = parents_[song];
    }
    return song;
}

void RowSorting::Join(std::uint32_t row) {
    const auto [first, second] = order_.Songs(row);
    const std::uint32_t a = RootOf(first);
    const std::uint32_t b = RootOf(second);
    parents_[std::max(a, b)] = std::min(a, b);
}

std::uint32_t RowSorting::GroupOf(std::uint32_t row) {
    return groupOfSong_[RootOf(order_.Songs(row).first)];
}

void RowSorting::NumberGroup(std::uint32_t row) {
    std::uint32_t& group = groupOfSong_[RootOf(order_.Songs(row).first)];
    if (group == kNoGroup) group = groups_++;
}
