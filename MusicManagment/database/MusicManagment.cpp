#include "MusicManagment/database/MusicManagment.h"

#include <algorithm>
#include <cmath>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Collation.h"
#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/MusicFolder.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/BannList.h"
#include "MusicManagment/database/RecycleBin.h"

using namespace Qt::StringLiterals;

namespace {

constexpr quint8 kHighestGenre = 254;

// For songs on their way into the collection: no question, and no copy in place of the song.
constexpr ResolveOptions kOriginalOnly = {.Ask = false, .UseCache = false};

QString WithTrailingSeparator(const QString& folder) {
    return folder.endsWith(u'/') ? folder : folder + u'/';
}

QString WithoutTrailingSeparators(QString name) {
    while (name.size() > 1 && (name.endsWith(u'/') || name.endsWith(u'\\')))
        name.chop(1);
    return name;
}

quint8 ValidMainGenre(quint8 genre) {
    return genre < kMainGenreCount ? genre : quint8{0};
}

double ValidAddTime(double time) {
    return time == 0 || !std::isfinite(time) ? CurrentClock().Now() : time;
}

void ApplyOverrides(const SongOverrides& overrides, TID3Tag& record) {
    record.Length = overrides.Length.value_or(record.Length);
    record.MainGenre = overrides.MainGenre.value_or(record.MainGenre);
    record.Flags = overrides.Flags.value_or(record.Flags);
    record.AddTime = overrides.AddTime.value_or(record.AddTime);
    record.PlayCount = overrides.PlayCount.value_or(record.PlayCount);
    record.Reserved = overrides.Reserved.value_or(record.Reserved);
}

// An entry with a known serial loses its place to a later one with the same serial.
void KeepLastOfEachSerial(std::vector<CdName>& names) {
    for (std::size_t i = names.size(); i-- > 0;) {
        const auto later = names.begin() + static_cast<std::ptrdiff_t>(i) + 1;
        const bool repeated = std::any_of(later, names.end(),
                                          [&](const CdName& name) { return name.Serial == names[i].Serial; });
        if (names[i].Serial == 0 || repeated) names.erase(names.begin() + static_cast<std::ptrdiff_t>(i));
    }
}

}  // namespace

TMusicDatabase::TMusicDatabase(QObject* parent) : QObject(parent), mp3NamePattern_(u"%ARTIST% - %TITLE%"_s) {
    SubscribeSlots();
    SubscribeProgressSlots();
    SetMP3MoveRootDir(MusicFolder());
    // The list of an earlier version, which a component has until settings are loaded; the setter adds the
    // rest.
    SetMP3MoveSubDirs({u"Unsorted"_s, u"Alternative, Psychedelic, Punk, Funk"_s, u"Comedy"_s,
                       u"Hard Rock, Heavy Metal"_s, u"Jazz, Blues, Latin, Reggae"_s, u"Mystic"_s, u"Oldies"_s,
                       u"Rap"_s, u"Rock, Pop"_s, u"Soul, Soft"_s, u"Techno, Trance, Dance, Wave, Rave"_s,
                       u"Trailers & Game-Soundtracks"_s, u"Stimmungs-Lieder"_s});
}

TMusicDatabase::~TMusicDatabase() = default;

// --- Songs ---

SongIndex TMusicDatabase::IndexOf(const QString& fileName) const {
    const TID3Tag* record = songs_.Find(fileName);
    return record != nullptr ? songs_.PositionOf(*record) : -1;
}

TID3Tag TMusicDatabase::GetEntry(SongIndex index, const QString& fileName) const {
    if (index >= 0) {
        if (index >= Count())
            throw EMusicDatabaseException(u"Kein Song mit der Nummer "_s + QString::number(index));
        return Song(index);
    }
    if (const TID3Tag* record = songs_.Find(fileName)) return *record;
    TID3Tag read;
    ReadAudioFile(fileName, AudioReadOptions(), read);
    return read;
}

SongIndex TMusicDatabase::RequireIndexOf(const QString& fileName) const {
    const SongIndex index = IndexOf(fileName);
    if (index < 0)
        throw EMusicDatabaseException(u"Kann den Eintrag "_s + fileName + u" nicht mehr finden."_s);
    return index;
}

bool TMusicDatabase::IsBanned(const TID3Tag& record) const {
    return bannList_.Contains(BanEntry(record));
}

void TMusicDatabase::MarkSong(SongIndex index) {
    if (OnMarkSong && index >= 0 && index < Count()) OnMarkSong(*this, index);
}

// The looks at the disk and at the ban list before a song is taken in.
bool TMusicDatabase::Accepts(const TID3Tag& record) {
    const QString path = ResolveSongPath(record.FileName, kOriginalOnly);
    if (!path.isEmpty() && !FileSource::Exists(path)) return false;
    if (!IsBanned(record)) return true;
    if (autoDelBannedFiles_) MoveToRecycleBin(record.FileName, true);
    return false;
}

SongIndex TMusicDatabase::AddEntry(const QString& fileName, TID3Tag record, AddAs as) {
    if (Busy() || (readOnly_ && !Loading())) return -1;
    if (!fileName.isEmpty()) record.FileName = fileName;
    if (record.MainGenre > kHighestGenre) record.MainGenre = 0;
    const bool fromFile = as == AddAs::Loaded || as == AddAs::LoadedUncounted;
    if (as == AddAs::CountedOnly) {
        SetModified(true);
        groups_.Add(record);
        return -1;
    }
    if ((as == AddAs::New || as == AddAs::LoadedUncounted) && !Accepts(record)) return -1;

    if (!fromFile) SetModified(true);
    if (!Loading()) EnsureSorted();
    record.AddTime = ValidAddTime(record.AddTime);
    record.MainGenre = ValidMainGenre(record.MainGenre);
    const SongHandle song = songs_.Append(std::move(record));
    if (as != AddAs::Loaded) groups_.Add(*songs_.Find(song));
    if (Loading()) return Count() - 1;
    const SongIndex index = Replace(Count() - 1);
    if (as != AddAs::Loaded) events_.Inserted.Tell(index);
    return index;
}

SongIndex TMusicDatabase::AddSong(const QString& path, const SongOverrides& overrides, AddAs as) {
    const QString resolved = ResolveSongPath(path, kOriginalOnly);
    TID3Tag record;
    if (!ReadAudioFile(resolved, AudioReadOptions(), record).isEmpty()) return -1;
    ApplyOverrides(overrides, record);
    return AddEntry(path, std::move(record), as);
}

SongIndex TMusicDatabase::UpdateEntry(SongIndex index, TID3Tag record) {
    if (!TakesChanges() || index < 0 || index >= Count()) return -1;
    const SongHandle song = songs_.HandleOf(index);
    EnsureSorted();
    index = songs_.PositionOf(song);
    const QString before = Song(index).FileName;
    const QString after = record.FileName;
    const SongIndex place = ChangeSong(index, std::move(record));
    if (before != after) events_.Renamed.Tell({{before, after}});
    return place;
}

// In a list that is in order.
SongIndex TMusicDatabase::ChangeSong(SongIndex index, TID3Tag record) {
    const TID3Tag before = PutRecord(index, std::move(record));
    // One that is as before to the order has its place already.
    const SongIndex place = CompareSongs(order_, before, Song(index)) == 0 ? index : Replace(index);
    if (place != index) events_.Moved.Tell(index, place);
    TellChanged(place, before);
    return place;
}

TID3Tag TMusicDatabase::PutRecord(SongIndex index, TID3Tag record) {
    record.MainGenre = ValidMainGenre(record.MainGenre);
    TID3Tag before = songs_.Exchange(index, std::move(record));
    groups_.Change(before, Song(index));
    SetModified(true);
    return before;
}

void TMusicDatabase::TellChanged(SongIndex place, const TID3Tag& before) {
    const TID3Tag after = Song(place);
    events_.Changed.Tell(place, before, after);
}

bool TMusicDatabase::RemoveEntry(SongIndex index) {
    if (!TakesChanges() || index < 0 || index >= Count()) return false;
    RemoveSong(index);
    return true;
}

TID3Tag TMusicDatabase::RemoveSong(SongIndex index) {
    TID3Tag removed = songs_.Remove(index);
    groups_.Remove(removed);
    SetModified(true);
    events_.Removed.Tell(index, removed);
    return removed;
}

void TMusicDatabase::Clear(bool notify, bool keepFileName) {
    if (Busy()) return;
    if (!keepFileName) fileName_.clear();
    songs_.Clear();
    updateFolders_.clear();
    groups_.Clear();
    side_.Forget();
    maybeUnsorted_ = false;
    SetModified(false);
    groups_.TellRebuilt();
    if (notify) events_.Cleared.Tell();
}

void TMusicDatabase::RecountGroups() {
    GroupTally tally;
    for (const auto& song : songs_)
        tally.Add(*song);
    groups_.Clear();
    tally.WriteTo(groups_);
    groups_.TellRebuilt();
}

// --- Order ---

SongIndex TMusicDatabase::Replace(SongIndex index) {
    const SongIndex target = TargetPosition(order_, songs_, index);
    if (target == index) return index;
    const SongIndex place = target > index ? target - 1 : target;
    songs_.Move(index, place);
    return place;
}

void TMusicDatabase::Resort() {
    if (Busy()) throw EMusicDatabaseException(u"Umsortieren der Datenbank ist momentan nicht möglich."_s);
    LookForMedia();
    events_.Reordering.Tell();
    auto entries = songs_.TakeAll();
    SortSongs(order_, entries);
    songs_.PutAll(std::move(entries));
    maybeUnsorted_ = false;
    events_.Reordered.Tell();
}

// The order by the kind of cache changes with what is mounted.
void TMusicDatabase::LookForMedia() {
    if (order_.SortType != stCacheType) return;
    QList<quint32> there;
    for (const Volume& volume : CurrentVolumes().Mounted())
        there.append({volume.Serials.begin(), volume.Serials.end()});
    std::ranges::sort(there);
    if (order_.MediaThere == there) return;
    order_.MediaThere = std::move(there);
    maybeUnsorted_ = true;
}

void TMusicDatabase::EnsureSorted() {
    LookForMedia();
    if (!maybeUnsorted_) return;
    if (!IsSorted(order_, songs_)) return Resort();
    maybeUnsorted_ = false;
}

void TMusicDatabase::SetOrder(const SongOrder& order) {
    if (order == order_) return;
    if (Busy()) throw EMusicDatabaseException(u"Umsortieren der Datenbank ist momentan nicht möglich."_s);
    order_ = order;
    Resort();
}

void TMusicDatabase::SetSortType(TSortType type) {
    SongOrder order = order_;
    order.SortType = type;
    SetOrder(order);
}

void TMusicDatabase::SetSubSortType(TSubSortType type) {
    SongOrder order = order_;
    order.SubSortType = type;
    SetOrder(order);
}

void TMusicDatabase::SetSortBackwards(bool backwards) {
    SongOrder order = order_;
    order.Backwards = backwards;
    SetOrder(order);
}

void TMusicDatabase::SetShownFlag(quint32 flag) {
    SongOrder order = order_;
    order.ShownFlag = flag;
    if (order_.SortType == stFlags)
        SetOrder(order);
    else
        order_ = order;
}

// --- Properties ---

void TMusicDatabase::SetModified(bool modified) {
    if (modified == modified_) return;
    modified_ = modified;
    events_.ModifiedChanged.Tell();
}

void TMusicDatabase::SetCompression(int level) {
    if (level < clNone || level > clMax)
        throw EMusicDatabaseException(QString::number(level) + u" ist keine gültige Kompressionsstufe."_s);
    compression_ = static_cast<TCompressionLevel>(level);
}

void TMusicDatabase::SetMP3MoveRootDir(const QString& folder) {
    mp3MoveRootDir_ = WithTrailingSeparator(folder);
}

void TMusicDatabase::SetMP3MoveSubDirs(QStringList names) {
    while (names.size() > kMainGenreCount)
        names.removeLast();
    while (names.size() < kMainGenreCount)
        names << u"Genre #"_s + QString::number(names.size());
    for (QString& name : names)
        name = WithoutTrailingSeparators(name);
    mp3MoveSubDirs_ = names;
}

void TMusicDatabase::SetCDNames(std::vector<CdName> names) {
    KeepLastOfEachSerial(names);
    std::stable_sort(names.begin(), names.end(), [](const CdName& a, const CdName& b) {
        return Collation::CompareExactly(a.Name, b.Name) < 0;
    });
    cdNames_ = std::move(names);
}

ReadOptions TMusicDatabase::AudioReadOptions() const {
    ReadOptions options;
    options.Profile = modernTags_ ? ReadProfile::Modern : ReadProfile::Classic;
    options.DeriveMainGenre = derivedGenres_;
    // A song in a genre folder is not by an artist of that name.
    for (const QString& name : mp3MoveSubDirs_)
        options.ExcludedArtistFolders << name.toUpper();
    return options;
}

void TMusicDatabase::SetReadOnly(bool value) {
    if (value == readOnly_) return;
    readOnly_ = value;
    events_.ReadOnlyChanged.Tell();
}

// --- Automatic save ---

void TMusicDatabase::SetAutoSave(int interval) {
    if (interval < -1)
        throw EMusicDatabaseException(QString::number(interval) +
                                      u" ist kein gültiges AutoSave-Intervall."_s);
    autoSave_ = interval;
    if (interval <= 0) {
        if (autoSaveTimer_) autoSaveTimer_->stop();
        return;
    }
    if (!autoSaveTimer_) {
        autoSaveTimer_ = std::make_unique<QTimer>();
        QObject::connect(autoSaveTimer_.get(), &QTimer::timeout, this, &TMusicDatabase::AutoSaveTick);
    }
    autoSaveTimer_->start(interval);
}

void TMusicDatabase::AutoSaveTick() {
    if (autoSaveTimer_) autoSaveTimer_->stop();
    // A run in progress is not disturbed; the next tick comes.
    if (!fileName_.isEmpty() && !ProgressRunning() && !fileLock_.IsElsewhere())
        RunCommand([this] { SaveDatabase(fileName_, true); });
    if (autoSaveTimer_ && autoSave_ > 0) autoSaveTimer_->start(autoSave_);
}

void TMusicDatabase::SaveAfterCommand() {
    if (autoSave_ == -1 && !fileName_.isEmpty()) SaveDatabase(fileName_, true);
}

// --- Long operations ---

void TMusicDatabase::SubscribeProgressSlots() {
    const auto raise = [this](TNotifyEvent TMusicDatabase::*slot) {
        return [this, slot] {
            if (this->*slot) (this->*slot)(*this);
        };
    };
    progressSlots_ += operation_.Starting.Subscribe(raise(&TMusicDatabase::OnStartProgress));
    progressSlots_ += operation_.TitleChanged.Subscribe(raise(&TMusicDatabase::OnCaptionChanged));
    progressSlots_ += operation_.Reset.Subscribe(raise(&TMusicDatabase::OnResetProgress));
    progressSlots_ += operation_.Ending.Subscribe(raise(&TMusicDatabase::OnEndProgress));
    progressSlots_ += operation_.Advanced.Subscribe([this](const ProgressPoint& point) {
        if (OnProgress) OnProgress(*this, point);
    });
}

QString TMusicDatabase::Caption() const {
    const auto& run = operation_.Title();
    return run ? u"MusicDatabase v6.0 - "_s + *run : u"MusicDatabase v6.0"_s;
}

void TMusicDatabase::StartProgress(const QString& description, bool lockMenu) {
    operation_.Start(description, lockMenu ? Operation::Commands::Rest : Operation::Commands::Stay);
}

bool TMusicDatabase::Progress(const ProgressPoint& point, bool resetAbort, bool report) {
    const bool stop = operation_.Reach(point, report ? Operation::Point::Told : Operation::Point::Kept);
    if (resetAbort) operation_.ForgetStop();
    return stop;
}

void TMusicDatabase::EndProgress(bool unlockMenu) {
    operation_.End(unlockMenu ? Operation::Commands::Stay : Operation::Commands::Rest);
}

// --- Events ---

void TMusicDatabase::SubscribeSlots() {
    const auto change = [this](SongIndex index, TChangeType type) {
        if (OnChange) OnChange(*this, index, type);
    };
    slots_ += events_.Inserted.Subscribe([change](SongIndex index) { change(index, ctInserted); });
    slots_ += events_.Changed.Subscribe(
        [change](SongIndex index, const TID3Tag&, const TID3Tag&) { change(index, ctChanged); });
    slots_ +=
        events_.Removed.Subscribe([change](SongIndex index, const TID3Tag&) { change(index, ctRemoved); });
    slots_ += events_.Renamed.Subscribe([this](const PathChanges& changes) { side_.Follow(changes); });
    slots_ += events_.Reordered.Subscribe([change] { change(-1, ctChanged); });
    slots_ += events_.Replaced.Subscribe([change] { change(-1, ctChanged); });
    slots_ += events_.Cleared.Subscribe([this, change] {
        change(-1, ctRemoved);
        if (OnClear) OnClear(*this);
    });
    slots_ += events_.Reserve.Subscribe([this](int count) {
        if (OnPrepareMultiAdd) OnPrepareMultiAdd(*this, count);
    });
    slots_ += events_.ModifiedChanged.Subscribe([this] {
        if (OnModifiedChange) OnModifiedChange(*this);
    });
    GroupEvents& groups = groups_.Events();
    slots_ += groups.Rebuilt.Subscribe([this] {
        if (OnOverviewChanged) OnOverviewChanged(*this);
    });
    slots_ += groups.Inserted.Subscribe([this](TOVType type, int row, const QString& caption, int count) {
        if (OnOverviewInsert) OnOverviewInsert(*this, type, row, caption, count);
    });
    slots_ += groups.Deleted.Subscribe([this](TOVType type, int row) {
        if (OnOverviewDelete) OnOverviewDelete(*this, type, row);
    });
    slots_ += groups.Updated.Subscribe([this](TOVType type, int row, int count) {
        if (OnOverviewUpdate) OnOverviewUpdate(*this, type, row, count);
    });
}
