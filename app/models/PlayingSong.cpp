#include "app/models/PlayingSong.h"

#include <QFileInfo>

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playlist/PlayList.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

std::optional<TID3Tag> RecordOf(const QString& name, const TPlayList& list) {
    const int entry = list.IndexOf(name);
    if (entry >= 0 && list.Entry(entry).Record) return list.Entry(entry).Record;
    const TMusicDatabase* database = list.MusicDatabase();
    const SongIndex song = database != nullptr ? database->IndexOf(name) : -1;
    if (song < 0) return std::nullopt;
    return database->Song(song);
}

}  // namespace

PlayingSong SongOf(const TPlaySound& player, const TPlayList& list) {
    if (player.FileName().isEmpty()) return {};
    const bool listed = player.FileName() == list.CurrentFile();
    PlayingSong song{.FileName = listed ? list.CurrentSong() : player.FileName()};
    if (const auto record = RecordOf(song.FileName, list)) {
        song.Title = record->Title;
        song.Artist = record->Artist;
        song.Album = record->Album;
        song.Track = record->Track;
    }
    if (song.Title.isEmpty()) song.Title = QFileInfo(song.FileName).completeBaseName();
    return song;
}

QString OneLine(const PlayingSong& song) {
    return TitleBehindArtist(song.Artist, song.Title);
}
