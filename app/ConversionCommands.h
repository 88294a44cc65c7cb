#pragma once

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/conversion/ConvertSongs.h"
#include "MusicManagment/database/commands/Settings.h"

class SongListWidget;

// Converts songs of the list, or all, as the user says in a dialog that remembers what was chosen last.
class ConversionCommands : public SettingsClient {
 public:
    ConversionCommands(TMusicDatabase& database, SongListWidget& list);

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void Convert();

    TMusicDatabase& database_;
    SongListWidget& list_;
    ConversionPlace place_ = ConversionPlace::Beside;
    QString folder_;
    Subscriptions handlers_;
};
