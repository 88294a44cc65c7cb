#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"

namespace {

// Which groups are listed is a matter of the view that lists them.
constexpr DatabaseCommand List(int type, QStringView caption, QStringView keys) {
    return {
        .Id = mcListArtists + type, .Caption = caption, .Keys = keys, .Kind = DatabaseCommand::Mark::Radio};
}

constexpr DatabaseCommand kRows[] = {
    List(ovArtist, u"Artisten auflisten", u"Alt+1"),
    List(ovAlbum, u"Alben auflisten", u"Alt+2"),
    List(ovYear, u"Jahre auflisten", u"Alt+3"),
    List(ovLength, u"Längen auflisten", u"Alt+4"),
    List(ovGenre, u"Genre auflisten", u"Alt+5"),
    {.Id = mcRecount,
     .Caption = u"Liste neu berechnen",
     .Run = [](TMusicDatabase& database, int) { database.RecountGroups(); },
     .For = DatabaseCommand::Needs::Writing},
};

}  // namespace

constinit const DatabaseCommands kOverviewCommands = kRows;
