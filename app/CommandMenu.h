#pragma once

#include <QHash>
#include <QPointer>
#include <QWidget>

#include "CommonRUKTools/Listeners.h"

class CommandDispatcher;
class QAction;
class QMenu;
class TMenuExItem;

// A caption with a mark at its first letter that is not in `taken`, by which the keyboard chooses it; the
// letter is taken then.
QString WithAccessKey(const QString& caption, QString& taken);
// Marks those items of a menu that have no such letter yet.
void AddAccessKeys(const QMenu& menu);

// The command menu of a component as the toolkit shows it, always as it is now.
class CommandMenu {
 public:
    // What a chosen command throws is shown to the user.
    explicit CommandMenu(CommandDispatcher& commands);

    // Adds the items below `parent`, a part of the component's menu, to a menu.
    void Fill(QMenu& menu, const TMenuExItem& parent);
    // Forgets what was filled in. The caller deletes the menus.
    void Clear();
    // The keys of a command work only while this widget has the focus: other views have other commands for
    // them. Holds also for menus that are filled later.
    void Bind(int id, QWidget& view);
    // Enables, disables, marks and names the items as the component's menu says now.
    void Update();

 private:
    void AddCommand(QMenu& menu, const TMenuExItem& item, QString& taken);
    void BindAction(QAction& action, int id);

    CommandDispatcher& commands_;
    QHash<int, QAction*> actions_;  // by number
    QHash<int, QPointer<QWidget>> views_;
    Subscription changes_;
};
