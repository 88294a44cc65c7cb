#pragma once

#include <QString>
#include <QStringList>

#include "ReadMPEGHeader/ID3Tag.h"

// The record that a file's name makes: "Artist - Title.mp3", or the title alone in a folder named after the
// artist. `excludedFolders` holds, in capitals, names of folders that are no artists. All fields but file
// name, title and artist have their defaults; the file time is 0.
TID3Tag TagFromFileName(const QString& path, const QStringList& excludedFolders);
