#include "MusicManagment/database/duplicates/ComparedTexts.h"

#include <algorithm>
#include <numeric>

#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/duplicates/Lanes.h"

void ComparedTexts::Add(QStringView text) {
    letters_ += CompareKey(text);
    starts_.push_back(letters_.size());
}

void ComparedTexts::Classify() {
    // Most collections need a small part of the code points.
    const std::size_t codePoints =
        letters_.empty() ? 0 : std::size_t{*std::ranges::max_element(letters_)} + 1;
    std::vector<std::uint32_t> counts(codePoints);
    std::vector<char32_t> letters;  // each once
    for (const char32_t letter : letters_)
        if (counts[letter]++ == 0) letters.push_back(letter);
    std::ranges::sort(letters, [&counts](char32_t a, char32_t b) {
        return counts[a] != counts[b] ? counts[a] > counts[b] : a < b;
    });
    std::vector<std::uint8_t> classes(codePoints);
    for (std::size_t rank = 0; rank < letters.size(); ++rank)
        classes[letters[rank]] = static_cast<std::uint8_t>(rank % kLetterClasses);
    classes_.resize(letters_.size());
    std::ranges::transform(letters_, classes_.begin(),
                           [&classes](char32_t letter) { return classes[letter]; });
}
