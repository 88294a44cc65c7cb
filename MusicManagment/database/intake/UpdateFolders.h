#pragma once

#include <QString>
#include <QStringList>

class TMusicDatabase;

// The folders in which an update looks for songs.

// Whether the path lies below one of the folders.
bool LiesBelow(const QString& path, const QStringList& folders);

// `folders` and `more` in one list, in which no folder lies below another.
QStringList MergeFolders(QStringList folders, const QStringList& more);

// Remembers folders for later updates; one that lies below a remembered folder is not remembered twice.
void RememberFolders(TMusicDatabase& database, const QStringList& folders);

// Where to search now: for a folder that lies on catalogued media the places where these are mounted, else
// the folder itself. Notes in the side file on which medium each folder lies. With the classic rules the
// folders as they stand.
QStringList FoldersToSearch(TMusicDatabase& database);
