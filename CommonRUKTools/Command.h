#pragma once

#include <QStringView>
#include <span>
#include <variant>

enum class CommandMark { None, Switch, Radio };
enum class CommandNeeds { Nothing, Writing };

// A command of a component: what its menu says of it and what it does. Each belongs to the capability that
// it starts, which lists it in a source of its own.
template <typename Component>
struct ComponentCommand {
    using Mark = CommandMark;
    using Needs = CommandNeeds;

    int Id = 0;
    QStringView Caption{};
    QStringView Keys{};  // as "Ctrl+Alt+N"
    QStringView Icon{};  // its name in the freedesktop icon themes
    // What the engine does, unless the shell has a handler of its own. None: it takes a window, or is still
    // to be built. May throw.
    void (*Run)(Component& component, int id) = nullptr;
    Needs For = Needs::Nothing;
    Mark Kind = Mark::None;
    bool (*IsOn)(const Component& component, int id) = nullptr;  // whether its mark is set
    int Image = -1;                                              // number of its picture; -1 none
    bool IsDefault = false;                                      // what a double click does
};

struct MenuOutline;

// A command, by its number, or a menu below.
using MenuLine = std::variant<int, const MenuOutline*>;

// In place of a command's number: a line between commands, and one that a read-only component does not have.
inline constexpr int kSeparator = 0;
inline constexpr int kWritableSeparator = -1;

// What stands in a menu, in which order.
struct MenuOutline {
    QStringView Caption{};
    std::span<const MenuLine> Lines{};
    int Id = 0;
    CommandNeeds For = CommandNeeds::Nothing;
};
