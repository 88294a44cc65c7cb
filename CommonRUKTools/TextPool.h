#pragma once

#include <QString>
#include <cstdint>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// Turns system texts of a file into QStrings, of which equal ones share their characters: a text that was
// seen before is neither converted nor allocated again. Forgets everything when it has grown to some
// megabytes, so that a file whose texts are all different costs no more than that.
class TextPool {
 public:
    QString Get(ByteSpan bytes);

 private:
    struct Entry {
        std::size_t Start;  // in bytes_
        std::size_t Size;
        QString Text;
    };
    // A place of the hash table; the hash in it spares most looks at entries.
    struct Place {
        std::uint32_t Hash = 0;
        std::uint32_t Number = 0;  // of the entry, plus 1; 0 free
    };

    Place& Find(ByteSpan bytes, std::uint32_t hash);
    void Forget();
    void Grow();

    std::vector<Place> places_;  // a power of two, at most half of them taken
    std::vector<Entry> entries_;
    std::vector<std::uint8_t> bytes_;  // of all entries, as they stand in the file
};
