#pragma once

#include <QString>

#include "MusicManagment/database/sorting/Sorting.h"
#include "ReadMPEGHeader/ID3Tag.h"

// What a sort type compares; shared by the comparison of two songs and the sorting of all.

template <typename T>
int CompareNumbers(T a, T b) {
    return a < b ? -1 : a > b ? 1 : 0;
}

// The text that the sort type compares; nullptr for types that compare numbers.
const QString* PrimaryText(TSortType type, const TID3Tag& song);
// The value that a numeric sort type compares, as a number of the same order.
quint64 PrimaryNumber(const SongOrder& order, const TID3Tag& song);
