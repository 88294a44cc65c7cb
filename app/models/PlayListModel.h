#pragma once

#include <QAbstractTableModel>
#include <QHash>

#include "MusicManagment/playlist/PlayList.h"
#include "app/models/FilePresence.h"
#include "app/models/SongMime.h"

enum class PlayListColumn { Number, Title, Length };

// The entries of a playlist as rows of a table; nothing is copied.
class PlayListModel : public QAbstractTableModel {
 public:
    enum Role {
        // Place in the queue, counted from 1; nothing for entries that do not wait.
        QueueRole = Qt::UserRole + 1,
        // Whether it is the entry that plays.
        CurrentRole,
    };

    // Follows the changes of the list.
    explicit PlayListModel(TPlayList& list, QObject* parent = nullptr);

    TPlayList& List() { return list_; }
    // The entry that plays; -1 when it is not listed.
    int CurrentRow() const { return current_; }
    // Has the files of these rows looked for; those that are missing are shown so as soon as that is known.
    void LookForFiles(int first, int last);
    // As drag and drop takes them along.
    std::vector<SongRef> Songs(const std::vector<int>& rows) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    QStringList mimeTypes() const override;
    Qt::DropActions supportedDropActions() const override { return Qt::CopyAction | Qt::MoveAction; }

 private:
    void FollowList();
    void Reset();
    void EntryInserted(int row);
    void EntryRemoved(int row);
    void EntriesMoved(const std::vector<int>& former);
    void CurrentChanged();
    void ShowAgain(int first, int last);
    int QueuePlace(int row) const { return list_.QueuePosition(row) + 1; }
    bool IsMissing(const QString& name) const;
    QString Text(int row, PlayListColumn column) const;
    QString Spoken(int row, PlayListColumn column) const;
    QVariant Font(int row) const;
    QString ToolTip(int row) const;

    TPlayList& list_;
    FilePresence files_;
    QHash<QString, QString> paths_;  // of entries that are no files themselves, as far as looked for
    int rows_ = 0;                   // as the views know it
    int current_ = -1;
    Subscriptions subscriptions_;
};
