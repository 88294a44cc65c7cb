#pragma once

#include <QDialog>
#include <QTimer>
#include <functional>

#include "app/models/SearchHitsModel.h"

class QLabel;
class QPushButton;
class QTableView;

// Shows what a search in the Internet has found, while it is still being read; closing the window ends that.
class OnlineSearchForm : public QDialog {
 public:
    // A service may know nothing but artist and title.
    enum class Details { ArtistAndTitle, Album };

    OnlineSearchForm(HitSource source, Details details, QWidget* parent = nullptr);

    // The user wants a hit in the tag of a song, or the cover of its album.
    std::function<void(const SearchHit& hit)> OnTake;
    std::function<void(const SearchHit& hit)> OnTakeCover;

 private:
    void SetUpTable();
    void FitColumns();
    void SetUpLayout();
    void ReadOn();
    void ShowState();
    const SearchHit* Chosen() const;

    HitSource source_;
    Details details_;
    SearchHitsModel* hits_;
    QTableView* table_;
    QLabel* count_;
    QPushButton* take_;
    QPushButton* cover_;
    QTimer readOn_;
};
