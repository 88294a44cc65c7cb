#pragma once

#include <QStringView>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "MusicManagment/database/duplicates/Lanes.h"

// Many texts that are compared with each other, in one piece of memory, beside the classes of their letters
// (see Lanes.h).
class ComparedTexts {
 public:
    // Two texts that differ only in case and in composition are the same (CompareKey).
    void Add(QStringView text);
    // Chooses the classes, once all texts are there: the most frequent letters get one of their own.
    void Classify();

    std::size_t Count() const { return starts_.size() - 1; }
    std::size_t Length(std::size_t number) const { return starts_[number + 1] - starts_[number]; }
    std::u32string_view Text(std::size_t number) const {
        return std::u32string_view(letters_).substr(starts_[number], Length(number));
    }
    // As many as the text has letters, each below kLetterClasses.
    const std::uint8_t* Classes(std::size_t number) const { return classes_.data() + starts_[number]; }
    // Whether no two different letters of these two texts share a class: their distance is then that of
    // their classes.
    bool AreTrueToClasses(std::size_t a, std::size_t b) const {
        const std::uint64_t letters = letterSets_[a] | letterSets_[b];
        return (letters & (letters >> kLetterClasses)) == 0;
    }

 private:
    std::u32string letters_;
    std::vector<std::uint8_t> classes_;
    // Of each text, a bit a letter: in the lower half the most frequent one of each class, in the upper half
    // the next; all bits for a text with a letter rarer than these.
    std::vector<std::uint64_t> letterSets_;
    std::vector<std::size_t> starts_{0};  // and one behind the last
};
