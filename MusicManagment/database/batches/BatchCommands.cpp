#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/batches/FlagBatch.h"
#include "MusicManagment/database/batches/TagBatch.h"

// Those about all songs need no view; the others are about the songs that one has marked.

namespace {

constexpr auto kWriting = DatabaseCommand::Needs::Writing;

void AdaptAll(TMusicDatabase& database, int) {
    if (database.Count() > 0) ReportAdaption(AdaptGenres(database, AllSongs(database)));
}

void ChangeFlagOfAll(TMusicDatabase& database, int id) {
    if (database.Count() == 0) return;
    const FlagChange change = id == mcSetFlagOfAll ? FlagChange::Set : FlagChange::Remove;
    if (const auto flag = AskForFlag(change))
        ReportBatch(ChangeFlag(database, AllSongs(database), *flag, change));
}

void RemoveAll(TMusicDatabase& database, int) {
    if (database.Count() > 0 && MayRemoveTags(BatchRange::All))
        ReportBatch(RemoveTags(database, AllSongs(database)));
}

void RereadAll(TMusicDatabase& database, int) {
    if (database.Count() > 0 && MayRereadTags(BatchRange::All))
        ReportBatch(RereadTags(database, AllSongs(database)));
}

constexpr DatabaseCommand kRows[] = {
    {.Id = mcTakeGenre, .Caption = u"In passendes Genre aufnehmen", .Keys = u"Alt+A", .For = kWriting},
    {.Id = mcVerifyLengths, .Caption = u"Korrektheit von Länge und Format sicherstellen"},
    {.Id = mcEnterLength, .Caption = u"Länge manuell eingeben"},
    {.Id = mcLoadLyrics, .Caption = u"Lyrikfang downloaden"},
    {.Id = mcSetFlag, .Caption = u"Flag setzen...", .For = kWriting},
    {.Id = mcRemoveFlag, .Caption = u"Flag entfernen...", .For = kWriting},
    {.Id = mcCorrect, .Caption = u"Nach Korrekturdatei ändern...", .For = kWriting},
    {.Id = mcCorrectAll, .Caption = u"Alle Songs nach Korrekturdatei ändern..."},
    {.Id = mcRereadTags, .Caption = u"ID3-Tags neu einlesen...", .For = kWriting},
    {.Id = mcRemoveTags, .Caption = u"ID3-Tags entfernen...", .For = kWriting},
    {.Id = mcConvert, .Caption = u"Song konvertieren"},
    {.Id = mcConvertMarked, .Caption = u"Konvertieren...", .For = kWriting},
    {.Id = mcAdaptAllGenres, .Caption = u"Genre aller Songs anpassen", .Run = AdaptAll},
    {.Id = mcSetFlagOfAll, .Caption = u"Flag für alle Songs setzen...", .Run = ChangeFlagOfAll},
    {.Id = mcRemoveFlagOfAll, .Caption = u"Flag für alle Songs entfernen...", .Run = ChangeFlagOfAll},
    {.Id = mcRereadAllTags, .Caption = u"ID3-Tags aller Songs neu einlesen...", .Run = RereadAll},
    {.Id = mcRemoveAllTags, .Caption = u"ID3-Tags aller Songs entfernen...", .Run = RemoveAll},
};

}  // namespace

constinit const DatabaseCommands kBatchCommands = kRows;
