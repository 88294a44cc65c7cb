#include "MusicManagment/database/batches/FlagBatch.h"
#include "MusicManagment/database/batches/GenreAdaption.h"
#include "MusicManagment/database/batches/LengthBatch.h"
#include "MusicManagment/database/batches/TagBatch.h"
#include "cli/AgreeingDialogs.h"
#include "cli/ChosenSongs.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

struct Outcome {
    BatchResult Changes;
    QStringList Remarks;  // songs that the user should look at
};

using Deed = std::function<Outcome(TMusicDatabase& database, const BatchSongs& songs)>;

Outcome AdaptGenre(TMusicDatabase& database, const BatchSongs& songs) {
    GenreAdaption adaption = AdaptGenres(database, songs);
    Outcome outcome{.Changes = std::move(adaption.Updates), .Remarks = {}};
    for (const QString& song : adaption.WithoutGenre)
        outcome.Remarks << u"Kann kein passendes Genre für den Song "_s + song + u" finden."_s;
    return outcome;
}

Outcome CheckLengths(TMusicDatabase& database, const BatchSongs& songs) {
    LengthBatchResult checked = VerifyLengths(database, songs);
    return {.Changes = std::move(checked.Updates), .Remarks = std::move(checked.Damaged)};
}

Outcome Remove(TMusicDatabase& database, const BatchSongs& songs) {
    if (!MayRemoveTags(songs.Range)) throw EAbort();
    return {.Changes = RemoveTags(database, songs), .Remarks = {}};
}

Outcome Reread(TMusicDatabase& database, const BatchSongs& songs) {
    if (!MayRereadTags(songs.Range)) throw EAbort();
    return {.Changes = RereadTags(database, songs), .Remarks = {}};
}

Deed FlagDeed(const QString& name, FlagChange change) {
    const auto flag = FlagByName(name);
    if (!flag)
        throw EUsageError(u"Dieses Flag gibt es nicht: "_s + name + u". Möglich sind: "_s +
                          SongFlagNames().join(u", "_s));
    return [flag = *flag, change](TMusicDatabase& database, const BatchSongs& songs) {
        return Outcome{.Changes = ChangeFlag(database, songs, flag, change), .Remarks = {}};
    };
}

Deed DeedOf(const QString& text) {
    const QString name = text.section(u'=', 0, 0);
    const QString value = text.section(u'=', 1);
    if (text == u"adapt-genre"_s) return AdaptGenre;
    if (text == u"remove-tags"_s) return Remove;
    if (text == u"reread"_s) return Reread;
    if (text == u"check-length"_s) return CheckLengths;
    if (name == u"set-flag"_s) return FlagDeed(value, FlagChange::Set);
    if (name == u"clear-flag"_s) return FlagDeed(value, FlagChange::Remove);
    ThrowUnknownChoice(u"--do", text,
                       {u"adapt-genre"_s, u"set-flag=NAME"_s, u"clear-flag=NAME"_s, u"remove-tags"_s,
                        u"reread"_s, u"check-length"_s});
}

void WriteOutcome(const Outcome& outcome, bool asJson, Console& console) {
    if (!asJson)
        return console.WriteLine(SongCountText(static_cast<std::size_t>(outcome.Changes.Changed)) +
                                 u" geändert"_s);
    JsonLine line;
    line.Begin();
    line.Number("changed", outcome.Changes.Changed);
    line.Number("renamed", outcome.Changes.Renamed);
    line.Texts("failed", outcome.Changes.Failed);
    line.Texts("remarks", outcome.Remarks);
    console.Write(line.End());
}

int RunBatchCommand(const Arguments& arguments, Console& console) {
    const Deed deed = DeedOf(arguments.Value(u"--do"));
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database, arguments.Has(u"--classic") ? Rules::Classic : Rules::Modern);
    OpenForChanges(database, arguments.Value(u"--db"), false, console);
    const ChosenSongs chosen = ChooseSongs(database, arguments, console);
    const BatchSongs songs{.Range = BatchRange::Marked, .Songs = chosen.Songs};
    const JournalSession journal(console);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    std::optional<AgreeingDialogs> agreeing;
    if (arguments.Has(u"--yes")) agreeing.emplace();
    const Outcome outcome = deed(database, songs);
    WriteOutcome(outcome, arguments.Has(u"--json"), console);
    for (const QString& remark : outcome.Remarks)
        console.Message(Printable(remark));
    return ReportChanges(outcome.Changes, console) && chosen.AllFound ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Sammlung (.tsdb), in der die Songs stehen", true},
    {u"--do", u"VORGANG",
     u"adapt-genre (Hauptgenre von anderen Songs des Artists), set-flag=NAME, clear-flag=NAME, remove-tags,\n"
     u"reread (Tags neu einlesen) oder check-length (jeden Frame zählen)",
     true},
    {u"--yes", u"", u"beantwortet jede Frage mit Ja"},
    kAllOption,
    kFilterOption,
    kClassicChangesOption,
    {u"--json", u"", u"gibt das Ergebnis als ein JSON-Objekt aus"},
};

}  // namespace

const CommandRow kBatchCommand = {
    u"batch",
    u"Ändert viele Songs auf einmal",
    u"Ohne --yes wird am Terminal gefragt, wo eine Frage zu stellen ist; kann niemand antworten, gilt Nein. "
    u"Die\n"
    u"Namen der Flags sind Gebrannt, Beschädigt, \"Korrekte Länge\" und Remixed. Der Befehl undo nimmt "
    u"alles\n"
    u"zurück.\n"
    u"JSON-Format: {\"changed\":N,\"renamed\":N,\"failed\":[...],\"remarks\":[...]}\n",
    {.Name = u"SONG", .Help = u"Songs der Sammlung", .Required = false},
    kOptions,
    RunBatchCommand,
};
