#pragma once

#include <span>

#include "CommonRUKTools/Command.h"

class TMusicDatabase;

// Numbers of the commands of the database's menu.
enum MenuCommand : int {
    mcNew = 101,
    mcOpen = 102,
    mcSave = 103,
    mcSaveAs = 104,
    mcUpdate = 111,
    mcUpdateWithTags = 112,
    mcAddSongs = 113,
    mcAddFolder = 114,
    mcFind = 201,
    mcFindNext = 202,
    mcFindOnline = 203,
    mcMarkAll = 211,
    mcInvertMarks = 212,
    mcMarkByFilter = 213,
    mcRemoveFromDatabase = 221,
    mcRemoveFromDisk = 222,
    mcCopyTo = 223,
    mcBan = 224,
    mcListArtists = 301,  // 302 to 305: albums, years, lengths, genres
    mcListGenres = 305,
    mcRecount = 311,
    mcPlay = 401,
    mcAddToPlayList = 402,
    mcOpenExternally = 403,
    mcTakeGenre = 404,
    mcSortSubmenu = 410,
    mcSortFirst = 411,  // to 423, in the order of TSortType
    mcSortLast = 423,
    mcSubSortSubmenu = 430,
    mcSubSortFirst = 431,  // to 433, in the order of TSubSortType
    mcSubSortLast = 433,
    mcReverse = 441,
    mcFollowFocus = 442,
    mcFindDuplicates = 501,
    mcSearchNew = 502,
    mcReadBackupCd = 503,
    mcVerifyLengths = 504,
    mcFindSimilarArtists = 505,
    mcFindDuplicatesOfArtists = 506,
    mcPrepareBurning = 507,
    mcLoadLyrics = 508,
    mcEnterLength = 509,
    mcConvert = 510,
    mcCacheCdSongs = 512,
    mcDropCaches = 513,
    mcRenameCds = 514,
    mcFindDuplicatesOfMarked = 515,
    mcTagsSubmenu = 600,
    mcSetFlag = 601,
    mcRemoveFlag = 602,
    mcRemoveTags = 603,
    mcRereadTags = 604,
    mcRenameByPattern = 605,
    mcEditBannList = 606,
    mcTagsFromNames = 607,
    mcConvertMarked = 608,
    mcCorrect = 609,
    mcAllSongsSubmenu = 610,
    mcAdaptAllGenres = 611,
    mcSetFlagOfAll = 612,
    mcRemoveFlagOfAll = 613,
    mcRemoveAllTags = 614,
    mcRereadAllTags = 615,
    mcCorrectAll = 616,
};

using DatabaseCommand = ComponentCommand<TMusicDatabase>;
using DatabaseCommands = std::span<const DatabaseCommand>;

// One list a capability.
extern const DatabaseCommands kFileCommands;
extern const DatabaseCommands kIntakeCommands;
extern const DatabaseCommands kFindCommands;
extern const DatabaseCommands kSongFileCommands;
extern const DatabaseCommands kOrderCommands;
extern const DatabaseCommands kOverviewCommands;
extern const DatabaseCommands kBatchCommands;
extern const DatabaseCommands kMediaCommands;
extern const DatabaseCommands kDuplicateCommands;
extern const DatabaseCommands kArtistCommands;
extern const DatabaseCommands kBackupCommands;
extern const DatabaseCommands kPlayCommands;
