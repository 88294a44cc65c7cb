#pragma once

#include <QString>

class QWidget;

// Brings a window that is on the screen to the front, out of the task bar too. `activationToken`, which may
// be empty, is the desktop's permission that another program has handed over.
void RaiseWindow(QWidget& window, const QString& activationToken);
