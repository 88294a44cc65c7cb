#include "MusicManagment/database/Command.h"

// Each goes to the capability that it starts as soon as there is one.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcFindOnline, .Caption = u"Suchen im Internet...", .Keys = u"Ctrl+Alt+F"},
    {.Id = mcLoadLyrics, .Caption = u"Lyrikfang downloaden"},
};

}  // namespace

constinit const DatabaseCommands kLaterCommands = kRows;
