#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"

// The menu of the database, of the commands of all capabilities.

namespace {

constexpr auto kWriting = CommandNeeds::Writing;

constexpr MenuLine kDatabaseLines[] = {mcNew,    mcOpen,           mcSave,     mcSaveAs,   kSeparator,
                                       mcUpdate, mcUpdateWithTags, mcAddSongs, mcAddFolder};
constexpr MenuLine kEditLines[] = {
    mcFind,         mcFindOnline,       mcFindNext,           kSeparator,       mcMarkAll, mcInvertMarks,
    mcMarkByFilter, kWritableSeparator, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan,     mcEditBannList,
    mcCopyTo};
constexpr MenuLine kSortLines[] = {411, 412, 413, 414, 415, 416, 417, 418, 419, 420, 421, 422, 423};
constexpr MenuOutline kSort{u"Anordnen nach", kSortLines, mcSortSubmenu};
constexpr MenuLine kSubSortLines[] = {431, 432, 433};
constexpr MenuOutline kSubSort{u"Untergeordnet anordnen nach", kSubSortLines, mcSubSortSubmenu};
constexpr MenuLine kTagLines[] = {mcSetFlag, mcRemoveFlag, kSeparator, mcCorrect, mcRereadTags, mcRemoveTags};
constexpr MenuOutline kTags{
    .Caption = u"Tags und Flags", .Lines = kTagLines, .Id = mcTagsSubmenu, .For = kWriting};
constexpr MenuLine kSongLines[] = {
    mcPlay,          mcAddToPlayList, mcOpenExternally, mcTakeGenre, &kTags,    mcRenameByPattern,
    mcTagsFromNames, mcConvertMarked, kSeparator,       &kSort,      &kSubSort, mcReverse,
    mcFollowFocus};
constexpr MenuLine kAllSongsLines[] = {mcAdaptAllGenres, mcSetFlagOfAll,  mcRemoveFlagOfAll, kSeparator,
                                       mcCorrectAll,     mcRereadAllTags, mcRemoveAllTags};
constexpr MenuOutline kAllSongs{
    .Caption = u"Tags und Flags aller Songs", .Lines = kAllSongsLines, .Id = mcAllSongsSubmenu};
constexpr MenuLine kExtrasLines[] = {mcFindDuplicates,
                                     mcFindDuplicatesOfArtists,
                                     mcFindDuplicatesOfMarked,
                                     mcFindSimilarArtists,
                                     mcVerifyLengths,
                                     mcSearchNew,
                                     mcReadBackupCd,
                                     mcPrepareBurning,
                                     mcLoadLyrics,
                                     mcEnterLength,
                                     mcConvert,
                                     &kAllSongs,
                                     kSeparator,
                                     mcCacheCdSongs,
                                     mcDropCaches,
                                     mcRenameCds};
constexpr MenuLine kOverviewLines[] = {301, 302, 303, 304, 305, kWritableSeparator, mcRecount};

constexpr MenuOutline kDatabase{.Caption = u"Datenbank", .Lines = kDatabaseLines, .For = kWriting};
constexpr MenuOutline kEdit{u"Bearbeiten", kEditLines};
constexpr MenuOutline kSong{u"Song", kSongLines};
constexpr MenuOutline kExtras{.Caption = u"Extras", .Lines = kExtrasLines, .For = kWriting};
constexpr MenuOutline kOverview{u"Übersicht", kOverviewLines};
constexpr MenuLine kMenus[] = {&kDatabase, &kEdit, &kSong, &kExtras, &kOverview};
constexpr MenuOutline kMenu{u"Musik-Datenbank", kMenus};

bool TellOfClick(TMusicDatabase& database, const TMenuExItem& item, void* platformItem) {
    bool proceed = true;
    if (database.OnMenuItemClicked)
        database.OnMenuItemClicked(database, item, platformItem, item.Id(), proceed);
    return proceed;
}

}  // namespace

CommandDispatcher& TMusicDatabase::Commands() {
    if (commands_) return *commands_;
    commands_ = std::make_unique<CommandDispatcher>(
        kMenu, CommandConditions{
                   .IsReadOnly = [this] { return ReadOnly(); },
                   .Rests = [this] { return MenuLocked(); },
                   .MayRun = [this](const TMenuExItem& item,
                                    void* platformItem) { return TellOfClick(*this, item, platformItem); }});
    for (const DatabaseCommands& capability :
         {kFileCommands, kIntakeCommands, kFindCommands, kSongFileCommands, kOrderCommands, kOverviewCommands,
          kPlayCommands, kBatchCommands, kMediaCommands, kDuplicateCommands, kArtistCommands,
          kBackupCommands})
        commands_->Register(*this, capability);
    for (Listeners<>* change :
         {&CurrentOperation().Started, &CurrentOperation().Ended, &Events().ReadOnlyChanged})
        commands_->Follow(*change);
    return *commands_;
}

TMenuExItem& TMusicDatabase::Menu() {
    return Commands().Menu();
}

bool TMusicDatabase::ClickMenuItem(int id, void* platformItem) {
    return Commands().Run(id, platformItem);
}
