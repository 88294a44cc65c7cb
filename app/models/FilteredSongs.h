#pragma once

#include <QAbstractProxyModel>
#include <functional>
#include <optional>
#include <vector>

#include "MusicManagment/database/search/SongFilter.h"
#include "app/models/SongListModel.h"

// An order by a column that the database has no order for. Songs that it finds equal keep the order of the
// database.
struct ShownOrder {
    int Column;
    bool Backwards = false;
};
// The rows of the song list that a filter lets through, in their order or another. Without either every row
// is its own and nothing is kept for any of them. A change of the filter is told in one step, and what views
// hold on to (focus, selection) stays with the songs that are still shown.
class FilteredSongs : public QAbstractProxyModel {
 public:
    using Restriction = std::function<bool(const TID3Tag&)>;

    explicit FilteredSongs(SongListModel& songs, QObject* parent = nullptr);

    // What the user has typed, see SongFilter.
    void SetText(const QString& text);
    const QString& Text() const { return text_; }
    // What else songs must fulfil to be shown; an empty function for nothing. Several threads ask it at once.
    void SetRestriction(Restriction restriction);
    bool Restricted() const { return restriction_ != nullptr; }
    // Nothing for the order of the database.
    void SetOrder(std::optional<ShownOrder> order);
    const std::optional<ShownOrder>& Order() const { return order_; }
    // After each change of the text or the restriction.
    std::function<void()> OnFilterChange;

    const SongListModel& Songs() const { return songs_; }
    SongListModel& Songs() { return songs_; }
    // The song in a row; nullptr when it has been removed since the views were told.
    const TID3Tag* SongAt(int row) const;
    // Its position in the database; -1 when it has been removed.
    SongIndex IndexAt(int row) const;
    int SourceRow(int row) const;
    // -1 when the row is not shown.
    int RowOfSource(int sourceRow) const;

    QModelIndex mapFromSource(const QModelIndex& index) const override;
    QModelIndex mapToSource(const QModelIndex& index) const override;
    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QModelIndex parent(const QModelIndex& child) const override;
    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    bool hasChildren(const QModelIndex& parent = {}) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
    using Rows = std::vector<int>;  // of the song list

    void FollowSongs();
    void RowsInserted(int first, int last);
    void RowsAboutToBeRemoved(int first, int last);
    void RowsRemoved(int first, int last);
    void LayoutAboutToBeChanged();
    void LayoutChanged();
    void DataChanged(const QModelIndex& topLeft, const QModelIndex& bottomRight);

    // Whether rows are others, or stand in another order, than those of the song list.
    bool Wanted() const { return !filter_.IsEmpty() || restriction_ || order_; }
    bool Passes(const TID3Tag& song) const;
    Rows Passing(const Rows& rows) const;
    Rows Passing(int first, int last) const;
    Rows AllPassing() const;
    Rows Sorted(const Rows& rows) const;
    void ApplyFilter(bool narrower);
    void Show(Rows rows);
    void SetShown(Rows rows);
    void GrowTo(int rows);
    void ShrinkTo(int rows);
    int WantedRows() const;

    SongListModel& songs_;
    QString text_;
    SongFilter filter_;
    Restriction restriction_;
    std::optional<ShownOrder> order_;
    bool filtering_ = false;
    Rows shown_;    // while filtering; ascending unless there is an order
    Rows places_;   // with an order: where each row of the song list stands in `shown_`, -1 nowhere
    int rows_ = 0;  // as the views know it; while the rows are exchanged some behind the last show nothing
    bool removing_ = false;
    QModelIndexList held_;  // by the views, while the song list changes its order
    std::vector<QPersistentModelIndex> heldSongs_;
};
