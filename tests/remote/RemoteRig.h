#pragma once

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagmentRemoteControl/RemoteMessages.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/ScriptedBackend.h"
#include "tests/database/SongFolder.h"

// Two songs in the collection and in the list, the first of which plays at its tenth second.
struct PlayingProgram {
    PlayingProgram() {
        for (const char16_t* name : {u"a", u"b"}) {
            TID3Tag record;
            record.Title = QStringLiteral("T\u00E4\u0416");  // "Ж" is not in the legacy code page
            record.Artist = QStringLiteral("Band");
            record.Album = QStringLiteral("Platte");
            record.Comment = QStringLiteral("Text");
            record.Year = QStringLiteral("1999");
            record.Track = 7;
            const QString path = Folder.Add(QString::fromUtf16(name) + QStringLiteral(".wav"));
            Database.AddEntry(path, record);
            List.Insert(List.Count(), {.Name = path, .Record = record});
        }
        List.SetMusicDatabase(&Database);
        Player.SetMusicDatabase(&Database);
        Player.SetPlayList(&List);
        List.PlayEntry(0);
        Song.Position = 10'000;
    }
    QString Path(const QString& name) const { return Folder.Path(name); }

    SongFolder Folder;
    ScriptedDialogs Dialogs;
    ScriptedSong Song;
    TMusicDatabase Database;
    TPlayList List;
    TPlaySound Player{ScriptedEngines(Song)};
};
