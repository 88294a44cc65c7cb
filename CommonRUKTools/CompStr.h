#pragma once

#include <QStringView>
#include <cstddef>
#include <string>
#include <string_view>

// How alike two texts are, in percent: the Similarity of what CompareKey makes of them.
double CompStr(QStringView a, QStringView b);

// The form in which texts are compared: in lower case, then composed (NFC).
std::u32string CompareKey(QStringView text);

// Fewest insertions, deletions and replacements of one code point that make one text of the other.
std::size_t EditDistance(std::u32string_view a, std::u32string_view b);

// How alike two texts are, in percent, by the length of the longer one and their edit distance, both in code
// points. 100 exactly when they are equal, two empty ones included.
constexpr double Similarity(std::size_t distance, std::size_t longerLength) {
    if (longerLength == 0) return 100;
    return 100 * static_cast<double>(longerLength - distance) / static_cast<double>(longerLength);
}

// From so many percent on two texts count as alike.
inline constexpr int kAlikePercent = 60;

// Decided in integers, so that no rounding moves the limit.
constexpr bool IsAlike(std::size_t distance, std::size_t longerLength) {
    return 100 * distance <= std::size_t{100 - kAlikePercent} * longerLength;
}
