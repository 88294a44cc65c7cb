#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/intake/Update.h"

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcUpdate,
     .Caption = u"Datenbank updaten (Nur neue oder entfernte Songs suchen)...",
     .Keys = u"Ctrl+U",
     .Icon = u"view-refresh",
     .Run = [](TMusicDatabase& database, int) { UpdateDatabase(database, UpdateTags::Keep); }},
    {.Id = mcUpdateWithTags,
     .Caption = u"Datenbank updaten (Auch ID3-Tags auf Änderungen prüfen)...",
     .Keys = u"Ctrl+Alt+U",
     .Run = [](TMusicDatabase& database, int) { UpdateDatabase(database, UpdateTags::Reread); }},
    {.Id = mcAddSongs,
     .Caption = u"Songs zur Datenbank hinzufügen...",
     .Icon = u"audio-x-generic",
     .Run = [](TMusicDatabase& database, int) { AddSongsFromDialog(database); }},
    {.Id = mcAddFolder,
     .Caption = u"Ordner zur Datenbank hinzufügen...",
     .Icon = u"folder-music",
     .Run = [](TMusicDatabase& database, int) { AddFolder(database, QString(), true); }},
    {.Id = mcSearchNew,
     .Caption = u"Nach neuen Songs suchen",
     .Run = [](TMusicDatabase& database, int) { SearchNewSongs(database); }},
};

}  // namespace

constinit const DatabaseCommands kIntakeCommands = kRows;
