#include "MusicManagment/database/duplicates/SimilarArtists.h"

#include "MusicManagment/database/duplicates/DuplicateSearch.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

void WritePair(const SimilarArtists& pair, bool asJson, JsonLine& line, Console& console) {
    if (!asJson)
        return console.WriteLine(SimilarityText(pair.Percent) + u'\t' + Printable(pair.First) + u'\t' +
                                 Printable(pair.Second) + u'\t' + QString::number(pair.FirstSongs) + u'\t' +
                                 QString::number(pair.SecondSongs));
    line.Begin();
    line.Real("percent", pair.Percent);
    line.Text("artist1", pair.First);
    line.Text("artist2", pair.Second);
    line.Number("songs1", pair.FirstSongs);
    line.Number("songs2", pair.SecondSongs);
    console.Write(line.End());
}

int RunSimilarArtists(const Arguments& arguments, Console& console) {
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database);
    ReadInto(database, arguments.Value(u"--db"), console, StopBy::Interrupt);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    bool stopped = false;
    JsonLine line;
    for (const SimilarArtists& pair : FindSimilarArtists(database, stopped))
        WritePair(pair, arguments.Has(u"--json"), line, console);
    if (stopped) console.Message(u"Abgebrochen: die Liste ist unvollständig."_s);
    return stopped ? esFailed : esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Sammlung (.tsdb), deren Artists verglichen werden", true},
    {u"--json", u"", u"ein JSON-Objekt je Paar"},
};

}  // namespace

const CommandRow kSimilarArtistsCommand = {
    u"similar-artists",
    u"Sucht Artists mit ähnlichem oder ähnlich klingendem Namen",
    u"Je Paar eine Zeile: Ähnlichkeit, die beiden Artists, die Anzahl ihrer Songs.\n",
    {u"", u""},
    kOptions,
    RunSimilarArtists,
};
