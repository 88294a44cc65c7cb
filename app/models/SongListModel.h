#pragma once

#include <QAbstractTableModel>
#include <QTimer>
#include <functional>

#include "MusicManagment/database/MusicManagment.h"
#include "app/models/RowJournal.h"

// The songs of the database as rows of a table; nothing is copied. A scan inserts thousands of songs a
// second, so views are told a few times a second at most: until then every row goes on showing the song that
// the views were told it shows, wherever that song stands by now.
class SongListModel : public QAbstractTableModel {
 public:
    explicit SongListModel(TMusicDatabase& database);
    ~SongListModel() override;

    // The song in a row; nullptr when it has been removed since the views were told.
    const TID3Tag* SongAt(int row) const;
    // Its position in the database; -1 when it has been removed.
    SongIndex IndexAt(int row) const;
    // Sorts the database. Throws EMusicDatabaseException while a long
    // operation runs.
    void SetOrder(const SongOrder& order);
    // Tells the views at once what has changed.
    void SyncViews();
    // Another flag is shown as a mark (TMusicDatabase::ShownFlag).
    void ShownFlagChanged();
    // The user clicked at the mark of a song, which is to have it or not.
    std::function<void(SongHandle song, bool on)> OnFlagClick;
    // Marks the song that plays, by its path; empty for none.
    void SetPlaying(const QString& path);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role = Qt::EditRole) override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
    class Reordering;

    void Subscribe();
    void Reset();
    void ScheduleSync();
    void SyncRows();
    void PlaceRows();
    bool ShowsMark(const QModelIndex& index) const;
    QVariant MediumLook(int row, int role) const;
    void ShowFontOf(const QString& path);

    TMusicDatabase& database_;
    RowJournal journal_;
    int rows_ = 0;                            // as the views know it
    bool contentChanged_ = false;             // of a song that stayed where it was
    std::unique_ptr<Reordering> reordering_;  // while all songs change their places
    QTimer syncTimer_;
    qint64 nextSync_ = 0;  // ticks of the clock
    QString playing_;
    Subscriptions subscriptions_;
};
