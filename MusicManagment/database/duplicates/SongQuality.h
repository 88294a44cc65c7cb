#pragma once

#include <optional>
#include <span>
#include <vector>

#include "MusicManagment/database/duplicates/DuplicateSearch.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// Which of two songs that hold the same piece of music is the better one.

// Songs whose lengths are so far apart, in seconds, are taken for the same recording.
inline constexpr int kSameLength = 5;

struct SongVerdict {
    enum class Side { Neither, First, Second };
    Side Better = Side::Neither;
    QString Reason{};  // what decides: "höhere Bitrate (320 statt 128 kBit/s)"
};

// The first that differs decides: damage, a medium that can be away, bit rate, length (beyond kSameLength),
// fields of the tag that tell something, plays.
SongVerdict CompareQuality(const TID3Tag& first, const TID3Tag& second);

// A song that may go, since a better one is like it.
struct KeepSuggestion {
    SongReplacement Songs{};
    double Percent = 0;  // how alike their names are
    QString Reason{};

    // Names that differ more are often those of two songs.
    bool IsSafe() const { return Percent >= kSafePercent; }
    static constexpr int kSafePercent = 90;
};

// For pairs of the same recording: each song that goes has its better one in a pair of its own, and none that
// stays for another goes. The safe ones first, each kind ordered by the songs that stay. Pairs whose songs
// have gone are passed over.
std::vector<KeepSuggestion> SuggestKept(const TMusicDatabase& database, std::span<const DuplicatePair> pairs);
