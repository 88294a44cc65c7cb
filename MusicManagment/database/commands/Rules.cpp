#include "MusicManagment/database/commands/Rules.h"

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/database/commands/Settings.h"

void UseRules(TMusicDatabase& database, Rules rules) {
    SetRulesOf(database, DatabaseSettings::kRules, rules);
    for (SettingsClient* client : database.SettingsClients())
        client->UseRules(rules);
}
