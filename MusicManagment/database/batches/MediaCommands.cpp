#include "MusicManagment/database/batches/MediaCommands.h"

#include <algorithm>
#include <map>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BurningBatch.h"
#include "MusicManagment/database/batches/CacheBatch.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

using namespace Qt::StringLiterals;

namespace {

struct KnownMedium {
    quint32 Serial;
    QString Name;  // or its label; empty where it has neither

    // Two may have one name.
    QString Caption() const {
        const QString serial = SerialText(Serial);
        return Name.isEmpty() ? serial : Name + u" ("_s + serial + u')';
    }
};

std::vector<KnownMedium> KnownMedia(const TMusicDatabase& database) {
    std::map<quint32, QString> media;
    for (const auto& song : database.Songs())
        if (const quint32 serial = SerialOfCdPath(song->FileName); serial != 0) media[serial];
    for (const CdName& name : database.CDNames())
        media[name.Serial];
    const CataloguedMedia catalogued(database);
    for (const Volume& volume : CurrentVolumes().Mounted()) {
        if (!volume.CanBeTakenAway() || volume.Serials.empty()) continue;
        const quint32 known = catalogued.SerialOf(volume);
        media[known != 0 ? known : volume.Serials.front()] = volume.Label;
    }
    std::vector<KnownMedium> known;
    for (const auto& [serial, label] : media) {
        const QString onMedium = MakeCdPath(serial, u"/"_s);
        const QString name = database.CDNameOf(onMedium);
        known.push_back({serial, name != onMedium ? name : label});
    }
    std::ranges::stable_sort(known, [](const KnownMedium& a, const KnownMedium& b) {
        return a.Name.compare(b.Name, Qt::CaseInsensitive) < 0;
    });
    return known;
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

QString PrepareBurningCommand(TMusicDatabase& database, const BatchSongs& songs) {
    if (songs.IsEmpty()) return {};
    const auto folder = UserDialogs().ChooseFolder(u"Ordner für die zu brennenden Dateien auswählen:"_s);
    if (!folder || folder->isEmpty()) return {};
    const MediaBatchResult result = PrepareBurning(database, songs, *folder);
    ReportMediaBatch(result, u"zum Brennen bereitgelegt"_s);
    return result.Done > 0 && !result.Stopped ? AbsolutePath(*folder) : QString();
}

void NameMediaCommand(TMusicDatabase& database) {
    const std::vector<KnownMedium> media = KnownMedia(database);
    if (media.empty())
        return UserDialogs().ShowMessage(
            MessageKind::Information, u"Es ist weder ein Datenträger katalogisiert noch einer eingelegt."_s);
    const QString caption = u"Namen der CDs anpassen"_s;
    QStringList choices;
    for (const KnownMedium& medium : media)
        choices << medium.Caption();
    const auto chosen = UserDialogs().Input(caption, u"Datenträger:"_s, choices, choices.front());
    if (!chosen) return;
    const auto medium = std::ranges::find(media, *chosen, &KnownMedium::Caption);
    if (medium == media.end()) return;
    const auto name = UserDialogs().Input(caption, u"Name:"_s, {}, medium->Name);
    if (!name || name->trimmed().isEmpty()) return;
    NameMedium(database, medium->Serial, *name, {});
    database.Events().MediaChanged.Tell();
}
