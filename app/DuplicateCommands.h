#pragma once

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "app/views/DuplicatesForm.h"

class Playing;
class QMenu;
class SongListWidget;

// The search for duplicates: its commands, its window, and what becomes of the songs about which the user has
// decided there.
class DuplicateCommands {
 public:
    DuplicateCommands(TMusicDatabase& database, SongListWidget& list, Playing& playing);
    ~DuplicateCommands();
    DuplicateCommands(const DuplicateCommands&) = delete;
    DuplicateCommands& operator=(const DuplicateCommands&) = delete;

    DuplicatesForm& Form() { return *form_; }
    // Adds the item that shows the window.
    void AddTo(QMenu& menu);

 private:
    void HandleCommands();
    void SetUpForm();
    void Search(DuplicateQuery query);
    void SearchAgain();
    void Decide(PairDecision decision, const std::vector<DuplicatePair>& pairs);
    void Replace(const std::vector<SongReplacement>& replacements);
    void KeepBoth(const std::vector<DuplicatePair>& pairs);
    void Ban(const std::vector<DuplicatePair>& pairs);
    void Suggest(const std::vector<DuplicatePair>& pairs);
    void Listen(SongHandle song, SongHandle instead);
    void Tell(const BatchResult& result);

    TMusicDatabase& database_;
    SongListWidget& list_;
    Playing& playing_;
    DuplicatesForm* form_;
    DuplicateQuery query_;  // the last one
    Subscriptions handlers_;
};
