#pragma once

#include <QByteArray>
#include <vector>

#include "HTTPRetrieval/SearchHit.h"

// The search of MusicBrainz for recordings, as its documentation describes it, and the covers that the Cover
// Art Archive has for its albums.

// Between two requests, milliseconds: the service answers nobody more than once a second, and the second
// request may be faster on its way than the first.
inline constexpr qint64 kMusicBrainzPause = 1100;

// `address` as "https://musicbrainz.org". A query "Artist - Title" looks for that title by that artist, any
// other for its words.
QString MusicBrainzUrl(const QString& address, const QString& query);

// A hit for each album that a recording is on, in the service's order; nothing where the answer is none.
std::optional<std::vector<SearchHit>> ReadMusicBrainz(const QByteArray& json);

// Of the front cover of an album, 500 pixels wide.
QString CoverUrl(const QString& address, const QString& release);
