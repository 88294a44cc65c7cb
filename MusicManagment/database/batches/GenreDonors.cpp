#include "MusicManagment/database/batches/GenreDonors.h"

#include <algorithm>

#include "CommonRUKTools/CompStr.h"

namespace {

using Letters = std::array<std::uint8_t, 32>;

Letters CountLetters(std::u32string_view text) {
    Letters letters{};
    for (const char32_t character : text)
        if (std::uint8_t& count = letters[character % letters.size()]; count < UINT8_MAX) ++count;
    return letters;
}

// What one text has too much of and the other too little can be mended by replacements at best.
std::size_t LeastDistance(const Letters& a, const Letters& b) {
    std::size_t onlyInA = 0;
    std::size_t onlyInB = 0;
    for (std::size_t i = 0; i < a.size(); ++i) {
        onlyInA += a[i] > b[i] ? a[i] - b[i] : 0;
        onlyInB += b[i] > a[i] ? b[i] - a[i] : 0;
    }
    return std::max(onlyInA, onlyInB);
}

// A similarity of two texts, compared as a fraction so that no rounding makes two of them equal.
struct Fraction {
    std::size_t Distance = 0;
    std::size_t Length = 1;

    bool IsAbove(const Fraction& other) const {
        return (Length - Distance) * other.Length > (other.Length - other.Distance) * Length;
    }
    bool Equals(const Fraction& other) const { return !IsAbove(other) && !other.IsAbove(*this); }
    int Percent() const { return static_cast<int>(100 * (Length - Distance) / Length); }
};

}  // namespace

GenreDonors::Key GenreDonors::MakeKey(const QString& artist, std::size_t place) {
    Key key{.Text = CompareKey(artist), .Place = place};
    key.Letters = CountLetters(key.Text);
    return key;
}

GenreDonors::GenreDonors(const TMusicDatabase& database) {
    for (SongIndex i = 0; i < database.Count(); ++i) {
        const TID3Tag& song = database.Song(i);
        if (song.MainGenre == 0) continue;
        const QString folded = song.Artist.toCaseFolded();
        if (byFoldedArtist_.contains(folded)) continue;
        byFoldedArtist_.insert(folded, donors_.size());
        keys_.push_back(MakeKey(song.Artist, donors_.size()));
        donors_.push_back({song.Artist, song.MainGenre});
    }
    std::ranges::stable_sort(keys_, {}, [](const Key& key) { return key.Text.size(); });
}

const GenreDonors::Donor* GenreDonors::OfArtist(const QString& artist) const {
    const auto found = byFoldedArtist_.constFind(artist.toCaseFolded());
    return found == byFoldedArtist_.cend() ? nullptr : &donors_[*found];
}

std::optional<GenreDonors::Likeness> GenreDonors::MostAlike(const QString& artist) const {
    const Key wanted = MakeKey(artist, 0);
    const std::size_t length = wanted.Text.size();
    // Lengths that differ by more than two fifths of the longer one are too far apart.
    const auto first = std::ranges::lower_bound(keys_, (3 * length + 4) / 5, {},
                                                [](const Key& key) { return key.Text.size(); });
    const Key* best = nullptr;
    Fraction bestLikeness{.Distance = 1};
    for (auto key = first; key != keys_.end(); ++key) {
        const std::size_t longer = std::max(length, key->Text.size());
        if (!IsAlike(longer - std::min(length, key->Text.size()), longer)) break;
        const Fraction atBest{LeastDistance(wanted.Letters, key->Letters), std::max<std::size_t>(longer, 1)};
        if (!IsAlike(atBest.Distance, longer) || bestLikeness.IsAbove(atBest)) continue;
        const Fraction likeness{EditDistance(wanted.Text, key->Text), atBest.Length};
        if (!IsAlike(likeness.Distance, longer)) continue;
        const bool isBetter = best == nullptr || likeness.IsAbove(bestLikeness) ||
                              (likeness.Equals(bestLikeness) && key->Place < best->Place);
        if (!isBetter) continue;
        best = &*key;
        bestLikeness = likeness;
    }
    if (best == nullptr) return std::nullopt;
    return Likeness{donors_[best->Place], bestLikeness.Percent()};
}
