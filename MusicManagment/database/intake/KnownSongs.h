#pragma once

#include <QHash>
#include <QString>
#include <optional>
#include <unordered_map>

#include "CommonRUKTools/FolderEntries.h"

class TMusicDatabase;
struct TID3Tag;

// Tells, within a run, whether a file is in the collection already, be it under another path that leads to
// the same folder: through a link, or a folder that is mounted in two places. A song on a medium that is
// mounted is known where it lies now, and by its copy on the disk.
class KnownSongs {
 public:
    // `database` must live longer.
    explicit KnownSongs(TMusicDatabase& database) : database_(database) {}

    // `path` is where the file lies, `stored` the path under which it would be stored.
    bool Contains(const QString& path, const QString& stored);
    // A song has come into the collection.
    void Add(const QString& path, const QString& stored);

 private:
    struct Known {
        QString Path;    // where its file lies
        QString Stored;  // its path in the collection
    };

    void IndexNames();
    void IndexCopies();
    void AddToIndex(const TID3Tag& song);
    std::optional<FolderIdentity> FolderOf(const QString& path);
    bool IsSameFile(const QString& a, const QString& b);

    TMusicDatabase& database_;
    bool isIndexed_ = false;
    std::unordered_multimap<std::size_t, Known> byName_;  // by the hash of the name behind the folder
    QHash<QString, std::optional<FolderIdentity>> folders_;
};
