#pragma once

#include <QAbstractTableModel>
#include <QTimer>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"

// One of the summary lists as a table of captions and song counts; the first row stands for all groups. A
// scan changes the lists thousands of times a second, so the model shows the list as it was when its views
// were told last, which happens a few times a second at most.
class OverviewModel : public QAbstractTableModel {
 public:
    enum Column { CaptionColumn, SongsColumn, ColumnCount };
    static constexpr int kAllRow = 0;

    explicit OverviewModel(TMusicDatabase& database);

    TOVType Type() const { return type_; }
    void SetType(TOVType type);
    // Only groups whose captions contain `text` are shown; case and umlauts do not matter.
    void SetFilter(const QString& text);
    // The group's own caption, empty where none was given; not for the row of all groups.
    const QString& GroupCaptionOf(int row) const { return groups_[GroupPlace(row)].Caption; }
    // The row of the summary list when the views were told last; not for the row of all groups.
    int ListRowOf(int row) const { return groups_[GroupPlace(row)].ListRow; }
    // Tells the views at once what has changed.
    void SyncViews();
    bool SyncPending() const { return syncTimer_.isActive(); }

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
    struct Group {
        QString Caption;
        int SongCount = 0;
        int ListRow = 0;
    };
    using Groups = std::vector<Group>;
    struct Totals {
        int GroupCount = 0;  // with at least one song
        qint64 SongCount = 0;
    };

    static std::size_t GroupPlace(int row) { return static_cast<std::size_t>(row - 1); }
    QString Text(int row, int column) const;
    Groups ReadGroups(Totals& totals) const;
    void Subscribe();
    void ScheduleSync(TOVType type);
    void PlaceRows(Groups groups);
    QModelIndexList NewPlaces(const QModelIndexList& held, std::size_t known, const Groups& groups) const;
    void Reset();

    QPointer<TMusicDatabase> database_;
    TOVType type_ = ovArtist;
    QString filter_;  // folded
    Groups groups_;   // as the views know them
    Totals totals_;
    QTimer syncTimer_;
    qint64 nextSync_ = 0;  // ticks of the clock
    Subscriptions subscriptions_;
};
