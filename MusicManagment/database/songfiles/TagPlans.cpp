#include "MusicManagment/database/songfiles/TagPlans.h"

#include "CommonRUKTools/BufferedSource.h"
#include "MusicManagment/database/SongFields.h"

namespace {

constexpr int kThreads = 4;
// About a group of files that are carried out together.
constexpr std::size_t kWindow = 1024;
constexpr std::int64_t kMostHeld = std::int64_t{32} << 20;

bool ConcernsFile(const SongUpdate& update, const QString& path) {
    return update.Tags != TagAction::Leave && !IsCdPath(path);
}

}  // namespace

TagPlans::TagPlans(TMusicDatabase& database, const std::vector<SongUpdate>& updates)
    : database_(database),
      updates_(updates),
      profile_(database.ModernTags() ? ReadProfile::Modern : ReadProfile::Classic),
      work_(
          updates.size(), kThreads, [this](std::size_t number, auto) { return WorkOf(number); }, kWindow) {}

TID3Tag RecordAfter(const SongUpdate& update, const TID3Tag& song) {
    TID3Tag record = MergedChange(song, update.Basis, update.Record, MergeConflict::TakesMerged);
    record.FileName = song.FileName;
    return record;
}

std::function<TagPlans::Planned()> TagPlans::WorkOf(std::size_t number) {
    const SongUpdate& update = updates_[number];
    const TID3Tag* song = database_.Songs().Find(update.Song);
    if (song == nullptr || !ConcernsFile(update, song->FileName)) return {};
    return [this, &update, record = RecordAfter(update, *song)] { return Ahead(update, record); };
}

TagPlans::Planned TagPlans::Ahead(const SongUpdate& update, TID3Tag record) {
    Planned planned{.Record = std::move(record)};
    if (held_ >= kMostHeld) return planned;
    planned.Made = Plan(update, planned.Record);
    planned.Held = planned.Made->Patch.InsertedBytes();
    held_ += planned.Held;
    return planned;
}

TagChange TagPlans::Plan(const SongUpdate& update, const TID3Tag& record) const {
    const QString& path = record.FileName;
    TagChange change{.Before = StateOf(path)};
    FileSource file(path);
    BufferedSource source(file);
    change.Patch = update.Tags == TagAction::Remove
                       ? PlanTagRemoval(source, path)
                       : PlanTag(source, path,
                                 {.Record = record, .TrackTotal = update.TrackTotal, .Cover = update.Cover},
                                 {.Profile = profile_});
    return change;
}

void TagPlans::Next() {
    work_.Next();
    ++taken_;
}

// What was computed ahead, unless song or file have changed since.
std::optional<TagChange> TagPlans::Ready(const TID3Tag& record) {
    try {
        auto planned = work_.Take([this] {
            database_.Progress(database_.LastProgress(), false, false);
            return true;
        });
        if (!planned) return std::nullopt;
        held_ -= planned->Held;
        if (!planned->Made || planned->Record != record ||
            !StateOf(record.FileName).IsStill(planned->Made->Before))
            return std::nullopt;
        return std::move(planned->Made);
    } catch (const EStreamError&) {
        return std::nullopt;  // it is tried again, and told then
    }
}

std::optional<TagChange> TagPlans::Take(const TID3Tag& record) {
    const SongUpdate& update = updates_[taken_ - 1];
    if (!ConcernsFile(update, record.FileName)) return std::nullopt;
    auto change = Ready(record);
    if (!change) change = Plan(update, record);
    if (change->Patch.ChangesNothing(change->Before.Size)) return std::nullopt;
    return change;
}
