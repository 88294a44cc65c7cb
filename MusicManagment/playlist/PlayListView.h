#pragma once

#include <vector>

// What a playlist asks its view: which entries the user means. The view follows the list by its events.
class PlayListView {
 public:
    virtual ~PlayListView() = default;

    // Positions in ascending order.
    virtual std::vector<int> SelectedEntries() const = 0;
    // The entry with the focus; -1 none.
    virtual int CurrentEntry() const = 0;
};
