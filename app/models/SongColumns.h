#pragma once

#include <QString>
#include <Qt>
#include <optional>
#include <span>

#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The numbers stand in the settings: columns to come get the next ones.
enum class SongColumnId {
    Title,
    Artist,
    Album,
    Year,
    Length,
    Genre,
    Id3Genre,
    Track,
    BitRate,
    SampleRate,
    Channels,
    Format,
    PlayCount,
    Comment,
    AddTime,
    Flags,
    Path,
};

// A column of the song list.
struct SongColumn {
    SongColumnId Id;
    const char16_t* Caption;
    int Width;  // at first, in average characters
    Qt::AlignmentFlag Alignment;
    bool Shown;                     // at first
    std::optional<TSortType> Sort;  // what a click on the header sorts by; some columns have no order
    QString (*Text)(const TID3Tag& song);
};

// All columns, from left to right.
std::span<const SongColumn> SongColumns();
// The column that shows what songs are sorted by; -1 when none does.
int ColumnOfSortType(TSortType type);
