#pragma once

#include <vector>

#include "app/models/SongColumns.h"

// For each of the songs the rank of its text in the column: the lower, the earlier a reader expects it. Equal
// texts have equal ranks, and numbers within texts count as numbers.
std::vector<int> ColumnRanks(const SongColumn& column, const std::vector<const TID3Tag*>& songs);
