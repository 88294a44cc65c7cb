#pragma once

#include <QString>
#include <QStringList>

// Makes the folder, with all that are missing above it, and in it a link to each song, which the file manager
// opens with a double click as it opens the song: a symbolic link, on Windows a shortcut. It has the song's
// name; where another file has it already, a number is added. A link to the same song that is there already
// serves. Throws EStreamError.
void WriteLinkFolder(const QString& folder, const QStringList& paths);
