#pragma once

#include <QDockWidget>

#include "CommonRUKTools/Listeners.h"

class QComboBox;
class QLabel;
class QSpinBox;
class QToolButton;
class TPlayList;
class TVisPlayList;

// The tool window of the playlist: the list, how it is played, and how long it takes. Songs and files can be
// dropped anywhere on it.
class TPlaylistForm : public QDockWidget {
 public:
    explicit TPlaylistForm(TPlayList& list, QWidget* parent = nullptr);

    TVisPlayList& View() { return *view_; }

 protected:
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dragMoveEvent(QDragMoveEvent* event) override;
    void dropEvent(QDropEvent* event) override;

 private:
    void FollowList();
    QWidget* MakeOptions();
    void SetUpOrder();
    void SetUpRepeat();
    void SetUpScan();
    void ShowOptions();
    void ShowTotals();
    void Consider(QDropEvent& drag) const;

    TPlayList& list_;
    TVisPlayList* view_;
    QComboBox* order_;
    QToolButton* repeat_;
    QToolButton* scan_;
    QSpinBox* scanTime_;
    QLabel* totals_;
    Subscriptions subscriptions_;
};
