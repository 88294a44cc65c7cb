#pragma once

#include <QString>
#include <functional>

#include "CommonRUKTools/Listeners.h"

class QWidget;
class TMusicDatabase;
struct WizardChoice;

// The commands that change how the program works, which it adds to the menu: its options and the set-up.
class SettingsCommands {
 public:
    // `key` and `file` name the settings store, as for TRWReg. The dialogs belong to `window`.
    SettingsCommands(QWidget& window, TMusicDatabase& database, const QString& key, const QString& file);

    // Told when settings have changed.
    std::function<void()> OnApplied;

    void ShowOptions();
    // At the first start, where there is no collection yet.
    void OfferWizard();
    void ShowWizard();

 private:
    void RunWizard(const WizardChoice& start);

    QWidget& window_;
    TMusicDatabase& database_;
    QString key_;
    QString file_;
    Subscriptions handlers_;
};
