#pragma once

#include <span>

#include "CommonRUKTools/Command.h"

class TPlayList;

// Numbers of the commands of the playlist's menu.
enum PlayListCommand : int {
    pcNew = 101,
    pcOpen = 102,
    pcSave = 103,
    pcSaveAs = 104,
    pcExportAsLinks = 105,
    pcRemoveSelected = 201,
    pcMarkCurrent = 202,
    pcRemoveUnavailable = 203,
};

using PlayListCommands = std::span<const ComponentCommand<TPlayList>>;

// One list a capability.
extern const PlayListCommands kListFileCommands;
extern const PlayListCommands kEntryCommands;
