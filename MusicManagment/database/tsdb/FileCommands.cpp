#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"

namespace {

constexpr DatabaseCommand kRows[] = {
    {.Id = mcNew,
     .Caption = u"Neue Datenbank",
     .Keys = u"Ctrl+Alt+N",
     .Icon = u"document-new",
     .Run = [](TMusicDatabase& database, int) { database.OpenDatabase(QString()); }},
    {.Id = mcOpen,
     .Caption = u"Datenbank öffnen...",
     .Keys = u"Ctrl+Alt+O",
     .Icon = u"document-open",
     .Run = [](TMusicDatabase& database, int) { database.OpenDatabaseFromDialog(); }},
    {.Id = mcSave,
     .Caption = u"Datenbank speichern",
     .Keys = u"Ctrl+Alt+S",
     .Icon = u"document-save",
     .Run = [](TMusicDatabase& database, int) { database.SaveDatabase(); }},
    {.Id = mcSaveAs,
     .Caption = u"Datenbank speichern unter...",
     .Icon = u"document-save-as",
     .Run = [](TMusicDatabase& database, int) { database.SaveDatabase(QString(), false, true); }},
};

}  // namespace

constinit const DatabaseCommands kFileCommands = kRows;
