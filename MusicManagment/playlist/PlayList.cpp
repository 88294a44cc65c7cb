#include "MusicManagment/playlist/PlayList.h"

#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "MusicManagment/playlist/PlayListView.h"
#include "MusicManagment/playlist/SongPlayer.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ResolveOptions kWithoutAsking = {.Ask = false};

bool IsThere(const QString& path) {
    return !path.isEmpty() && QFileInfo(path).isFile();
}

// Positions that exist, each once, ascending.
std::vector<int> ValidPositions(std::vector<int> indices, int count) {
    std::erase_if(indices, [count](int index) { return index < 0 || index >= count; });
    std::ranges::sort(indices);
    indices.erase(std::unique(indices.begin(), indices.end()), indices.end());
    return indices;
}

}  // namespace

TPlayList::TPlayList(QObject* parent) : QObject(parent), random_(std::random_device{}()) {
    ForwardChanges();
}

TPlayList::~TPlayList() {
    SetMusicDatabase(nullptr);
}

// --- Entries ---

int TPlayList::IndexOf(const QString& name) const {
    return name.isEmpty() ? entries_.Find(current_) : entries_.Find(name);
}

void TPlayList::InsertSong(int position, SongIndex song) {
    if (!database_)
        throw EPlayListException(
            u"Zugriff auf die MusicDatenbank nicht mmöglich, da auf MusicDatabase kein Wert zugewiesen wurde"_s);
    TID3Tag record = database_->GetEntry(song < 0 ? database_->Count() : song);
    const QString name = record.FileName;
    Insert(position, {name, std::move(record)});
}

void TPlayList::Insert(int position, PlayListEntry entry) {
    position = std::clamp(position, 0, Count());
    entries_.Insert(position, std::move(entry));
    SetModified(true);
    events_.Inserted.Tell(position);
}

void TPlayList::Remove(int index) {
    if (index < 0 || index >= Count()) return;
    const bool waited = queue_.removeOne(entries_.IdAt(index));
    entries_.Remove(index);
    SetModified(true);
    events_.Removed.Tell(index);
    if (waited) events_.QueueChanged.Tell();
}

void TPlayList::Remove(std::vector<int> indices) {
    const std::vector<int> positions = ValidPositions(std::move(indices), Count());
    for (auto index = positions.rbegin(); index != positions.rend(); ++index)
        Remove(*index);
}

void TPlayList::Clear() {
    if (Count() > 0) SetModified(true);
    entries_.Clear();
    queue_.clear();
    reasons_.clear();
    // What was played of the old list would otherwise be passed over in the next one.
    StartNewRound();
    events_.Cleared.Tell();
}

int TPlayList::Move(std::vector<int> indices, int before) {
    const std::vector<int> positions = ValidPositions(std::move(indices), Count());
    if (positions.empty()) return std::clamp(before, 0, Count());
    const std::vector<int> former = entries_.Move(positions, before);
    SetModified(true);
    events_.Moved.Tell(former);
    return static_cast<int>(std::ranges::find(former, positions.front()) - former.begin());
}

void TPlayList::RefreshRecord(int index, SongIndex databaseHint) {
    if (index < 0 || index >= Count()) return;
    const QString name = NameAt(index);
    std::optional<TID3Tag> record = FindRecord(name, databaseHint);
    if (!record) return;
    entries_.SetRecord(index, std::move(*record));
    events_.Changed.Tell(index);
}

int TPlayList::RemoveUnavailable() {
    const int before = Count();
    // Who is told of a removal may remove others.
    for (int index = before - 1; index >= 0; index = std::min(index, Count()) - 1)
        if (!IsThere(ResolvedPath(NameAt(index), kWithoutAsking))) Remove(index);
    return before - Count();
}

// What the database knows of a song, or what its file tells; nothing when neither does.
std::optional<TID3Tag> TPlayList::FindRecord(const QString& name, SongIndex databaseHint) const {
    if (database_) {
        const bool hintIsRight = databaseHint >= 0 && databaseHint < database_->Count() &&
                                 database_->Song(databaseHint).FileName == name;
        // Where the song stands would be looked for in the whole collection.
        const TID3Tag* song = hintIsRight ? &database_->Song(databaseHint) : database_->Songs().Find(name);
        if (song != nullptr) return *song;
    }
    const QString path = ResolvedPath(name, kWithoutAsking);
    if (!IsThere(path)) return std::nullopt;
    ReadOptions options;
    options.Profile = ReadProfile::Modern;
    if (database_) options = database_->AudioReadOptions();
    SongReading reading = ReadSong(path, options);
    // A list shows what it can; playing the file will say what is wrong with it.
    if (!reading.Succeeded()) return std::nullopt;
    reading.Tag.FileName = name;
    return std::move(reading.Tag);
}

QString TPlayList::ResolvedPath(const QString& name, const ResolveOptions& options) const {
    return database_ ? database_->ResolveSongPath(name, options) : name;
}

QString TPlayList::PlayablePath(const QString& name) const {
    const QString path = ResolvedPath(name, {});
    // The player would do nothing with a file that is not there, and wait for its end for ever.
    return IsThere(path) ? path : QString();
}

// --- Queue ---

QStringList TPlayList::Queue() const {
    QStringList names;
    for (const EntryId entry : queue_)
        names << NameAt(entries_.Find(entry));
    return names;
}

void TPlayList::Enqueue(int index) {
    if (index < 0 || index >= Count() || QueuePosition(index) >= 0) return;
    queue_.append(entries_.IdAt(index));
    events_.QueueChanged.Tell();
}

void TPlayList::Dequeue(int index) {
    if (index < 0 || index >= Count() || !queue_.removeOne(entries_.IdAt(index))) return;
    events_.QueueChanged.Tell();
}

int TPlayList::QueuePosition(int index) const {
    return static_cast<int>(queue_.indexOf(entries_.IdAt(index)));
}

// --- Others ---

QStringList TPlayList::History() const {
    QStringList names;
    for (const RememberedEntry& entry : history_)
        names << entry.Name;
    return names;
}

void TPlayList::StartNewRound() {
    history_.clear();
    told_.clear();
    roundIsOver_ = false;
}

bool TPlayList::MarkSong(int index) {
    if (index < 0 && view_ != nullptr) index = view_->CurrentEntry();
    if (!database_ || index < 0 || index >= Count()) return false;
    const SongIndex song = database_->IndexOf(NameAt(index));
    if (song < 0) return false;
    database_->MarkSong(song);
    return true;
}

void TPlayList::SetScan(bool scan) {
    if (scan == scan_) return;
    SetOption(scan_, scan);
    if (player_ != nullptr) player_->SetAutoStop(scan_ ? scanTime_ : 0);
}

void TPlayList::SetScanTime(int milliseconds) {
    milliseconds = std::max(milliseconds, 0);
    if (milliseconds == scanTime_) return;
    SetOption(scanTime_, milliseconds);
    if (scan_ && player_ != nullptr) player_->SetAutoStop(scanTime_);
}

void TPlayList::SetMusicDatabase(TMusicDatabase* database) {
    if (database == database_) return;
    renaming_.End();
    if (database_) {
        database_->LeaveSettings(*this);
        if (database_->PlayList() == this) database_->SetPlayList(nullptr);
    }
    database_ = database;
    if (database == nullptr) return;
    database->SetPlayList(this);
    database->JoinSettings(*this);
    const auto follow = [this](const PathChanges& changes) { FollowRenamed(changes); };
    renaming_ += database->Events().Renamed.Subscribe(follow);
    renaming_ += database->Events().Superseded.Subscribe(follow);
}

void TPlayList::SetPlaySound(SongPlayer* player) {
    if (player == player_) return;
    player_ = player;
    if (player_ != nullptr && scan_) player_->SetAutoStop(scanTime_);
}

// --- Events ---

void TPlayList::RedrawView() {
    events_.CurrentChanged.Tell();
}

void TPlayList::SetModified(bool modified) {
    if (modified == modified_) return;
    modified_ = modified;
    events_.NameChanged.Tell();
}

// OnChange knows positions and three kinds of changes only.
void TPlayList::ForwardChanges() {
    const auto raise = [this](TChangeType change) {
        return [this, change](int index) {
            if (OnChange) OnChange(*this, index, change);
        };
    };
    const auto raiseForAll = [raise](TChangeType change) {
        return [forward = raise(change)] { forward(-1); };
    };
    forwarding_ += events_.Inserted.Subscribe(raise(ctInserted));
    forwarding_ += events_.Changed.Subscribe(raise(ctChanged));
    forwarding_ += events_.Removed.Subscribe(raise(ctRemoved));
    forwarding_ += events_.Cleared.Subscribe(raiseForAll(ctRemoved));
    forwarding_ += events_.Loaded.Subscribe(raiseForAll(ctChanged));
    forwarding_ +=
        events_.Moved.Subscribe([forward = raise(ctChanged)](const std::vector<int>&) { forward(-1); });
}

// --- Commands ---

namespace {

constexpr ComponentCommand<TPlayList> kRows[] = {
    {.Id = pcRemoveSelected,
     .Caption = u"Markierte Einträge entfernen",
     .Keys = u"Del",
     .Icon = u"list-remove",
     .Run =
         [](TPlayList& list, int) {
             if (const PlayListView* view = list.View()) list.Remove(view->SelectedEntries());
         },
     .Image = 65},
    {.Id = pcMarkCurrent,
     .Caption = u"Dieses Lied markieren",
     .Keys = u"Ctrl+Shift+F",
     .Icon = u"go-jump",
     .Run = [](TPlayList& list, int) { list.MarkSong(); },
     .Image = 66},
    {.Id = pcRemoveUnavailable,
     .Caption = u"Nicht verfügbare Lieder entfernen",
     .Keys = u"Ctrl+Shift+Del",
     .Icon = u"edit-clear-list",
     .Run = [](TPlayList& list, int) { list.RemoveUnavailable(); },
     .Image = 67},
};

}  // namespace

constinit const PlayListCommands kEntryCommands = kRows;
