#pragma once

#include <QStringList>

#include "MusicManagment/playlist/SongPlayer.h"

// A player that plays nothing and keeps what it was told.
class ScriptedPlayer : public SongPlayer {
 public:
    QStringList Played;
    int Limit = 0;  // milliseconds

    bool AutoPlay() const override { return true; }
    void SetAutoStop(int milliseconds) override { Limit = milliseconds; }
    void SetFileName(const QString& path) override { Played << path; }
    void Play() override {}
    bool PlayWithCrossFade(const QString&) override { return false; }
    void RedrawPanel() override {}
};
