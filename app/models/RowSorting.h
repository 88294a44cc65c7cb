#pragma once

#include <cstdint>
#include <functional>
#include <utility>
#include <vector>

// Which of many rows are shown and in which order. `Songs` of a row are numbers below SongCount.
struct RowOrder {
    std::size_t Rows = 0;  // these are looked at
    std::size_t SongCount = 0;
    // Called for each song before the first row is looked at; may be missing.
    std::function<void(std::uint32_t song)> Prepare{};
    std::function<bool(std::uint32_t row)> Passes{};
    // Smaller ones come first, equal ones stay as they are; missing: all stay.
    std::function<std::uint32_t(std::uint32_t row)> Key{};
    std::function<std::pair<std::uint32_t, std::uint32_t>(std::uint32_t row)> Songs{};
    // Rows whose songs hang together come one after the other.
    bool InGroups = false;
};

// Works that out in slices of any size, so that an interface goes on meanwhile. Its time grows linearly: a
// sort by two halves of a number.
class RowSorting {
 public:
    explicit RowSorting(RowOrder order);

    // Takes about so many rows further; false when all is done.
    bool Work(std::size_t steps);
    const RowOrder& Order() const { return order_; }

    // Of what is done:
    std::vector<std::uint32_t> TakeRows() { return std::move(rows_); }
    // Of each song the number of its group, in the order of the rows; those in no row have none.
    static constexpr std::uint32_t kNoGroup = ~std::uint32_t{0};
    std::vector<std::uint32_t> TakeGroups() { return std::move(groupOfSong_); }

 private:
    using Key = std::function<std::uint32_t(std::uint32_t row)>;
    enum class Phase { Prepare, Choose, Count, ByLowHalf, ByHighHalf, Group, Done };

    std::size_t RowsIn(Phase phase) const;
    void Take(std::size_t place);
    void EndPhase();
    void BeginSort(Key key);
    void BeginScatter(std::vector<std::uint32_t>& places);
    void EndSort();
    void Scatter(std::size_t place, std::vector<std::uint32_t>& places, unsigned shift);
    std::uint32_t RootOf(std::uint32_t song);
    void Join(std::uint32_t row);
    void NumberGroup(std::uint32_t row);
    std::uint32_t GroupOf(std::uint32_t row);

    RowOrder order_;
    Phase phase_ = Phase::Prepare;
    std::size_t place_ = 0;  // in the phase
    std::vector<std::uint32_t> rows_;
    std::vector<std::uint32_t> sorted_;
    Key key_;
    std::vector<std::uint32_t> low_;  // where the next row with this half of the key goes
    std::vector<std::uint32_t> high_;
    std::vector<std::uint32_t> parents_;      // of songs
    std::vector<std::uint32_t> groupOfSong_;  // of the roots, until all have one
    std::uint32_t groups_ = 0;
    bool sortsByGroup_ = false;
};
