#pragma once

#include <QString>

#include "CommonRUKTools/ByteReader.h"

enum class PlayListFormat {
    Native,
    M3u,   // in the system's code page
    M3u8,  // in UTF-8 on every system
    Pls,
    Plain,
};

// What a file is by its first bytes, and where the reader of that format begins.
struct RecognizedList {
    PlayListFormat Format;
    ByteSpan Contents;
};

// A byte-order mark at the head is no part of the list. Of a plain list of nine bytes or more the first nine
// are lost: they were read to recognise it, and lists in use are written with that in mind.
RecognizedList RecognizeList(ByteSpan file);

// The format in which a file of this name is written.
PlayListFormat FormatOfName(const QString& fileName);
// Whether a file of this name is taken for a playlist.
bool IsPlayListName(const QString& fileName);
