#include "app/SongFlags.h"

#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

using namespace Qt::StringLiterals;

void SetSongFlag(TMusicDatabase& database, SongHandle song, quint32 flag, bool on) {
    const TID3Tag* record = database.Songs().Find(song);
    if (record == nullptr) return;
    TID3Tag changed = *record;
    changed.Flags = on ? changed.Flags | flag : changed.Flags & ~flag;
    if (changed == *record) return;
    const BatchResult result = UpdateSongs(database, on ? u"Flag setzen"_s : u"Flag entfernen"_s,
                                           {{.Song = song, .Record = changed}}, Renaming::BySettings);
    if (!result.Failed.isEmpty()) ReportBatch(result);
}
