#pragma once

#include <QString>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"

// The songs that a batch command is about.
enum class BatchRange { All, Marked, One };

// At most so many marks are looked at.
inline constexpr std::size_t kMostMarks = 65536;

// What a view shows as chosen.
struct ViewSelection {
    std::vector<SongHandle> Marked;  // in the order of the collection
    SongHandle Selected{};           // the song that has the focus
};

struct BatchSongs {
    BatchRange Range = BatchRange::One;
    // Held before the first change: a song that changes may move.
    std::vector<SongHandle> Songs;
    std::size_t Passed = 0;  // marks beyond the limit

    bool IsEmpty() const { return Songs.empty(); }
};

// All songs in the order of the collection.
BatchSongs AllSongs(const TMusicDatabase& database);
// The marked ones; where exactly one is marked, the selected one in its place, which need not be the same.
BatchSongs MarkedSongs(const ViewSelection& selection);
BatchSongs OneSong(SongHandle song);
