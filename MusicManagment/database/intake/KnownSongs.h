#pragma once

#include <QHash>
#include <QString>
#include <optional>
#include <unordered_map>

#include "CommonRUKTools/FolderEntries.h"

class TMusicDatabase;

// Tells, within a run, whether a file is in the collection already, be it under another path that leads to
// the same folder: through a link, or a folder that is mounted in two places.
class KnownSongs {
 public:
    // `database` must live longer.
    explicit KnownSongs(TMusicDatabase& database) : database_(database) {}

    bool Contains(const QString& path);
    // A song has come into the collection.
    void Add(const QString& path);

 private:
    void IndexNames();
    std::optional<FolderIdentity> FolderOf(const QString& path);
    bool IsSameFile(const QString& a, const QString& b);

    TMusicDatabase& database_;
    bool isIndexed_ = false;
    std::unordered_multimap<std::size_t, QString>
        byName_;  // paths, by the hash of the name behind the folder
    QHash<QString, std::optional<FolderIdentity>> folders_;
};
