#include "MusicManagment/database/Command.h"

// It takes a window: what is found waits for decisions.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcFindSimilarArtists, .Caption = u"Ähnlich klingende Artists suchen"},
};

}  // namespace

constinit const DatabaseCommands kArtistCommands = kRows;
