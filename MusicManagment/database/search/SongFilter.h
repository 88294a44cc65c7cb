#pragma once

#include <QString>
#include <QStringList>
#include <QStringView>
#include <functional>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"

// What a user types to narrow the list. Words in any order, each of which must stand in one of the song's
// texts; case and umlauts do not matter. "..." keeps words together, a leading - excludes. FIELD:VALUE looks
// at one field only; fields of numbers take 1980, 1980..1989, >=192, <3:30.
class SongFilter {
 public:
    SongFilter() = default;
    static SongFilter Parse(QStringView text);

    bool IsEmpty() const { return terms_.empty(); }
    bool Matches(const TID3Tag& song) const;

    // What stands before a colon in `text` like a field's name and is none: such a word is looked for as it
    // is.
    static QStringList UnknownFields(QStringView text);
    // The names of the fields, for help and completion.
    static QStringList FieldNames();

 private:
    struct Term {
        std::function<bool(const TID3Tag&)> Test;
        bool Excludes = false;
    };
    std::vector<Term> terms_;
};
