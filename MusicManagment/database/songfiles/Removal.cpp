#include "MusicManagment/database/songfiles/Removal.h"

#include <QSet>

#include "MusicManagment/database/CollectionEdit.h"
#include "MusicManagment/database/journal/FileBatch.h"

int RemoveSongs(TMusicDatabase& database, const QStringList& paths) {
    const QSet<QString> wanted(paths.begin(), paths.end());
    CollectionEdit edit(database);
    for (const auto& song : database.Songs())
        if (wanted.contains(song->FileName)) edit.Remove(database.Songs().HandleOf(*song));
    edit.Commit();
    return static_cast<int>(edit.Done().size());
}

int RemoveSongs(Journal& journal, TMusicDatabase& database, const std::vector<SongHandle>& songs,
                const QString& caption) {
    FileBatch batch(&journal, &database, caption);
    for (const SongHandle song : songs)
        if (const TID3Tag* record = database.Songs().Find(song))
            batch.Add(std::move(FileItem().Record(*record, std::nullopt)));
    batch.Finish();
    if (!batch.Failures().isEmpty()) throw EStreamError(batch.Failures().front());
    return batch.ItemsDone();
}
