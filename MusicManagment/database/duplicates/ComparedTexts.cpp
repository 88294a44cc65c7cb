#include "MusicManagment/database/duplicates/ComparedTexts.h"

#include <algorithm>

#include "CommonRUKTools/CompStr.h"

namespace {

// Each letter of the text once, the most frequent one first.
std::vector<char32_t> LettersByFrequency(std::u32string_view text, std::size_t codePoints) {
    std::vector<std::uint32_t> counts(codePoints);
    std::vector<char32_t> letters;
    for (const char32_t letter : text)
        if (counts[letter]++ == 0) letters.push_back(letter);
    std::ranges::sort(letters, [&counts](char32_t a, char32_t b) {
        return counts[a] != counts[b] ? counts[a] > counts[b] : a < b;
    });
    return letters;
}

}  // namespace

void ComparedTexts::Add(QStringView text) {
    letters_ += CompareKey(text);
    starts_.push_back(letters_.size());
}

void ComparedTexts::Classify() {
    // Most collections need a small part of the code points.
    const std::size_t codePoints =
        letters_.empty() ? 0 : std::size_t{*std::ranges::max_element(letters_)} + 1;
    const std::vector<char32_t> letters = LettersByFrequency(letters_, codePoints);
    // The most frequent letters have a class each; the others share them, beginning with the class of the
    // least frequent of these, so that few texts have two letters of one class.
    std::vector<std::uint8_t> classes(codePoints);
    std::vector<std::uint64_t> bits(codePoints);
    for (std::size_t rank = 0; rank < letters.size(); ++rank) {
        const std::size_t place = rank % kLetterClasses;
        const bool isAlone = rank < kLetterClasses;
        const std::size_t letterClass = isAlone ? place : kLetterClasses - 1 - place;
        classes[letters[rank]] = static_cast<std::uint8_t>(letterClass);
        bits[letters[rank]] = rank < 2 * kLetterClasses
                                  ? std::uint64_t{1} << (letterClass + (isAlone ? 0 : kLetterClasses))
                                  : ~std::uint64_t{0};
    }
    for (const char32_t letter : letters_)
        classes_.push_back(classes[letter]);
    for (std::size_t number = 0; number < Count(); ++number) {
        letterSets_.push_back(0);
        for (const char32_t letter : Text(number))
            letterSets_.back() |= bits[letter];
    }
}
