#include "MusicManagment/database/MusicManagment.h"

#include <QCoreApplication>
#include <QStandardPaths>
#include <algorithm>
#include <cmath>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Collation.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/Views.h"
#include "MusicManagment/database/commands/Menu.h"
#include "MusicManagment/database/intake/BannList.h"
#include "MusicManagment/database/songfiles/RecycleBin.h"

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

// Turns changes of the group lists into the database's events.
class TMusicDatabase::GroupEvents : public GroupListener {
 public:
    explicit GroupEvents(TMusicDatabase& database) : database_(database) {}

    void RowInserted(TOVType type, int row, const QString& caption, int count) override {
        if (database_.OnOverviewInsert) database_.OnOverviewInsert(database_, type, row, caption, count);
        if (database_.overviewView_ != nullptr)
            database_.overviewView_->OverviewInserted(type, row, caption, count);
    }
    void RowDeleted(TOVType type, int row) override {
        if (database_.OnOverviewDelete) database_.OnOverviewDelete(database_, type, row);
        if (database_.overviewView_ != nullptr) database_.overviewView_->OverviewDeleted(type, row);
    }
    void RowUpdated(TOVType type, int row, int count) override {
        if (database_.OnOverviewUpdate) database_.OnOverviewUpdate(database_, type, row, count);
        if (database_.overviewView_ != nullptr) database_.overviewView_->OverviewUpdated(type, row, count);
    }

 private:
    TMusicDatabase& database_;
};

TMusicDatabase::TMusicDatabase(QObject* parent)
    : QObject(parent),
      groupEvents_(std::make_unique<GroupEvents>(*this)),
      mp3NamePattern_(u"%ARTIST% - %TITLE%"_s) {
    caption_ = u"MusicDatabase v6.0"_s;
    SetMP3MoveRootDir(QStandardPaths::writableLocation(QStandardPaths::MusicLocation));
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
    return record != nullptr ? songs_.PositionOf(record) : -1;
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

QString TMusicDatabase::ResolveSongPath(const QString& path, const ResolveOptions& options) const {
    if (!IsCdPath(path)) return path;
    return OnResolveCdPath ? OnResolveCdPath(path, options) : QString();
}

void TMusicDatabase::MarkSong(SongIndex index) {
    if (OnMarkSong && index >= 0 && index < Count()) OnMarkSong(*this, index);
}

// The looks at the disk and at the ban list before a song is taken in.
bool TMusicDatabase::Accepts(const TID3Tag& record, const AddOptions& options) {
    if (options.SkipChecks || options.SkipDiskChecks) return true;
    const QString path = ResolveSongPath(record.FileName, kOriginalOnly);
    if (!path.isEmpty() && !FileSource::Exists(path)) return false;
    if (!IsBanned(record)) return true;
    if (autoDelBannedFiles_) MoveToRecycleBin(path, true);
    return false;
}

SongIndex TMusicDatabase::AddEntry(const QString& fileName, TID3Tag record, const AddOptions& options) {
    if (!fileName.isEmpty()) record.FileName = fileName;
    return AddEntry(std::make_unique<TID3Tag>(std::move(record)), options);
}

SongIndex TMusicDatabase::AddEntry(std::unique_ptr<TID3Tag> entry, const AddOptions& options) {
    if (Busy() || (readOnly_ && !Loading())) return -1;
    if (entry->MainGenre > kHighestGenre) entry->MainGenre = 0;
    if (options.CountOnly) {
        if (!options.KeepModified) SetModified(true);
        groups_.Add(*entry, groupEvents_.get());
        return -1;
    }
    if (!Accepts(*entry, options)) return -1;

    if (!options.KeepModified) SetModified(true);
    if (!Loading()) EnsureSorted();
    entry->AddTime = ValidAddTime(entry->AddTime);
    entry->MainGenre = ValidMainGenre(entry->MainGenre);
    const TID3Tag& added = *entry;
    songs_.Append(std::move(entry));
    if (!options.SkipChecks) groups_.Add(added, groupEvents_.get());
    SongIndex index = Count() - 1;
    if (Loading()) return index;
    index = Replace(index);
    if (!options.SkipChecks) RaiseChange(index, ctInserted);
    return index;
}

SongIndex TMusicDatabase::AddSong(const QString& path, const SongOverrides& overrides,
                                  const AddOptions& options) {
    const QString resolved = ResolveSongPath(path, kOriginalOnly);
    TID3Tag record;
    if (!ReadAudioFile(resolved, AudioReadOptions(), record).isEmpty()) return -1;
    ApplyOverrides(overrides, record);
    return AddEntry(path, std::move(record), options);
}

SongIndex TMusicDatabase::UpdateEntry(SongIndex index, TID3Tag record) {
    if (Busy() || readOnly_ || index < 0 || index >= Count()) return -1;
    record.MainGenre = ValidMainGenre(record.MainGenre);
    EnsureSorted();
    groups_.Remove(Song(index), groupEvents_.get());
    groups_.Add(record, groupEvents_.get());
    songs_.Set(index, std::move(record));
    SetModified(true);
    const SongIndex place = Replace(index);
    if (place != index && songListView_ != nullptr) songListView_->SongMoved(index, place);
    RaiseChange(place, ctChanged);
    return place;
}

bool TMusicDatabase::RemoveEntry(SongIndex index) {
    if (Busy() || readOnly_ || index < 0 || index >= Count()) return false;
    groups_.Remove(Song(index), groupEvents_.get());
    songs_.Remove(index);
    SetModified(true);
    RaiseChange(index, ctRemoved);
    return true;
}

void TMusicDatabase::Clear(bool notify, bool keepFileName) {
    if (Busy()) return;
    if (!keepFileName) fileName_.clear();
    songs_.Clear();
    updateFolders_.clear();
    groups_.Clear();
    maybeUnsorted_ = false;
    SetModified(false);
    RaiseOverviewChanged();
    if (!notify) return;
    RaiseChange(-1, ctRemoved);
    RaiseClear();
}

void TMusicDatabase::RecountGroups() {
    GroupTally tally;
    for (const auto& song : songs_)
        tally.Add(*song);
    groups_.Clear();
    tally.WriteTo(groups_);
    RaiseOverviewChanged();
}

// --- Order ---

SongOrder TMusicDatabase::CurrentOrder() const {
    SongOrder order = order_;
    order.ShownFlag = songListView_ != nullptr ? songListView_->ShownFlag() : 0;
    return order;
}

SongIndex TMusicDatabase::Replace(SongIndex index) {
    const SongIndex target = TargetPosition(CurrentOrder(), songs_, index);
    if (target == index) return index;
    const SongIndex place = target > index ? target - 1 : target;
    songs_.Move(index, place);
    return place;
}

void TMusicDatabase::Resort() {
    if (Busy()) throw EMusicDatabaseException(u"Umsortieren der Datenbank ist momentan nicht möglich."_s);
    auto entries = songs_.TakeAll();
    SortSongs(CurrentOrder(), entries);
    songs_.PutAll(std::move(entries));
    maybeUnsorted_ = false;
    RaiseChange(-1, ctChanged);
}

void TMusicDatabase::EnsureSorted() {
    if (!maybeUnsorted_) return;
    if (!IsSorted(CurrentOrder(), songs_)) return Resort();
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

// --- Properties ---

void TMusicDatabase::SetModified(bool modified) {
    if (modified == modified_) return;
    modified_ = modified;
    if (OnModifiedChange) OnModifiedChange(*this);
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
    menu_.reset();
    if (OnMenuChanged) OnMenuChanged(*this);
}

// --- Command menu ---

TMenuExItem& TMusicDatabase::Menu() {
    if (!menu_) menu_ = BuildDatabaseMenu(readOnly_);
    UpdateDatabaseMenu(*menu_, *this);
    return *menu_;
}

bool TMusicDatabase::ClickMenuItem(int id, void* platformItem) {
    const TMenuExItem* item = Menu().Find(id);
    if (item == nullptr || !item->Enabled()) return false;
    bool proceed = true;
    if (OnMenuItemClicked) OnMenuItemClicked(*this, *item, platformItem, id, proceed);
    return !proceed || RunDatabaseCommand(*this, id);
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
    if (!fileName_.isEmpty() && !progressRunning_) {
        try {
            SaveDatabase(fileName_, true);
        } catch (const EAbort&) {
            // The user has been told.
        } catch (const ERukException& error) {
            UserDialogs().ShowMessage(MessageKind::Error, error.Message());
        }
    }
    if (autoSaveTimer_ && autoSave_ > 0) autoSaveTimer_->start(autoSave_);
}

void TMusicDatabase::SaveAfterCommand() {
    if (autoSave_ == -1 && !fileName_.isEmpty()) SaveDatabase(fileName_, true);
}

// --- Long operations ---

void TMusicDatabase::StartProgress(const QString& description, bool lockMenu) {
    if (progressRunning_) {
        UserDialogs().ShowMessage(
            MessageKind::Warning,
            u"Warten Sie, bis der gerade laufende Vorgang beendet wurde oder brechen Sie ihn ab."_s);
        throw EAbort();
    }
    ResetProgress();
    caption_ = u"MusicDatabase v6.0 - "_s + description;
    if (OnStartProgress) OnStartProgress(*this);
    if (OnCaptionChanged) OnCaptionChanged(*this);
    progressRunning_ = true;
    abortRequested_ = false;
    if (lockMenu) menuLocked_ = true;
}

bool TMusicDatabase::Progress(const ProgressPoint& point, bool resetAbort, bool report) {
    lastProgress_ = point;
    if (report) ReportProgress();
    if (asynchronous_ && QCoreApplication::instance() != nullptr) QCoreApplication::processEvents();
    if (!abortRequested_) return false;
    if (resetAbort) abortRequested_ = false;
    return true;
}

void TMusicDatabase::ReportProgress() {
    const auto normalise = [](qint64& current, qint64& maximum) {
        if (maximum != -1) return;
        maximum = current == -1 ? 0 : 100;
        if (current == -1) current = 0;
    };
    const auto percent = [](qint64 current, qint64 maximum) {
        return maximum > 0
                   ? static_cast<int>(100.0 / static_cast<double>(maximum) * static_cast<double>(current))
                   : -1;
    };
    normalise(lastProgress_.Cur, lastProgress_.Max);
    normalise(lastProgress_.CurSub, lastProgress_.MaxSub);
    mainPercent_ = percent(lastProgress_.Cur, lastProgress_.Max);
    subPercent_ = percent(lastProgress_.CurSub, lastProgress_.MaxSub);
    if (OnProgress) OnProgress(*this, lastProgress_);
}

void TMusicDatabase::EndProgress(bool unlockMenu) {
    if (unlockMenu) menuLocked_ = false;
    progressRunning_ = false;
    abortRequested_ = false;
    caption_ = u"MusicDatabase v6.0"_s;
    if (OnCaptionChanged) OnCaptionChanged(*this);
    if (OnEndProgress) OnEndProgress(*this);
    ResetProgress();
}

void TMusicDatabase::ResetProgress() {
    lastProgress_ = ProgressPoint();
    mainPercent_ = -1;
    subPercent_ = -1;
    if (OnResetProgress) OnResetProgress(*this);
}

// --- Events ---

void TMusicDatabase::RaiseChange(SongIndex index, TChangeType change) {
    if (OnChange) OnChange(*this, index, change);
    if (songListView_ != nullptr) songListView_->SongChanged(index, change);
}

void TMusicDatabase::RaiseClear() {
    if (OnClear) OnClear(*this);
    if (songListView_ != nullptr) songListView_->DatabaseCleared();
}

void TMusicDatabase::RaisePrepareMultiAdd(int count) {
    if (OnPrepareMultiAdd) OnPrepareMultiAdd(*this, count);
    if (songListView_ != nullptr) songListView_->PrepareMultiAdd(count);
}

void TMusicDatabase::RaiseOverviewChanged() {
    if (OnOverviewChanged) OnOverviewChanged(*this);
    if (overviewView_ != nullptr) overviewView_->OverviewChanged();
}
