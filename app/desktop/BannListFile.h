#pragma once

#include "CommonRUKTools/SortedTextList.h"
#include "CommonRUKTools/StandardFiles.h"

// The standard ban list between the start of the program and its end. Entries on the disk are only replaced
// once they have been read.
class BannListFile {
 public:
    BannListFile(SortedTextList& list, const StandardFiles& files) : list_(list), files_(files) {}

    // Throws EStreamError; the program can go on without the list.
    void Load();
    // Does nothing before Load(). Throws EStreamError, also when there are new entries and the old ones could
    // not be read.
    void Save();
    // The user has removed the file: nothing is saved any more.
    void Forget();

 private:
    enum class State { NotLoaded, Loaded, Unreadable };

    SortedTextList& list_;
    const StandardFiles& files_;
    State state_ = State::NotLoaded;
};
