#pragma once

#include <QString>

class CommandDispatcher;

// Arranges the menu of a component as the file "Tunestead3_NAME_Menu.menu" in the folder says, where there is
// one. Returns what is wrong with it, for the user; the menu then stays as the component has it.
QString ArrangeMenu(CommandDispatcher& commands, const QString& folder, const QString& name);
