#pragma once

#include <QString>
#include <utility>
#include <vector>

class TMusicDatabase;
struct TID3Tag;

// Pairs of songs that are alike and of which the user wants to keep both, in the side file.

// By the paths of the songs.
std::vector<std::pair<QString, QString>> KeptPairs(const TMusicDatabase& database);
// Remembers a pair, or forgets it. Throws EStreamError when the side file cannot be written; it counts for
// now all the same.
void SetKeptPair(TMusicDatabase& database, const TID3Tag& first, const TID3Tag& second, bool kept);
