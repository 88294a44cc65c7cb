#pragma once

#include <QWizard>

#include "app/dialogs/wizard/WizardChoice.h"

// Leads through the set-up of the collection at the first start, and whenever the user wants it again.
class TWizardForm : public QWizard {
 public:
    explicit TWizardForm(const WizardChoice& start, QWidget* parent = nullptr);

    // What was chosen; complete when the wizard has been accepted.
    const WizardChoice& Choice() const { return choice_; }

 private:
    WizardChoice choice_;
};
