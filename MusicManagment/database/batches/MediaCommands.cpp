#include "MusicManagment/database/batches/MediaCommands.h"

#include <algorithm>
#include <map>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BurningBatch.h"
#include "MusicManagment/database/batches/CacheBatch.h"

using namespace Qt::StringLiterals;

namespace {

// Serial numbers of media, and what they are called where they have no name.
std::map<quint32, QString> KnownMedia(const TMusicDatabase& database) {
    std::map<quint32, QString> media;
    for (const auto& song : database.Songs())
        if (const quint32 serial = SerialOfCdPath(song->FileName); serial != 0) media[serial];
    for (const Volume& volume : CurrentVolumes().Mounted())
        if (volume.CanBeTakenAway() && !volume.Serials.empty()) media[volume.Serials.front()] = volume.Label;
    for (const CdName& name : database.CDNames())
        media[name.Serial] = name.Name;
    return media;
}

constexpr DatabaseCommand kRows[] = {
    {.Id = mcPrepareBurning,
     .Caption = u"Brennen auf CD vorbereiten",
     .Run = [](TMusicDatabase& database, int) { PrepareBurningCommand(database, AllSongs(database)); }},
    {.Id = mcCacheCdSongs,
     .Caption = u"Songs von CD zwischenspeichern",
     .Run = [](TMusicDatabase& database, int) { CacheSongsCommand(database, AllSongs(database)); }},
    {.Id = mcDropCaches,
     .Caption = u"Zwischenspeicherungen entfernen",
     .Run = [](TMusicDatabase& database, int) { DropCachesCommand(database, AllSongs(database)); }},
    {.Id = mcRenameCds,
     .Caption = u"Namen der CDs anpassen...",
     .Run = [](TMusicDatabase& database, int) { NameMediaCommand(database); }},
};

}  // namespace

constinit const DatabaseCommands kMediaCommands = kRows;

void CacheSongsCommand(TMusicDatabase& database, const BatchSongs& songs) {
    ReportMediaBatch(CacheSongs(database, songs), u"zwischengespeichert"_s);
}

void DropCachesCommand(TMusicDatabase& database, const BatchSongs& songs) {
    ReportMediaBatch(DropCaches(database, songs), u"ohne Zwischenspeicherung"_s);
}

void PrepareBurningCommand(TMusicDatabase& database, const BatchSongs& songs) {
    if (songs.IsEmpty()) return;
    const auto folder = UserDialogs().ChooseFolder(u"Ordner für die zu brennenden Dateien auswählen:"_s);
    if (!folder || folder->isEmpty()) return;
    ReportMediaBatch(PrepareBurning(database, songs, *folder), u"zum Brennen bereitgelegt"_s);
}

void NameMediaCommand(TMusicDatabase& database) {
    const auto media = KnownMedia(database);
    if (media.empty())
        return UserDialogs().ShowMessage(
            MessageKind::Information, u"Es ist weder ein Datenträger katalogisiert noch einer eingelegt."_s);
    const QString caption = u"Namen der CDs anpassen"_s;
    QStringList choices;
    for (const auto& [serial, name] : media)
        choices << SerialText(serial) + (name.isEmpty() ? QString() : u": "_s + name);
    const auto chosen = UserDialogs().Input(caption, u"Datenträger:"_s, choices, choices.front());
    if (!chosen) return;
    const auto medium = std::ranges::find_if(
        media, [&](const auto& row) { return chosen->startsWith(SerialText(row.first)); });
    if (medium == media.end()) return;
    const auto name = UserDialogs().Input(caption, u"Name:"_s, {}, medium->second);
    if (!name || name->trimmed().isEmpty()) return;
    std::vector<CdName> names = database.CDNames();
    names.push_back({name->trimmed(), medium->first});  // of one serial number the last counts
    database.SetCDNames(std::move(names));
    database.Events().MediaChanged.Tell();
}
