#pragma once

#include <QString>
#include <QStringList>

// Turns "Musik|*.mp3;*.wav|Alle Dateien|*.*" into the name filters of a file dialog: "Musik (*.mp3 *.wav)",
// "Alle Dateien (*)". A caption without patterns is dropped.
QStringList NameFilters(const QString& filter);
