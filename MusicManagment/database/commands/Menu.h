#pragma once

#include <QHash>
#include <QString>
#include <functional>
#include <memory>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "CommonRUKTools/MenuItem.h"
#include "MusicManagment/database/Command.h"

class TMusicDatabase;

// What the shell does for a command. What is left out is the engine's, or always so.
struct CommandHandler {
    std::function<void()> Run{};  // may throw
    std::function<bool()> IsEnabled{};
    std::function<bool()> IsOn{};
    std::function<QString()> Caption{};
};

// A command of the shell's own in one of the database's menus.
struct ShellCommand {
    enum class Place { First, Last };
    enum class DuringRuns { Rests, Stays };

    int Id = 0;  // none of the database's
    QString Caption{};
    QChar Letter{};  // by which the keyboard chooses it
    QString Keys{};
    QString Icon{};
    QStringView Menu{};  // caption of the menu; where that is missing, or empty, the first one
    Place Where = Place::Last;
    bool BehindLine = true;  // a line parts it from the others, or from its predecessor in the same place
    DuringRuns Then = DuringRuns::Rests;
};

// The commands of a database: its menu, and the one way to run them, whether they come from the menu, from a
// key or from another program.
class DatabaseMenu {
 public:
    explicit DatabaseMenu(TMusicDatabase& database);

    // Takes the place of what the engine does for a command, as long as the subscription lasts.
    [[nodiscard]] Subscription Handle(int id, CommandHandler handler);
    // Adds a command to the menu; without its handler it is disabled.
    [[nodiscard]] Subscription Add(const ShellCommand& command, CommandHandler handler);

    // Built at the first call and kept until it has to be another; the items show the state of the database.
    TMenuExItem& Menu();
    // Another number for each menu that is built.
    int Revision() const { return revision_; }
    // Raises OnMenuItemClicked and then, unless its handler stops that, runs the command. False when it is
    // unknown, rests, or has nothing that it could run. Throws what the command throws.
    bool Run(int id, void* platformItem = nullptr);

    // Commands may be enabled, marked or named differently now.
    Listeners<> Changed;

 private:
    void Build();
    void BuildShellCommands();
    void Refresh(TMenuExItem& item) const;
    bool Rests(int id) const;
    std::shared_ptr<CommandHandler> HandlerOf(int id) const;
    const ShellCommand* ShellCommandOf(int id) const;

    TMusicDatabase& database_;
    Subscriptions followed_;
    QHash<int, std::weak_ptr<CommandHandler>> handlers_;
    std::vector<ShellCommand> shellCommands_;
    std::unique_ptr<TMenuExItem> menu_;
    bool readOnly_ = false;  // as the menu was built for
    int revision_ = 0;
};
