#pragma once

#include <memory>

#include "CommonRUKTools/MenuItem.h"

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

std::unique_ptr<TMenuExItem> BuildPlayListMenu();
