#include "MusicManagment/database/commands/Menu.h"

#include <QScopeGuard>
#include <algorithm>

#include "MusicManagment/database/MusicManagment.h"

using namespace Qt::StringLiterals;

namespace {

using Kind = TMenuExItem::ItemKind;

// In place of a command's number.
constexpr int kLine = 0;
constexpr int kWritableLine = -1;  // one that a read-only database does not have

constexpr int kDatabase[] = {mcNew,    mcOpen,           mcSave,     mcSaveAs,   kLine,
                             mcUpdate, mcUpdateWithTags, mcAddSongs, mcAddFolder};
constexpr int kEdit[] = {
    mcFind,        mcFindOnline,         mcFindNext,       kLine, mcMarkAll, mcInvertMarks, mcMarkByFilter,
    kWritableLine, mcRemoveFromDatabase, mcRemoveFromDisk, mcBan, mcCopyTo};
constexpr int kSong[] = {mcPlay,        mcAddToPlayList,  mcOpenExternally, mcTakeGenre,  kLine,
                         mcSortSubmenu, mcSubSortSubmenu, mcReverse,        mcFollowFocus};
constexpr int kSort[] = {411, 412, 413, 414, 415, 416, 417, 418, 419, 420, 421, 422, 423};
constexpr int kSubSort[] = {431, 432, 433};
constexpr int kExtras[] = {mcFindDuplicates,
                           mcFindDuplicatesOfArtists,
                           mcFindSimilarArtists,
                           mcVerifyLengths,
                           mcSearchNew,
                           mcReadBackupCd,
                           mcPrepareBurning,
                           mcLoadLyrics,
                           mcEnterLength,
                           mcConvert,
                           kLine,
                           mcCacheCdSongs,
                           mcDropCaches,
                           mcRenameCds};
constexpr int kOverview[] = {301, 302, 303, 304, 305, kWritableLine, mcRecount};

struct MenuOutline {
    QStringView Caption;
    std::span<const int> Items;
    bool NeedsWriting = false;
};

constexpr MenuOutline kMenus[] = {{u"Datenbank", kDatabase, true},
                                  {u"Bearbeiten", kEdit},
                                  {u"Song", kSong},
                                  {u"Extras", kExtras, true},
                                  {u"Übersicht", kOverview}};

using CommandsById = QHash<int, const DatabaseCommand*>;

CommandsById AllCommands() {
    CommandsById commands;
    for (const DatabaseCommands& capability :
         {kFileCommands, kIntakeCommands, kFindCommands, kSongFileCommands, kOrderCommands, kOverviewCommands,
          kPlayCommands, kLaterCommands})
        for (const DatabaseCommand& command : capability)
            commands.insert(command.Id, &command);
    return commands;
}

// nullptr for a number that is none of the database's commands.
const DatabaseCommand* CommandOf(int id) {
    static const CommandsById commands = AllCommands();
    return commands.value(id);
}

void AddItems(TMenuExItem& menu, std::span<const int> items, bool readOnly);

void AddCommand(TMenuExItem& menu, const DatabaseCommand& command) {
    const Kind kind = command.Kind == DatabaseCommand::Mark::Radio ? Kind::Radio : Kind::Command;
    TMenuExItem& item = menu.Add(kind, command.Caption.toString(), command.Id, command.Keys.toString());
    item.SetIcon(command.Icon.toString());
    item.SetCheckable(command.Kind == DatabaseCommand::Mark::Switch);
    item.SetDefault(command.Id == mcPlay);
}

void AddItem(TMenuExItem& menu, int id, bool readOnly) {
    switch (id) {
        case kWritableLine:
            if (readOnly) return;
            [[fallthrough]];
        case kLine:
            menu.Add(Kind::Separator, QString());
            return;
        case mcSortSubmenu:
            return AddItems(menu.Add(Kind::Submenu, u"Anordnen nach"_s, id), kSort, readOnly);
        case mcSubSortSubmenu:
            return AddItems(menu.Add(Kind::Submenu, u"Untergeordnet anordnen nach"_s, id), kSubSort,
                            readOnly);
        default:
            const DatabaseCommand& command = *CommandOf(id);
            if (!readOnly || command.For == DatabaseCommand::Needs::Nothing) AddCommand(menu, command);
    }
}

void AddItems(TMenuExItem& menu, std::span<const int> items, bool readOnly) {
    for (const int id : items)
        AddItem(menu, id, readOnly);
}

bool IsCommand(const TMenuExItem& item) {
    return item.Kind() == Kind::Command || item.Kind() == Kind::Radio;
}

}  // namespace

DatabaseMenu::DatabaseMenu(TMusicDatabase& database) : database_(database) {
    const auto tell = [this] { Changed.Tell(); };
    followed_ += database.CurrentOperation().Started.Subscribe(tell);
    followed_ += database.CurrentOperation().Ended.Subscribe(tell);
    followed_ += database.Events().ReadOnlyChanged.Subscribe(tell);
}

// --- Who runs a command ---

Subscription DatabaseMenu::Handle(int id, CommandHandler handler) {
    auto kept = std::make_shared<CommandHandler>(std::move(handler));
    handlers_[id] = kept;
    Changed.Tell();
    return Subscription(kept);
}

Subscription DatabaseMenu::Add(const ShellCommand& command, CommandHandler handler) {
    shellCommands_.push_back(command);
    menu_.reset();
    return Handle(command.Id, std::move(handler));
}

std::shared_ptr<CommandHandler> DatabaseMenu::HandlerOf(int id) const {
    return handlers_.value(id).lock();
}

const ShellCommand* DatabaseMenu::ShellCommandOf(int id) const {
    const auto found = std::ranges::find(shellCommands_, id, &ShellCommand::Id);
    return found == shellCommands_.end() ? nullptr : &*found;
}

bool DatabaseMenu::Rests(int id) const {
    const ShellCommand* own = ShellCommandOf(id);
    return database_.MenuLocked() && (own == nullptr || own->Then == ShellCommand::DuringRuns::Rests);
}

bool DatabaseMenu::Run(int id, void* platformItem) {
    const TMenuExItem* item = Menu().Find(id);
    if (item == nullptr || !IsCommand(*item) || Rests(id)) return false;
    // Also a refused command: the toolkit has moved the mark of its item already.
    const auto tell = qScopeGuard([this] { Changed.Tell(); });
    bool proceed = true;
    if (database_.OnMenuItemClicked) database_.OnMenuItemClicked(database_, *item, platformItem, id, proceed);
    if (!proceed) return true;
    if (const auto handler = HandlerOf(id); handler && handler->Run) {
        if (handler->IsEnabled && !handler->IsEnabled()) return false;
        handler->Run();
        return true;
    }
    const DatabaseCommand* command = CommandOf(id);
    if (command == nullptr || command->Run == nullptr) return false;
    command->Run(database_, id);
    return true;
}

// --- The menu ---

TMenuExItem& DatabaseMenu::Menu() {
    if (!menu_ || readOnly_ != database_.ReadOnly()) Build();
    Refresh(*menu_);
    return *menu_;
}

void DatabaseMenu::Build() {
    readOnly_ = database_.ReadOnly();
    ++revision_;
    menu_ = std::make_unique<TMenuExItem>(Kind::Submenu, u"Musik-Datenbank"_s);
    for (const MenuOutline& menu : kMenus)
        if (!readOnly_ || !menu.NeedsWriting)
            AddItems(menu_->Add(Kind::Submenu, menu.Caption.toString()), menu.Items, readOnly_);
    BuildShellCommands();
}

void DatabaseMenu::BuildShellCommands() {
    const auto& menus = menu_->Items();
    for (const ShellCommand& command : shellCommands_) {
        const auto wanted = std::ranges::find_if(
            menus, [&](const auto& menu) { return QStringView(menu->Caption()) == command.Menu; });
        TMenuExItem& menu = wanted == menus.end() ? *menus.front() : **wanted;
        const bool first = command.Where == ShellCommand::Place::First;
        if (command.BehindLine) menu.Insert(first ? 0 : menu.Items().size(), Kind::Separator, QString());
        TMenuExItem& item = menu.Insert(first ? 0 : menu.Items().size(), Kind::Command, command.Caption,
                                        command.Id, command.Keys);
        item.SetIcon(command.Icon);
        item.SetLetter(command.Letter);
    }
}

void DatabaseMenu::Refresh(TMenuExItem& item) const {
    for (const auto& child : item.Items())
        Refresh(*child);
    if (!IsCommand(item)) return;
    const DatabaseCommand* command = CommandOf(item.Id());
    const auto handler = HandlerOf(item.Id());
    const bool canRun = (handler && handler->Run) || (command != nullptr && command->Run != nullptr);
    item.SetEnabled(canRun && !Rests(item.Id()) && (!handler || !handler->IsEnabled || handler->IsEnabled()));
    item.SetHint(canRun ? QString() : u"Kommt mit einer der nächsten Versionen"_s);
    if (handler && handler->IsOn)
        item.SetChecked(handler->IsOn());
    else if (command != nullptr && command->IsOn != nullptr)
        item.SetChecked(command->IsOn(database_, item.Id()));
    if (handler && handler->Caption) item.SetCaption(handler->Caption());
}

// --- The database's own way to it ---

DatabaseMenu& TMusicDatabase::Commands() {
    if (!commands_) commands_ = std::make_shared<DatabaseMenu>(*this);
    return *commands_;
}

TMenuExItem& TMusicDatabase::Menu() {
    return Commands().Menu();
}

bool TMusicDatabase::ClickMenuItem(int id, void* platformItem) {
    return Commands().Run(id, platformItem);
}
