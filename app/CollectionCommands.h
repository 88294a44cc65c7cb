#pragma once

#include <QStringList>
#include <functional>

#include "CommonRUKTools/Listeners.h"
#include "CommonRUKTools/StandardFiles.h"
#include "app/desktop/BannListFile.h"

class TMusicDatabase;
struct IntakeResult;

// What the user can do with the collection as a whole: handles those commands about its file and its intake
// where the program does more than the engine. Each may throw what the database throws.
class CollectionCommands {
 public:
    CollectionCommands(TMusicDatabase& database, StandardFiles files);

    // Told what came of files and folders that were taken in without a report of the engine's own.
    std::function<void(const IntakeResult&)> OnIntake;

    // Told when another collection was opened from its file.
    std::function<void()> OnOpened;

    // Asked before the collection or the program goes; false keeps it.
    std::function<bool()> OnLeave;

    void New();
    void Open();
    void OpenFile(const QString& path);
    void Save();
    void AddFolder();  // with its sub-folders
    void AddPaths(const QStringList& paths);

    // Before the collection goes: the standard database saves its changes, any other asks. False when the
    // user wants to keep it open.
    bool KeepChanges();
    // The same before the program ends, and for the ban list. Changes that cannot be saved are given up only
    // on request.
    bool MayClose();
    // The user has removed the standard database: it is not to come back when the program ends.
    void ForgetStandard();

    const StandardFiles& Files() const { return files_; }
    BannListFile& BannList() { return bannList_; }

 private:
    bool MayLeave() const { return !OnLeave || OnLeave(); }
    bool SaveChanges();
    bool StandardInUse() const;
    bool SaveCurrent();
    void Opened();

    TMusicDatabase& database_;
    StandardFiles files_;
    BannListFile bannList_;
    Subscriptions handlers_;
};
