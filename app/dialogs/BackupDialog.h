#pragma once

#include <QDialog>
#include <functional>

#include "app/models/BackupModel.h"

class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;
class QTableView;

// Shows the files of a backup medium beside the songs of the collection that they may be, and lets the user
// decide about each, by a key where he likes. Nothing happens here: accepting it is what the user agrees to.
class BackupDialog : public QDialog {
 public:
    // `name`: of the medium, as proposed. The others must live as long.
    BackupDialog(const TMusicDatabase& database, const std::vector<BackupFile>& files,
                 const std::vector<BackupCandidates>& candidates, const QString& name,
                 QWidget* parent = nullptr);

    const std::vector<BackupDecision>& Decisions() const { return model_->Decisions(); }
    QString MediumName() const;

 protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

 private:
    void SetUpTable();
    void SetUpCandidates();
    void SetUpLayout(const QString& name);
    void ShowCandidates();
    void ShowSummary();
    // For all selected files; a single one that is decided gives way to the next.
    void TieSelected(int candidate);
    void DecideSelected(BackupDecision::Kind kind);
    // `decide` tells whether it could.
    void ForSelected(const std::function<bool(int row)>& decide);
    bool IsDecision(int key);

    const TMusicDatabase& database_;
    BackupModel* model_;
    QLineEdit* name_;
    QTableView* table_;
    QListWidget* candidates_;
    QLabel* summary_;
    QPushButton* agree_;
};
