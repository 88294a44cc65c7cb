#include "MusicManagment/database/duplicates/DuplicateSearch.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

int PercentOf(const Arguments& arguments) {
    if (!arguments.Has(u"--min")) return DuplicateQuery().LeastPercent;
    bool isNumber = false;
    const int percent = arguments.Value(u"--min").toInt(&isNumber);
    if (!isNumber || percent < DuplicateQuery().LeastPercent || percent > 100)
        throw EUsageError(u"--min geht von 60 bis 100."_s);
    return percent;
}

void WriteRow(const TMusicDatabase& database, const DuplicatePair& pair, bool sameArtistOnly, bool asJson,
              JsonLine& line, Console& console) {
    const TID3Tag& first = *database.Songs().Find(pair.First);
    const TID3Tag& second = *database.Songs().Find(pair.Second);
    const QString title1 = ComparedName(first, sameArtistOnly);
    const QString title2 = ComparedName(second, sameArtistOnly);
    if (!asJson) {
        console.WriteLine(SimilarityText(pair.Percent) + u'\t' + Printable(title1) + u'\t' +
                          Printable(title2) + u'\t' + Printable(first.FileName) + u'\t' +
                          Printable(second.FileName));
        return;
    }
    line.Begin();
    line.Real("percent", pair.Percent);
    line.Text("title1", title1);
    line.Number("length1", first.Length);
    line.Text("title2", title2);
    line.Number("length2", second.Length);
    line.Text("file1", first.FileName);
    line.Text("file2", second.FileName);
    console.Write(line.End());
}

int RunDuplicates(const Arguments& arguments, Console& console) {
    const DuplicateQuery query{.SameArtistOnly = arguments.Has(u"--same-artist"),
                               .LeastPercent = PercentOf(arguments)};
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database);
    ReadInto(database, arguments.Value(u"--db"), console, StopBy::Interrupt);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    DuplicateRows rows;
    const DuplicateEnd end = FindDuplicates(database, query, rows);
    JsonLine line;
    for (std::size_t row = 0; row < rows.Count(); ++row)
        WriteRow(database, rows.At(row), query.SameArtistOnly, arguments.Has(u"--json"), line, console);
    if (end == DuplicateEnd::Done) return esDone;
    console.Message(end == DuplicateEnd::Stopped
                        ? u"Abgebrochen: die Liste ist unvollständig."_s
                        : u"Zu viele Paare: die Liste ist unvollständig. Mit --min werden es weniger."_s);
    return esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Sammlung (.tsdb), deren Songs verglichen werden", true},
    {u"--same-artist", u"", u"vergleicht nur Titel, und nur innerhalb eines Artists"},
    {u"--min", u"PROZENT", u"ab dieser Ähnlichkeit, 60 bis 100; ohne die Option 60"},
    {u"--json", u"", u"ein JSON-Objekt je Paar"},
};

}  // namespace

const CommandRow kDuplicatesCommand = {
    u"duplicates",
    u"Sucht Songs mit ähnlichem Namen",
    u"Verglichen werden Artist und Titel jedes Songs mit denen jedes anderen. Je Paar eine Zeile: "
    u"Ähnlichkeit,\n"
    u"die beiden Namen, die beiden Dateien.\n",
    {u"", u""},
    kOptions,
    RunDuplicates,
};
