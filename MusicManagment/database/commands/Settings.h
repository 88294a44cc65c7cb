#pragma once

#include "CommonRUKTools/SettingsSchema.h"
#include "MusicManagment/database/commands/Rules.h"

class TMusicDatabase;
class TRWReg;

// A component whose settings are kept together with those of the database: playlist, player, remote control,
// views. Values that are missing leave the component as it is.
class SettingsClient {
 public:
    virtual ~SettingsClient() = default;
    virtual void LoadSettings(const TRWReg& settings) = 0;
    virtual void SaveSettings(TRWReg& settings) const = 0;
    // Sets the pairs of rules of this component, where it has any.
    virtual void UseRules(Rules) {}
};

// Sets the pairs of rules that a table of settings holds.
template <typename Table, typename Owner>
void SetRulesOf(Owner& owner, const Table& table, Rules rules) {
    ForEachSetting(table, [&](const auto& pair) { pair.SetOf(owner, rules == Rules::Modern); });
}

// Reads the settings of the database and of every client that has joined it. A missing value leaves its
// property as it is, but AutoSave becomes 0 and missing genre folders become the 20 default names. Values out
// of range count as missing.
void LoadDatabaseSettings(TMusicDatabase& database, const TRWReg& settings);
void SaveDatabaseSettings(const TMusicDatabase& database, TRWReg& settings);
