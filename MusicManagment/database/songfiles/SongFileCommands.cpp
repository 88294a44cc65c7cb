#include "MusicManagment/database/Command.h"

// All of these are about the songs that a view has marked.

namespace {

constexpr auto kWriting = DatabaseCommand::Needs::Writing;

constexpr DatabaseCommand kRows[] = {
    {.Id = mcRemoveFromDatabase,
     .Caption = u"Markierte aus der Datenbank entfernen",
     .Keys = u"Del",
     .Icon = u"list-remove",
     .For = kWriting},
    {.Id = mcRemoveFromDisk,
     .Caption = u"Markierte vom Datenträger entfernen",
     .Keys = u"Alt+Del",
     .For = kWriting},
    {.Id = mcBan, .Caption = u"~ und in die Bannlist aufnehmen", .Keys = u"Ctrl+B", .For = kWriting},
    {.Id = mcCopyTo,
     .Caption = u"Markierte kopieren nach ...",
     .Keys = u"Ctrl+C",
     .Icon = u"edit-copy",
     .For = kWriting},
    {.Id = mcRenameByPattern, .Caption = u"Umbenennen nach Muster...", .Keys = u"Shift+F2", .For = kWriting},
    {.Id = mcTagsFromNames,
     .Caption = u"Tags aus dem Dateinamen...",
     .Keys = u"Ctrl+Shift+F2",
     .For = kWriting},
    {.Id = mcEditBannList, .Caption = u"Bann-Liste bearbeiten...", .For = kWriting},
    {.Id = mcOpenExternally, .Caption = u"Mit externem Programm öffnen", .For = kWriting},
};

}  // namespace

constinit const DatabaseCommands kSongFileCommands = kRows;
