#pragma once

#include <QPersistentModelIndex>
#include <QTableView>

#include "MusicManagment/database/Sorting.h"

class SongListModel;
class TMusicDatabase;

// The list of songs. A click on a column's header sorts by it, a second one backwards.
class SongListWidget : public QTableView {
 public:
    SongListWidget(SongListModel& model, TMusicDatabase& database, QWidget* parent = nullptr);

    // Sorts the database; the focused song stays in sight when the database wants that. Throws
    // EMusicDatabaseException while a long operation runs.
    void SetOrder(const SongOrder& order);
    // Whether a click on a header sorts.
    void SetSortingAllowed(bool allowed);

 protected:
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void changeEvent(QEvent* event) override;

 private:
    void SetUpLook();
    void SetUpHeader();
    void FitToFont();
    void SetColumnWidths();
    void HeaderClicked(int section);
    void ShowSortIndicator();
    void FollowModel();
    void KeepTopRow();
    void RestoreTopRow();
    void RestoreFocus();

    SongListModel& model_;
    TMusicDatabase& database_;
    QString focusedPath_;
    QPersistentModelIndex topRow_;
    bool sorting_ = false;
};
