#pragma once

#include <QString>

class QDialog;
class QDialogButtonBox;
class QPushButton;

// What stands below a dialog that shows what would happen.
struct DecisionButtons {
    QDialogButtonBox* Box = nullptr;
    QPushButton* Agree = nullptr;   // accepts the dialog
    QPushButton* Cancel = nullptr;  // rejects it
};

// `agreement` with the letter to reach it by. Which of them the Return key presses is up to the dialog.
DecisionButtons MakeDecisionButtons(QDialog& dialog, const QString& agreement);
