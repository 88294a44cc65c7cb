#pragma once

#include <QHash>
#include <QList>
#include <vector>

#include "MusicManagment/database/SongList.h"
#include "MusicManagment/database/SongTypes.h"

// An order of songs.
struct SongOrder {
    TSortType SortType = stGenre;
    TSubSortType SubSortType = sstGATL;
    bool Backwards = false;
    quint32 ShownFlag = 0;  // with stFlags: the only bit that counts; 0 compares the whole flags
    // With stCacheType: the sorted serial numbers of the media that are mounted. The database keeps them.
    QList<quint32> MediaThere{};

    bool operator==(const SongOrder&) const = default;
};

// Below, equal or above 0, as `a` comes before, beside or after `b`.
int CompareSongs(const SongOrder& order, const TID3Tag& a, const TID3Tag& b);

// Sorts all entries. Songs that are equal in every key keep their relative position.
void SortSongs(const SongOrder& order, std::vector<SongList::Entry>& entries);
bool IsSorted(const SongOrder& order, const SongList& songs);

// Where the entry at `index` belongs, counted before it is taken out: `index` itself when it stays, else the
// position before which it is to stand. All other entries must be in order. Among equal entries the place is
// the one that a walk from the middle of the list (from beside the entry, when it is not the first) meets
// first.
SongIndex TargetPosition(const SongOrder& order, const SongList& songs, SongIndex index);
