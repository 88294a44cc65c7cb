#include "ReadMPEGHeader/DisplayTexts.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ChoiceRow<TSortType> kSortTypes[] = {
    {u"stTitle", stTitle},           {u"stArtist", stArtist}, {u"stAlbum", stAlbum},
    {u"stComment", stComment},       {u"stYear", stYear},     {u"stLength", stLength},
    {u"stGenre", stGenre},           {u"stPath", stPath},     {u"stPlayCnt", stPlayCnt},
    {u"stAddTime", stAddTime},       {u"stFlags", stFlags},   {u"stCacheType", stCacheType},
    {u"stAlbumOrder", stAlbumOrder},
};

constexpr ChoiceRow<TSubSortType> kSubSortTypes[] = {
    {u"sstGATL", sstGATL},
    {u"sstATL", sstATL},
    {u"sstPath", sstPath},
};

void WriteText(const TMusicDatabase& database, Console& console) {
    for (SongIndex i = 0; i < database.Count(); ++i) {
        const TID3Tag& song = database.Song(i);
        console.WriteLine(QString::number(i) + u'\t' + Printable(song.Artist) + u'\t' +
                          Printable(song.Title) + u'\t' + Printable(song.Album) + u'\t' +
                          FormatLength(song.Length, true));
    }
}

void WriteJson(const TMusicDatabase& database, Console& console) {
    JsonLine line;
    for (SongIndex i = 0; i < database.Count(); ++i) {
        line.Begin();
        line.Number("index", i);
        WriteSongFields(line, database.Song(i));
        console.Write(line.End());
    }
}

int RunList(const Arguments& arguments, Console& console) {
    TMusicDatabase database;
    PrepareDatabase(database);
    // While it is empty the order costs nothing; a file need not be in it.
    database.SetSortType(ChoiceOf(arguments, u"--sort", kSortTypes, database.SortType()));
    database.SetSubSortType(ChoiceOf(arguments, u"--subsort", kSubSortTypes, database.SubSortType()));
    database.SetSortBackwards(arguments.Has(u"--backwards"));
    ReadInto(database, arguments.Value(u"--db"), console, StopBy::Nothing);
    database.EnsureSorted();
    arguments.Has(u"--json") ? WriteJson(database, console) : WriteText(database, console);
    return esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Datei der Sammlung (.tsdb)", true},
    {u"--sort", u"SCHLÜSSEL",
     u"stTitle, stArtist, stAlbum, stComment, stYear, stLength, stGenre (Vorgabe), stPath, stPlayCnt,\n"
     u"stAddTime, stFlags, stCacheType oder stAlbumOrder (Album, Ordner, Track)"},
    {u"--subsort", u"SCHLÜSSEL",
     u"ordnet, was sonst gleich ist: sstGATL (Genre, Interpret, Titel, Länge; Vorgabe), sstATL\n"
     u"(Interpret, Titel, Länge) oder sstPath (Pfad)"},
    {u"--backwards", u"", u"kehrt die Reihenfolge um"},
    {u"--json", u"", u"ein JSON-Objekt je Song und Zeile"},
};

}  // namespace

const CommandRow kListCommand = {
    u"list",
    u"Zeigt die Songs der Sammlung",
    u"Eine Zeile je Song: Nummer (ab 0), Interpret, Titel, Album und Länge, durch Tabulatoren getrennt.\n"
    u"Felder im JSON-Format: index und die Felder des Datensatzes, wie der Befehl info sie zeigt.\n",
    {u"", u""},
    kOptions,
    RunList,
};
