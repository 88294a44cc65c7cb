#pragma once

#include <QByteArray>
#include <QString>

// How the windows stand, as a desktop file (".df") keeps it.
struct Arrangement {
    QByteArray Placement;  // size and position of the main window
    QByteArray Docks;      // where the tool windows are and which are shown
    QByteArray Columns;    // of the song list
};

// Throws EStreamError when the file cannot be read or is none of ours.
Arrangement ReadArrangement(const QString& path);
// Throws EStreamError.
void WriteArrangement(const QString& path, const Arrangement& arrangement);
