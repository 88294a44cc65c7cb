#include "app/models/OverviewModel.h"

#include <QFont>
#include <QGuiApplication>
#include <QHash>
#include <QLocale>
#include <QPalette>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/FoldedText.h"

using namespace Qt::StringLiterals;

namespace {

// Milliseconds between two times at which the views are told.
constexpr qint64 kSyncInterval = 250;
// Reading a long list takes its time; it gets at most the tenth part of a scan.
constexpr qint64 kRestPerWork = 9;
constexpr qint64 kLongestRest = 3000;

QString Number(qint64 number) {
    return QLocale(QLocale::German).toString(number);
}

QString ShownCaption(const QString& caption) {
    return caption.isEmpty() ? u"(ohne Angabe)"_s : caption;
}

// A caption that only stands in for a missing one must not look like a name.
QVariant StandInLook(int role) {
    if (role == Qt::ForegroundRole) return QGuiApplication::palette().color(QPalette::PlaceholderText);
    if (role != Qt::FontRole) return {};
    QFont font;
    font.setItalic(true);
    return font;
}

}  // namespace

OverviewModel::OverviewModel(TMusicDatabase& database) : database_(&database) {
    syncTimer_.setSingleShot(true);
    QObject::connect(&syncTimer_, &QTimer::timeout, this, &OverviewModel::SyncViews);
    Subscribe();
    groups_ = ReadGroups(totals_);
}

void OverviewModel::SetType(TOVType type) {
    if (type == type_) return;
    type_ = type;
    Reset();
}

void OverviewModel::SetFilter(const QString& text) {
    const QString folded = FoldText(text);
    if (folded == filter_) return;
    filter_ = folded;
    SyncViews();
}

// --- What views ask ---

int OverviewModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(groups_.size()) + 1;
}

int OverviewModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant OverviewModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    if (role == Qt::DisplayRole) return Text(index.row(), index.column());
    if (role == Qt::TextAlignmentRole && index.column() == SongsColumn)
        return (Qt::AlignRight | Qt::AlignVCenter).toInt();
    if (index.row() == kAllRow || index.column() != CaptionColumn) return {};
    const QString& caption = GroupCaptionOf(index.row());
    if (role == Qt::ToolTipRole) return ShownCaption(caption);
    return caption.isEmpty() ? StandInLook(role) : QVariant();
}

QString OverviewModel::Text(int row, int column) const {
    if (row == kAllRow)
        return column == SongsColumn ? Number(totals_.SongCount)
                                     : u"Alle ("_s + Number(totals_.GroupCount) + u')';
    if (column == SongsColumn) return Number(groups_[GroupPlace(row)].SongCount);
    return ShownCaption(GroupCaptionOf(row));
}

QVariant OverviewModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || section < 0 || section >= ColumnCount) return {};
    if (role == Qt::TextAlignmentRole && section == SongsColumn)
        return (Qt::AlignRight | Qt::AlignVCenter).toInt();
    if (role == Qt::TextAlignmentRole) return (Qt::AlignLeft | Qt::AlignVCenter).toInt();
    if (role != Qt::DisplayRole) return {};
    static constexpr const char16_t* kCaptions[kOverviewTypeCount] = {u"Artist", u"Album", u"Jahr", u"Länge",
                                                                      u"Genre"};
    return section == SongsColumn ? u"Songs"_s : QString::fromUtf16(kCaptions[type_]);
}

// --- What the database tells ---

void OverviewModel::Subscribe() {
    GroupEvents& groups = database_->GroupChanges();
    subscriptions_ += groups.Rebuilt.Subscribe([this] { ScheduleSync(type_); });
    subscriptions_ += groups.Inserted.Subscribe([this](TOVType type, auto&&...) { ScheduleSync(type); });
    subscriptions_ += groups.Deleted.Subscribe([this](TOVType type, int) { ScheduleSync(type); });
    subscriptions_ += groups.Updated.Subscribe([this](TOVType type, int, int) { ScheduleSync(type); });
}

void OverviewModel::ScheduleSync(TOVType type) {
    if (type != type_ || syncTimer_.isActive()) return;
    const qint64 rest = nextSync_ - CurrentClock().Ticks();
    syncTimer_.start(static_cast<int>(std::clamp<qint64>(rest, 0, kLongestRest)));
}

// --- Telling the views ---

OverviewModel::Groups OverviewModel::ReadGroups(Totals& totals) const {
    Groups groups;
    totals = {};
    if (database_ == nullptr) return groups;
    const GroupLists& lists = database_->Groups();
    const int count = lists.RowCount(type_);
    if (filter_.isEmpty()) groups.reserve(static_cast<std::size_t>(count));
    for (int row = 0; row < count; ++row) {
        Group group{lists.RowCaption(type_, row), lists.RowSongCount(type_, row), row};
        totals.SongCount += group.SongCount;
        if (group.SongCount > 0) ++totals.GroupCount;
        if (filter_.isEmpty() || ContainsFolded(ShownCaption(group.Caption), filter_))
            groups.push_back(std::move(group));
    }
    return groups;
}

void OverviewModel::SyncViews() {
    syncTimer_.stop();
    const qint64 begin = CurrentClock().Ticks();
    Groups groups = ReadGroups(totals_);
    if (std::ranges::equal(groups, groups_, {}, &Group::Caption, &Group::Caption))
        groups_ = std::move(groups);
    else
        PlaceRows(std::move(groups));
    Q_EMIT dataChanged(index(0, 0), index(rowCount() - 1, ColumnCount - 1));
    const qint64 end = CurrentClock().Ticks();
    nextSync_ = end + std::max(kSyncInterval, (end - begin) * kRestPerWork);
}

// New rows first come at the end and removed rows last go from the end; between the two all rows take their
// places in one step. So the views have one look at their whole list and not one for every group.
void OverviewModel::PlaceRows(Groups groups) {
    const auto before = groups_.size();
    const auto after = groups.size();
    if (after > before) {
        beginInsertRows({}, static_cast<int>(before) + 1, static_cast<int>(after));
        groups_.resize(after);
        endInsertRows();
    }
    Q_EMIT layoutAboutToBeChanged({}, VerticalSortHint);
    const QModelIndexList held = persistentIndexList();
    const QModelIndexList places = NewPlaces(held, before, groups);
    groups.resize(std::max(before, after));
    groups_ = std::move(groups);
    changePersistentIndexList(held, places);
    Q_EMIT layoutChanged({}, VerticalSortHint);
    if (after < before) {
        beginRemoveRows({}, static_cast<int>(after) + 1, static_cast<int>(before));
        groups_.resize(after);
        endRemoveRows();
    }
}

// Where rows that the views hold on to stand in `groups`; no index for a removed group. The first `known`
// groups have been told to the views.
QModelIndexList OverviewModel::NewPlaces(const QModelIndexList& held, std::size_t known,
                                         const Groups& groups) const {
    const auto isGroup = [known](int row) { return row != kAllRow && GroupPlace(row) < known; };
    QHash<QString, int> rows;
    for (const QModelIndex& index : held)
        if (isGroup(index.row())) rows.insert(GroupCaptionOf(index.row()), -1);
    for (std::size_t i = 0; i < groups.size() && !rows.isEmpty(); ++i)
        if (const auto found = rows.find(groups[i].Caption); found != rows.end())
            *found = static_cast<int>(i) + 1;
    QModelIndexList places;
    places.reserve(held.size());
    for (const QModelIndex& old : held) {
        int row = old.row() == kAllRow ? kAllRow : -1;
        if (isGroup(old.row())) row = rows.value(GroupCaptionOf(old.row()));
        places << index(row, old.column());
    }
    return places;
}

void OverviewModel::Reset() {
    syncTimer_.stop();
    beginResetModel();
    groups_ = ReadGroups(totals_);
    endResetModel();
}
