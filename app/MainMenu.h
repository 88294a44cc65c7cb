#pragma once

#include <QList>
#include <functional>

class CollectionCommands;
class QAction;
class QMenuBar;

// The main window's menu.
class MainMenu {
 public:
    // Commands are run through RunCommand; `exit` is the last item.
    MainMenu(QMenuBar& bar, CollectionCommands& commands, std::function<void()> exit);

    // Everything but the last item, which asks while an operation runs.
    void SetCommandsEnabled(bool enabled);

 private:
    QList<QAction*> commands_;
};
