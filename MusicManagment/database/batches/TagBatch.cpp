#include "MusicManagment/database/batches/TagBatch.h"

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/batches/BatchFrame.h"
#include "MusicManagment/database/batches/FilesAhead.h"
#include "ReadMPEGHeader/FileNameTag.h"

using namespace Qt::StringLiterals;

namespace {

constexpr BatchTexts kRemoving = {.All = u"ID3-Tags aller Songs entfernen",
                                  .Marked = u"ID3-Tags aller markierter Songs entfernen",
                                  .One = u"ID3-Tag entfernen"};
constexpr BatchTexts kRereading = {.All = u"ID3-Tags aller Songs neu einlesen",
                                   .Marked = u"ID3-Tags aller markierter Songs neu einlesen",
                                   .One = u"ID3-Tag neu einlesen"};

QString SongsOf(BatchRange range) {
    switch (range) {
        case BatchRange::All:
            return u"die ID3-Tags aller Dateien"_s;
        case BatchRange::Marked:
            return u"die ID3-Tags aller markierter Dateien"_s;
        case BatchRange::One:
            break;
    }
    return u"der ID3-Tag dieser Datei"_s;
}

QString Verb(BatchRange range) {
    return range == BatchRange::One ? u"Soll wirklich "_s : u"Sollen wirklich "_s;
}

// What stays of a record when its tags are read anew.
void KeepCollectionFields(const TID3Tag& song, TID3Tag& record) {
    record.FileName = song.FileName;
    record.PlayCount = song.PlayCount;
    record.Reserved = song.Reserved;
    record.Flags = song.Flags;
    record.MainGenre = song.MainGenre;
    record.AddTime = song.AddTime;
}

TID3Tag WithoutTags(const TMusicDatabase& database, const TID3Tag& song) {
    TID3Tag record = song;
    const TID3Tag named = TagFromFileName(song.FileName, database.AudioReadOptions().ExcludedArtistFolders);
    record.Title = named.Title;
    record.Artist = named.Artist;
    record.Album = named.Album;
    record.Year = named.Year;
    record.Comment = named.Comment;
    record.Genre = named.Genre;
    record.Track = named.Track;
    record.Remix = false;
    return record;
}

}  // namespace

bool MayRemoveTags(BatchRange range) {
    return UserDialogs().Confirm(
        Verb(range) + SongsOf(range) + u" entfernen werden?\n\nAuch die Bilder darin gehen."_s,
        u"Entfernen"_s);
}

bool MayRereadTags(BatchRange range) {
    return UserDialogs().Confirm(Verb(range) + SongsOf(range) + u" neu eingelesen werden?"_s,
                                 u"Neu einlesen"_s);
}

BatchResult RemoveTags(TMusicDatabase& database, const BatchSongs& songs) {
    return RunUpdates(database, songs, kRemoving, u"ID3-Tags entfernen"_s, Renaming::Never,
                      [&](const TID3Tag& song) -> std::optional<SongUpdate> {
                          SongUpdate update;
                          update.Record = WithoutTags(database, song);
                          update.Tags = TagAction::Remove;
                          return update;
                      });
}

BatchResult RereadTags(TMusicDatabase& database, const BatchSongs& songs) {
    QStringList unread;
    FilesAhead<SongReading> files(
        database, songs,
        [options = database.AudioReadOptions()](const QString& path) { return ReadSong(path, options); });
    const auto maker = [&](const TID3Tag& song) -> std::optional<SongUpdate> {
        auto reading = files.Next();
        if (!reading) return std::nullopt;
        if (!reading->Succeeded()) {
            unread << song.FileName + u": "_s + reading->Failure();
            return std::nullopt;
        }
        SongUpdate update;
        update.Record = std::move(reading->Tag);
        KeepCollectionFields(song, update.Record);
        update.Tags = TagAction::Leave;
        if (update.Record == song) return std::nullopt;
        return update;
    };
    BatchResult result =
        RunUpdates(database, songs, kRereading, u"ID3-Tags neu einlesen"_s, Renaming::Never, maker);
    result.Failed = unread + result.Failed;
    return result;
}
