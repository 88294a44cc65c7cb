#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <set>
#include <vector>

#include "CommonRUKTools/FolderEntries.h"

struct FolderWalkOptions {
    bool WithSubfolders = true;
    // Whether a file of this name is looked for.
    std::function<bool(const QString& name)> IsWanted{};
    // Told of each folder, and again every few hundred entries of a large one; true stops the walk.
    std::function<bool(const QString& folder)> Progress{};
};

// Collects the wanted files of folders. The files of a folder come before those of its sub-folders, both
// sorted by name. Each folder is entered once, however many links lead to it and however often Walk is
// called. Links to files are files under the link's own name. Recycle bins and folders that belong to the
// system are entered only when Walk is called for them.
class FolderWalk {
 public:
    explicit FolderWalk(FolderWalkOptions options) : options_(std::move(options)) {}

    // Appends what it finds; false when the walk was stopped. `folder` is a clean absolute path.
    bool Walk(const QString& folder, QStringList& files);
    // What could not be read so far: folders, and wanted files that have an impossible name or are none; each
    // with the reason.
    const QStringList& Unreadable() const { return unreadable_; }

 private:
    struct Found;

    bool Visit(const QString& folder, QStringList& files);
    bool ReadEntries(const QString& folder, Found& found);
    void Sort(const FolderEntry& entry, const QString& prefix, Found& found);

    FolderWalkOptions options_;
    std::set<FolderIdentity> entered_;
    std::vector<QString> waiting_;  // folders still to be walked, the next one last
    QStringList unreadable_;
};
