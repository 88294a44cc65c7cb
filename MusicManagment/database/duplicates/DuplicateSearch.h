#pragma once

#include <deque>
#include <functional>
#include <vector>

#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/MusicManagment.h"

// Songs that may hold the same piece of music, because their names are alike.

// A collection with more songs is not compared by the original rule.
inline constexpr std::size_t kMostComparedSongs = 65536;
// Where there are more pairs the search ends.
inline constexpr std::size_t kMostDuplicateRows = 20'000'000;

struct DuplicatePair {
    SongHandle First{};
    SongHandle Second{};
    double Percent = 0;  // 100: their names are the same
};

// The pairs in the order in which they were found, as few bytes each as will do: what is shown of them is
// made from the songs.
class DuplicateRows {
 public:
    std::size_t Count() const { return rows_.size(); }
    DuplicatePair At(std::size_t row) const {
        const Row& held = rows_[row];
        return {songs_[held.First], songs_[held.Second], Similarity(held.Distance, held.Length)};
    }

    // The same by the places of the songs in Songs().
    struct Numbered {
        std::uint32_t First = 0;
        std::uint32_t Second = 0;
        double Percent = 0;
    };
    Numbered NumbersAt(std::size_t row) const {
        return {rows_[row].First, rows_[row].Second, At(row).Percent};
    }
    // Those that were compared, in the order of the collection.
    const std::vector<SongHandle>& Songs() const { return songs_; }
    // A song that went and has come back is another one.
    void PutBack(std::uint32_t number, SongHandle song) { songs_[number] = song; }

    // For the search: the songs by their numbers, and pairs of these.
    void Begin(std::vector<SongHandle> songs);
    // `length` is that of the longer of the two compared names.
    void Add(std::uint32_t first, std::uint32_t second, std::size_t distance, std::size_t length);

 private:
    struct Row {
        std::uint32_t First = 0;
        std::uint32_t Second = 0;
        std::uint16_t Distance = 0;
        std::uint16_t Length = 0;
    };
    std::vector<SongHandle> songs_;
    std::deque<Row> rows_;
};

struct DuplicateQuery {
    // The songs that are compared with all others, in any order; empty: all songs.
    std::vector<SongHandle> References{};
    bool AmongReferencesOnly = false;  // not with the others
    // Compares titles, of songs by the same artist only; else artist and title.
    bool SameArtistOnly = false;
    int LeastPercent = kAlikePercent;  // from there to 100
};

enum class DuplicateEnd {
    Done,
    Stopped,      // by the user
    TooManyRows,  // kMostDuplicateRows were found
};

// Fills `rows`, which may be looked at meanwhile: `onRows` tells now and then that there are more. A long
// operation. For a reference, in the order of the collection, come the songs that it is like; a pair of
// references comes once. Throws EAbort, after telling the user, when another operation runs.
DuplicateEnd FindDuplicates(TMusicDatabase& database, const DuplicateQuery& query, DuplicateRows& rows,
                            const std::function<void()>& onRows = {});

// How long the comparison of all songs with each other takes about, in seconds.
double ExpectedSearchTime(std::size_t songs);

// What a row shows of a similarity: "100%", or one decimal behind a blank.
QString SimilarityText(double percent);
// And of a song: its key in lower case, behind the mark of a song on a CD.
QString ComparedName(const TID3Tag& song, bool sameArtistOnly);
