#pragma once

#include <QString>
#include <functional>
#include <optional>
#include <vector>

#include "MusicManagment/database/songfiles/SongUpdates.h"

// What a change of one song's field is about to do. A row without a field begins a song.
struct TagPreviewRow {
    QString File{};   // its path
    QString Field{};  // caption; empty in the row of the file itself
    QString Old{};
    QString New{};
};

struct TagPreview {
    std::vector<TagPreviewRow> Rows{};  // song by song
    int Songs = 0;                      // that change
    int Renamed = 0;                    // files that will have another path
    QString NewPath{};                  // of the first of these
};

// The total in a song's file; nothing when it is not known.
using TrackTotalOf = std::function<std::optional<int>(SongHandle)>;

// What `updates` will do, with the renaming that the settings of the database ask for.
TagPreview PreviewOf(const TMusicDatabase& database, const std::vector<SongUpdate>& updates,
                     const TrackTotalOf& totalOf);

// "Album: Sommer → Winter"
QString PreviewLine(const TagPreviewRow& row);
// What all of it is, in a sentence that names the button which does it.
QString PreviewSummary(const TagPreview& preview, const QString& button);
