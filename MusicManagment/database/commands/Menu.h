#pragma once

#include <memory>

#include "CommonRUKTools/MenuItem.h"

class TMusicDatabase;

// Numbers of the commands of the database menu.
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
    mcSortSubmenu = 410,
    mcSortFirst = 411,  // to 423, in the order of TSortType
    mcSortLast = 423,
    mcSubSortSubmenu = 430,
    mcSubSortFirst = 431,  // to 433, in the order of TSubSortType
    mcSubSortLast = 433,
    mcReverse = 441,
    mcFollowFocus = 442,
    mcSearchNew = 502,
};

// Builds the command menu of a database; without the items that write when it is read-only.
std::unique_ptr<TMenuExItem> BuildDatabaseMenu(bool readOnly);

// Sets the marks of the items that show the state of the database, and disables its commands while a run has
// locked the menu.
void UpdateDatabaseMenu(TMenuExItem& menu, const TMusicDatabase& database);

// Runs the operation behind a command. False when it is none of the engine's: the shell's, or of a later
// version. Throws what the operation throws.
bool RunDatabaseCommand(TMusicDatabase& database, int id);
