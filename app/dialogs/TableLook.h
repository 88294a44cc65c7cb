#pragma once

#include <QStringList>

class QTableWidget;

// Gives a small table of a dialog its headings, a height of some rows and the keys of a dialog: Tab leaves
// the table, F2, typing and a double click edit a cell. The last column takes the space that is left.
void SetTableLook(QTableWidget& table, const QStringList& headings, int shownRows);
