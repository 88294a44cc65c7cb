#pragma once

#include <QString>
#include <optional>

#include "ReadMPEGHeader/asf/Asf.h"
#include "ReadMPEGHeader/asf/AsfCursor.h"

// What the named attributes of a header say ("WM/AlbumTitle", "WM/TrackNumber", ...). The first value of a
// name that says something counts.
struct AsfAttributes {
    QString Title;
    QString Artist;
    QString Album;
    QString Year;
    QString Comment;
    std::optional<quint8> GenreOfName;
    std::optional<quint8> GenreOfId;
    std::optional<quint8> TrackNumber;
    std::optional<quint8> TrackAfterIndex;  // from the older attribute that counts from 0

    // The attributes fill what the content description left empty.
    void Complete(TASFInfo& info) const;
};

// Each reads the body of one object and adds to `attributes`. False when the object is damaged.
bool ReadExtendedContent(AsfCursor& body, AsfAttributes& attributes);
// The metadata object and the metadata library have the same layout.
bool ReadMetadata(AsfCursor& body, AsfAttributes& attributes);
