#include "MusicManagment/database/intake/MediumQuestion.h"

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

using namespace Qt::StringLiterals;

namespace {

// Media whose songs are stored by ordinary paths, by their serial number.
const QString kSection = QStringLiteral("medium");
const QString kOrdinary = QStringLiteral("ordinary");

QString DisplayName(const Volume& volume) {
    return volume.Label.isEmpty() ? volume.MountPoint
                                  : u'„' + volume.Label + u"“ ("_s + volume.MountPoint + u')';
}

void NoteOrdinary(TMusicDatabase& database, quint32 serial) {
    database.Side().Add(kSection, {SerialText(serial), kOrdinary});
    database.SetModified(true);
}

void AskAbout(TMusicDatabase& database, const Volume& volume) {
    enum Answer { Catalogue, Ordinary, Cancel };
    const int answer =
        UserDialogs().Ask({.Text = u"Der Datenträger "_s + DisplayName(volume) +
                                   u" kann entfernt werden. Soll er katalogisiert werden? Seine Songs werden "
                                   u"dann überall gefunden, "
                                   u"wo er eingelegt ist, und sonst wird er mit seinem Namen verlangt."_s,
                           .Buttons = {u"Katalogisieren"_s, u"Als gewöhnlichen Ordner"_s, u"Abbrechen"_s},
                           .Cancel = Cancel,
                           .Default = Catalogue});
    if (answer == Cancel) throw EAbort();
    if (answer == Ordinary) return NoteOrdinary(database, volume.Serials.front());
    const auto name =
        UserDialogs().Input(u"Datenträger katalogisieren"_s, u"Name des Mediums:"_s, {},
                            volume.Label.isEmpty() ? SerialText(volume.Serials.front()) : volume.Label);
    if (!name) throw EAbort();
    const quint32 serial = volume.Serials.front();
    if (CurrentVolumes().WithSerial(serial) == nullptr)
        throw EMusicDatabaseException(u"Der Datenträger "_s + DisplayName(volume) +
                                      u" ist nicht mehr eingelegt."_s);
    NameMedium(database, serial, *name, volume.Label);
}

}  // namespace

void AskAboutMedia(TMusicDatabase& database, const QStringList& paths) {
    if (!database.ModernMedia()) return;
    std::optional<CataloguedMedia> known;
    QStringList asked;
    for (const QString& path : paths) {
        const Volume* found = CurrentVolumes().Holding(AbsolutePath(path));
        if (found == nullptr || !found->CanBeTakenAway() || found->Serials.empty()) continue;
        const Volume volume = *found;  // a question lets time pass
        if (!known) known.emplace(database);
        const QString serial = SerialText(volume.Serials.front());
        if (asked.contains(serial) || known->IsCatalogued(volume)) continue;
        if (database.Side().Contains(kSection, {serial, kOrdinary})) continue;
        asked << serial;
        AskAbout(database, volume);
    }
}
