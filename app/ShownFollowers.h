#pragma once

#include <QString>
#include <vector>

#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/playlist/PlayList.h"

// After a double click in the song list the songs that followed there are played too. They come into the
// playlist, behind what waits there, one by one as others begin: a click on the first of 20,000 songs does
// not bury the user's list.
class ShownFollowers : public SettingsClient {
 public:
    static constexpr std::size_t kMost = 10'000;  // songs that are remembered
    // In the queue at a time: where one cannot be played the next is at hand.
    static constexpr std::size_t kAhead = 2;

    // `list` has a database.
    explicit ShownFollowers(TPlayList& list) : list_(list) {}

    // Whether only the song itself is played.
    bool OnlyThisSong() const { return onlyThisSong_; }
    void SetOnlyThisSong(bool value) { onlyThisSong_ = value; }

    // The songs, by name; the first of them plays.
    void Begin(std::vector<QString> songs);
    // What waits to follow waits no longer.
    void End();
    // Another song plays.
    void FollowSong();

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void QueueNext();
    void FollowRenamed(const PathChanges& renamed);

    TPlayList& list_;
    std::vector<QString> songs_;
    Subscription renaming_;    // of the database, while there are songs
    std::size_t waiting_ = 0;  // the first of those in the queue
    std::size_t next_ = 0;     // the one behind them
    bool onlyThisSong_ = false;
};
