#include "CommonRUKTools/TextPool.h"

#include <QHashFunctions>
#include <algorithm>
#include <cstring>

#include "CommonRUKTools/CodePage.h"

namespace {

constexpr std::size_t kFewest = 1024;  // places
constexpr std::size_t kMostTexts = 300'000;
constexpr std::size_t kMostBytes = std::size_t{16} * 1024 * 1024;

// Seeded, so that no file can be made whose texts all meet in one place.
std::uint32_t HashOf(ByteSpan bytes) {
    return static_cast<std::uint32_t>(qHashBits(bytes.data(), bytes.size(), QHashSeed::globalSeed()));
}

}  // namespace

QString TextPool::Get(ByteSpan bytes) {
    if (bytes.empty()) return {};
    if (entries_.size() == kMostTexts || bytes_.size() + bytes.size() > kMostBytes) Forget();
    if (2 * entries_.size() >= places_.size()) Grow();
    const std::uint32_t hash = HashOf(bytes);
    Place& place = Find(bytes, hash);
    if (place.Number != 0) return entries_[place.Number - 1].Text;

    entries_.push_back({bytes_.size(), bytes.size(), CodePage::FromSystem(bytes)});
    bytes_.insert(bytes_.end(), bytes.begin(), bytes.end());
    place = {hash, static_cast<std::uint32_t>(entries_.size())};
    return entries_.back().Text;
}

TextPool::Place& TextPool::Find(ByteSpan bytes, std::uint32_t hash) {
    const std::size_t mask = places_.size() - 1;
    for (std::size_t i = hash & mask;; i = (i + 1) & mask) {
        Place& place = places_[i];
        if (place.Number == 0) return place;
        if (place.Hash != hash) continue;
        const Entry& entry = entries_[place.Number - 1];
        if (entry.Size == bytes.size() &&
            std::memcmp(bytes_.data() + entry.Start, bytes.data(), bytes.size()) == 0)
            return place;
    }
}

void TextPool::Forget() {
    entries_.clear();
    bytes_.clear();
    places_.clear();
}

void TextPool::Grow() {
    std::vector<Place> old(std::max(kFewest, 2 * places_.size()));
    old.swap(places_);
    const std::size_t mask = places_.size() - 1;
    for (const Place& place : old) {
        if (place.Number == 0) continue;
        std::size_t i = place.Hash & mask;
        while (places_[i].Number != 0)
            i = (i + 1) & mask;
        places_[i] = place;
    }
}
