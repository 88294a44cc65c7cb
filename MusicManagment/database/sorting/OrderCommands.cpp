#include "MusicManagment/database/sorting/OrderCommands.h"

#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"

namespace {

void ChangeOrder(TMusicDatabase& database, int command) {
    database.SetOrder(OrderAfter(database.Order(), command));
}

constexpr DatabaseCommand SortBy(int type, QStringView caption, QStringView keys = {}) {
    return {.Id = mcSortFirst + type,
            .Caption = caption,
            .Keys = keys,
            .Run = &ChangeOrder,
            .Kind = DatabaseCommand::Mark::Radio,
            .IsOn = [](const TMusicDatabase& database, int id) {
                return database.SortType() == id - mcSortFirst;
            }};
}

constexpr DatabaseCommand SubSortBy(int type, QStringView caption) {
    return {.Id = mcSubSortFirst + type,
            .Caption = caption,
            .Run = &ChangeOrder,
            .Kind = DatabaseCommand::Mark::Radio,
            .IsOn = [](const TMusicDatabase& database, int id) {
                return database.SubSortType() == id - mcSubSortFirst;
            }};
}

constexpr DatabaseCommand kRows[] = {
    SortBy(stTitle, u"Titel", u"Ctrl+1"),
    SortBy(stArtist, u"Artist", u"Ctrl+2"),
    SortBy(stAlbum, u"Album", u"Ctrl+3"),
    SortBy(stComment, u"Kommentar", u"Ctrl+4"),
    SortBy(stYear, u"Jahr", u"Ctrl+5"),
    SortBy(stLength, u"Länge", u"Ctrl+6"),
    SortBy(stGenre, u"Genre", u"Ctrl+7"),
    SortBy(stPath, u"Pfad", u"Ctrl+8"),
    SortBy(stPlayCnt, u"Beliebtheit", u"Ctrl+9"),
    SortBy(stAddTime, u"Datum", u"Ctrl+0"),
    // Key code 219: the key right of the 0, which is ß on a German keyboard.
    SortBy(stFlags, u"Flags", u"Ctrl+ß"),
    SortBy(stCacheType, u"Cache-Typ"),
    SortBy(stAlbumOrder, u"Albumreihenfolge"),
    SubSortBy(sstGATL, u"Genre->Artist->Titel->Länge"),
    SubSortBy(sstATL, u"Artist->Titel->Länge"),
    SubSortBy(sstPath, u"Pfad"),
    {.Id = mcReverse,
     .Caption = u"Reihenfolge umkehren",
     .Run = &ChangeOrder,
     .Kind = DatabaseCommand::Mark::Switch,
     .IsOn = [](const TMusicDatabase& database, int) { return database.SortBackwards(); }},
    {.Id = mcFollowFocus,
     .Caption = u"Markierung verfolgen",
     .Keys = u"Ctrl+Space",
     .Run = [](TMusicDatabase& database, int) { database.SetFollowFocus(!database.FollowFocus()); },
     .Kind = DatabaseCommand::Mark::Switch,
     .IsOn = [](const TMusicDatabase& database, int) { return database.FollowFocus(); }},
};

}  // namespace

constinit const DatabaseCommands kOrderCommands = kRows;

SongOrder OrderAfter(SongOrder order, int command) {
    if (command == mcReverse)
        order.Backwards = !order.Backwards;
    else if (command >= mcSubSortFirst)
        order.SubSortType = static_cast<TSubSortType>(command - mcSubSortFirst);
    else
        order.SortType = static_cast<TSortType>(command - mcSortFirst);
    return order;
}
