#pragma once

#include <QString>
#include <QStringList>
#include <QtGlobal>

#include "MusicManagment/database/CdPath.h"

// Position of a song in the list, 0 to count - 1; -1 none, or all songs where an event says so.
using SongIndex = int;

enum TSortType {
    stTitle,
    stArtist,
    stAlbum,
    stComment,
    stYear,
    stLength,
    stGenre,
    stPath,
    stPlayCnt,
    stAddTime,
    stFlags,
    stCacheType,
    stAlbumOrder,  // album, folder, track: as the songs of an album follow each other
};

// What decides between songs that are equal under the sort type.
enum TSubSortType {
    sstGATL,  // genre, artist, title, length
    sstATL,   // artist, title, length
    sstPath,
};

enum TOVType { ovArtist, ovAlbum, ovYear, ovLength, ovGenre };
inline constexpr int kOverviewTypeCount = 5;

enum TCompressionLevel { clNone = 0, clFastest = 1, clDefault = 2, clMax = 3 };

enum TChangeType { ctChanged = 0, ctInserted = 1, ctRemoved = 2 };

// Headings of progress runs. The numbers are part of the interface to the views.
enum TProgressType {
    ptOther = 0,
    ptLoadDatabase = 3,
    ptSaveDatabase = 4,
    ptSearchFolders = 5,
    ptAddSongs = 6,
    ptReadBackupCd = 7,
    ptCopySongs = 8,
};

// Bits of TID3Tag::Flags.
enum TSongFlag : quint32 { sfBurned = 1, sfDamaged = 2, sfLengthCorrect = 4, sfRemixed = 8 };

// "Auf CD gebrannt, Remixed"; "(keine)" when no bit is set.
QString FormatSongFlags(quint32 flags);
// The names offered where flags are set or cleared, in bit order.
QStringList SongFlagNames();

// "1 Song", "2 Songs"
QString SongCountText(std::size_t count);

// Default names of the genre folders, one for each main genre.
QStringList DefaultGenreFolderNames();

// Before the name of the file in a stored path; -1 when it is only a name. A path on a CD keeps its own
// separators on every system.
qsizetype LastSeparator(const QString& path);
// Without a separator at its end, unless it is the root.
QString FolderOf(const QString& path);
