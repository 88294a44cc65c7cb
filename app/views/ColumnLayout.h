#pragma once

#include <QByteArray>

class QHeaderView;

// How the user has laid out the columns of the song list: which are shown, in which order, how wide.

// For the settings.
QByteArray SaveColumnLayout(QHeaderView& header);
// Columns that the saved layout does not know come last and are as wide as they are. False when the bytes are
// no saved layout; the columns then stay as they are.
bool RestoreColumnLayout(QHeaderView& header, const QByteArray& saved);
