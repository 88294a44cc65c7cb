#pragma once

#include <algorithm>
#include <string_view>
#include <vector>

// The distance of two texts as it is defined, row by row of its matrix: what every faster way is held
// against.
inline std::size_t PlainDistance(std::u32string_view a, std::u32string_view b) {
    std::vector<std::size_t> above(b.size() + 1);
    for (std::size_t j = 0; j <= b.size(); ++j)
        above[j] = j;
    std::vector<std::size_t> row(b.size() + 1);
    for (std::size_t i = 1; i <= a.size(); ++i) {
        row[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j)
            row[j] = std::min({above[j] + 1, row[j - 1] + 1, above[j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1)});
        above.swap(row);
    }
    return above.back();
}
