#pragma once

#include <QAbstractTableModel>
#include <vector>

#include "MusicManagment/database/backup/BackupTaking.h"

// The files of a backup medium, which song each may be, and what the user has decided about it.
class BackupModel : public QAbstractTableModel {
 public:
    enum Column { File, Candidate, OwnFile, Decision, ColumnCount };

    // All three must live as long; the candidates are those of the files, in their order.
    BackupModel(const TMusicDatabase& database, const std::vector<BackupFile>& files,
                const std::vector<BackupCandidates>& candidates, QObject* parent = nullptr);

    const std::vector<BackupDecision>& Decisions() const { return decisions_; }
    const BackupCandidates& CandidatesOf(int row) const { return candidates_[At(row)]; }
    // How many files something happens with.
    int CountOf(BackupDecision::Kind kind) const;
    // The place of the song that the file is tied to, among its candidates; -1 for none.
    int TiedCandidate(int row) const;

    // Ties the file to its candidate in this place; another file loses the song. False where there is none.
    bool Tie(int row, std::size_t candidate);
    void Decide(int row, BackupDecision::Kind kind);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(const QModelIndex& index, int role) const override;

 private:
    static std::size_t At(int row) { return static_cast<std::size_t>(row); }
    // The tied song, else the best one.
    const BackupCandidate* ShownCandidate(int row) const;
    QString CandidateCell(int row) const;
    QString OwnFileCell(int row) const;
    QString DecisionCell(int row) const;
    void Changed(int row);

    const TMusicDatabase& database_;
    const std::vector<BackupFile>& files_;
    const std::vector<BackupCandidates>& candidates_;
    std::vector<BackupDecision> decisions_;
};
