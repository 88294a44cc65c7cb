#pragma once

#include <QString>
#include <memory>

#include "CommonRUKTools/FileLock.h"

class TMusicDatabase;

// Who may write the file of a database. Two programs that have read one file would overwrite each other's
// changes, so the first to open it for writing holds its lock as long as it has it open, and for a later one
// the database is read-only. Asks for no lock unless it is wanted, as in a new component.
class DatabaseLock {
 public:
    explicit DatabaseLock(TMusicDatabase& database) : database_(database) {}

    bool IsWanted() const { return wanted_; }
    void SetWanted(bool value) { wanted_ = value; }

    // From now on the database is the one in this file: takes the file's lock and gives up the former one.
    // When somebody else has it the user is told, and the database becomes read-only.
    void Claim(const QString& path);
    // The database is no file's any more.
    void Release();
    // Whether somebody else writes the file of the database.
    bool IsElsewhere() const { return lock_ && !lock_->IsTaken(); }

    // A lock for as long as `path` is written; nullptr when none is needed. Throws EMusicDatabaseException
    // when somebody else has it.
    std::unique_ptr<FileLock> ForSaving(const QString& path) const;
    // What was saved under that lock is the database's own file now.
    void Adopt(std::unique_ptr<FileLock> lock);

 private:
    TMusicDatabase& database_;
    bool wanted_ = false;
    bool wasReadOnly_ = false;  // before somebody else was found to write the file
    std::unique_ptr<FileLock> lock_;
};
