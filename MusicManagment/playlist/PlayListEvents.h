#pragma once

#include <vector>

#include "CommonRUKTools/Listeners.h"

// What a playlist tells everybody who has subscribed, each after it has happened. Positions are those of
// then.
struct PlayListEvents {
    Listeners<int> Inserted;                   // where the new entry stands
    Listeners<int> Changed;                    // whose record was read anew, or whose file was renamed
    Listeners<int> Removed;                    // where the entry stood
    Listeners<const std::vector<int>&> Moved;  // where the entry of each position stood before
    Listeners<> Cleared;                       // the list was emptied
    Listeners<> Loaded;                        // it has become another list
    Listeners<> CurrentChanged;                // another entry plays, or its player has begun anew
    Listeners<> QueueChanged;
    Listeners<> NameChanged;     // the name of the file, or whether there is anything to save
    Listeners<> OptionsChanged;  // order, repetition, intro scan, copies, rules for lists
};
