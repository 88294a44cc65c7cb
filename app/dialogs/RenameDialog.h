#pragma once

#include "MusicManagment/database/songfiles/RenamePlan.h"
#include "app/dialogs/PatternDialog.h"

// Asks for the pattern by which songs are renamed and shows what comes of it. The moves are what the user has
// agreed to.
class RenameDialog : public PatternDialog {
 public:
    RenameDialog(const TMusicDatabase& database, std::vector<SongHandle> songs, QWidget* parent = nullptr);

    // Of the last look; empty until the dialog is accepted.
    std::vector<SongMove> Moves() const;

 protected:
    PatternOutcome Plan(const QString& pattern) override;
    QVariant Cell(std::size_t row, int column, int role) const override;

 private:
    enum Column { OldName, NewName, Problem };

    const TMusicDatabase& database_;
    std::vector<SongHandle> songs_;
    std::vector<PlannedRename> plans_;
};
