#pragma once

#include <QString>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/commands/Settings.h"

class SongListWidget;
class TMusicDatabase;

// Replaces misspelt artists and titles as a file of corrections says: shows what would change, and changes it
// when the user agrees.
class CorrectionCommands : public SettingsClient {
 public:
    CorrectionCommands(TMusicDatabase& database, SongListWidget& list);

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void Correct(const BatchSongs& songs);

    TMusicDatabase& database_;
    SongListWidget& list_;
    QString file_;  // the last one
    Subscriptions handlers_;
};
