#include "CommonRUKTools/CompStr.h"

#include <QString>
#include <algorithm>
#include <array>
#include <cstdint>
#include <utility>
#include <vector>

namespace {

constexpr std::size_t kWordBits = 64;
constexpr std::size_t kCommonCharacters =
    0x180;  // with the letters of all European languages in Latin script

// Where each character stands in a text of at most 64: a bit a place.
class CharacterPlaces {
 public:
    explicit CharacterPlaces(std::u32string_view text) {
        for (std::size_t i = 0; i < text.size(); ++i)
            At(text[i]) |= std::uint64_t{1} << i;
    }

    std::uint64_t Of(char32_t character) const {
        if (character < common_.size()) return common_[character];
        const auto found = std::ranges::find(rare_, character, &Place::first);
        return found == rare_.end() ? 0 : found->second;
    }

 private:
    using Place = std::pair<char32_t, std::uint64_t>;

    std::uint64_t& At(char32_t character) {
        if (character < common_.size()) return common_[character];
        const auto found = std::ranges::find(rare_, character, &Place::first);
        return found == rare_.end() ? rare_.emplace_back(character, 0).second : found->second;
    }

    std::array<std::uint64_t, kCommonCharacters> common_{};
    std::vector<Place> rare_;
};

// Hyyrö's bit-parallel form of Myers' algorithm: one column of the distance matrix in two machine words. The
// pattern has at most 64 code points and at least one.
std::size_t DistanceInWord(std::u32string_view pattern, std::u32string_view text) {
    const CharacterPlaces places(pattern);
    const std::uint64_t last = std::uint64_t{1} << (pattern.size() - 1);
    std::uint64_t up = ~std::uint64_t{0};  // rows that are one more than the row above
    std::uint64_t down = 0;                // rows that are one less
    std::size_t distance = pattern.size();
    for (const char32_t character : text) {
        const std::uint64_t equal = places.Of(character);
        const std::uint64_t diagonal = (((equal & up) + up) ^ up) | equal | down;
        std::uint64_t right = down | ~(diagonal | up);
        std::uint64_t left = up & diagonal;
        if ((right & last) != 0) ++distance;
        if ((left & last) != 0) --distance;
        right = (right << 1) | 1;
        left <<= 1;
        up = left | ~(diagonal | right);
        down = right & diagonal;
    }
    return distance;
}

std::size_t DistanceByRows(std::u32string_view a, std::u32string_view b) {
    std::vector<std::size_t> row(a.size() + 1);
    for (std::size_t i = 0; i < row.size(); ++i)
        row[i] = i;
    for (std::size_t j = 0; j < b.size(); ++j) {
        std::size_t diagonal = row[0];
        row[0] = j + 1;
        for (std::size_t i = 0; i < a.size(); ++i) {
            const std::size_t replaced = diagonal + (a[i] == b[j] ? 0 : 1);
            diagonal = row[i + 1];
            row[i + 1] = std::min({replaced, row[i] + 1, diagonal + 1});
        }
    }
    return row.back();
}

void DropSharedEnds(std::u32string_view& a, std::u32string_view& b) {
    const auto head = std::ranges::mismatch(a, b);
    const auto shared = static_cast<std::size_t>(head.in1 - a.begin());
    a.remove_prefix(shared);
    b.remove_prefix(shared);
    while (!a.empty() && !b.empty() && a.back() == b.back()) {
        a.remove_suffix(1);
        b.remove_suffix(1);
    }
}

}  // namespace

std::u32string CompareKey(QStringView text) {
    return text.toString().toLower().normalized(QString::NormalizationForm_C).toStdU32String();
}

std::size_t EditDistance(std::u32string_view a, std::u32string_view b) {
    DropSharedEnds(a, b);
    if (a.size() > b.size()) std::swap(a, b);
    if (a.empty()) return b.size();
    return a.size() <= kWordBits ? DistanceInWord(a, b) : DistanceByRows(a, b);
}

double CompStr(QStringView a, QStringView b) {
    const std::u32string first = CompareKey(a);
    const std::u32string second = CompareKey(b);
    return Similarity(EditDistance(first, second), std::max(first.size(), second.size()));
}
