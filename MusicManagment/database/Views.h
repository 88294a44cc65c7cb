#pragma once

#include <QString>

#include "MusicManagment/database/SongTypes.h"

// What the database tells the song list view directly, after the events of the same meaning.
class SongListView {
 public:
    virtual ~SongListView() = default;
    virtual void SongChanged(SongIndex index, TChangeType change) = 0;  // index -1: all songs
    virtual void SongMoved(SongIndex from, SongIndex to) = 0;           // an existing song was re-placed
    virtual void DatabaseCleared() = 0;
    virtual void PrepareMultiAdd(int count) = 0;
    // The flag bit that the view's flag column shows; it alone counts when sorting by flags.
    virtual quint32 ShownFlag() const = 0;
};

// What the database tells the overview view directly.
class OverviewView {
 public:
    virtual ~OverviewView() = default;
    virtual void OverviewChanged() = 0;
    virtual void OverviewInserted(TOVType type, int row, const QString& caption, int count) = 0;
    virtual void OverviewDeleted(TOVType type, int row) = 0;
    virtual void OverviewUpdated(TOVType type, int row, int count) = 0;
};
