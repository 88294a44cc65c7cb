#include "MusicManagment/database/Command.h"

// The player and the playlist know the database, not the other way round: the shell brings them together.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcPlay,
     .Caption = u"Abspielen",
     .Keys = u"Return",
     .Icon = u"media-playback-start",
     .IsDefault = true},
    {.Id = mcAddToPlayList, .Caption = u"Zur PlayList hinzufügen", .Icon = u"media-playlist-append"},
};

}  // namespace

constinit const DatabaseCommands kPlayCommands = kRows;
