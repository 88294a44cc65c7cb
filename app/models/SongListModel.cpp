#include "app/models/SongListModel.h"

#include <QFont>
#include <QGuiApplication>
#include <QPalette>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "app/models/SongColumns.h"

using namespace Qt::StringLiterals;

namespace {

// Milliseconds between two times at which the views are told.
constexpr qint64 kSyncInterval = 250;
// Telling the views of a large list takes its time; it gets at most the tenth part of a scan.
constexpr qint64 kRestPerWork = 9;
constexpr qint64 kLongestRest = 3000;
// A journal of more pieces costs more than telling the views.
constexpr std::size_t kJournalLimit = 4000;

const SongColumn& ColumnOf(int section) {
    return SongColumns()[static_cast<std::size_t>(section)];
}

QVariant CellAlignment(const SongColumn& column) {
    return QVariant::fromValue(column.Alignment | Qt::AlignVCenter);
}

QString FlagName(quint32 flag) {
    const QStringList names = SongFlagNames();
    for (qsizetype bit = 0; bit < names.size(); ++bit)
        if (flag == 1U << bit) return names[bit];
    return {};
}

// The views' own font, but bold.
QVariant BoldFont() {
    QFont font;
    font.setBold(true);
    font.setResolveMask(QFont::WeightResolved);
    return font;
}

}  // namespace

// While it lives all songs may change their rows; its end tells the views where each of theirs has gone. What
// is selected stays selected.
class SongListModel::Reordering {
 public:
    explicit Reordering(SongListModel& model) : model_(model) {
        Q_EMIT model_.layoutAboutToBeChanged({}, VerticalSortHint);
        before_ = model_.persistentIndexList();
        for (const QModelIndex& index : std::as_const(before_))
            songs_.push_back(model_.database_.Songs().HandleOf(model_.IndexAt(index.row())));
    }
    ~Reordering() {
        const SongList& songs = model_.database_.Songs();
        QModelIndexList after;
        after.reserve(before_.size());
        for (qsizetype i = 0; i < before_.size(); ++i)
            after << model_.index(songs.PositionOf(songs_[static_cast<std::size_t>(i)]), before_[i].column());
        model_.changePersistentIndexList(before_, after);
        Q_EMIT model_.layoutChanged({}, VerticalSortHint);
    }
    Reordering(const Reordering&) = delete;
    Reordering& operator=(const Reordering&) = delete;

 private:
    SongListModel& model_;
    QModelIndexList before_;         // what the views hold on to
    std::vector<SongHandle> songs_;  // the song of each
};

SongListModel::SongListModel(TMusicDatabase& database) : database_(database) {
    syncTimer_.setSingleShot(true);
    QObject::connect(&syncTimer_, &QTimer::timeout, this, &SongListModel::SyncViews);
    Subscribe();
    Reset();
}

SongListModel::~SongListModel() = default;

// --- What views ask ---

const TID3Tag* SongListModel::SongAt(int row) const {
    const SongIndex place = IndexAt(row);
    return place >= 0 ? &database_.Song(place) : nullptr;
}

SongIndex SongListModel::IndexAt(int row) const {
    const int place = journal_.Empty() ? row : journal_.NewRowOf(row);
    return place < database_.Count() ? place : -1;
}

int SongListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : rows_;
}

int SongListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(SongColumns().size());
}

Qt::ItemFlags SongListModel::flags(const QModelIndex& index) const {
    Qt::ItemFlags flags = QAbstractTableModel::flags(index);
    if (index.isValid()) flags |= Qt::ItemIsDragEnabled;
    if (ShowsMark(index) && database_.TakesChanges()) flags |= Qt::ItemIsUserCheckable;
    return flags;
}

QVariant SongListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    const SongColumn& column = ColumnOf(index.column());
    if (role == Qt::TextAlignmentRole) return CellAlignment(column);
    if (ShowsMark(index)) {
        if (role != Qt::CheckStateRole) return {};
        const TID3Tag* song = SongAt(index.row());
        const bool isSet = song != nullptr && (song->Flags & database_.ShownFlag()) != 0;
        return isSet ? Qt::Checked : Qt::Unchecked;
    }
    if (role == Qt::ForegroundRole || role == Qt::ToolTipRole) return MediumLook(index.row(), role);
    if (role != Qt::DisplayRole && (role != Qt::FontRole || playing_.isEmpty())) return {};
    const TID3Tag* song = SongAt(index.row());
    if (role == Qt::FontRole) return song != nullptr && song->FileName == playing_ ? BoldFont() : QVariant();
    return song != nullptr ? column.Text(*song) : QString();
}

// A song whose medium is away is grey, and tells which one it is.
QVariant SongListModel::MediumLook(int row, int role) const {
    const TID3Tag* song = SongAt(row);
    if (song == nullptr || !IsCdPath(song->FileName)) return {};
    const bool isThere = !FileWithinReach(database_, song->FileName).isEmpty();
    if (role == Qt::ForegroundRole)
        return isThere ? QVariant() : QGuiApplication::palette().brush(QPalette::Disabled, QPalette::Text);
    const QString name = database_.CDNameOf(song->FileName);
    return isThere ? name : name + u" (nicht eingelegt)"_s;
}

void SongListModel::SetPlaying(const QString& path) {
    if (path == playing_) return;
    SyncViews();
    const QString former = std::exchange(playing_, path);
    ShowFontOf(former);
    ShowFontOf(playing_);
}

void SongListModel::ShowFontOf(const QString& path) {
    const SongIndex song = path.isEmpty() ? -1 : database_.IndexOf(path);
    if (song >= 0) Q_EMIT dataChanged(index(song, 0), index(song, columnCount() - 1), {Qt::FontRole});
}

bool SongListModel::ShowsMark(const QModelIndex& index) const {
    return database_.ShownFlag() != 0 && ColumnOf(index.column()).Id == SongFieldId::Flags;
}

// The mark changes with the song, which takes a while.
bool SongListModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (role != Qt::CheckStateRole || !index.isValid() || !ShowsMark(index) || !OnFlagClick) return false;
    const TID3Tag* song = SongAt(index.row());
    if (song == nullptr) return false;
    OnFlagClick(database_.Songs().HandleOf(*song), value.toInt() == Qt::Checked);
    return true;
}

void SongListModel::ShownFlagChanged() {
    const int column = ColumnOfSortType(stFlags);
    Q_EMIT headerDataChanged(Qt::Horizontal, column, column);
    if (rows_ > 0) Q_EMIT dataChanged(index(0, column), index(rows_ - 1, column));
}

QVariant SongListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || section < 0 || section >= columnCount()) return {};
    const SongColumn& column = ColumnOf(section);
    if (role == Qt::TextAlignmentRole) return CellAlignment(column);
    if (role != Qt::DisplayRole) return {};
    const bool showsMark = column.Id == SongFieldId::Flags && database_.ShownFlag() != 0;
    return showsMark ? FlagName(database_.ShownFlag()) : column.Caption();
}

// --- Order ---

void SongListModel::SetOrder(const SongOrder& order) {
    // A run goes through the list by position and must not find it in another order.
    if (database_.ProgressRunning())
        throw EMusicDatabaseException(u"Umsortieren der Datenbank ist momentan nicht möglich."_s);
    database_.SetOrder(order);
}

// --- What the database tells ---

void SongListModel::Subscribe() {
    CollectionEvents& events = database_.Events();
    subscriptions_ += events.Inserted.Subscribe([this](SongIndex index) {
        journal_.Insert(index);
        ScheduleSync();
    });
    subscriptions_ += events.Removed.Subscribe([this](SongIndex index, const TID3Tag&) {
        journal_.Remove(index);
        ScheduleSync();
    });
    subscriptions_ += events.Moved.Subscribe([this](SongIndex from, SongIndex to) {
        journal_.Move(from, to);
        ScheduleSync();
    });
    const auto redraw = [this] {
        contentChanged_ = true;
        ScheduleSync();
    };
    subscriptions_ += events.Changed.Subscribe([redraw](auto&&...) { redraw(); });
    subscriptions_ += events.MediaChanged.Subscribe(redraw);
    subscriptions_ += events.Reordering.Subscribe([this] {
        SyncViews();
        reordering_ = std::make_unique<Reordering>(*this);
    });
    subscriptions_ += events.Reordered.Subscribe([this] { reordering_.reset(); });
    subscriptions_ += events.Replaced.Subscribe([this] { Reset(); });
    subscriptions_ += events.Cleared.Subscribe([this] { Reset(); });
}

// --- Telling the views ---

void SongListModel::Reset() {
    syncTimer_.stop();
    beginResetModel();
    rows_ = database_.Count();
    journal_.Start(rows_);
    contentChanged_ = false;
    endResetModel();
}

void SongListModel::ScheduleSync() {
    if (journal_.NewCount() != database_.Count()) return Reset();  // songs came without being told
    if (journal_.Size() > kJournalLimit) return SyncViews();
    if (syncTimer_.isActive()) return;
    const qint64 rest = nextSync_ - CurrentClock().Ticks();
    syncTimer_.start(static_cast<int>(std::clamp<qint64>(rest, 0, kLongestRest)));
}

void SongListModel::SyncViews() {
    syncTimer_.stop();
    const qint64 begin = CurrentClock().Ticks();
    if (!journal_.Empty()) SyncRows();
    if (contentChanged_ && rows_ > 0) Q_EMIT dataChanged(index(0, 0), index(rows_ - 1, columnCount() - 1));
    contentChanged_ = false;
    const qint64 end = CurrentClock().Ticks();
    nextSync_ = end + std::max(kSyncInterval, (end - begin) * kRestPerWork);
}

// New rows first come at the end and removed rows last go from the end; between the two all rows take their
// places in one step. So the views have one look at their whole list and not one for every song.
void SongListModel::SyncRows() {
    const int after = journal_.NewCount();
    const bool onlyAppended = journal_.OldRowsStay();
    if (onlyAppended) journal_.Start(after);
    if (after > rows_) {
        beginInsertRows({}, rows_, after - 1);
        rows_ = after;
        endInsertRows();
    }
    if (!onlyAppended) PlaceRows();
    if (after < rows_) {
        beginRemoveRows({}, after, rows_ - 1);
        rows_ = after;
        endRemoveRows();
    }
}

void SongListModel::PlaceRows() {
    Q_EMIT layoutAboutToBeChanged({}, VerticalSortHint);
    const QModelIndexList before = persistentIndexList();
    QModelIndexList after;
    after.reserve(before.size());
    for (const QModelIndex& old : before)
        after << index(journal_.NewRowOf(old.row()), old.column());  // no index for a removed song
    journal_.Start(journal_.NewCount());
    changePersistentIndexList(before, after);
    Q_EMIT layoutChanged({}, VerticalSortHint);
}
