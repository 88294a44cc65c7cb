#pragma once

#include <QString>
#include <Qt>
#include <span>

#include "MusicManagment/database/SongFields.h"

// A column of the song list: how a field of the songs is shown there.
struct SongColumn {
    SongFieldId Id;
    int Width;  // at first, in average characters
    Qt::AlignmentFlag Alignment;
    bool Shown = true;  // at first

    const SongField& Field() const { return FieldOf(Id); }
    QString Caption() const { return QString::fromUtf16(Field().ShortCaption); }
    QString Text(const TID3Tag& song) const;
};

// All columns, from left to right, in the order of their ids.
std::span<const SongColumn> SongColumns();
// The column that shows what songs are sorted by; -1 when none does.
int ColumnOfSortType(TSortType type);
