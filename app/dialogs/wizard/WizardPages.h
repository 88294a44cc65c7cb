#pragma once

#include <QWizardPage>

#include "app/dialogs/wizard/WizardChoice.h"

class FolderList;
class NamePatternEdit;
class QCheckBox;
class QLabel;
class QRadioButton;
class QVBoxLayout;
class RootFolderField;

// The pages of the set-up, each of which shows and changes its part of one choice.

class WizardSheet : public QWizardPage {
 public:
    WizardSheet(const QString& title, const QString& subTitle, WizardChoice& choice);

 protected:
    // The sheet scrolls where the window is too low for it.
    QVBoxLayout& Rows() { return *rows_; }
    QLabel* AddText(const QString& text);

    WizardChoice& choice_;

 private:
    QVBoxLayout* rows_;
};

class WelcomeSheet : public WizardSheet {
 public:
    explicit WelcomeSheet(WizardChoice& choice);
};

// "Wo liegt Ihre Musik?"
class FoldersSheet : public WizardSheet {
 public:
    explicit FoldersSheet(WizardChoice& choice);
    bool validatePage() override;

 private:
    FolderList* folders_;
};

// "Dateien umbenennen und verschieben?"
class RenameSheet : public WizardSheet {
 public:
    explicit RenameSheet(WizardChoice& choice);
    bool validatePage() override;

 private:
    void ShowExample();

    QRadioButton* keep_;
    QRadioButton* rename_;
    RootFolderField* root_;
    NamePatternEdit* pattern_;
    QCheckBox* inPlace_;
    QLabel* placeExample_;
};

// "Fertig": what will be done.
class FinishSheet : public WizardSheet {
 public:
    explicit FinishSheet(WizardChoice& choice);
    void initializePage() override;
    bool validatePage() override;

 private:
    QLabel* summary_;
    QCheckBox* scan_;
};
