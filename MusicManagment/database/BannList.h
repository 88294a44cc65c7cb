#pragma once

#include <QString>

#include "CommonRUKTools/SortedTextList.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The songs that the user never wants in the collection again, and the file that keeps them: one entry a line
// in the system's code page, lines end with CR LF.

// What the list knows a song by: artist, " - " and title. Line breaks become spaces, because the file has one
// line an entry.
QString BanEntry(const TID3Tag& record);

// Replaces the list by the file's entries. Any kind of line end is taken, empty lines are passed over.
// Throws EStreamError when the file cannot be read; the list then stays as it was.
void LoadBannList(SortedTextList& list, const QString& path);
// Throws EStreamError; a file that was there then stays as it was.
void SaveBannList(const SortedTextList& list, const QString& path);
