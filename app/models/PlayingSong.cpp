#include "app/models/PlayingSong.h"

#include <QFileInfo>

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playlist/PlayList.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

PlayingSong SongNamed(const QString& name, const TPlayList& list) {
    PlayingSong song{.FileName = name};
    const auto take = [&song](const TID3Tag& record) {
        song.Title = record.Title;
        song.Artist = record.Artist;
        song.Album = record.Album;
        song.Track = record.Track;
        song.PlayCount = record.PlayCount;
        song.Seconds = record.Length;
    };
    const TMusicDatabase* database = list.MusicDatabase();
    const SongIndex known = database != nullptr ? database->IndexOf(name) : -1;
    if (known >= 0) take(database->Song(known));
    if (const int entry = list.IndexOf(name); entry >= 0 && list.Entry(entry).Record) {
        const qint64 counted = song.PlayCount;
        take(*list.Entry(entry).Record);
        if (known >= 0) song.PlayCount = counted;
    }
    if (song.Title.isEmpty()) song.Title = QFileInfo(name).completeBaseName();
    return song;
}

PlayingSong SongOf(const TPlaySound& player, const TPlayList& list) {
    if (player.FileName().isEmpty()) return {};
    return SongNamed(player.FileName() == list.CurrentFile() ? list.CurrentSong() : player.FileName(), list);
}

QString OneLine(const PlayingSong& song) {
    return TitleBehindArtist(song.Artist, song.Title);
}
