#pragma once

#include <QDBusObjectPath>
#include <QVariantMap>

#include "MusicManagment/playlist/PlayListTypes.h"
#include "app/models/PlayingSong.h"

// How the bus names an entry of the playlist; 0: no track at all.
QDBusObjectPath TrackOfEntry(EntryId entry);
// 0 when it names none.
EntryId EntryOfTrack(const QDBusObjectPath& track);

// What the bus is told of a song, in the words of
// https://www.freedesktop.org/wiki/Specifications/mpris-spec/metadata/. `milliseconds`: 0 unknown; `coverUrl`
// may be empty.
QVariantMap MprisMetadata(const QDBusObjectPath& track, const PlayingSong& song, qint64 milliseconds,
                          const QString& coverUrl = QString());
