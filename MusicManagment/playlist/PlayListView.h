#pragma once

#include <vector>

// The view of a playlist, as the playlist knows it. What is in the list the view learns by
// TPlayList::OnChange.
class PlayListView {
 public:
    virtual ~PlayListView() = default;

    // Positions in ascending order.
    virtual std::vector<int> SelectedEntries() const = 0;
    // The entry with the focus; -1 none.
    virtual int CurrentEntry() const = 0;
    // Reads the whole list anew.
    virtual void Refresh() = 0;
    // Shows the same entries anew: the current song or the queue has changed.
    virtual void Redraw() = 0;
};
