#pragma once

class QMenuBar;
class QWidget;

// The menu "Hilfe". Its windows belong to `window`.
void AddHelpMenu(QMenuBar& bar, QWidget& window);
