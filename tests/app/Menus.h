#pragma once

#include <QAction>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>

// The item with this caption in the menus of a window, or in the one that is named; null when there is none.
inline QAction* MenuItem(const QMainWindow& window, const QString& caption, const QString& menu = {}) {
    for (const QAction* top : window.menuBar()->actions()) {
        if (!menu.isEmpty() && top->text().remove(u'&') != menu) continue;
        for (QAction* action : top->menu()->actions())
            if (action->text().remove(u'&') == caption) return action;
    }
    return nullptr;
}
