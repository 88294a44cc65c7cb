#pragma once

#include <QString>
#include <functional>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/commands/Settings.h"

class SongListWidget;
class TMusicDatabase;

// The commands that start other programs: one for a song, and the song-text tool.
class ProgramCommands : public SettingsClient {
 public:
    // `settingsFile` as for TRWReg: the tool has left its folder there.
    ProgramCommands(TMusicDatabase& database, SongListWidget& list, const QString& settingsFile);

    // Told what was started, in a sentence for the status bar.
    std::function<void(const QString&)> OnDone;

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void OpenSong();
    void LoadLyrics();

    TMusicDatabase& database_;
    SongListWidget& list_;
    QString settingsFile_;
    QString program_;  // for songs; empty: the desktop's
    Subscriptions handlers_;
};
