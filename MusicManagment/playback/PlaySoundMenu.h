#pragma once

#include <span>

#include "CommonRUKTools/Command.h"

class TPlaySound;

// Numbers of the commands of the player's menu.
enum PlayerCommand : int {
    plPlay = 101,
    plPause = 102,
    plStop = 103,
    plPrevious = 111,
    plNext = 112,
    plBack = 121,
    plForward = 122,
    plMarkSong = 131,
};

using PlayerCommands = std::span<const ComponentCommand<TPlaySound>>;

// One list a capability.
extern const PlayerCommands kSongCommands;
extern const PlayerCommands kFadeCommands;
