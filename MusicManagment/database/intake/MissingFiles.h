#pragma once

#include <QHash>
#include <QSet>
#include <QString>
#include <QStringList>
#include <vector>

// A folder whose songs are all missing at once.
struct EmptiedFolder {
    QString Folder;
    QStringList Songs;
};

// Looks for the files of songs, and tells of those that are missing whether they were removed or may only be
// out of reach. Ask for all songs first, then for what was found.
class MissingFiles {
 public:
    // Nothing below an update folder that is not there is ever missing.
    explicit MissingFiles(const QStringList& updateFolders);

    // The update folders that are there. One without any entry does not count: that is what the mount point
    // of an unplugged disk looks like.
    const QStringList& FoldersThere() const { return there_; }

    bool IsThere(const QString& song);

    // Missing songs from whose folders others are still there.
    QStringList Single() const;
    // The other missing songs by folder; of folders that are gone the topmost stands for all.
    std::vector<EmptiedFolder> ByFolder() const;
    // Folders that look like an unplugged disk, whose songs are no missing ones.
    QStringList OutOfReach() const;

 private:
    enum class State { There, Gone, OutOfReach };
    struct Folder {
        State Is;
        QString Top;  // the topmost folder that is like this
    };
    struct Missing {
        QString Song;
        QString Folder;
    };

    Folder Look(const QString& folder);
    Folder LookAtDisk(const QString& folder);

    QStringList there_;
    QStringList notThere_;
    QHash<QString, Folder> folders_;  // what is known of them
    QSet<QString> living_;            // folders with a song that is there
    QSet<QString> outOfReach_;
    std::vector<Missing> missing_;
};
