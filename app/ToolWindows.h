#pragma once

#include <functional>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/SongList.h"
#include "app/models/GroupSelection.h"

class QDockWidget;
class QMainWindow;
class QMenu;
class TID3TagForm;
class TMusicDatabase;
class TOverviewForm;
class TPropertyForm;

// The windows that dock at the main window, and what they follow. Handles the commands that the overview
// serves.
class ToolWindows {
 public:
    // The windows belong to `window`.
    ToolWindows(QMainWindow& window, TMusicDatabase& database);

    // Told when other groups are chosen in the overview.
    std::function<void(const GroupSelection&)> OnSelectionChanged;

    // Shows a song of the database in the window of its properties, which follows its changes; nullptr for
    // none.
    void ShowSong(const TID3Tag* song);
    // Puts the sheets behind a window at the same edge: beside it they would be too low.
    void LieBehind(QDockWidget& front);
    // The editor of the marked songs' tags.
    TID3TagForm& TagForm() { return *tag_; }
    // Adds the items that show and hide the windows.
    void AddTo(QMenu& menu);

 private:
    void HandleCommands(TMusicDatabase& database);
    void FollowSong();

    QMainWindow& window_;
    TMusicDatabase& database_;
    TOverviewForm* overview_;
    TPropertyForm* properties_;
    TID3TagForm* tag_;
    SongHandle song_;
    Subscriptions handlers_;
    Subscriptions subscriptions_;
};
