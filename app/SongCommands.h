#pragma once

#include <functional>
#include <vector>

#include "MusicManagment/database/songfiles/Removal.h"

class SongListWidget;
class TMusicDatabase;

// What the user can do with the songs of the list. Every command may throw what the database throws.
class SongCommands {
 public:
    SongCommands(TMusicDatabase& database, SongListWidget& list);

    // Puts the cursor where searching begins.
    std::function<void()> OnFind;
    // Goes to the next song that was searched for.
    std::function<void()> OnFindNext;
    // Told what came of a command, in a sentence for the status bar.
    std::function<void(const QString&)> OnDone;
    // Told when there is something to bring back, or nothing any more.
    std::function<void(bool)> OnUndoChanged;

    // The commands of the database's menu that need the list. False when the number is none of them.
    bool Run(int id);
    // Brings back what the last removal took out; earlier ones can be undone after it.
    void UndoRemoval();

 private:
    void SetOrder(int id);
    void RemoveChosen();
    void CopyChosen();
    void OpenExternally();
    void Tell(const QString& sentence) const;

    TMusicDatabase& database_;
    SongListWidget& list_;
    std::vector<RemovedSongs> removals_;
};
