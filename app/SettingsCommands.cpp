#include "app/SettingsCommands.h"

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/database/intake/Update.h"
#include "app/dialogs/options/OptionsForm.h"
#include "app/dialogs/wizard/WizardForm.h"

SettingsCommands::SettingsCommands(QWidget& window, TMusicDatabase& database, const QString& key,
                                   const QString& file)
    : window_(window), database_(database), key_(key), file_(file) {}

void SettingsCommands::ShowOptions() {
    TRWReg settings(key_, file_);
    TOptionsForm form(database_, settings, &window_);
    form.OnApplied = OnApplied;
    form.exec();
}

void SettingsCommands::OfferWizard() {
    if (database_.Count() == 0 && database_.UpdateFolders().isEmpty()) RunWizard(FirstChoice(database_));
}

void SettingsCommands::ShowWizard() {
    RunWizard(CurrentChoice(database_));
}

void SettingsCommands::RunWizard(const WizardChoice& start) {
    TWizardForm wizard(start, &window_);
    if (wizard.exec() != QDialog::Accepted) return;
    ApplyChoice(wizard.Choice(), database_);
    TRWReg settings(key_, file_);
    SaveDatabaseSettings(database_, settings);
    settings.Flush();
    if (OnApplied) OnApplied();
    if (wizard.Choice().ScanNow) SearchNewSongs(database_);
}
