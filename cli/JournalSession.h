#pragma once

#include "MusicManagment/database/journal/Journal.h"
#include "cli/Console.h"

// What a command that changes files needs: the journal beside the standard files, in use as long as this
// exists. What an earlier program has left half done is taken back, and told.
class JournalSession {
 public:
    // Throws EStreamError when the journal cannot be read.
    explicit JournalSession(Console& console);
    ~JournalSession();
    JournalSession(const JournalSession&) = delete;
    JournalSession& operator=(const JournalSession&) = delete;

    Journal& Get() { return journal_; }

 private:
    Journal journal_;
};

// Brings a database that is to be changed and saved into agreement with the files: a program that was ended
// may not have saved what it had done. Returns how many songs have changed. Throws EStreamError when the
// journal cannot be read.
int CatchUp(TMusicDatabase& database, Console& console);
