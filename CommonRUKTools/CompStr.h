#pragma once

#include <QStringView>
#include <cstddef>
#include <string>
#include <string_view>

// How alike two texts are, in percent: 100 * (L - d) / L, where L is the length of the longer one and d their
// Levenshtein distance, both in code points of the texts as CompareKey gives them. 100 exactly when these are
// equal, two empty ones included.
double CompStr(QStringView a, QStringView b);

// The form in which texts are compared: in lower case, then composed (NFC).
std::u32string CompareKey(QStringView text);

// Fewest insertions, deletions and replacements of one code point that make one text of the other.
std::size_t EditDistance(std::u32string_view a, std::u32string_view b);

// From 60 percent on two texts count as alike. Decided in integers, so that no rounding moves the limit.
constexpr bool IsAlike(std::size_t distance, std::size_t longerLength) {
    return 5 * distance <= 2 * longerLength;
}
