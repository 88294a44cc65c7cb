#pragma once

#include <QByteArray>
#include <QString>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// What the playlists made of text have in common: lines, and how a song is named in them.

// Cut at CR or LF; empty lines are left out.
std::vector<ByteSpan> ListLines(ByteSpan bytes);

// "http://..." and its like.
bool IsAddress(const QString& text);

// The name of the entry that a text stands for. A relative name is made absolute against the current folder,
// a file: address becomes a path. Left as they are: other addresses (http), paths with a drive letter, paths
// on catalogued CDs, and names of one character.
QString NameFromList(const QString& text);
QString NameFromList(ByteSpan text);

// The text for a song's path in the system's code page: a file: address where the path itself would not read
// back, because it has line ends in it or blanks at an end.
QByteArray PathForList(const QString& path);
// "artist - title" on one line.
QByteArray TitleForList(const QString& artist, const QString& title);
