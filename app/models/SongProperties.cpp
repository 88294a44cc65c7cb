#include "app/models/SongProperties.h"

#include <QStringList>

#include "MusicManagment/database/SongFields.h"

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

void AddText(std::vector<PropertyRow>& rows, const QString& name, const QString& value) {
    if (!value.isEmpty()) rows.push_back({name, value});
}

std::vector<PropertyRow> Rows(const TID3Tag& song, std::initializer_list<SongFieldId> ids) {
    std::vector<PropertyRow> rows;
    for (const SongFieldId id : ids)
        AddText(rows, QString::fromUtf16(FieldOf(id).Caption), FieldOf(id).Text(song));
    return rows;
}

}  // namespace

std::vector<PropertyRow> PathProperties(const TID3Tag& song) {
    std::vector<PropertyRow> rows;
    AddText(rows, u"Name"_s, song.FileName.mid(LastSeparator(song.FileName) + 1));
    AddText(rows, u"Ordner"_s, FolderOf(song.FileName));
    return rows;
}

std::vector<PropertyRow> TagProperties(const TID3Tag& song) {
    return Rows(song, {Id::Title, Id::Artist, Id::Album, Id::Year, Id::Track, Id::Genre, Id::Comment});
}

std::vector<PropertyRow> TechnicalProperties(const TID3Tag& song) {
    return Rows(song, {Id::Format, Id::Length, Id::BitRate, Id::SampleRate, Id::Channels, Id::Emphasis,
                       Id::HeaderFlags, Id::FrameSize});
}

std::vector<PropertyRow> CollectionProperties(const TID3Tag& song) {
    return Rows(song, {Id::MainGenre, Id::PlayCount, Id::Flags, Id::AddTime});
}

QString PropertyLine(const PropertyRow& row) {
    return row.Name + u": "_s + row.Value;
}

QString PropertyText(const std::vector<PropertyGroup>& groups) {
    QStringList lines;
    for (const PropertyGroup& group : groups) {
        if (group.Rows.empty()) continue;
        if (!lines.isEmpty()) lines << QString();
        lines << group.Caption;
        for (const PropertyRow& row : group.Rows)
            lines << PropertyLine(row);
    }
    return lines.join(u'\n');
}
