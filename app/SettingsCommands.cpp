#include "app/SettingsCommands.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/database/intake/Update.h"
#include "app/ShellCommands.h"
#include "app/dialogs/options/OptionsForm.h"
#include "app/dialogs/wizard/WizardForm.h"

using namespace Qt::StringLiterals;

SettingsCommands::SettingsCommands(QWidget& window, TMusicDatabase& database, const QString& key,
                                   const QString& file)
    : window_(window), database_(database), key_(key), file_(file) {
    handlers_ += database.Commands().Add({.Id = scOptions,
                                          .Caption = u"Einstellungen..."_s,
                                          .Letter = u'e',
                                          .Keys = u"Ctrl+,"_s,
                                          .Icon = u"configure"_s,
                                          .Menu = u"Extras"},
                                         {.Run = [this] { ShowOptions(); }});
    handlers_ += database.Commands().Add({.Id = scWizard,
                                          .Caption = u"Einrichtungsassistent..."_s,
                                          .Letter = u'i',
                                          .Icon = u"tools-wizard"_s,
                                          .Menu = u"Extras",
                                          .BehindLine = false},
                                         {.Run = [this] { ShowWizard(); }});
}

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
