#pragma once

#include <QString>

class QWidget;

// Position and size of a window between two starts, under a name in a settings file.
void StorePlacement(const QWidget& window, const QString& settingsFile, const QString& name);
// False when none was stored.
bool RestorePlacement(QWidget& window, const QString& settingsFile, const QString& name);
