#pragma once

#include <QString>

// Copies a song into the folder for songs that are being played, which is emptied first. The folder lies
// below the system's temporary folder and is this user's own. `playing` is a file that is still heard while
// the song begins: if it lies there it stays, and a song of the same name gets a name of its own; empty for
// none. Returns the path of the copy, or the song's own when it could not be copied (disk full, folder taken
// by someone else).
QString CopyForPlaying(const QString& path, const QString& playing = QString());
