#pragma once

#include <QString>

class FilteredSongs;

// What the user is told of a filter that does not do what was meant.

// Fields that there are none of; empty when all is well.
QString FilterWarning(const QString& filter);
// Why the list of songs is empty.
QString NothingShownText(const FilteredSongs& songs);
