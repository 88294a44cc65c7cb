#pragma once

#include <QTableView>
#include <functional>
#include <vector>

class DuplicateListModel;

// What the user decides about pairs of songs.
enum class PairDecision { KeepFirst, KeepSecond, KeepBoth, Ban };

// The list of the pairs that a search has found. One key decides about the chosen rows: 1, 2, B, V; the space
// bar plays, and plays the other song of the pair.
class TSrchDblsListView : public QTableView {
 public:
    explicit TSrchDblsListView(DuplicateListModel& pairs, QWidget* parent = nullptr);

    std::function<void(PairDecision)> OnDecision;
    std::function<void()> OnListen;
    // Another row has the focus, -1 none, or it shows something else.
    std::function<void(int row)> OnRow;

    // Ascending.
    std::vector<int> ChosenRows() const;
    void ShowGroups(bool shown);

 protected:
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void keyPressEvent(QKeyEvent* event) override;
    void changeEvent(QEvent* event) override;

 private:
    void SetUpColumns();
    void FitCaptions();
    void FollowModel();
    void KeepRow();
    void RestoreRow();

    DuplicateListModel& pairs_;
    int keptRow_ = -1;  // that had the focus before the rows were arranged anew
    quint32 keptNumber_ = 0;
};
