#include "MusicManagment/database/commands/Menu.h"

#include <iterator>
#include <span>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/intake/Update.h"

using namespace Qt::StringLiterals;

namespace {

using Kind = TMenuExItem::ItemKind;

// Whether an item is there in a read-only database.
enum class Shown { Always, Writable };

struct MenuRow {
    Kind ItemKind;
    QStringView Caption;
    int Id = 0;
    QStringView Shortcut{};
    Shown When = Shown::Always;
};

constexpr auto kCommand = Kind::Command;
constexpr auto kRadio = Kind::Radio;
constexpr MenuRow kLine = {Kind::Separator, {}};
constexpr MenuRow kWritableLine = {Kind::Separator, {}, 0, {}, Shown::Writable};

constexpr MenuRow kDatabase[] = {
    {kCommand, u"Neue Datenbank", mcNew, u"Ctrl+Alt+N"},
    {kCommand, u"Datenbank öffnen...", mcOpen, u"Ctrl+Alt+O"},
    {kCommand, u"Datenbank speichern", mcSave, u"Ctrl+Alt+S"},
    {kCommand, u"Datenbank speichern unter...", mcSaveAs},
    kLine,
    {kCommand, u"Datenbank updaten (Nur neue oder entfernte Songs suchen)...", mcUpdate, u"Ctrl+U"},
    {kCommand, u"Datenbank updaten (Auch ID3-Tags auf Änderungen prüfen)...", mcUpdateWithTags,
     u"Ctrl+Alt+U"},
    {kCommand, u"Songs zur Datenbank hinzufügen...", mcAddSongs},
    {kCommand, u"Ordner zur Datenbank hinzufügen...", mcAddFolder},
};

constexpr MenuRow kEdit[] = {
    {kCommand, u"Suchen...", mcFind, u"Ctrl+F"},
    {kCommand, u"Suchen im Internet...", mcFindOnline, u"Ctrl+Alt+F"},
    {kCommand, u"Weitersuchen", mcFindNext, u"F3"},
    kLine,
    {kCommand, u"Alles markieren", mcMarkAll, u"Ctrl+A"},
    {kCommand, u"Markierung umkehren", mcInvertMarks, u"Ctrl+Alt+A"},
    {kCommand, u"Mit Filter markieren", mcMarkByFilter, u"Alt+F"},
    kWritableLine,
    {kCommand, u"Markierte aus der Datenbank entfernen", mcRemoveFromDatabase, u"Del", Shown::Writable},
    {kCommand, u"Markierte vom Datenträger entfernen", mcRemoveFromDisk, u"Alt+Del", Shown::Writable},
    {kCommand, u"~ und in die Bannlist aufnehmen", mcBan, u"Ctrl+B", Shown::Writable},
    {kCommand, u"Markierte kopieren nach ...", mcCopyTo, u"Ctrl+C", Shown::Writable},
};

constexpr MenuRow kSong[] = {
    {kCommand, u"Abspielen", mcPlay, u"Return"},
    {kCommand, u"Zur PlayList hinzufügen", mcAddToPlayList},
    {kCommand, u"Mit externem Programm öffnen", mcOpenExternally, {}, Shown::Writable},
    {kCommand, u"In passendes Genre aufnehmen", 404, u"Alt+A", Shown::Writable},
    kLine,
};

constexpr MenuRow kSort[] = {
    {kRadio, u"Titel", 411, u"Ctrl+1"},
    {kRadio, u"Artist", 412, u"Ctrl+2"},
    {kRadio, u"Album", 413, u"Ctrl+3"},
    {kRadio, u"Kommentar", 414, u"Ctrl+4"},
    {kRadio, u"Jahr", 415, u"Ctrl+5"},
    {kRadio, u"Länge", 416, u"Ctrl+6"},
    {kRadio, u"Genre", 417, u"Ctrl+7"},
    {kRadio, u"Pfad", 418, u"Ctrl+8"},
    {kRadio, u"Beliebtheit", 419, u"Ctrl+9"},
    {kRadio, u"Datum", 420, u"Ctrl+0"},
    // Key code 219: the key right of the 0, which is ß on a German keyboard.
    {kRadio, u"Flags", 421, u"Ctrl+ß"},
    {kRadio, u"Cache-Typ", 422},
    {kRadio, u"Albumreihenfolge", 423},
};

constexpr MenuRow kSubSort[] = {
    {kRadio, u"Genre->Artist->Titel->Länge", 431},
    {kRadio, u"Artist->Titel->Länge", 432},
    {kRadio, u"Pfad", 433},
};

constexpr MenuRow kExtras[] = {
    {kCommand, u"Doppelte Einträge suchen (allgemein)", 501},
    {kCommand, u"Doppelte Einträge suchen (innerhalb der Artists)", 506},
    {kCommand, u"Ähnlich klingende Artists suchen", 505},
    {kCommand, u"Korrektheit von Länge und Format sicherstellen", 504},
    {kCommand, u"Nach neuen Songs suchen", mcSearchNew},
    {kCommand, u"Songs von einer Backup-CD wieder einlesen", 503},
    {kCommand, u"Brennen auf CD vorbereiten", 507},
    {kCommand, u"Lyrikfang downloaden", 508},
    {kCommand, u"Länge manuell eingeben", 509},
    {kCommand, u"Song konvertieren", 510},
    kLine,
    {kCommand, u"Songs von CD zwischenspeichern", 512},
    {kCommand, u"Zwischenspeicherungen entfernen", 513},
    {kCommand, u"Namen der CDs anpassen...", 514},
};

constexpr MenuRow kOverview[] = {
    {kRadio, u"Artisten auflisten", 301, u"Alt+1"},
    {kRadio, u"Alben auflisten", 302, u"Alt+2"},
    {kRadio, u"Jahre auflisten", 303, u"Alt+3"},
    {kRadio, u"Längen auflisten", 304, u"Alt+4"},
    {kRadio, u"Genre auflisten", 305, u"Alt+5"},
    kWritableLine,
    {kCommand, u"Liste neu berechnen", mcRecount, {}, Shown::Writable},
};

void AddRows(TMenuExItem& parent, std::span<const MenuRow> rows, bool readOnly) {
    for (const MenuRow& row : rows) {
        if (readOnly && row.When == Shown::Writable) continue;
        parent.Add(row.ItemKind, row.Caption.toString(), row.Id, row.Shortcut.toString());
    }
}

void AddSubmenu(TMenuExItem& parent, const QString& caption, int id, std::span<const MenuRow> rows,
                bool readOnly) {
    AddRows(parent.Add(Kind::Submenu, caption, id), rows, readOnly);
}

void AddSongMenu(TMenuExItem& root, bool readOnly) {
    TMenuExItem& song = root.Add(Kind::Submenu, u"Song"_s);
    AddRows(song, kSong, readOnly);
    song.Find(mcPlay)->SetDefault(true);
    AddSubmenu(song, u"Anordnen nach"_s, mcSortSubmenu, kSort, readOnly);
    AddSubmenu(song, u"Untergeordnet anordnen nach"_s, mcSubSortSubmenu, kSubSort, readOnly);
    song.Add(kCommand, u"Reihenfolge umkehren"_s, mcReverse).SetCheckable(true);
    song.Add(kCommand, u"Markierung verfolgen"_s, mcFollowFocus, u"Ctrl+Space"_s).SetCheckable(true);
}

// Commands whose operation is still to be built.
constexpr int kLater[] = {
    mcFindOnline, mcRemoveFromDisk, mcBan, 404, 501, 503, 504, 505, 506, 507, 508, 509, 510, 512, 513, 514};

void DisableLater(TMenuExItem& menu) {
    for (const int id : kLater) {
        TMenuExItem* item = menu.Find(id);
        if (item == nullptr) continue;
        item->SetEnabled(false);
        item->SetHint(u"Kommt mit einer der nächsten Versionen"_s);
    }
}

void SetChecked(TMenuExItem& menu, int id, bool checked) {
    if (TMenuExItem* item = menu.Find(id)) item->SetChecked(checked);
}

void EnableAll(TMenuExItem& menu, bool enabled) {
    if (menu.Kind() == Kind::Command || menu.Kind() == Kind::Radio) menu.SetEnabled(enabled);
    for (const auto& item : menu.Items())
        EnableAll(*item, enabled);
}

// True when the id was one of the kinds that only set a property.
bool ApplyOrderCommand(TMusicDatabase& database, int id) {
    if (id >= mcSortFirst && id <= mcSortLast)
        database.SetSortType(static_cast<TSortType>(id - mcSortFirst));
    else if (id >= mcSubSortFirst && id <= mcSubSortLast)
        database.SetSubSortType(static_cast<TSubSortType>(id - mcSubSortFirst));
    else if (id == mcReverse)
        database.SetSortBackwards(!database.SortBackwards());
    else if (id == mcFollowFocus)
        database.SetFollowFocus(!database.FollowFocus());
    else
        return false;
    return true;
}

}  // namespace

std::unique_ptr<TMenuExItem> BuildDatabaseMenu(bool readOnly) {
    auto root = std::make_unique<TMenuExItem>(Kind::Submenu, u"Musik-Datenbank"_s);
    if (!readOnly) AddSubmenu(*root, u"Datenbank"_s, 0, kDatabase, readOnly);
    AddSubmenu(*root, u"Bearbeiten"_s, 0, kEdit, readOnly);
    AddSongMenu(*root, readOnly);
    if (!readOnly) AddSubmenu(*root, u"Extras"_s, 0, kExtras, readOnly);
    AddSubmenu(*root, u"Übersicht"_s, 0, kOverview, readOnly);
    return root;
}

void UpdateDatabaseMenu(TMenuExItem& menu, const TMusicDatabase& database) {
    EnableAll(menu, !database.MenuLocked());
    DisableLater(menu);
    for (int id = mcSortFirst; id <= mcSortLast; ++id)
        SetChecked(menu, id, id - mcSortFirst == database.SortType());
    for (int id = mcSubSortFirst; id <= mcSubSortLast; ++id)
        SetChecked(menu, id, id - mcSubSortFirst == database.SubSortType());
    SetChecked(menu, mcReverse, database.SortBackwards());
    SetChecked(menu, mcFollowFocus, database.FollowFocus());
}

bool RunDatabaseCommand(TMusicDatabase& database, int id) {
    if (ApplyOrderCommand(database, id)) return true;
    switch (id) {
        case mcNew:
            database.OpenDatabase(QString());
            return true;
        case mcOpen:
            database.OpenDatabaseFromDialog();
            return true;
        case mcSave:
            database.SaveDatabase();
            return true;
        case mcSaveAs:
            database.SaveDatabase(QString(), false, true);
            return true;
        case mcUpdate:
            UpdateDatabase(database, UpdateTags::Keep);
            return true;
        case mcUpdateWithTags:
            UpdateDatabase(database, UpdateTags::Reread);
            return true;
        case mcAddSongs:
            AddSongsFromDialog(database);
            return true;
        case mcAddFolder:
            AddFolder(database, QString(), true);
            return true;
        case mcSearchNew:
            SearchNewSongs(database);
            return true;
        case mcRecount:
            database.RecountGroups();
            return true;
        default:
            return false;
    }
}
