#pragma once

class QDockWidget;
class QMenu;

// Adds an item that shows and hides the window. One that lies behind another, as a tab, comes to the front.
void AddDockAction(QMenu& menu, QDockWidget& dock);
