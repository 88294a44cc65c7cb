#pragma once

#include <QThreadPool>
#include <QTimer>
#include <QWidget>
#include <array>
#include <atomic>
#include <functional>
#include <memory>
#include <optional>

#include "MusicManagment/database/MusicManagment.h"
#include "app/models/SongDifferences.h"

class CoverView;
class QLabel;
class QPushButton;
class QTableWidget;

// Two songs side by side: what their records and files tell, where they differ, and which one is better.
class TCompFilesForm : public QWidget {
 public:
    explicit TCompFilesForm(TMusicDatabase& database, QWidget* parent = nullptr);
    ~TCompFilesForm() override;

    // Follows their changes; nothing is shown when one of them is not there.
    void ShowSongs(SongHandle first, SongHandle second);
    // Asked to play the first (0) or the second (1) song.
    std::function<void(int song)> OnListen;

 private:
    struct Side {
        SongHandle Song{};
        std::optional<TID3Tag> Record{};
        FileDetails Details{};
        CoverView* Cover = nullptr;
        QPushButton* Listen = nullptr;
    };

    void SetUpLayout();
    void SetUpTable();
    QWidget* MakeSide(int number);
    void Refresh();
    void ShowRows();
    void AddRow(const DifferenceRow& row);
    void ShowVerdict();
    void ReadFiles();
    void StopReading();

    TMusicDatabase& database_;
    std::array<Side, 2> sides_;
    QTableWidget* table_;
    QLabel* verdict_;
    QTimer readTimer_;
    std::shared_ptr<std::atomic<bool>> stop_;  // of the reading that counts
    Subscriptions subscriptions_;
    QThreadPool thread_;
};
