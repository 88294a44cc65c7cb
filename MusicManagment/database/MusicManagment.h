#pragma once

#include <QObject>
#include <QPointer>
#include <QString>
#include <QStringList>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/CollectionEvents.h"
#include "MusicManagment/database/ConversionSettings.h"
#include "MusicManagment/database/DatabaseLock.h"
#include "MusicManagment/database/GroupLists.h"
#include "MusicManagment/database/Operation.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/SongList.h"
#include "MusicManagment/database/SongTypes.h"
#include "MusicManagment/database/sidefile/SideFile.h"
#include "MusicManagment/database/sorting/Sorting.h"
#include "ReadMPEGHeader/AudioFile.h"

class CollectionEdit;
class CommandDispatcher;
class SettingsClient;
class TMenuExItem;
class TMusicDatabase;

class EMusicDatabaseException : public ERukException {
 public:
    using ERukException::ERukException;
};

// Nobody can be asked for the lengths of songs (TMusicDatabase::OnMeasureLength).
class ENoLengthMeasure : public ERukException {
 public:
    using ERukException::ERukException;
};

using TNotifyEvent = std::function<void(TMusicDatabase&)>;
using TChangeEvent = std::function<void(TMusicDatabase&, SongIndex index, TChangeType change)>;
// `platformItem` is the toolkit's own item, nullptr when the command came another way. With `proceed` set to
// false the database does nothing more.
using TMenuItemClickedEvent = std::function<void(TMusicDatabase&, const TMenuExItem& item, void* platformItem,
                                                 qint64 userId, bool& proceed)>;
using TProgressEvent = std::function<void(TMusicDatabase&, const ProgressPoint&)>;

// Why an entry is added, which decides what is checked, counted and told.
enum class AddAs {
    New,        // its file must be there, and it must not be banned
    Returning,  // brought back by the user: no look at disk and ban list
    Loaded,     // from a file that has its lists: not checked, counted or told; nothing is modified by it
    LoadedUncounted,  // from a file without lists: like New, but nothing is modified by it
    CountedOnly,      // not added at all, only counted in the summary lists
};

// Values that replace what was read from an audio file; absent keeps what was read.
struct SongOverrides {
    std::optional<quint16> Length{};
    std::optional<quint8> MainGenre{};
    std::optional<quint32> Flags{};
    std::optional<double> AddTime{};
    std::optional<quint32> PlayCount{};
    std::optional<quint16> Reserved{};
};

// How far finding a song's file may go.
struct ResolveOptions {
    bool Ask = true;       // ask the user for a medium that is not there
    bool UseCache = true;  // take the copy that was put on the disk
};

struct CdName {
    QString Name;
    quint32 Serial = 0;  // volume serial number
};

// Where the database looks for media first.
struct CdDrive {
    QString MountPoint;      // empty: none is known yet
    quint32 LastSerial = 0;  // of the medium that was in it when it was last looked at; 0: none
    bool Asking = false;     // the user is being asked for a medium
};

// The collection: song entries in one sort order, the lists that count them, the settings of the collection.
// Single-threaded. What a capability does with the songs (file format, intake, sorting) lies beside this
// class.
class TMusicDatabase : public QObject {
 public:
    explicit TMusicDatabase(QObject* parent = nullptr);
    ~TMusicDatabase() override;

    // --- Songs, in the current sort order ---
    int Count() const { return static_cast<int>(songs_.Count()); }
    const TID3Tag& Song(SongIndex index) const { return songs_.At(index); }
    const SongList& Songs() const { return songs_; }
    // -1 when no song has this path.
    SongIndex IndexOf(const QString& fileName) const;
    bool Contains(const QString& fileName) const { return songs_.Find(fileName) != nullptr; }
    // A copy of the entry at `index`, or with index -1 of the one with this path; a path that is not in the
    // collection is filled from the file itself. Throws EMusicDatabaseException for an index out of range.
    TID3Tag GetEntry(SongIndex index, const QString& fileName = QString()) const;
    // Throws EMusicDatabaseException when no song has this path.
    SongIndex RequireIndexOf(const QString& fileName) const;
    // A file keeps the order in which it was saved; this puts the songs into the current one when they are
    // not in it. Every placing of a song does so first. Throws EMusicDatabaseException while the database is
    // busy.
    void EnsureSorted();

    // Adds an entry, its path first taken from `fileName`. Returns its place, or -1 when it was only counted
    // or refused (database busy or read-only, file missing, song banned).
    SongIndex AddEntry(const QString& fileName, TID3Tag record, AddAs as = AddAs::New);
    // Reads the file and adds it; -1 when it does not exist or was refused. Throws EStreamError when it
    // cannot be read.
    SongIndex AddSong(const QString& path, const SongOverrides& overrides = {}, AddAs as = AddAs::New);
    // Single edits; several that belong together are a CollectionEdit.
    // Replaces an entry and puts it in its place; returns the new place, -1 when refused.
    SongIndex UpdateEntry(SongIndex index, TID3Tag record);
    // Removes an entry from the collection; the file stays. False when refused.
    bool RemoveEntry(SongIndex index);
    // Whether songs may be changed and removed now.
    bool TakesChanges() const { return !Busy() && !readOnly_; }
    // Empties the database; does nothing while it is busy.
    void Clear(bool notify = true, bool keepFileName = false);
    bool IsBanned(const TID3Tag& record) const;

    // --- Media that can be taken away (media/) ---
    // The path under which a song's file can be opened now; empty when its medium is not there. An ordinary
    // path is its own answer, whether or not there is such a file.
    QString ResolveSongPath(const QString& path, const ResolveOptions& options = {});
    // The name of the medium of a path on one; the path itself where it has none, and of an ordinary path.
    QString CDNameOf(const QString& path) const;
    // Whether two paths, of which exactly one is on a medium, are the same but for medium and drive.
    static bool SameFileIgnoringMedium(const QString& a, const QString& b);
    // What the record of a song has no field for.
    SideFile& Side() { return side_; }
    const SideFile& Side() const { return side_; }
    // Has the views mark a song and show it.
    void MarkSong(SongIndex index);
    // Sorts the whole list anew. Throws EMusicDatabaseException while the database is busy.
    void Resort();

    // --- Files (DatabaseFile.cpp) ---
    // Writes to `fileName`, or the current one, or asks. False when the user cancelled or stopped the run.
    // Throws EMusicDatabaseException or EStreamError; the old file is then as it was.
    bool SaveDatabase(const QString& fileName = QString(), bool keepName = false, bool askForName = false);
    // Reads a database, an empty name clears. False when the user stopped the run; the songs read so far are
    // kept. Throws EMusicDatabaseException or EStreamError; the songs read before the error are kept.
    bool OpenDatabase(const QString& fileName, bool keepName = false);
    // Asks for the file first; false also when the user cancelled.
    bool OpenDatabaseFromDialog();
    // Keeps other programs from writing the file meanwhile; the programs switch it on.
    DatabaseLock& Lock() { return fileLock_; }

    // --- Summary lists: caption and number of songs of each row ---
    const GroupLists& Groups() const { return groups_; }
    GroupLists& EditGroups() { return groups_; }  // for the reader of database files
    const SortedTextList& Artists() const { return groups_.Artists(); }
    const SortedTextList& Albums() const { return groups_.Albums(); }
    const SortedTextList& Years() const { return groups_.Years(); }
    const SortedTextList& Lengths() const { return groups_.Lengths(); }
    const GenreCounts& Genres() const { return groups_.Genres(); }
    // Counts everything anew from the songs and tells that the lists were rebuilt.
    void RecountGroups();

    // --- Properties ---
    const QString& FileName() const { return fileName_; }
    void SetFileName(const QString& fileName) { fileName_ = fileName; }
    int AutoSave() const { return autoSave_; }
    // Milliseconds; 0 and -1 stop the timed saving, -1 saves after every command. Throws
    // EMusicDatabaseException below -1.
    void SetAutoSave(int interval);
    bool Modified() const { return modified_; }
    void SetModified(bool modified);
    const QStringList& UpdateFolders() const { return updateFolders_; }
    void SetUpdateFolders(const QStringList& folders) { updateFolders_ = folders; }
    SortedTextList& BannList() { return bannList_; }
    const SortedTextList& BannList() const { return bannList_; }
    QString Caption() const;
    int Compression() const { return compression_; }
    // A TCompressionLevel. Throws EMusicDatabaseException for any other number.
    void SetCompression(int level);
    bool Asynchronous() const { return operation_.LetsInterfaceWork(); }
    void SetAsynchronous(bool value) { operation_.SetLetsInterfaceWork(value); }
    bool AutoDelBannedFiles() const { return autoDelBannedFiles_; }
    void SetAutoDelBannedFiles(bool value) { autoDelBannedFiles_ = value; }
    TSortType SortType() const { return order_.SortType; }
    TSubSortType SubSortType() const { return order_.SubSortType; }
    bool SortBackwards() const { return order_.Backwards; }
    // Each sorts the list anew when the value changes. Throw EMusicDatabaseException while the database is
    // busy.
    void SetSortType(TSortType type);
    void SetSubSortType(TSubSortType type);
    void SetSortBackwards(bool backwards);
    const SongOrder& Order() const { return order_; }
    // All of it in one sort.
    void SetOrder(const SongOrder& order);
    // The flag bit that the flag column of the song list shows, which alone counts when sorting by flags; 0:
    // the whole flags.
    quint32 ShownFlag() const { return order_.ShownFlag; }
    void SetShownFlag(quint32 flag);
    bool FollowFocus() const { return followFocus_; }
    void SetFollowFocus(bool value) { followFocus_ = value; }
    bool MoveMP3sAfterGenreChange() const { return moveMP3sAfterGenreChange_; }
    void SetMoveMP3sAfterGenreChange(bool value) { moveMP3sAfterGenreChange_ = value; }
    const QString& MP3MoveRootDir() const { return mp3MoveRootDir_; }
    void SetMP3MoveRootDir(const QString& folder);  // stored with a trailing separator
    const QStringList& MP3MoveSubDirs() const { return mp3MoveSubDirs_; }
    void SetMP3MoveSubDirs(QStringList names);  // stored as exactly 20 names without trailing separators
    const QString& MP3NamePattern() const { return mp3NamePattern_; }
    void SetMP3NamePattern(const QString& pattern) { mp3NamePattern_ = pattern; }
    const std::vector<CdName>& CDNames() const { return cdNames_; }
    void SetCDNames(
        std::vector<CdName> names);  // sorted by name; of one serial the last stays, serial 0 is dropped
    // Whether lengths are verified by OnMeasureLength.
    bool UseWinAmpForLenCheck() const { return useWinAmpForLenCheck_; }
    void SetUseWinAmpForLenCheck(bool value) { useWinAmpForLenCheck_ = value; }
    bool ReadOnly() const { return readOnly_; }
    void SetReadOnly(bool value);
    bool RenameAndMoveMP3s() const { return renameAndMoveMP3s_; }
    void SetRenameAndMoveMP3s(bool value) { renameAndMoveMP3s_ = value; }
    // Whether a renamed file stays in its folder where no genre folder is its target; off in a new component,
    // where it goes below MP3MoveRootDir. Switched on by the programs.
    bool RenameInPlace() const { return renameInPlace_; }
    void SetRenameInPlace(bool value) { renameInPlace_ = value; }
    // Whether files are read with the modern profile; off in a new component, switched on by the programs.
    bool ModernTags() const { return modernTags_; }
    void SetModernTags(bool value) { modernTags_ = value; }
    // Whether songs of old database files stay when their audio files cannot be found; off in a new
    // component, switched on by the programs.
    bool KeepLostSongs() const { return keepLostSongs_; }
    void SetKeepLostSongs(bool value) { keepLostSongs_ = value; }
    // Whether a song that comes in without a main genre gets the one that its tag's genre belongs to; off in
    // a new component, switched on by the programs.
    bool DerivedGenres() const { return derivedGenres_; }
    void SetDerivedGenres(bool value) { derivedGenres_ = value; }

    // Whether a batch asks once an artist and tells at its end what did not go; off in a new component,
    // switched on by the programs.
    bool QuietBatches() const { return quietBatches_; }
    void SetQuietBatches(bool value) { quietBatches_ = value; }
    // Whether duplicates are looked for in collections of any size; off in a new component, which compares
    // kMostComparedSongs at most, switched on by the programs.
    bool UnlimitedSearch() const { return unlimitedSearch_; }
    void SetUnlimitedSearch(bool value) { unlimitedSearch_ = value; }
    // Whether a medium is looked for on all mounted volumes before the user is asked for it, and the user is
    // asked at intake whether one is to be catalogued; off in a new component, which looks at one drive and
    // asks nothing, switched on by the programs.
    bool ModernMedia() const { return modernMedia_; }
    void SetModernMedia(bool value) { modernMedia_ = value; }

    // Linked components; each reference clears itself when the other goes.
    QObject* PlayList() const { return playList_; }
    void SetPlayList(QObject* component) { playList_ = component; }
    QObject* PlaySound() const { return playSound_; }
    void SetPlaySound(QObject* component) { playSound_ = component; }
    QObject* RemoteControl() const { return remoteControl_; }
    void SetRemoteControl(QObject* component) { remoteControl_ = component; }

    // --- Long operations ---
    // Whoever shows it subscribes to it; who works begins it with the ProgressRun object of Progress.h.
    Operation& CurrentOperation() { return operation_; }
    const Operation& CurrentOperation() const { return operation_; }
    // The same in other words. The first shows a message and throws EAbort when a run is going; the second is
    // true when the user asked to stop.
    void StartProgress(const QString& description, bool lockMenu);
    bool Progress(const ProgressPoint& point, bool resetAbort = false, bool report = true);
    void EndProgress(bool unlockMenu);
    void RequestAbort() { operation_.RequestStop(); }
    bool ProgressRunning() const { return operation_.Running(); }
    bool MenuLocked() const { return operation_.CommandsRest(); }
    const ProgressPoint& LastProgress() const { return operation_.LastPoint(); }
    int MainPercent() const { return operation_.MainPercent(); }  // -1 unknown
    int SubPercent() const { return operation_.SubPercent(); }

    // While above 0 the song list must not change.
    bool Busy() const { return busy_ > 0; }
    void BeginBusy() { ++busy_; }
    void EndBusy() { --busy_; }
    // While above 0 added songs keep the order of the file and views are not told of each.
    bool Loading() const { return loading_ > 0; }
    void BeginLoading() {
        ++loading_;
        maybeUnsorted_ = true;
    }
    void EndLoading() {
        --loading_;
        maybeUnsorted_ = true;  // whatever happened between two songs
    }

    // What the automatic save does at each tick of its timer.
    void AutoSaveTick();
    bool AutoSaveTimerActive() const { return autoSaveTimer_ && autoSaveTimer_->isActive(); }
    // Saves at once when AutoSave is -1; called at the end of every command that changes songs.
    void SaveAfterCommand();

    // --- Command menu (commands/Menu.cpp, which knows the commands of all capabilities) ---
    CommandDispatcher& Commands();
    // Built at the first call and kept until ReadOnly changes.
    TMenuExItem& Menu();
    // Raises OnMenuItemClicked and then, unless the handler stops it, runs the command behind the item. False
    // when it can do nothing now. Throws what the command throws.
    bool ClickMenuItem(int id, void* platformItem = nullptr);

    // --- Settings (Settings.h) ---
    ConversionSettings& Conversion() { return conversion_; }
    const ConversionSettings& Conversion() const { return conversion_; }
    // Components whose settings are kept with those of the database; each leaves before it goes.
    void JoinSettings(SettingsClient& client) { settingsClients_.push_back(&client); }
    void LeaveSettings(SettingsClient& client) { std::erase(settingsClients_, &client); }
    const std::vector<SettingsClient*>& SettingsClients() const { return settingsClients_; }

    // How this database reads audio files.
    ReadOptions AudioReadOptions() const;

    // --- Events ---
    // Everybody who wants to know subscribes here.
    CollectionEvents& Events() { return events_; }
    GroupEvents& GroupChanges() { return groups_.Events(); }

    // One slot each, told before all who have subscribed since.
    TNotifyEvent OnModifiedChange;
    TChangeEvent OnChange;
    TNotifyEvent OnClear;
    std::function<void(TMusicDatabase&, int count)> OnPrepareMultiAdd;
    TNotifyEvent OnOverviewChanged;
    std::function<void(TMusicDatabase&, TOVType, int index, const QString& caption, int count)>
        OnOverviewInsert;
    std::function<void(TMusicDatabase&, TOVType, int index)> OnOverviewDelete;
    std::function<void(TMusicDatabase&, TOVType, int index, int count)> OnOverviewUpdate;
    TNotifyEvent OnStartProgress;
    TProgressEvent OnProgress;
    TNotifyEvent OnResetProgress;
    TNotifyEvent OnEndProgress;
    TNotifyEvent OnCaptionChanged;
    TMenuItemClickedEvent OnMenuItemClicked;
    std::function<void(TMusicDatabase&, SongIndex index)> OnMarkSong;
    // A file is about to be moved or removed: whoever holds it open lets go of it, and returns what takes it
    // up again under the path that it has then. Empty where nobody holds it.
    std::function<std::function<void(const QString& path)>(const QString& path)> OnReleaseFile;
    // Asks another player how long a song is, in milliseconds, and lets the interface work meanwhile. Throws
    // ENoLengthMeasure when there is none to ask, another exception when it does not tell.
    std::function<quint32(const QString& path)> OnMeasureLength;
    // The playlist has played all its songs; `showException` is whether the user is told.
    std::function<void(TMusicDatabase&, bool& showException)> OnAllFilesPlayed;

 private:
    friend class CollectionEdit;

    void SubscribeProgressSlots();
    bool Accepts(const TID3Tag& record);
    TID3Tag PutRecord(SongIndex index, TID3Tag record);
    SongIndex ChangeSong(SongIndex index, TID3Tag record);
    SongIndex Replace(SongIndex index);
    void TellChanged(SongIndex place, const TID3Tag& before);
    TID3Tag RemoveSong(SongIndex index);
    void SubscribeSlots();
    void NoteDriveSerial(quint32 serial);
    bool AskForMedium(const QString& path);
    void LookForMedia();

    SongList songs_;
    GroupLists groups_;
    CollectionEvents events_;
    Subscriptions slots_;
    SongOrder order_;
    bool maybeUnsorted_ = false;  // after reading a file, until the order has been looked at

    QString fileName_;
    QStringList updateFolders_;
    SortedTextList bannList_;
    std::vector<CdName> cdNames_;
    CdDrive drive_;
    SideFile side_;
    std::unique_ptr<CommandDispatcher> commands_;
    ConversionSettings conversion_;
    std::vector<SettingsClient*> settingsClients_;
    QString mp3MoveRootDir_;
    QStringList mp3MoveSubDirs_;
    QString mp3NamePattern_;
    int autoSave_ = 0;
    TCompressionLevel compression_ = clFastest;
    bool modified_ = false;
    bool autoDelBannedFiles_ = false;
    bool followFocus_ = true;
    bool moveMP3sAfterGenreChange_ = false;
    bool useWinAmpForLenCheck_ = false;
    bool readOnly_ = false;
    bool renameAndMoveMP3s_ = true;
    bool renameInPlace_ = false;
    bool quietBatches_ = false;
    bool unlimitedSearch_ = false;
    bool modernMedia_ = false;
    bool modernTags_ = false;
    bool keepLostSongs_ = false;
    DatabaseLock fileLock_{*this};
    bool derivedGenres_ = false;

    QPointer<QObject> playList_;
    QPointer<QObject> playSound_;
    QPointer<QObject> remoteControl_;
    std::unique_ptr<QTimer> autoSaveTimer_;

    Operation operation_;
    Subscriptions progressSlots_;
    int busy_ = 0;
    int loading_ = 0;
};
