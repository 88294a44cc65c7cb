#include "app/views/TypeAhead.h"

#include <QApplication>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/FoldedText.h"
#include "app/models/FilteredSongs.h"
#include "app/models/SongColumns.h"

namespace {

// The title is looked for without the mark of a CD, as it is sorted.
QString SearchedText(const SongColumn& column, const TID3Tag& song) {
    return column.Id == SongFieldId::Title ? song.Title : column.Text(song);
}

bool IsOneLetter(const QString& text) {
    return std::ranges::all_of(text, [&text](QChar c) { return c == text[0]; });
}

}  // namespace

int TypeAhead::Next(const FilteredSongs& songs, const SongColumn& column, int current,
                    const QString& letters) {
    const qint64 now = CurrentClock().Ticks();
    if (now - lastKey_ > QApplication::keyboardInputInterval()) typed_.clear();
    lastKey_ = now;
    typed_ += FoldText(letters);
    if (typed_.isEmpty()) return -1;

    const bool again = IsOneLetter(typed_);
    const QString wanted = again ? typed_.left(1) : typed_;
    const int count = songs.rowCount();
    const int start = current < 0 ? 0 : current + (again ? 1 : 0);
    for (int i = 0; i < count; ++i) {
        const int row = (start + i) % count;
        const TID3Tag* song = songs.SongAt(row);
        if (song != nullptr && FoldText(SearchedText(column, *song)).startsWith(wanted)) return row;
    }
    return -1;
}
