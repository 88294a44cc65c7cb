#include "MusicManagment/playlist/PlayList.h"

#include <QFileInfo>
#include <algorithm>

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

TPlayList::TPlayList(QObject* parent) : QObject(parent), random_(std::random_device{}()) {}

TPlayList::~TPlayList() {
    SetMusicDatabase(nullptr);
}

// --- Entries ---

int TPlayList::IndexOf(const QString& name) const {
    return entries_.Find(name.isEmpty() ? currentSong_ : name);
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
    RaiseChange(position, ctInserted);
}

void TPlayList::Remove(int index) {
    if (index < 0 || index >= Count()) return;
    queue_.removeAll(NameAt(index));
    entries_.Remove(index);
    RaiseChange(index, ctRemoved);
}

void TPlayList::Remove(std::vector<int> indices) {
    const std::vector<int> positions = ValidPositions(std::move(indices), Count());
    for (auto index = positions.rbegin(); index != positions.rend(); ++index)
        Remove(*index);
}

void TPlayList::Clear() {
    entries_.Clear();
    queue_.clear();
    // What was played of the old list would otherwise be passed over in the next one.
    StartNewRound();
    RaiseChange(-1, ctRemoved);
}

int TPlayList::Move(std::vector<int> indices, int before) {
    const std::vector<int> positions = ValidPositions(std::move(indices), Count());
    if (positions.empty()) return std::clamp(before, 0, Count());
    const int first = entries_.Move(positions, before);
    RaiseChange(-1, ctChanged);
    return first;
}

void TPlayList::RefreshRecord(int index, SongIndex databaseHint) {
    if (index < 0 || index >= Count()) return;
    const QString name = NameAt(index);
    std::optional<TID3Tag> record = FindRecord(name, databaseHint);
    if (!record) return;
    entries_.SetRecord(index, std::move(*record));
    RaiseChange(index, ctChanged);
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

void TPlayList::Enqueue(int index) {
    if (index < 0 || index >= Count() || queue_.contains(NameAt(index))) return;
    queue_.append(NameAt(index));
    RedrawView();
}

void TPlayList::Dequeue(int index) {
    if (index < 0 || index >= Count() || queue_.removeAll(NameAt(index)) == 0) return;
    RedrawView();
}

int TPlayList::QueuePosition(int index) const {
    return static_cast<int>(queue_.indexOf(NameAt(index)));
}

// --- Others ---

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
    scan_ = scan;
    if (player_ != nullptr) player_->SetAutoStop(scan_ ? scanTime_ : 0);
}

void TPlayList::SetScanTime(int milliseconds) {
    milliseconds = std::max(milliseconds, 0);
    if (milliseconds == scanTime_) return;
    scanTime_ = milliseconds;
    if (scan_ && player_ != nullptr) player_->SetAutoStop(scanTime_);
}

void TPlayList::SetMusicDatabase(TMusicDatabase* database) {
    if (database == database_) return;
    if (database_) {
        database_->LeaveSettings(*this);
        if (database_->PlayList() == this) database_->SetPlayList(nullptr);
    }
    database_ = database;
    if (database == nullptr) return;
    database->SetPlayList(this);
    database->JoinSettings(*this);
}

void TPlayList::SetPlaySound(SongPlayer* player) {
    if (player == player_) return;
    player_ = player;
    if (player_ != nullptr && scan_) player_->SetAutoStop(scanTime_);
}

void TPlayList::RefreshView() {
    if (view_ != nullptr) view_->Refresh();
}

void TPlayList::RedrawView() {
    if (view_ != nullptr) view_->Redraw();
}

void TPlayList::RaiseChange(int index, TChangeType change) {
    if (OnChange) OnChange(*this, index, change);
}
