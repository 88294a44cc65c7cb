#pragma once

#include <QDialog>

#include "MusicManagment/database/duplicates/SongQuality.h"

class QPushButton;

// Shows which songs would go in favour of which, with a reason each. Nothing happens here: the replacements
// are what the user has agreed to.
class SuggestionDialog : public QDialog {
 public:
    SuggestionDialog(const TMusicDatabase& database, std::vector<KeepSuggestion> suggestions,
                     QWidget* parent = nullptr);

    // Empty until the dialog is accepted.
    std::vector<SongReplacement> Agreed() const;

 private:
    class Rows;

    void SetUpLayout();
    void ShowCount();

    Rows* rows_;
    QPushButton* discard_;
};
