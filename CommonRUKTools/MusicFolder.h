#pragma once

#include <QString>

// The folder in which the user keeps music, as the system or else its name tells ("Musik", "Music"); of
// several the first that holds something. Where there is none, the one that the system would make.
QString MusicFolder();
// The same for a folder that the system names and a home folder.
QString MusicFolder(const QString& named, const QString& home);
