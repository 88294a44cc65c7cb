#include "app/views/DockAction.h"

#include <QAction>
#include <QDockWidget>
#include <QMenu>

namespace {

bool IsInFront(const QDockWidget& dock) {
    return !dock.isHidden() && !dock.visibleRegion().isEmpty();
}

void Toggle(QDockWidget& dock) {
    if (IsInFront(dock)) {
        dock.close();  // which it may refuse
        return;
    }
    dock.show();
    dock.raise();
}

}  // namespace

// Not the window's own action, which would hide a window that nobody sees.
void AddDockAction(QMenu& menu, QDockWidget& dock) {
    QAction* action = menu.addAction(dock.toggleViewAction()->text());
    action->setCheckable(true);
    action->setChecked(!dock.isHidden());
    QObject::connect(dock.toggleViewAction(), &QAction::toggled, action, &QAction::setChecked);
    QObject::connect(action, &QAction::triggered, &dock, [action, &dock] {
        Toggle(dock);
        action->setChecked(!dock.isHidden());
    });
}
