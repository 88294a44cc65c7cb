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
