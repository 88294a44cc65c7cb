#include "app/models/FilteredSongs.h"

#include <QStringList>
#include <algorithm>
#include <functional>
#include <numeric>

#include "app/models/ColumnRanks.h"
#include "app/models/PassingSongs.h"

using namespace Qt::StringLiterals;

namespace {

// A last word that was typed on finds fewer songs only when it is looked for as it stands: "-a" becoming
// "-ab" excludes fewer, "jahr:198" becoming "jahr:1980" finds others.
bool WordNarrows(const QString& before, const QString& after) {
    if (before == after) return true;
    return after.startsWith(before) && !after.startsWith(u'-') && !after.contains(u':');
}

// Whether every song that passes `after` has passed `before`; false also where that is not easily seen.
bool Narrows(const QString& before, const QString& after) {
    if (before.contains(u'"') || after.contains(u'"')) return before.isEmpty();
    const QStringList old = before.simplified().split(u' ', Qt::SkipEmptyParts);
    const QStringList now = after.simplified().split(u' ', Qt::SkipEmptyParts);
    if (now.size() < old.size()) return false;
    return std::equal(old.begin(), old.end(), now.begin(), &WordNarrows);
}

}  // namespace

FilteredSongs::FilteredSongs(SongListModel& songs, QObject* parent)
    : QAbstractProxyModel(parent), songs_(songs) {
    setSourceModel(&songs);
    rows_ = songs.rowCount();
    FollowSongs();
}

// --- The filter ---

void FilteredSongs::SetText(const QString& text) {
    if (text == text_) return;
    const bool narrower = Narrows(text_, text);
    text_ = text;
    filter_ = SongFilter::Parse(text);
    ApplyFilter(narrower);
}

void FilteredSongs::SetRestriction(Restriction restriction) {
    const bool narrower = !restriction_;
    restriction_ = std::move(restriction);
    ApplyFilter(narrower);
}

void FilteredSongs::SetOrder(std::optional<ShownOrder> order) {
    if (!order && !order_) return;
    order_ = order;
    Show(Wanted() ? AllPassing() : Rows());
}

bool FilteredSongs::Passes(const TID3Tag& song) const {
    return (!restriction_ || restriction_(song)) && filter_.Matches(song);
}

FilteredSongs::Rows FilteredSongs::Passing(const Rows& rows) const {
    std::vector<const TID3Tag*> songs;
    Rows there;
    songs.reserve(rows.size());
    there.reserve(rows.size());
    for (const int row : rows) {
        const TID3Tag* song = songs_.SongAt(row);
        if (song == nullptr) continue;
        songs.push_back(song);
        there.push_back(row);
    }
    const auto passed = TestSongs(songs, [this](const TID3Tag& song) { return Passes(song); });
    Rows passing;
    for (std::size_t place = 0; place < there.size(); ++place)
        if (passed[place]) passing.push_back(there[place]);
    return passing;
}

FilteredSongs::Rows FilteredSongs::Passing(int first, int last) const {
    Rows rows(static_cast<std::size_t>(last - first + 1));
    std::iota(rows.begin(), rows.end(), first);
    return Passing(rows);
}

FilteredSongs::Rows FilteredSongs::AllPassing() const {
    Rows rows = Passing(0, songs_.rowCount() - 1);
    return order_ ? Sorted(rows) : rows;
}

FilteredSongs::Rows FilteredSongs::Sorted(const Rows& rows) const {
    std::vector<const TID3Tag*> songs;
    songs.reserve(rows.size());
    for (const int row : rows)
        songs.push_back(songs_.SongAt(row));
    const std::vector<int> ranks =
        ColumnRanks(SongColumns()[static_cast<std::size_t>(order_->Column)], songs);
    std::vector<std::size_t> order(rows.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    const auto rankOf = [&ranks](std::size_t place) { return ranks[place]; };
    if (order_->Backwards)
        std::ranges::stable_sort(order, std::greater(), rankOf);
    else
        std::ranges::stable_sort(order, std::less(), rankOf);
    Rows sorted;
    sorted.reserve(rows.size());
    for (const std::size_t place : order)
        sorted.push_back(rows[place]);
    return sorted;
}

void FilteredSongs::ApplyFilter(bool narrower) {
    Rows rows;
    if (filtering_ && narrower)
        rows = Passing(shown_);
    else if (Wanted())
        rows = AllPassing();
    if (filtering_ != Wanted() || rows != shown_) Show(std::move(rows));
    if (OnFilterChange) OnFilterChange();
}

// --- Which row is which ---

int FilteredSongs::SourceRow(int row) const {
    if (row < 0) return -1;
    if (!filtering_) return row < songs_.rowCount() ? row : -1;
    return row < static_cast<int>(shown_.size()) ? shown_[static_cast<std::size_t>(row)] : -1;
}

int FilteredSongs::RowOfSource(int sourceRow) const {
    if (sourceRow < 0) return -1;
    if (!filtering_) return sourceRow < rows_ ? sourceRow : -1;
    if (!places_.empty())
        return sourceRow < static_cast<int>(places_.size()) ? places_[static_cast<std::size_t>(sourceRow)]
                                                            : -1;
    const auto found = std::ranges::lower_bound(shown_, sourceRow);
    return found != shown_.end() && *found == sourceRow ? static_cast<int>(found - shown_.begin()) : -1;
}

const TID3Tag* FilteredSongs::SongAt(int row) const {
    const int sourceRow = SourceRow(row);
    return sourceRow >= 0 ? songs_.SongAt(sourceRow) : nullptr;
}

SongIndex FilteredSongs::IndexAt(int row) const {
    const int sourceRow = SourceRow(row);
    return sourceRow >= 0 ? songs_.IndexAt(sourceRow) : -1;
}

QModelIndex FilteredSongs::mapFromSource(const QModelIndex& index) const {
    const int row = index.isValid() ? RowOfSource(index.row()) : -1;
    return row >= 0 ? createIndex(row, index.column()) : QModelIndex();
}

QModelIndex FilteredSongs::mapToSource(const QModelIndex& index) const {
    const int row = index.isValid() ? SourceRow(index.row()) : -1;
    return row >= 0 ? songs_.index(row, index.column()) : QModelIndex();
}

QModelIndex FilteredSongs::index(int row, int column, const QModelIndex& parent) const {
    return hasIndex(row, column, parent) ? createIndex(row, column) : QModelIndex();
}

QModelIndex FilteredSongs::parent(const QModelIndex&) const {
    return {};
}

int FilteredSongs::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : rows_;
}

int FilteredSongs::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : songs_.columnCount();
}

bool FilteredSongs::hasChildren(const QModelIndex& parent) const {
    return rowCount(parent) > 0;
}

// The base would ask the first row, which a filter may have left none of.
QVariant FilteredSongs::headerData(int section, Qt::Orientation orientation, int role) const {
    return songs_.headerData(section, orientation, role);
}

// --- Exchanging the rows ---

int FilteredSongs::WantedRows() const {
    return filtering_ ? static_cast<int>(shown_.size()) : songs_.rowCount();
}

// New rows first come at the end and those too many last go from the end; between the two all rows change
// at once. So views look at their whole list once, however the rows that come and go are scattered.
void FilteredSongs::Show(Rows rows) {
    GrowTo(Wanted() ? static_cast<int>(rows.size()) : songs_.rowCount());
    Q_EMIT layoutAboutToBeChanged({}, VerticalSortHint);
    const QModelIndexList before = persistentIndexList();
    Rows sourceRows;
    sourceRows.reserve(static_cast<std::size_t>(before.size()));
    for (const QModelIndex& old : before)
        sourceRows.push_back(SourceRow(old.row()));
    filtering_ = Wanted();
    SetShown(std::move(rows));
    QModelIndexList after;
    after.reserve(before.size());
    for (qsizetype i = 0; i < before.size(); ++i)
        after << index(RowOfSource(sourceRows[static_cast<std::size_t>(i)]), before[i].column());
    changePersistentIndexList(before, after);
    Q_EMIT layoutChanged({}, VerticalSortHint);
    ShrinkTo(WantedRows());
}

void FilteredSongs::SetShown(Rows rows) {
    shown_ = std::move(rows);
    places_.clear();
    if (!order_) return;
    places_.resize(static_cast<std::size_t>(songs_.rowCount()), -1);
    for (std::size_t place = 0; place < shown_.size(); ++place)
        places_[static_cast<std::size_t>(shown_[place])] = static_cast<int>(place);
}

void FilteredSongs::GrowTo(int rows) {
    if (rows <= rows_) return;
    beginInsertRows({}, rows_, rows - 1);
    rows_ = rows;
    endInsertRows();
}

void FilteredSongs::ShrinkTo(int rows) {
    if (rows >= rows_) return;
    beginRemoveRows({}, rows, rows_ - 1);
    rows_ = rows;
    endRemoveRows();
}

// --- What the song list tells ---

void FilteredSongs::FollowSongs() {
    connect(&songs_, &QAbstractItemModel::modelAboutToBeReset, this, [this] { beginResetModel(); });
    connect(&songs_, &QAbstractItemModel::modelReset, this, [this] {
        SetShown(filtering_ ? AllPassing() : Rows());
        rows_ = WantedRows();
        endResetModel();
    });
    connect(&songs_, &QAbstractItemModel::headerDataChanged, this, &QAbstractItemModel::headerDataChanged);
    const auto beforeInsert = [this](const QModelIndex&, int first, int last) {
        if (!filtering_) beginInsertRows({}, first, last);
    };
    connect(&songs_, &QAbstractItemModel::rowsAboutToBeInserted, this, beforeInsert);
    connect(&songs_, &QAbstractItemModel::rowsInserted, this,
            [this](const QModelIndex&, int first, int last) { RowsInserted(first, last); });
    connect(&songs_, &QAbstractItemModel::rowsAboutToBeRemoved, this,
            [this](const QModelIndex&, int first, int last) { RowsAboutToBeRemoved(first, last); });
    connect(&songs_, &QAbstractItemModel::rowsRemoved, this,
            [this](const QModelIndex&, int first, int last) { RowsRemoved(first, last); });
    connect(&songs_, &QAbstractItemModel::layoutAboutToBeChanged, this,
            &FilteredSongs::LayoutAboutToBeChanged);
    connect(&songs_, &QAbstractItemModel::layoutChanged, this, &FilteredSongs::LayoutChanged);
    connect(&songs_, &QAbstractItemModel::dataChanged, this, &FilteredSongs::DataChanged);
}

void FilteredSongs::RowsInserted(int first, int last) {
    const int count = last - first + 1;
    if (!filtering_) {
        rows_ += count;
        return endInsertRows();
    }
    if (order_) {
        for (int& row : shown_)
            if (row >= first) row += count;
        return Show(AllPassing());
    }
    const Rows added = Passing(first, last);
    const auto at = std::ranges::lower_bound(shown_, first);
    std::for_each(at, shown_.end(), [count](int& row) { row += count; });
    if (added.empty()) return;
    const int row = static_cast<int>(at - shown_.begin());
    beginInsertRows({}, row, row + static_cast<int>(added.size()) - 1);
    shown_.insert(at, added.begin(), added.end());
    rows_ = WantedRows();
    endInsertRows();
}

void FilteredSongs::RowsAboutToBeRemoved(int first, int last) {
    if (order_) {
        Rows rest = shown_;
        std::erase_if(rest, [first, last](int row) { return row >= first && row <= last; });
        Show(std::move(rest));
        removing_ = false;
        return;
    }
    if (filtering_) {
        first = static_cast<int>(std::ranges::lower_bound(shown_, first) - shown_.begin());
        last = static_cast<int>(std::ranges::upper_bound(shown_, last) - shown_.begin()) - 1;
    }
    removing_ = first <= last;
    if (removing_) beginRemoveRows({}, first, last);
}

void FilteredSongs::RowsRemoved(int first, int last) {
    const int count = last - first + 1;
    if (order_) {
        Rows rows = shown_;
        for (int& row : rows)
            if (row > last) row -= count;
        return SetShown(std::move(rows));
    }
    const auto from =
        shown_.erase(std::ranges::lower_bound(shown_, first), std::ranges::upper_bound(shown_, last));
    std::for_each(from, shown_.end(), [count](int& row) { row -= count; });
    rows_ = WantedRows();
    if (removing_) endRemoveRows();
}

// How many rows will be shown turns out only when the order has changed: rows are added for all of them.
void FilteredSongs::LayoutAboutToBeChanged() {
    if (filtering_) GrowTo(songs_.rowCount());
    Q_EMIT layoutAboutToBeChanged({}, VerticalSortHint);
    held_ = persistentIndexList();
    heldSongs_.clear();
    heldSongs_.reserve(static_cast<std::size_t>(held_.size()));
    for (const QModelIndex& held : std::as_const(held_))
        heldSongs_.emplace_back(mapToSource(held));
}

void FilteredSongs::LayoutChanged() {
    if (filtering_) SetShown(AllPassing());
    QModelIndexList after;
    after.reserve(held_.size());
    for (const QPersistentModelIndex& song : heldSongs_)
        after << mapFromSource(song);
    changePersistentIndexList(held_, after);
    held_.clear();
    heldSongs_.clear();
    Q_EMIT layoutChanged({}, VerticalSortHint);
    ShrinkTo(WantedRows());
}

void FilteredSongs::DataChanged(const QModelIndex& topLeft, const QModelIndex& bottomRight) {
    if (order_) {
        if (Rows rows = AllPassing(); rows != shown_) Show(std::move(rows));
    } else if (filtering_) {
        const auto first = std::ranges::lower_bound(shown_, topLeft.row());
        const auto behind = std::ranges::upper_bound(shown_, bottomRight.row());
        Rows rows(shown_.begin(), first);
        const Rows changed = Passing(topLeft.row(), bottomRight.row());
        rows.insert(rows.end(), changed.begin(), changed.end());
        rows.insert(rows.end(), behind, shown_.end());
        if (rows != shown_) Show(std::move(rows));
    }
    if (rows_ > 0) Q_EMIT dataChanged(index(0, topLeft.column()), index(rows_ - 1, bottomRight.column()));
}
