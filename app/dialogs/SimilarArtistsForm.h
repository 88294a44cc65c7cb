#pragma once

#include <QDialog>
#include <QTimer>
#include <array>
#include <functional>

#include "CommonRUKTools/Listeners.h"
#include "app/models/SimilarArtistsModel.h"

class QLabel;
class QLineEdit;
class QPushButton;
class QSplitter;
class QTableView;
class SongRows;

// Shows artists that may be one, and the songs of the chosen pair, and unites them under one spelling. It
// stays open beside the main window: a row goes with its artists, and comes again with them.
class SimilarArtistsForm : public QDialog {
 public:
    SimilarArtistsForm(TMusicDatabase& database, QWidget* parent = nullptr);

    // `stopped`: the search was ended before its time.
    void SetPairs(std::vector<SimilarArtists> pairs, bool stopped);

    // Takes back the last step of the user; false where there was none.
    std::function<bool()> OnUndo;
    // Offers to correct all songs as a file of corrections says.
    std::function<void()> OnCorrect;

 protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

 private:
    class OpenPairs;
    enum class Spelling { First, Second, Other, AreTwo };

    void SetUpTable();
    QSplitter* MakeSongLists();
    QWidget* MakeButtons();
    void SetUpLayout();
    void FollowDatabase();
    void Refresh();
    void ShowPair();
    void ShowSongs();
    void ShowCount();
    // The row of the model; -1 for none.
    int CurrentRow() const;
    void Decide(Spelling spelling);
    void Unify(const QStringList& artists, const QString& spelling);
    bool LeavesFilter(int key);

    TMusicDatabase& database_;
    SimilarArtistsModel* pairs_;
    OpenPairs* shown_;
    QLineEdit* filter_;
    QLabel* count_;
    QTableView* table_;
    std::array<SongRows*, 2> songs_{};
    std::array<QLabel*, 2> headings_{};
    std::array<QPushButton*, 4> decisions_{};
    QLabel* done_;
    QTimer songsLater_;  // a moment after the row was chosen: whoever runs down the rows does not wait
    QTimer refreshLater_;
    bool stopped_ = false;
    Subscriptions subscriptions_;
};
