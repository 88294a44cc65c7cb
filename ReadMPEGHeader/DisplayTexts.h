#pragma once

#include <QString>

#include "ReadMPEGHeader/ID3Tag.h"

// Texts in which the fields of a record are shown.

// "Artist - Title": what a song is called in a message, and what its name is compared by. The dash stays
// where one of them is missing.
QString ArtistAndTitle(const QString& artist, const QString& title);
QString ArtistAndTitle(const TID3Tag& song);
// The same for the eye: without an artist the title alone.
QString TitleBehindArtist(const QString& artist, const QString& title);

// "45 s", "3:05", "1:00:00"; with `alwaysClock` "0:45". Seconds, not negative.
QString FormatLength(int seconds, bool alwaysClock);
QString FormatBitRate(int kbits);
QString FormatSampleRate(int hertz);
QString FormatChannelMode(int mode);
QString FormatEmphasis(int emphasis);
// "Private, Original"; empty when no bit is set.
QString FormatHeaderFlags(const TID3Tag& tag);
// For containers that count channels (WAV, WMA).
QString FormatChannelCount(int count);

// The genre as people know it: the long name of the main genre; where that is unknown the tag's genre.
QString GenreDisplayText(const TID3Tag& tag);

// Exactly four characters, each a digit or a capital letter A to Z.
bool IsValidYearText(const QString& text);
// The year that a text means: two digits below 21 are in this century, 21 to 98 in the last; 0 when no
// number. 99 stays 99: the bound is exclusive on purpose.
int ExpandYear(const QString& text);
