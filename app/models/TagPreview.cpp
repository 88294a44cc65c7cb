#include "app/models/TagPreview.h"

#include <QSet>

#include "MusicManagment/database/SongFields.h"
#include "MusicManagment/database/songfiles/RenameTarget.h"

using namespace Qt::StringLiterals;

namespace {

QString NameOf(const QString& path) {
    return path.mid(LastSeparator(path) + 1);
}

void AddRow(TagPreview& preview, const QString& path, QString field, QString before, QString after) {
    preview.Rows.push_back({path, std::move(field), std::move(before), std::move(after)});
}

void AddFields(TagPreview& preview, const TID3Tag& before, const TID3Tag& after) {
    for (const SongField& field : SongFields()) {
        if (field.Set == nullptr) continue;
        QString old = EditText(field, before);
        QString text = EditText(field, after);
        if (old == text) continue;
        AddRow(preview, before.FileName, QString::fromUtf16(field.Caption), std::move(old), std::move(text));
    }
}

void AddTotal(TagPreview& preview, const QString& path, std::optional<int> before, int after) {
    const auto text = [](int total) { return total > 0 ? QString::number(total) : QString(); };
    AddRow(preview, path, u"Tracks"_s, before ? text(*before) : u"?"_s, text(after));
}

void AddCover(TagPreview& preview, const QString& path, const CoverChange& change) {
    const bool removed = std::holds_alternative<CoverRemoval>(change);
    AddRow(preview, path, u"Cover"_s, {}, removed ? u"(wird entfernt)"_s : u"(neues Bild)"_s);
}

// Whole paths where the folder is another one.
void AddPath(TagPreview& preview, const QString& path, const QString& target) {
    const bool moves = FolderOf(path) != FolderOf(target);
    AddRow(preview, path, moves ? u"Ort"_s : u"Name"_s, moves ? path : NameOf(path),
           moves ? target : NameOf(target));
    if (preview.Renamed++ == 0) preview.NewPath = target;
}

QString Quoted(const QString& text) {
    QString line = text;
    return text.isEmpty() ? u"(leer)"_s : line.replace(u'\n', u' ');
}

}  // namespace

TagPreview PreviewOf(const TMusicDatabase& database, const std::vector<SongUpdate>& updates,
                     const TrackTotalOf& totalOf) {
    TagPreview preview;
    QSet<QString> targets;
    for (const SongUpdate& update : updates) {
        const TID3Tag* record = database.Songs().Find(update.Song);
        if (record == nullptr) continue;
        ++preview.Songs;
        const QString& path = record->FileName;
        AddRow(preview, path, {}, NameOf(path), {});
        AddFields(preview, *record, update.Record);
        if (update.TrackTotal) AddTotal(preview, path, totalOf(update.Song), *update.TrackTotal);
        if (update.Cover) AddCover(preview, path, *update.Cover);
        const QString target = RenameTarget(database, path, update.Record);
        if (target.compare(path, Qt::CaseInsensitive) == 0) continue;
        AddPath(preview, path, target);
        const bool isTaken = database.Contains(target) || targets.contains(target.toLower());
        if (isTaken) preview.Rows.back().New += u" (gibt es schon)"_s;
        targets.insert(target.toLower());
    }
    return preview;
}

QString PreviewLine(const TagPreviewRow& row) {
    if (row.Field.isEmpty()) return row.Old;
    if (row.Field == u"Cover"_s) return row.Field + u": "_s + row.New;
    return row.Field + u": "_s + Quoted(row.Old) + u" → "_s + Quoted(row.New);
}

QString PreviewSummary(const TagPreview& preview, const QString& button) {
    if (preview.Songs == 0) return u"„%1“ ändert nichts."_s.arg(button);
    const QString songs = SongCountText(static_cast<std::size_t>(preview.Songs));
    if (preview.Renamed == 0) return u"„%1“ ändert %2 und benennt keine Datei um."_s.arg(button, songs);
    if (preview.Renamed > 1)
        return u"„%1“ ändert %2 und benennt %3 Dateien um."_s.arg(button, songs).arg(preview.Renamed);
    return u"„%1“ ändert %2 und benennt eine Datei um. Neuer Name: %3"_s.arg(button, songs,
                                                                             NameOf(preview.NewPath));
}
