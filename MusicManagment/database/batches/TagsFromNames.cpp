#include "MusicManagment/database/batches/TagsFromNames.h"

#include "MusicManagment/database/batches/BatchFrame.h"

using namespace Qt::StringLiterals;

namespace {

constexpr BatchTexts kTexts = {.All = u"Tags aller Songs aus den Dateinamen",
                               .Marked = u"Tags aller markierter Songs aus den Dateinamen",
                               .One = u"Tag aus dem Dateinamen"};

}  // namespace

std::vector<PlannedTags> PlanTagsFromNames(const TMusicDatabase& database,
                                           const std::vector<SongHandle>& songs, const NameMatcher& matcher) {
    std::vector<PlannedTags> plans;
    plans.reserve(songs.size());
    for (const SongHandle song : songs) {
        const TID3Tag* record = database.Songs().Find(song);
        if (record == nullptr) continue;
        PlannedTags plan{.Song = song, .Reading = matcher.Read(record->FileName)};
        plan.Changes = WithNamedFields(*record, plan.Reading) != *record;
        plans.push_back(std::move(plan));
    }
    return plans;
}

BatchResult TakeTagsFromNames(TMusicDatabase& database, const BatchSongs& songs, const NameMatcher& matcher) {
    const auto maker = [&](const TID3Tag& song) -> std::optional<SongUpdate> {
        SongUpdate update;
        update.Record = WithNamedFields(song, matcher.Read(song.FileName));
        if (update.Record == song) return std::nullopt;
        return update;
    };
    return RunUpdates(database, songs, kTexts, u"Tags aus Dateinamen"_s, Renaming::Never, maker);
}
