#include "app/SongChoice.h"

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

BatchSongs MarkedIn(const TMusicDatabase& database, const SongListWidget& list) {
    ViewSelection selection{.Marked = list.ChosenHandles()};
    if (const SongIndex focused = list.FocusedSong(); focused >= 0)
        selection.Selected = database.Songs().HandleOf(focused);
    return selection.Marked.empty() ? BatchSongs() : MarkedSongs(selection);
}

BatchSongs ChosenSongs(const TMusicDatabase& database, const SongListWidget& list) {
    BatchSongs songs = MarkedIn(database, list);
    TellOfPassedMarks(songs);
    return songs;
}

std::optional<BatchSongs> AskForSongs(const TMusicDatabase& database, const SongListWidget& list,
                                      const QString& all, const QString& marked, SongPreset preset) {
    enum Answer { Marked, All, Cancel };
    const auto count = list.ChosenHandles().size();
    if (count == 0) return AllSongs(database);
    const int answer = UserDialogs().Ask({.Text = u"Für welche Songs? Markiert: "_s + SongCountText(count) +
                                                  u", in der Sammlung: "_s +
                                                  SongCountText(static_cast<std::size_t>(database.Count())),
                                          .Buttons = {marked, all, u"Abbrechen"_s},
                                          .Cancel = Cancel,
                                          .Default = preset == SongPreset::Marked ? Marked : Cancel});
    if (answer == Cancel) return std::nullopt;
    return answer == Marked ? ChosenSongs(database, list) : AllSongs(database);
}
