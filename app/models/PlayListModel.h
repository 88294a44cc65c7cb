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
        // Whether it is the song that plays.
        CurrentRole,
    };

    // Follows the changes of the list, whose OnChange is taken by this model.
    explicit PlayListModel(TPlayList& list, QObject* parent = nullptr);
    ~PlayListModel() override;

    TPlayList& List() { return list_; }
    // -1 when the song that plays is not listed.
    int CurrentRow() const { return current_; }
    // Reads the whole list anew.
    void Refresh();
    // The current song or the queue has changed.
    void Redraw();
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
    void ListChanged(int index, TChangeType change);
    void ShowAgain(int first, int last);
    int QueuePlace(const QString& name) const;
    bool IsMissing(const QString& name) const;
    QString Text(int row, PlayListColumn column) const;
    QString Spoken(int row, PlayListColumn column) const;
    QVariant Font(int row) const;
    QString ToolTip(int row) const;

    TPlayList& list_;
    FilePresence files_;
    QHash<QString, QString> paths_;      // of entries that are no files themselves, as far as looked for
    mutable QHash<QString, int> queue_;  // places, counted from 1
    mutable bool queueIsKnown_ = false;
    int rows_ = 0;  // as the views know it
    int current_ = -1;
};
