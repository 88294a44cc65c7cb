#pragma once

#include <algorithm>
#include <cassert>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <vector>

// For lists whose items need not know where they are.
struct NoPlacement {
    template <typename T>
    static void Put(T&, std::uint32_t) {}
};

// A sequence with access by position in O(log blocks), and insertion and removal anywhere without moving the
// whole sequence: it is kept in blocks of some 16 KiB. `Placement::Put` tells an item the number of the block
// in which it lies, by which PositionIn finds it again.
template <typename T, typename Placement = NoPlacement>
class BlockedList {
 public:
    class const_iterator {
     public:
        using iterator_category = std::forward_iterator_tag;
        using value_type = T;
        using difference_type = std::ptrdiff_t;
        using pointer = const T*;
        using reference = const T&;

        const_iterator() = default;
        const_iterator(const BlockedList* list, std::size_t block, std::size_t offset)
            : list_(list), block_(block), offset_(offset) {}
        reference operator*() const { return list_->blocks_[block_].Items[offset_]; }
        pointer operator->() const { return &**this; }
        const_iterator& operator++() {
            if (++offset_ == list_->blocks_[block_].Items.size()) {
                ++block_;
                offset_ = 0;
            }
            return *this;
        }
        const_iterator operator++(int) {
            auto before = *this;
            ++*this;
            return before;
        }
        bool operator==(const const_iterator& other) const = default;

     private:
        const BlockedList* list_ = nullptr;
        std::size_t block_ = 0;
        std::size_t offset_ = 0;
    };

    std::size_t size() const { return size_; }
    bool empty() const { return size_ == 0; }
    const_iterator begin() const { return {this, 0, 0}; }
    const_iterator end() const { return {this, blocks_.size(), 0}; }

    const T& operator[](std::size_t index) const {
        const auto block = BlockOf(index);
        return blocks_[block].Items[index - starts_[block]];
    }
    T& operator[](std::size_t index) {
        const auto block = BlockOf(index);
        return blocks_[block].Items[index - starts_[block]];
    }

    // Position of the item in block number `number` for which `isIt` is true; it must be there.
    template <typename Predicate>
    std::size_t PositionIn(std::uint32_t number, Predicate isIt) const {
        const std::size_t block = placeOf_[number];
        const auto& items = blocks_[block].Items;
        const auto found = std::find_if(items.begin(), items.end(), isIt);
        assert(found != items.end());
        return starts_[block] + static_cast<std::size_t>(found - items.begin());
    }

    void clear() {
        blocks_.clear();
        starts_.clear();
        placeOf_.clear();
        freeNumbers_.clear();
        size_ = 0;
    }

    void append(T item) { insert(size_, std::move(item)); }

    // Before the item at `index`; `index` may be size().
    void insert(std::size_t index, T item) {
        assert(index <= size_);
        if (blocks_.empty()) InsertBlock(0, {}, 0);
        const auto block = index == size_ ? blocks_.size() - 1 : BlockOf(index);
        Placement::Put(item, blocks_[block].Number);
        auto& items = blocks_[block].Items;
        items.insert(items.begin() + static_cast<std::ptrdiff_t>(index - starts_[block]), std::move(item));
        ++size_;
        for (std::size_t later = block + 1; later < starts_.size(); ++later)
            ++starts_[later];
        if (items.size() >= kBlockLimit) Split(block);
    }

    void removeAt(std::size_t index) {
        assert(index < size_);
        const auto block = BlockOf(index);
        auto& items = blocks_[block].Items;
        items.erase(items.begin() + static_cast<std::ptrdiff_t>(index - starts_[block]));
        --size_;
        for (std::size_t later = block + 1; later < starts_.size(); ++later)
            --starts_[later];
        if (items.empty()) EraseBlock(block);
    }

    // Empties the list and returns its items in their order.
    std::vector<T> takeAll() {
        std::vector<T> items;
        items.reserve(size_);
        for (auto& block : blocks_)
            items.insert(items.end(), std::make_move_iterator(block.Items.begin()),
                         std::make_move_iterator(block.Items.end()));
        clear();
        return items;
    }

    // Replaces the contents.
    void assign(std::vector<T> items) {
        clear();
        for (std::size_t from = 0; from < items.size(); from += kBlockLimit / 2) {
            const auto to = std::min(items.size(), from + kBlockLimit / 2);
            InsertBlock(blocks_.size(),
                        {std::make_move_iterator(items.begin() + static_cast<std::ptrdiff_t>(from)),
                         std::make_move_iterator(items.begin() + static_cast<std::ptrdiff_t>(to))},
                        from);
        }
        size_ = items.size();
    }

 private:
    // Items of a block: few enough that moving half of them costs less than the search that came before.
    static constexpr std::size_t kBlockLimit = std::max<std::size_t>(64, 16'384 / sizeof(T));

    std::size_t BlockOf(std::size_t index) const {
        assert(index < size_);
        const auto next = std::upper_bound(starts_.begin(), starts_.end(), index);
        return static_cast<std::size_t>(next - starts_.begin()) - 1;
    }

    struct Block {
        std::vector<T> Items;
        std::uint32_t Number;  // its own as long as it lives
    };

    void InsertBlock(std::size_t block, std::vector<T> items, std::size_t start) {
        const std::uint32_t number = NewNumber();
        for (T& item : items)
            Placement::Put(item, number);
        blocks_.insert(blocks_.begin() + static_cast<std::ptrdiff_t>(block), {std::move(items), number});
        starts_.insert(starts_.begin() + static_cast<std::ptrdiff_t>(block), start);
        NotePlacesFrom(block);
    }

    void EraseBlock(std::size_t block) {
        freeNumbers_.push_back(blocks_[block].Number);
        blocks_.erase(blocks_.begin() + static_cast<std::ptrdiff_t>(block));
        starts_.erase(starts_.begin() + static_cast<std::ptrdiff_t>(block));
        NotePlacesFrom(block);
    }

    std::uint32_t NewNumber() {
        if (freeNumbers_.empty()) {
            placeOf_.push_back(0);
            return static_cast<std::uint32_t>(placeOf_.size() - 1);
        }
        const std::uint32_t number = freeNumbers_.back();
        freeNumbers_.pop_back();
        return number;
    }

    void NotePlacesFrom(std::size_t block) {
        for (; block < blocks_.size(); ++block)
            placeOf_[blocks_[block].Number] = block;
    }

    void Split(std::size_t block) {
        // Appending (reading a file, adding at the end) leaves full blocks behind; elsewhere both halves get
        // room.
        const bool last = block + 1 == blocks_.size();
        const auto keep = last ? kBlockLimit - 1 : kBlockLimit / 2;
        auto& items = blocks_[block].Items;
        const auto cut = items.begin() + static_cast<std::ptrdiff_t>(keep);
        std::vector<T> tail(std::make_move_iterator(cut), std::make_move_iterator(items.end()));
        items.erase(cut, items.end());
        InsertBlock(block + 1, std::move(tail), starts_[block] + keep);
    }

    std::vector<Block> blocks_;
    std::vector<std::size_t> starts_;   // position of each block's first item
    std::vector<std::size_t> placeOf_;  // where the block of each number stands
    std::vector<std::uint32_t> freeNumbers_;
    std::size_t size_ = 0;
};
