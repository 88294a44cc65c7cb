#include "MusicManagment/database/batches/BatchFrame.h"

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/Progress.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kProgressEvery = 50;  // milliseconds

// What is to happen, song by song. Ends early when the user stops; what was found until then still happens.
std::vector<SongUpdate> Collect(TMusicDatabase& database, const BatchSongs& songs, const QString& caption,
                                const SongUpdateMaker& maker, bool& stopped) {
    const ProgressRun run(database, caption);
    std::vector<SongUpdate> updates;
    qint64 nextPoint = 0;
    for (std::size_t i = 0; i < songs.Songs.size() && !stopped; ++i) {
        const TID3Tag* song = database.Songs().Find(songs.Songs[i]);
        if (song == nullptr) continue;
        // A copy: a question lets time pass, and the record may go.
        const TID3Tag before = *song;
        if (auto update = maker(before)) {
            update->Song = songs.Songs[i];
            update->Basis = before;
            updates.push_back(std::move(*update));
        }
        const qint64 now = CurrentClock().Ticks();
        if (now < nextPoint) continue;
        nextPoint = now + kProgressEvery;
        stopped = database.Progress(
            {.Cur = static_cast<qint64>(i + 1), .Max = static_cast<qint64>(songs.Songs.size())});
    }
    return updates;
}

}  // namespace

BatchResult RunUpdates(TMusicDatabase& database, const BatchSongs& songs, const BatchTexts& texts,
                       const QString& done, Renaming renaming, const SongUpdateMaker& maker) {
    if (database.Count() == 0 || songs.IsEmpty()) return {};
    const QString heading = texts.Of(songs.Range);
    bool stopped = false;
    auto updates = Collect(database, songs, heading, maker, stopped);
    const QString caption = done + u" ("_s + SongCountText(updates.size()) + u')';
    BatchResult result;
    if (!updates.empty()) result = UpdateSongs(database, caption, updates, renaming, heading);
    result.Stopped = result.Stopped || stopped;
    return result;
}

BatchResult RunBatch(TMusicDatabase& database, const BatchSongs& songs, const BatchTexts& texts,
                     const QString& done, const SongChange& change) {
    return RunUpdates(database, songs, texts, done, Renaming::BySettings,
                      [&](const TID3Tag& song) -> std::optional<SongUpdate> {
                          auto record = change(song);
                          if (!record) return std::nullopt;
                          SongUpdate update;
                          update.Record = std::move(*record);
                          return update;
                      });
}
