#pragma once

#include <QDockWidget>

class QComboBox;
class QLabel;
class QSpinBox;
class QToolButton;
class TPlayList;
class TVisPlayList;

// The tool window of the playlist: the list, how it is played, and how long it takes.
class TPlaylistForm : public QDockWidget {
 public:
    explicit TPlaylistForm(TPlayList& list, QWidget* parent = nullptr);

    TVisPlayList& View() { return *view_; }
    // Shows how the list is played, which can have been set elsewhere.
    void ShowOptions();

 protected:
    void changeEvent(QEvent* event) override;
    void showEvent(QShowEvent* event) override;

 private:
    QWidget* MakeOptions();
    void SetUpOrder();
    void SetUpRepeat();
    void SetUpScan();
    void ShowTotals();

    TPlayList& list_;
    TVisPlayList* view_;
    QComboBox* order_;
    QToolButton* repeat_;
    QToolButton* scan_;
    QSpinBox* scanTime_;
    QLabel* totals_;
};
