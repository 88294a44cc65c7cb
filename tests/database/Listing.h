#pragma once

#include "MusicManagment/database/MusicManagment.h"

// What a collection holds, in its order.
inline QStringList TitlesOf(const TMusicDatabase& database) {
    QStringList titles;
    for (const auto& song : database.Songs())
        titles << song->Title;
    return titles;
}

inline QStringList TextsOf(const SortedTextList& list) {
    QStringList texts;
    for (const auto& row : list)
        texts << row.Text;
    return texts;
}
