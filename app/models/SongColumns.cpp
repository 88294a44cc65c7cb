#include "app/models/SongColumns.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

constexpr SongColumn kColumns[] = {
    {Id::Title, 34, Qt::AlignLeft},
    {Id::Artist, 24, Qt::AlignLeft},
    {Id::Album, 24, Qt::AlignLeft},
    {Id::Year, 7, Qt::AlignRight},
    {Id::Length, 9, Qt::AlignRight},
    {Id::MainGenre, 18, Qt::AlignLeft},
    {Id::Genre, 18, Qt::AlignLeft, false},
    {Id::Track, 7, Qt::AlignRight},
    {Id::BitRate, 14, Qt::AlignRight},
    {Id::SampleRate, 12, Qt::AlignRight},
    {Id::Channels, 12, Qt::AlignLeft, false},
    {Id::Format, 25, Qt::AlignLeft},
    {Id::PlayCount, 11, Qt::AlignRight},
    {Id::Comment, 20, Qt::AlignLeft},
    {Id::AddTime, 21, Qt::AlignLeft},
    {Id::Flags, 20, Qt::AlignLeft},
    {Id::Path, 50, Qt::AlignLeft},
};

}  // namespace

QString SongColumn::Text(const TID3Tag& song) const {
    const QString text = Field().Text(song);
    return Id == SongFieldId::Title && IsCdPath(song.FileName) ? u"[CD] "_s + text : text;
}

std::span<const SongColumn> SongColumns() {
    return kColumns;
}

int ColumnOfSortType(TSortType type) {
    if (type == stAlbumOrder) type = stAlbum;
    const auto sortOf = [](const SongColumn& column) { return column.Field().Sort; };
    const auto found = std::ranges::find(kColumns, std::optional(type), sortOf);
    return found != std::end(kColumns) ? static_cast<int>(found - std::begin(kColumns)) : -1;
}
