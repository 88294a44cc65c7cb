#include "MusicManagment/database/batches/LengthBatch.h"

#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/batches/BatchFrame.h"
#include "MusicManagment/database/batches/FilesAhead.h"
#include "MusicManagment/database/songfiles/SongFinder.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/LengthCheck.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kLongestLength = 65535;  // seconds, as a record holds them

constexpr BatchTexts kVerifying = {.All = u"Korrektheit von Länge und Format sicherstellen",
                                   .Marked = u"Korrektheit von Länge und Format sicherstellen",
                                   .One = u"Korrektheit von Länge und Format sicherstellen"};

struct Checked {
    std::optional<LengthCheck> Check;
    QString Failure;  // why there is none
};

Checked CheckFile(const QString& path) {
    try {
        return {.Check = CheckLength(path), .Failure = u"In der Datei ist kein Klang gefunden worden"_s};
    } catch (const EStreamError& error) {
        return {.Check = {}, .Failure = error.Message()};
    }
}

// Takes what was measured over into the record.
TID3Tag Verified(const TID3Tag& song, const LengthCheck& check) {
    TID3Tag record = song;
    ApplyLengthCheck(check, record);
    record.Flags |= sfLengthCorrect;
    record.Flags = check.Damage.isEmpty() ? record.Flags & ~quint32{sfDamaged} : record.Flags | sfDamaged;
    return record;
}

TID3Tag WithLength(const TID3Tag& song, int seconds) {
    TID3Tag record = song;
    record.Length = static_cast<quint16>(seconds);
    record.Flags |= sfLengthCorrect;
    return record;
}

std::optional<SongUpdate> RecordOnly(const TID3Tag& song, TID3Tag record) {
    if (record == song) return std::nullopt;
    SongUpdate update;
    update.Record = std::move(record);
    update.Tags = TagAction::Leave;
    return update;
}

LengthBatchResult RunCheck(TMusicDatabase& database, const BatchSongs& songs, const SongUpdateMaker& maker) {
    LengthBatchResult result;
    result.Updates = RunUpdates(database, songs, kVerifying, u"Länge prüfen"_s, Renaming::Never, maker);
    return result;
}

LengthBatchResult CountFrames(TMusicDatabase& database, const BatchSongs& songs) {
    QStringList damaged;
    QStringList failed;
    FilesAhead<Checked> checks(database, songs, CheckFile);
    const auto maker = [&](const TID3Tag& song) -> std::optional<SongUpdate> {
        const auto checked = checks.Next();
        if (!checked) return std::nullopt;
        if (!checked->Check) {
            failed << song.FileName + u": "_s + checked->Failure;
            return std::nullopt;
        }
        if (!checked->Check->Damage.isEmpty()) damaged << song.FileName + u": "_s + checked->Check->Damage;
        return RecordOnly(song, Verified(song, *checked->Check));
    };
    LengthBatchResult result = RunCheck(database, songs, maker);
    result.Damaged = std::move(damaged);
    result.Updates.Failed = failed + result.Updates.Failed;
    return result;
}

int AskForLength(const TMusicDatabase& database, const QString& path) {
    if (!FileSource::Exists(path)) throw EStreamError(u"Datei nicht gefunden"_s);
    return static_cast<int>(std::min(database.OnMeasureLength(path) / 1000, quint32{kLongestLength}));
}

// Throws ENoLengthMeasure; nothing has happened then.
LengthBatchResult AskForLengths(TMusicDatabase& database, const BatchSongs& songs) {
    if (!database.OnMeasureLength) throw ENoLengthMeasure(u"Dieses Programm hat keinen Weg dorthin."_s);
    QStringList failed;
    SongFinder finder(database);
    const auto maker = [&](const TID3Tag& song) -> std::optional<SongUpdate> {
        try {
            return RecordOnly(song, WithLength(song, AskForLength(database, finder.Find(song.FileName))));
        } catch (const ENoLengthMeasure&) {
            throw;
        } catch (const EAbort&) {
            throw;
        } catch (const ERukException& error) {
            failed << song.FileName + u": "_s + error.Message();
            return std::nullopt;
        }
    };
    LengthBatchResult result = RunCheck(database, songs, maker);
    result.Updates.Failed = failed + result.Updates.Failed;
    return result;
}

}  // namespace

LengthBatchResult VerifyLengths(TMusicDatabase& database, const BatchSongs& songs) {
    if (!database.UseWinAmpForLenCheck()) return CountFrames(database, songs);
    QString reason;
    try {
        return AskForLengths(database, songs);
    } catch (const ENoLengthMeasure& error) {
        reason = error.Message();
    }
    LengthBatchResult result = CountFrames(database, songs);
    result.Remark =
        u"Winamp kann nicht nach den Längen gefragt werden; stattdessen sind die Frames gezählt worden. "_s +
        reason;
    return result;
}

std::optional<int> ParseLength(const QString& text) {
    const QStringList parts = text.trimmed().split(u':');
    if (parts.size() > 3) return std::nullopt;
    qint64 seconds = 0;
    for (qsizetype i = 0; i < parts.size(); ++i) {
        bool isNumber = false;
        const uint part = parts[i].toUInt(&isNumber);
        if (!isNumber || (i > 0 && part > 59)) return std::nullopt;
        seconds = seconds * 60 + part;
        if (seconds > kLongestLength) return std::nullopt;
    }
    return static_cast<int>(seconds);
}

BatchResult EnterLength(TMusicDatabase& database, SongHandle song) {
    const TID3Tag* record = database.Songs().Find(song);
    if (record == nullptr) return {};
    const QString name = ArtistAndTitle(*record);
    const auto text = UserDialogs().Input(u"Länge manuell eingeben"_s,
                                          u"Länge von "_s + name + u" (Minuten:Sekunden oder Sekunden):"_s,
                                          {}, FormatLength(record->Length, true));
    if (!text) return {};
    const auto seconds = ParseLength(*text);
    if (!seconds) throw EMusicDatabaseException(*text + u" ist keine Länge."_s);
    record = database.Songs().Find(song);
    if (record == nullptr) return {};
    const SongUpdate update{.Song = song, .Basis = *record, .Record = WithLength(*record, *seconds)};
    if (update.Record == update.Basis) return {};
    return UpdateSongs(database, u"Länge eingeben"_s, {update}, Renaming::Never);
}
