#pragma once

#include <QHash>
#include <QString>
#include <functional>
#include <map>
#include <memory>
#include <vector>

#include "CommonRUKTools/Command.h"
#include "CommonRUKTools/Listeners.h"
#include "CommonRUKTools/MenuFile.h"
#include "CommonRUKTools/MenuItem.h"

// What the shell does for a command. What is left out is the engine's, or always so.
struct CommandHandler {
    std::function<void()> Run{};  // may throw
    std::function<bool()> IsEnabled{};
    std::function<bool()> IsOn{};
    std::function<QString()> Caption{};
};

// A command of the shell's own in one of a component's menus.
struct ShellCommand {
    enum class Place { First, Last };
    enum class DuringRuns { Rests, Stays };

    int Id = 0;  // none of the component's
    QString Caption{};
    QChar Letter{};  // by which the keyboard chooses it
    QString Keys{};
    QString Icon{};
    QStringView Menu{};  // caption of the menu; where that is missing, or empty, the first one
    Place Where = Place::Last;
    bool BehindLine = true;  // a line parts it from the others, or from its predecessor in the same place
    DuringRuns Then = DuringRuns::Rests;
};

// What a component says of its commands as a whole. What is left out is never so, or always allowed.
struct CommandConditions {
    std::function<bool()> IsReadOnly{};  // commands that write are in no menu then
    std::function<bool()> Rests{};       // none runs
    // Asked before one runs; `platformItem` is the toolkit's own item, nullptr when the command came another
    // way.
    std::function<bool(const TMenuExItem& item, void* platformItem)> MayRun{};
};

// The commands of a component: its menu, and the one way to run them, whether they come from the menu, from a
// key, a button or another program.
class CommandDispatcher {
 public:
    // The outline lives as long as the dispatcher.
    explicit CommandDispatcher(const MenuOutline& outline, CommandConditions conditions = {});

    // The commands of one capability; all that the outline names come in before the menu is asked for.
    template <typename Component>
    void Register(Component& component, std::span<const ComponentCommand<Component>> commands) {
        for (const auto& command : commands) {
            Entry entry{command.Caption,   command.Keys, command.Icon,
                        command.Image,     command.For,  command.Kind,
                        command.IsDefault, {},           {}};
            if (command.Run != nullptr)
                entry.Run = [&component, run = command.Run, id = command.Id] { run(component, id); };
            if (command.IsOn != nullptr)
                entry.IsOn = [&component, isOn = command.IsOn, id = command.Id] {
                    return isOn(component, id);
                };
            entries_.insert_or_assign(command.Id, std::move(entry));
        }
    }
    // What is told here may change what commands can do.
    void Follow(Listeners<>& source);

    // Takes the place of what the engine does for a command, as long as the subscription lasts.
    [[nodiscard]] Subscription Handle(int id, CommandHandler handler);
    // Adds a command to the menu; without its handler it is disabled.
    [[nodiscard]] Subscription Add(const ShellCommand& command, CommandHandler handler);

    // Built at the first call and kept until it has to be another; the items show the state of the component.
    TMenuExItem& Menu();
    // Shows the commands as a user has arranged them, for as long as this lives; what is not in it cannot be
    // chosen from the menu, but runs as ever. Throws ERukException, which names the line, for a command that
    // is unknown or stands twice; all stays as it was then.
    void Arrange(std::vector<MenuFileItem> arrangement);
    // The menu as it is shown: as the user has arranged it, else Menu().
    TMenuExItem& ShownMenu();
    // Another number for each menu that is built.
    int Revision() const { return revision_; }
    // Asks the component whether the command may run and then runs it. False when it is unknown, rests, or
    // has nothing that it could run. Throws what the command throws.
    bool Run(int id, void* platformItem = nullptr);

    // Commands may be enabled, marked or named differently now.
    Listeners<> Changed;

 private:
    // A command together with its component.
    struct Entry {
        QStringView Caption;
        QStringView Keys;
        QStringView Icon;
        int Image;
        CommandNeeds For;
        CommandMark Kind;
        bool IsDefault;
        std::function<void()> Run;
        std::function<bool()> IsOn;
    };

    void Build();
    void AddLines(TMenuExItem& menu, const MenuOutline& outline) const;
    void AddLine(TMenuExItem& menu, int id) const;
    void AddSubmenu(TMenuExItem& menu, const MenuOutline& outline) const;
    void AddShellCommands();
    void CheckArrangement(const std::vector<MenuFileItem>& items, int depth, std::map<int, int>& lines) const;
    void AddArranged(TMenuExItem& menu, const std::vector<MenuFileItem>& items) const;
    bool HoldsCommands(const MenuFileItem& wanted) const;
    void AddArrangedCommand(TMenuExItem& menu, const MenuFileItem& wanted) const;
    TMenuExItem& MenuOf(const ShellCommand& command) const;
    void Refresh(TMenuExItem& item) const;
    bool IsReadOnly() const { return conditions_.IsReadOnly && conditions_.IsReadOnly(); }
    bool IsLeftOut(CommandNeeds needs) const { return readOnly_ && needs == CommandNeeds::Writing; }
    bool Rests(int id) const;
    const Entry* EntryOf(int id) const;
    std::shared_ptr<CommandHandler> HandlerOf(int id) const;
    const ShellCommand* ShellCommandOf(int id) const;

    const MenuOutline& outline_;
    CommandConditions conditions_;
    Subscriptions followed_;
    std::map<int, Entry> entries_;  // by number
    QHash<int, std::weak_ptr<CommandHandler>> handlers_;
    std::vector<ShellCommand> shellCommands_;
    std::unique_ptr<TMenuExItem> menu_;
    std::vector<MenuFileItem> arrangement_;  // empty: as the outline has it
    std::unique_ptr<TMenuExItem> arranged_;  // made of menu_
    int arrangedRevision_ = -1;              // of the menu that it was made of
    bool readOnly_ = false;                  // as the menu was built for
    int revision_ = 0;
};
