#include "CommonRUKTools/CommandDispatcher.h"

#include <QScopeGuard>
#include <algorithm>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

using Kind = TMenuExItem::ItemKind;

bool IsCommand(const TMenuExItem& item) {
    return item.Kind() == Kind::Command || item.Kind() == Kind::Radio;
}

}  // namespace

CommandDispatcher::CommandDispatcher(const MenuOutline& outline, CommandConditions conditions)
    : outline_(outline), conditions_(std::move(conditions)) {}

void CommandDispatcher::Follow(Listeners<>& source) {
    followed_ += source.Subscribe([this] { Changed.Tell(); });
}

// --- Who runs a command ---

Subscription CommandDispatcher::Handle(int id, CommandHandler handler) {
    auto kept = std::make_shared<CommandHandler>(std::move(handler));
    handlers_[id] = kept;
    Changed.Tell();
    return Subscription(kept);
}

Subscription CommandDispatcher::Add(const ShellCommand& command, CommandHandler handler) {
    shellCommands_.push_back(command);
    menu_.reset();
    return Handle(command.Id, std::move(handler));
}

const CommandDispatcher::Entry* CommandDispatcher::EntryOf(int id) const {
    const auto found = entries_.find(id);
    return found == entries_.end() ? nullptr : &found->second;
}

std::shared_ptr<CommandHandler> CommandDispatcher::HandlerOf(int id) const {
    return handlers_.value(id).lock();
}

const ShellCommand* CommandDispatcher::ShellCommandOf(int id) const {
    const auto found = std::ranges::find(shellCommands_, id, &ShellCommand::Id);
    return found == shellCommands_.end() ? nullptr : &*found;
}

bool CommandDispatcher::Rests(int id) const {
    const ShellCommand* own = ShellCommandOf(id);
    return conditions_.Rests && conditions_.Rests() &&
           (own == nullptr || own->Then == ShellCommand::DuringRuns::Rests);
}

bool CommandDispatcher::Run(int id, void* platformItem) {
    const TMenuExItem* item = Menu().Find(id);
    if (item == nullptr || !IsCommand(*item) || Rests(id)) return false;
    // Also a refused command: the toolkit has moved the mark of its item already.
    const auto tell = qScopeGuard([this] { Changed.Tell(); });
    if (conditions_.MayRun && !conditions_.MayRun(*item, platformItem)) return true;
    if (const auto handler = HandlerOf(id); handler && handler->Run) {
        if (handler->IsEnabled && !handler->IsEnabled()) return false;
        handler->Run();
        return true;
    }
    const Entry* entry = EntryOf(id);
    if (entry == nullptr || !entry->Run) return false;
    entry->Run();
    return true;
}

// --- The menu ---

TMenuExItem& CommandDispatcher::Menu() {
    if (!menu_ || readOnly_ != IsReadOnly()) Build();
    Refresh(*menu_);
    return *menu_;
}

void CommandDispatcher::Build() {
    readOnly_ = IsReadOnly();
    ++revision_;
    menu_ = std::make_unique<TMenuExItem>(Kind::Submenu, outline_.Caption.toString(), outline_.Id);
    AddLines(*menu_, outline_);
    AddShellCommands();
}

void CommandDispatcher::AddLines(TMenuExItem& menu, const MenuOutline& outline) const {
    for (const MenuLine& line : outline.Lines) {
        if (const auto* submenu = std::get_if<const MenuOutline*>(&line))
            AddSubmenu(menu, **submenu);
        else
            AddLine(menu, std::get<int>(line));
    }
}

void CommandDispatcher::AddSubmenu(TMenuExItem& menu, const MenuOutline& outline) const {
    if (!IsLeftOut(outline.For))
        AddLines(menu.Add(Kind::Submenu, outline.Caption.toString(), outline.Id), outline);
}

void CommandDispatcher::AddLine(TMenuExItem& menu, int id) const {
    if (id == kSeparator || id == kWritableSeparator) {
        if (id == kSeparator || !readOnly_) menu.Add(Kind::Separator, QString());
        return;
    }
    const Entry& command = entries_.at(id);
    if (IsLeftOut(command.For)) return;
    const Kind kind = command.Kind == CommandMark::Radio ? Kind::Radio : Kind::Command;
    TMenuExItem& item = menu.Add(kind, command.Caption.toString(), id, command.Keys.toString());
    item.SetIcon(command.Icon.toString());
    item.SetImageIndex(command.Image);
    item.SetCheckable(command.Kind == CommandMark::Switch);
    item.SetDefault(command.IsDefault);
}

void CommandDispatcher::AddShellCommands() {
    for (const ShellCommand& command : shellCommands_) {
        TMenuExItem& menu = MenuOf(command);
        const bool first = command.Where == ShellCommand::Place::First;
        if (command.BehindLine) menu.Insert(first ? 0 : menu.Items().size(), Kind::Separator, QString());
        TMenuExItem& item = menu.Insert(first ? 0 : menu.Items().size(), Kind::Command, command.Caption,
                                        command.Id, command.Keys);
        item.SetIcon(command.Icon);
        item.SetLetter(command.Letter);
    }
}

// A menu of one level takes the command itself.
TMenuExItem& CommandDispatcher::MenuOf(const ShellCommand& command) const {
    TMenuExItem* chosen = nullptr;
    for (const auto& menu : menu_->Items()) {
        if (menu->Kind() != Kind::Submenu) continue;
        if (menu->Caption() == command.Menu) return *menu;
        if (chosen == nullptr) chosen = menu.get();
    }
    return chosen != nullptr ? *chosen : *menu_;
}

// --- The menu as a user has arranged it ---

void CommandDispatcher::Arrange(std::vector<MenuFileItem> arrangement) {
    std::map<int, int> lines;
    CheckArrangement(arrangement, 0, lines);
    arrangement_ = std::move(arrangement);
    menu_.reset();
    Changed.Tell();
}

// `lines`: where the commands stand. A component whose menu has several levels shows nothing but menus in its
// first.
void CommandDispatcher::CheckArrangement(const std::vector<MenuFileItem>& items, int depth,
                                         std::map<int, int>& lines) const {
    const bool takesCommands = depth > 0 || std::ranges::any_of(outline_.Lines, [](const MenuLine& line) {
                                   return line.index() == 0;
                               });
    for (const MenuFileItem& item : items) {
        const auto refuse = [&item](const QString& what) {
            throw ERukException(MenuFileFault(item.Line, what));
        };
        if (item.What == MenuFileItem::Kind::Submenu)
            CheckArrangement(item.Items, depth + 1, lines);
        else if (!takesCommands)
            refuse(u"Das steht in keinem Menü."_s);
        if (item.What != MenuFileItem::Kind::Command) continue;
        if (EntryOf(item.Id) == nullptr && ShellCommandOf(item.Id) == nullptr)
            refuse(u"Den Befehl %1 gibt es nicht."_s.arg(item.Id));
        if (const auto [first, isNew] = lines.emplace(item.Id, item.Line); !isNew)
            refuse(u"Der Befehl %1 steht schon in Zeile %2."_s.arg(item.Id).arg(first->second));
    }
}

TMenuExItem& CommandDispatcher::ShownMenu() {
    TMenuExItem& whole = Menu();
    if (arrangement_.empty()) return whole;
    if (std::exchange(arrangedRevision_, revision_) != revision_) {
        arranged_ = std::make_unique<TMenuExItem>(Kind::Submenu, whole.Caption(), whole.Id());
        AddArranged(*arranged_, arrangement_);
    }
    Refresh(*arranged_);
    return *arranged_;
}

// Menus and lines that nothing is left of, where a component is read-only, are left out.
void CommandDispatcher::AddArranged(TMenuExItem& menu, const std::vector<MenuFileItem>& items) const {
    bool lineIsDue = false;
    for (const MenuFileItem& wanted : items) {
        if (wanted.What == MenuFileItem::Kind::Separator) {
            lineIsDue = !menu.Items().empty();
            continue;
        }
        if (!HoldsCommands(wanted)) continue;
        if (std::exchange(lineIsDue, false)) menu.Add(Kind::Separator, QString());
        if (wanted.What == MenuFileItem::Kind::Submenu)
            AddArranged(menu.Add(Kind::Submenu, wanted.Caption), wanted.Items);
        else
            AddArrangedCommand(menu, wanted);
    }
}

bool CommandDispatcher::HoldsCommands(const MenuFileItem& wanted) const {
    if (wanted.What == MenuFileItem::Kind::Command) return menu_->Find(wanted.Id) != nullptr;
    return std::ranges::any_of(wanted.Items,
                               [this](const MenuFileItem& item) { return HoldsCommands(item); });
}

void CommandDispatcher::AddArrangedCommand(TMenuExItem& menu, const MenuFileItem& wanted) const {
    const TMenuExItem& item = *menu_->Find(wanted.Id);
    const QString caption = wanted.Caption.isEmpty() ? item.Caption() : wanted.Caption;
    TMenuExItem& shown = menu.Add(item.Kind(), caption, item.Id(), item.Shortcut());
    shown.SetIcon(item.Icon());
    shown.SetImageIndex(item.ImageIndex());
    shown.SetCheckable(item.Checkable());
    shown.SetDefault(item.IsDefault());
    if (caption.contains(item.Letter(), Qt::CaseInsensitive)) shown.SetLetter(item.Letter());
}

void CommandDispatcher::Refresh(TMenuExItem& item) const {
    for (const auto& child : item.Items())
        Refresh(*child);
    if (!IsCommand(item)) return;
    const Entry* command = EntryOf(item.Id());
    const auto handler = HandlerOf(item.Id());
    const bool canRun = (handler && handler->Run) || (command != nullptr && command->Run);
    item.SetEnabled(canRun && !Rests(item.Id()) && (!handler || !handler->IsEnabled || handler->IsEnabled()));
    item.SetHint(canRun ? QString() : u"Kommt mit einer der nächsten Versionen"_s);
    if (handler && handler->IsOn)
        item.SetChecked(handler->IsOn());
    else if (command != nullptr && command->IsOn)
        item.SetChecked(command->IsOn());
    if (handler && handler->Caption) item.SetCaption(handler->Caption());
}
