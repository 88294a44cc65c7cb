#pragma once

#include <memory>

#include "CommonRUKTools/MenuItem.h"

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

std::unique_ptr<TMenuExItem> BuildPlaySoundMenu();
