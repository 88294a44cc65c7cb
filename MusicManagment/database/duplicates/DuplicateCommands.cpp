#include "MusicManagment/database/Command.h"

// What is found is shown by the window of the program that handles them.

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcFindDuplicates, .Caption = u"Doppelte Einträge suchen (allgemein)"},
    {.Id = mcFindDuplicatesOfArtists, .Caption = u"Doppelte Einträge suchen (innerhalb der Artists)"},
    {.Id = mcFindDuplicatesOfMarked, .Caption = u"Doppelte Einträge der Markierten suchen"},
};

}  // namespace

constinit const DatabaseCommands kDuplicateCommands = kRows;
