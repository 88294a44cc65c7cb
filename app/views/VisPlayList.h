#pragma once

#include <QTableView>
#include <QTimer>
#include <functional>

#include "MusicManagment/playlist/PlayListView.h"
#include "app/models/PlayListModel.h"

// The list of the songs to play. Songs are brought in and into another order by drag and drop; Alt+Up and
// Alt+Down move the selected ones as well.
class TVisPlayList : public QTableView, public PlayListView {
 public:
    explicit TVisPlayList(TPlayList& list, QWidget* parent = nullptr);
    ~TVisPlayList() override;

    // An entry is to be played.
    std::function<void(int index)> OnPlay;
    // Where the menu of the selected entries is asked for, on the screen.
    std::function<void(const QPoint&)> OnContextMenu;

    void PlaySelected();
    // Puts the selected entries into the queue, or takes them out.
    void QueueSelected();
    void UnqueueSelected();
    // Exchanges the selected entries with the one above or below them.
    void MoveSelected(int step);
    void ShowEntry(int index);
    // Shows in a moment which of the songs in sight are there now.
    void LookForFilesSoon();

    std::vector<int> SelectedEntries() const override;
    int CurrentEntry() const override { return currentIndex().row(); }

    void keyboardSearch(const QString& letters) override;
    // Never sideways.
    void scrollTo(const QModelIndex& index, ScrollHint hint = EnsureVisible) override;

    // Takes what comes from elsewhere, once the drop is over, before the entry at `position`.
    void TakeDrop(QDropEvent& event, int position);

 protected:
    void changeEvent(QEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dragMoveEvent(QDragMoveEvent* event) override;
    void dropEvent(QDropEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void startDrag(Qt::DropActions actions) override;

 private:
    void SetUpColumns();
    void FitColumns();
    void CountChanged();
    void LookForFiles();
    int DropRow(const QPoint& position) const;
    void ChooseAction(QDropEvent& event) const;
    void Select(int first, int count);
    void PlayEntry(int index);
    void MoveTo(int before);
    void Insert(int position, const DroppedSongs& drop);

    TPlayList& list_;
    PlayListModel model_{list_};
    qsizetype digits_ = 0;  // that the numbers have room for
    QTimer lookTimer_;
};
