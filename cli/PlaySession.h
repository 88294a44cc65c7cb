#pragma once

#include <QStringList>
#include <memory>
#include <optional>

#include "MusicManagment/playback/PlaySoundSettings.h"
#include "MusicManagment/playback/PlayerPanel.h"
#include "MusicManagment/playback/fmod/OutputChoice.h"
#include "MusicManagment/playlist/PlayListTypes.h"
#include "cli/Console.h"

// What is played, and how.
struct PlaySessionOptions {
    QStringList Paths;  // songs, folders, playlists
    TPlayOrder Order = poDownwards;
    bool Repeat = false;
    std::optional<int> ScanTime{};  // ms; set: each song is played for so long
    TCrossover Mode = coAutoChange;
    EngineSettings Engines{};
    std::optional<OutputChoice> Output{};  // otherwise as the environment says
    bool Classic = false;                  // playlists and albums by the rules of the first versions
    bool Fast = false;                     // as fast as the output takes it; it must be one that waits for it
};

// Plays until all songs are played, or the user wants to stop. Writes a line for each song that begins.
// Returns an ExitStatus: failed when something could not be played.
int PlaySongs(const PlaySessionOptions& options, Console& console);
