#pragma once

#include <QString>
#include <QStringList>

#include "ReadMPEGHeader/ID3Tag.h"

// The name that a pattern such as "%ARTIST% - %TITLE%" gives a song: the folder and the extension of `path`
// are kept, the place-holders are replaced one after the other (a value that itself holds a later
// place-holder is expanded too, on purpose), and the result is made a valid file name. One that is too long
// for a file loses the end of the title, or, where that does not help, its own end; the extension stays.
QString BuildNameFromPattern(const QString& pattern, const QString& path, const TID3Tag& info);

// The place-holders of a pattern, in the order in which they are replaced.
QStringList NamePatternPlaceholders();
