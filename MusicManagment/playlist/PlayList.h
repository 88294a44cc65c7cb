#pragma once

#include <QList>
#include <QObject>
#include <QPointer>
#include <QSet>
#include <QString>
#include <QStringList>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <random>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/playlist/EntryList.h"
#include "MusicManagment/playlist/ListRules.h"
#include "MusicManagment/playlist/PlayListEvents.h"
#include "MusicManagment/playlist/PlayListTypes.h"

class CommandDispatcher;
class PlayListView;
struct EntryToSave;
class SongPlayer;
class TMenuExItem;

// How one entry is played.
struct PlayOptions {
    SongChange Change = SongChange::Hard;
    SongIndex DatabaseHint = -1;  // where the song probably stands in the database
    bool Record = true;           // put it into the history
};

// The songs to play: which of them comes next, which have been played in this round, which the user wants
// next. Single-threaded. Positions are 0 to Count() - 1.
class TPlayList : public QObject, public SettingsClient {
 public:
    explicit TPlayList(QObject* parent = nullptr);
    ~TPlayList() override;

    // --- Entries, in display order ---
    int Count() const { return entries_.Count(); }
    const PlayListEntry& Entry(int index) const { return entries_.At(index); }
    // The first entry with this name; an empty name means the entry that plays. -1 when it is not listed.
    int IndexOf(const QString& name = QString()) const;
    // The entry itself, wherever it stands later. -1 when it is not listed any more.
    EntryId IdAt(int index) const { return entries_.IdAt(index); }
    int IndexOfId(EntryId id) const { return entries_.Find(id); }
    // Playing time of all entries with a record, in seconds.
    qint64 TotalSeconds() const { return entries_.TotalSeconds(); }

    // Each inserts before `position`, which is brought into the range 0 to Count(). The first takes a song of
    // the database; throws EPlayListException without a database, EMusicDatabaseException for an index that
    // is none of its songs.
    void InsertSong(int position, SongIndex song);
    void Insert(int position, PlayListEntry entry);
    // What a drop brings (Drop.cpp): songs, folders with the songs in them, playlists with their entries. Of
    // songs the record is taken from the database or read from the file. One that takes its time is a long
    // operation of the database, in which the list may change; when the user stops it, the entries that have
    // been read come in. Returns how many were inserted. Throws EPlayListException or EStreamError for a
    // playlist that cannot be read, EAbort while another operation of the database is going.
    int InsertFiles(int position, const QStringList& paths);

    void Remove(int index);
    // Any order, duplicates allowed.
    void Remove(std::vector<int> indices);
    // Begins an empty list and a new round.
    void Clear();
    // Brings these entries, in their order, before the entry that stands at `before` now. Returns where the
    // first of them is then.
    int Move(std::vector<int> indices, int before);
    // Reads the entry's record anew from the database or the file.
    void RefreshRecord(int index, SongIndex databaseHint = -1);
    // Removes each entry whose file is not there now; returns how many.
    int RemoveUnavailable();

    // --- Queue: entries that are played before the order goes on ---
    // Their names, the next one first.
    QStringList Queue() const;
    // Puts entries at the end; one that waits already keeps its place.
    void Enqueue(int index);
    void Dequeue(int index);
    // 0 is played next; -1 not queued.
    int QueuePosition(int index) const;

    // --- Playing (Next.cpp) ---
    // Plays an entry. False when its file cannot be found; the song that plays then plays on. Throws
    // EPlayListException without a player, and what the player throws.
    bool PlayEntry(int index, const PlayOptions& options = {});
    // Plays what queue and order choose; an entry that cannot be played is passed over, and the user is told
    // once a round why. False when there is no next song: the user has been told that too. Throws
    // EPlayListException without a player.
    bool PlayNext(SongChange change = SongChange::Hard);
    // Whether PlayNext would find an entry; tells nobody and changes nothing.
    bool HasNext() const;
    // Goes back to the song that was played before the current one, which becomes the next one. False when
    // there is none.
    bool PlayPrevious(SongChange change = SongChange::Hard);
    bool HasPrevious() const { return history_.size() >= 2; }

    // The entry that plays, by its name in the list; empty before the first. Where it stands: IndexOf().
    const QString& CurrentSong() const { return current_.Name; }
    // The file that the player was given: the song or its copy.
    const QString& CurrentFile() const { return currentFile_; }
    // What was played in this round, the latest first.
    QStringList History() const;
    // Forgets what was played.
    void StartNewRound();
    // Has the database mark the song of an entry; -1 is the entry with the focus in the view. False when the
    // database does not have it.
    bool MarkSong(int index = -1);

    // --- Files (PlayListFiles.h, PlayListCommands.cpp) ---
    const QString& PlayListFileName() const { return playListFileName_; }
    // Whether entries have come, gone or moved, or files of entries were renamed, since the list was loaded
    // or saved.
    bool Modified() const { return modified_; }
    // Loads the list; an empty name begins an empty one. Throws EPlayListException or EStreamError; the list
    // is then as it was, but empty and without a name when the file is of an unknown version.
    void SetPlayListFileName(const QString& fileName);
    // The format goes by the extension. Throws EStreamError; an existing file is then as it was.
    void Save(const QString& fileName);
    // Saves under the known name, or asks for one. False when the user cancelled.
    bool SaveOrAsk(bool askForName = false);
    // For whoever is about to begin or load another list: lets the user save what was changed in this one,
    // or what only the standard file keeps. False when the user wants to keep it.
    bool MayBeReplaced();
    // The file that whichever list is open is kept in from one run of the program to the next. The next list
    // takes its place there, so a list that has no other file asks for a name when it is saved before that.
    void SetStandardFileName(const QString& fileName) { standardFileName_ = fileName; }
    // Makes the folder, and in it a link to each song. Throws EStreamError.
    void ExportAsLinks(const QString& folder);
    // Each asks which, and does nothing when the user cancels.
    void OpenFromDialog();
    void ExportFromDialog();

    // --- Properties ---
    TPlayOrder PlayOrder() const { return playOrder_; }
    void SetPlayOrder(TPlayOrder order) { SetOption(playOrder_, order); }
    // Intro scan: each song is played for ScanTime milliseconds. Both go on to the player.
    bool Scan() const { return scan_; }
    void SetScan(bool scan);
    int ScanTime() const { return scanTime_; }
    void SetScanTime(int milliseconds);
    // Whether a new round begins when all songs have been played.
    bool RepeatAll() const { return repeatAll_; }
    void SetRepeatAll(bool value) { SetOption(repeatAll_, value); }
    // Whether songs are played from a copy in the temporary folder, so that the medium can be taken out.
    bool CopyMp3sBeforePlay() const { return copyMp3sBeforePlay_; }
    void SetCopyMp3sBeforePlay(bool value) { SetOption(copyMp3sBeforePlay_, value); }
    // Whether lists are read as other programs write them (ListRules.h).
    bool ModernLists() const { return rules_ == &kModernLists; }
    void SetModernLists(bool value) { SetOption(rules_, value ? &kModernLists : &kClassicLists); }

    // --- Wiring ---
    TMusicDatabase* MusicDatabase() const { return database_; }
    // The database gets its reference to this list, and keeps its settings. Entries follow its songs to other
    // paths.
    void SetMusicDatabase(TMusicDatabase* database);
    SongPlayer* PlaySound() const { return player_; }
    // A player tells when it goes: SetPlaySound(nullptr).
    void SetPlaySound(SongPlayer* player);
    QObject* RemoteControl() const { return remoteControl_; }
    void SetRemoteControl(QObject* component) { remoteControl_ = component; }
    PlayListView* View() const { return view_; }
    // A view tells when it goes: SetView(nullptr).
    void SetView(PlayListView* view) { view_ = view; }
    // The player opens or shows a song anew: who shows the list does so too.
    void RedrawView();
    // The source of random choices; seeded differently in every run.
    void SetRandom(const std::mt19937& random) { random_ = random; }

    // --- Command menu (PlayListMenu.h) ---
    CommandDispatcher& Commands();
    // Built at the first call.
    TMenuExItem& Menu();
    // Runs the operation behind an item; false when it can do nothing. Throws what it throws.
    bool ClickMenuItem(int id);

    // --- Settings ---
    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;
    void UseRules(Rules rules) override;

    // --- Events ---
    // Everything that happens to the list, for any number of listeners.
    PlayListEvents& Events() { return events_; }
    // A round has ended. `showException` is whether the user is told; false unless the handler sets it.
    std::function<void(TPlayList&, bool& showException)> OnAllFilesPlayed;
    // One more listener. Index -1: the whole list (ctRemoved: it was emptied).
    std::function<void(TPlayList&, int index, TChangeType change)> OnChange;

 private:
    class Search;
    enum class Outcome { Failed, Playing, CurrentGoesOn };

    void ForwardChanges();
    void SetModified(bool modified);
    void SetFile(const QString& fileName);
    template <typename T>
    void SetOption(T& option, T value) {
        if (option == value) return;
        option = value;
        events_.OptionsChanged.Tell();
    }
    const QString& NameAt(int index) const { return entries_.At(index).Name; }
    QString ResolvedPath(const QString& name, const ResolveOptions& options) const;
    QString PlayablePath(const QString& name) const;
    std::optional<TID3Tag> FindRecord(const QString& name, SongIndex databaseHint) const;

    // Next.cpp
    Outcome Play(int index, const PlayOptions& options);
    bool FadeInto(const RememberedEntry& entry, const QString& file);
    void ChangeTo(const RememberedEntry& entry, const QString& file);
    RememberedEntry Remember(int index) const { return {entries_.IdAt(index), NameAt(index)}; }
    QSet<QString> PlayedNames() const;
    bool IsOpen(int index, int current, const QSet<QString>& played) const;
    std::vector<int> RestOfRound(int current);
    void HandleAllPlayed();
    void ReturnTo(const RememberedEntry& entry);
    void RequirePlayer() const;
    void TellReasons(bool found);

    // Drop.cpp
    std::vector<PlayListEntry> EntriesFor(const QStringList& paths) const;

    // Renamed.cpp
    void FollowRenamed(const PathChanges& renamed);

    // PlayListCommands.cpp
    std::vector<PlayListEntry> ReadList(const QString& fileName) const;
    void Replace(std::vector<PlayListEntry> entries, const QString& fileName);
    std::vector<EntryToSave> EntriesForSaving() const;

    PlayListEvents events_;
    Subscriptions forwarding_;  // to OnChange
    Subscriptions renaming_;    // of the database
    EntryList entries_;
    std::deque<RememberedEntry> history_;
    QList<EntryId> queue_;
    RememberedEntry current_;
    QString currentFile_;
    QString playListFileName_;
    QString standardFileName_;
    bool modified_ = false;
    QStringList reasons_;  // why entries failed, still to be told
    QSet<QString> told_;   // songs whose failure the user has been told of in this round
    std::mt19937 random_;

    const ListRules* rules_ = &kClassicLists;
    TPlayOrder playOrder_ = poDownwards;
    int scanTime_ = 10000;
    bool scan_ = false;
    bool repeatAll_ = false;
    bool copyMp3sBeforePlay_ = false;
    bool searching_ = false;
    bool roundIsOver_ = false;

    QPointer<TMusicDatabase> database_;
    QPointer<QObject> remoteControl_;
    SongPlayer* player_ = nullptr;
    PlayListView* view_ = nullptr;
    std::unique_ptr<CommandDispatcher> commands_;
};
