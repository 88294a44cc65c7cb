#include "MusicManagment/database/Command.h"

// All of these are about what a view shows and marks, or take a window.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcFind, .Caption = u"Suchen...", .Keys = u"Ctrl+F", .Icon = u"edit-find"},
    {.Id = mcFindOnline, .Caption = u"Suchen im Internet...", .Keys = u"Ctrl+Alt+F"},
    {.Id = mcFindNext, .Caption = u"Weitersuchen", .Keys = u"F3"},
    {.Id = mcMarkAll, .Caption = u"Alles markieren", .Keys = u"Ctrl+A", .Icon = u"edit-select-all"},
    {.Id = mcInvertMarks, .Caption = u"Markierung umkehren", .Keys = u"Ctrl+Alt+A"},
    {.Id = mcMarkByFilter, .Caption = u"Mit Filter markieren", .Keys = u"Alt+F"},
};

}  // namespace

constinit const DatabaseCommands kFindCommands = kRows;
