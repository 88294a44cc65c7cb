#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ChoiceRow<TOVType> kGroupings[] = {
    {u"artist", ovArtist}, {u"album", ovAlbum}, {u"year", ovYear}, {u"length", ovLength}, {u"genre", ovGenre},
};

void WriteGroup(const QString& caption, int count, bool asJson, JsonLine& line, Console& console) {
    if (!asJson) return console.WriteLine(Printable(caption) + u'\t' + QString::number(count));
    line.Begin();
    line.Text("caption", caption);
    line.Number("count", count);
    console.Write(line.End());
}

int RunGroups(const Arguments& arguments, Console& console) {
    const TOVType type = ChoiceOf(arguments, u"--by", kGroupings, ovArtist);
    TMusicDatabase database;
    PrepareDatabase(database);
    ReadInto(database, arguments.Value(u"--db"), console, StopBy::Nothing);
    const GroupLists& groups = database.Groups();
    JsonLine line;
    for (int row = 0; row < groups.RowCount(type); ++row)
        WriteGroup(groups.RowCaption(type, row), groups.RowSongCount(type, row), arguments.Has(u"--json"),
                   line, console);
    return esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Datei der Sammlung (.tsdb)", true},
    {u"--by", u"MERKMAL", u"artist, album, year, length oder genre", true},
    {u"--json", u"", u"ein JSON-Objekt je Gruppe und Zeile"},
};

}  // namespace

const CommandRow kGroupsCommand = {
    u"groups",
    u"Zählt die Songs der Sammlung nach Interpreten, Alben, Jahren, Längen oder Genres",
    u"Eine Zeile je Gruppe: Name und Anzahl der Songs, durch einen Tabulator getrennt.\n"
    u"Felder im JSON-Format: caption, count.\n",
    {u"", u""},
    kOptions,
    RunGroups,
};
