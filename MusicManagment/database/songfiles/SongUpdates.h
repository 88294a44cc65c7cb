#pragma once

#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"
#include "ReadMPEGHeader/TagWriting.h"

// The one way from an edit to a song's file, its record and the lists.

// What becomes of the tags in the file.
enum class TagAction {
    Write,   // they tell what the record tells
    Remove,  // ID3v1, ID3v2 and what lies behind the audio; APE stays
    Leave,
};

// What a song is to become.
struct SongUpdate {
    SongHandle Song{};
    // The record that the update was made from, and as it is to be; paths do not count. Only what differs
    // changes: a play that was counted meanwhile stays counted.
    TID3Tag Basis{};
    TID3Tag Record{};
    std::optional<int> TrackTotal{};  // for the tag; nothing: the one that stands there stays
    std::optional<CoverChange> Cover{};
    TagAction Tags = TagAction::Write;
};

enum class Renaming { Never, BySettings };

// What came of the songs of a command.
struct BatchResult {
    int Changed = 0;
    int Renamed = 0;
    QStringList Failed;    // path and reason
    bool Stopped = false;  // by the user: in a question or at a progress point
};

// Each command is one step that can be taken back, a long operation with progress, and saves at its end where
// AutoSave says so. A song whose file cannot be changed is named in the result and stays as it was, the
// others go on. `caption` is what was done, as undo names it: "40 Tags". Throws EAbort, after telling the
// user, when another operation runs or another program changes files.

// Changes tags and records and then, when asked, renames. `progress` is the heading of the operation.
BatchResult UpdateSongs(TMusicDatabase& database, const QString& caption,
                        const std::vector<SongUpdate>& updates, Renaming renaming,
                        const QString& progress = QString());

// A new path for the file of each song; the same as it has means nothing.
struct SongMove {
    SongHandle Song{};
    QString Target{};
};
BatchResult MoveSongs(TMusicDatabase& database, const QString& caption, const std::vector<SongMove>& moves);

// Moves the files into the recycle bin and takes the songs out of the collection; the banned ones are not
// taken in again.
enum class Banning { NotBanned, Banned };
BatchResult DiscardSongs(TMusicDatabase& database, const QString& caption,
                         const std::vector<SongHandle>& songs, Banning banning);

// Two songs that hold the same piece of music: one stays, the other goes.
struct SongReplacement {
    SongHandle Kept{};
    SongHandle Dropped{};
};
// Moves the files of the dropped songs into the recycle bin and takes them out of the collection. Their plays
// are added to those of the kept ones, which take their places in the playlist. A song stays where the file
// of the kept one is not there, or where one before has decided otherwise; of a file that has two paths only
// the song goes.
BatchResult ReplaceSongs(TMusicDatabase& database, const QString& caption,
                         const std::vector<SongReplacement>& replacements);

// Another file that holds the piece of music of a song.
struct SongSubstitute {
    SongHandle Song{};
    QString Source{};  // the song's file when the other was made of it
    QString File{};    // the other one; whole, and no song of the collection
    TID3Tag Sound{};   // its record, of which what is about the sound counts
};
// Moves the songs' files into the recycle bin; the songs then have the others, under the names that theirs
// would have by the settings. A file whose song stays as it is goes again.
BatchResult SubstituteFiles(TMusicDatabase& database, const QString& caption,
                            const std::vector<SongSubstitute>& substitutes);

// The database's operation to replace one song's record, a command of its own: returns the song's place, -1
// when it has gone.
SongIndex UpdateSongEntry(TMusicDatabase& database, SongIndex index, const TID3Tag& info, bool rename);
