#pragma once

#include <QHash>
#include <QIcon>
#include <QPointer>
#include <QWidget>
#include <functional>

class QAction;
class QMenu;
class TMenuExItem;

// A caption with a mark at its first letter that is not in `taken`, by which the keyboard chooses it; the
// letter is taken then.
QString WithAccessKey(const QString& caption, QString& taken);
// Marks those items of a menu that have no such letter yet.
void AddAccessKeys(const QMenu& menu);

// The command menu of a component as the toolkit shows it.
class CommandMenu {
 public:
    using IconOf = QIcon (*)(int id);

    // `run` is given the number of the chosen command.
    CommandMenu(std::function<void(int id)> run, IconOf icons) : run_(std::move(run)), icons_(icons) {}

    // Adds the items below `parent` to a menu. The letters in `taken` choose other items of that menu.
    void Fill(QMenu& menu, const TMenuExItem& parent, QString taken = {});
    // Forgets what was filled in. The caller deletes the menus.
    void Clear() { actions_.clear(); }
    // The keys of a command work only while this widget has the focus: other views have other commands for
    // them. Holds also for menus that are filled later.
    void Bind(int id, QWidget& view);
    // Enables, disables and marks the items as the component's menu says now; while it rests all are
    // disabled.
    void Update(const TMenuExItem& root, bool resting = false);

 private:
    void AddCommand(QMenu& menu, const TMenuExItem& item);
    void BindAction(QAction& action, int id);

    std::function<void(int)> run_;
    IconOf icons_;
    QHash<int, QAction*> actions_;  // by number
    QHash<int, QPointer<QWidget>> views_;
};
