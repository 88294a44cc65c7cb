#pragma once

#include <QString>
#include <map>
#include <optional>

#include "CommonRUKTools/ByteReader.h"

// What a PLS list says of the song with one number; empty texts where it says nothing.
struct PlsItem {
    QString File{};
    QString Title{};
    QString Length{};  // seconds
};

// The section "playlist" of a PLS list, a file in the form of an INI file. Of a key that comes twice the
// first counts.
struct PlsSection {
    std::map<int, PlsItem> Items{};
    std::optional<int> Count{};
};

// Values are taken by their bytes, commas and backslashes too, which a general reader of INI files would
// interpret. Throws EPlayListException when there are too many items.
PlsSection ReadPlsSection(ByteSpan contents);
