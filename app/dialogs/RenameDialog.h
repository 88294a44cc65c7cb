#pragma once

#include <QDialog>
#include <QTimer>

#include "MusicManagment/database/songfiles/RenamePlan.h"

class NamePatternEdit;
class QLabel;
class QPushButton;
class QTableView;

// Asks for the pattern by which songs are renamed and shows all the while what comes of it. Nothing happens
// here: the moves are what the user has agreed to.
class RenameDialog : public QDialog {
 public:
    RenameDialog(const TMusicDatabase& database, std::vector<SongHandle> songs, QWidget* parent = nullptr);

    // Of the last look; empty until the dialog is accepted.
    std::vector<SongMove> Moves() const;

 private:
    class Rows;

    void SetUpLayout();
    void Plan();

    const TMusicDatabase& database_;
    std::vector<SongHandle> songs_;
    NamePatternEdit* pattern_;
    Rows* rows_;
    QTableView* table_;
    QLabel* summary_;
    QPushButton* rename_;
    QTimer pause_;  // until the user has stopped typing
};
