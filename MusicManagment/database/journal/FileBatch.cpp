#include "MusicManagment/database/journal/FileBatch.h"

#include <algorithm>
#include <utility>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/journal/BatchRun.h"

using namespace Qt::StringLiterals;

// --- Items ---

FileItem& FileItem::Patch(const QString& path, FilePatch patch, const FileState& expected) {
    steps_.push_back(
        {.Kind = StepKind::Patch, .Path = path, .Patch = std::move(patch), .Expected = expected});
    return *this;
}

FileItem& FileItem::Move(const QString& from, const QString& to) {
    steps_.push_back({.Kind = StepKind::Move, .Path = from, .To = to});
    return *this;
}

FileItem& FileItem::Trash(const QString& path, bool banned) {
    steps_.push_back({.Kind = StepKind::Trash, .Path = path, .IsBanned = banned});
    return *this;
}

FileItem& FileItem::Record(std::optional<TID3Tag> before, std::optional<TID3Tag> after) {
    steps_.push_back({.Kind = StepKind::Record, .Record = {std::move(before), std::move(after)}});
    return *this;
}

FileItem& FileItem::Ban(const QString& entry) {
    steps_.push_back({.Kind = StepKind::Ban, .Ban = {entry, true}});
    return *this;
}

FileItem& FileItem::Unban(const QString& entry) {
    steps_.push_back({.Kind = StepKind::Ban, .Ban = {entry, false}});
    return *this;
}

FileItem& FileItem::Then(std::function<void(const ItemResult&)> done) {
    done_ = std::move(done);
    return *this;
}

namespace {

PlannedStep PlanMoveBehind(const QString& from, const QString& to, const PlannedStep* patch) {
    PlannedStep planned = PlanMoveStep(from, to);
    JournalStep& move = planned.Step;
    if (patch == nullptr || patch->Step.Before.Inode != move.Before.Inode) return planned;
    // It will be the new version that moves.
    const bool wasReadOnly = move.Before.ReadOnly;
    move.Before = patch->Step.After;
    move.After = patch->Step.After;
    move.Before.ReadOnly = wasReadOnly;
    return planned;
}

const PlannedStep* PatchIn(const PlannedItem& item) {
    const auto patch = std::ranges::find_if(
        item.Steps, [](const PlannedStep& step) { return step.Step.Kind == StepKind::Patch; });
    return patch != item.Steps.end() ? &*patch : nullptr;
}

}  // namespace

PlannedItem FileItem::Plan() const {
    PlannedItem planned;
    const auto plan = [&planned](const Wanted& step) {
        switch (step.Kind) {
            case StepKind::Patch:
                return PlanPatchStep(step.Path, step.Patch, step.Expected);
            case StepKind::Move:
                return PlanMoveBehind(step.Path, step.To, PatchIn(planned));
            case StepKind::Trash:
                return PlanTrashStep(step.Path, step.IsBanned);
            case StepKind::Record:
                return PlanRecordStep(step.Record);
            default:
                return PlanBanStep(step.Ban);
        }
    };
    try {
        for (const Wanted& step : steps_)
            planned.Steps.push_back(plan(step));
    } catch (const EStreamError& error) {
        planned.Message = error.Message();
    }
    return planned;
}

// --- The batch ---

FileBatch::FileBatch(Journal* journal, TMusicDatabase* database, const QString& caption)
    : journal_(journal), database_(database) {
    if (database != nullptr && !database->TakesChanges())
        throw EMusicDatabaseException(u"Die Datenbank kann jetzt nicht geändert werden."_s);
    BatchHeader header;
    header.Caption = caption;
    header.Time = FromDayCount(CurrentClock().Now()).toMSecsSinceEpoch();
    if (database != nullptr) header.Database = AbsolutePath(database->FileName());
    run_ =
        std::make_unique<BatchRun>(journal != nullptr ? journal->OpenForBatch() : nullptr, std::move(header));
}

FileBatch::~FileBatch() {
    try {
        Finish();
    } catch (const ERukException&) {
        // The journal could not be written to its end; the next batch ends it.
    }
}

void FileBatch::Add(FileItem item) {
    const bool waits = std::ranges::any_of(item.steps_, [this](const FileItem::Wanted& step) {
        return run_->Touches(step.Path) || run_->Touches(step.To);
    });
    if (waits) Settle();
    PlannedItem planned = item.Plan();
    if (run_->Touches(planned)) {
        Settle();
        planned = item.Plan();
    }
    for (FileItem::Wanted& step : item.steps_)
        step.Patch = {};  // the plan has it
    const PlannedStep* patch = PatchIn(planned);
    const int otherNames = patch != nullptr ? patch->OtherNames : 0;
    planned.Done = [this, item = std::move(item), otherNames](std::size_t done, const QString& message) {
        Note(item, {.StepsDone = static_cast<int>(done), .Message = message, .OtherNames = otherNames});
    };
    run_->Add(std::move(planned));
}

void FileBatch::Note(const FileItem& item, const ItemResult& result) {
    for (int i = 0; i < result.StepsDone; ++i) {
        const FileItem::Wanted& step = item.steps_[static_cast<std::size_t>(i)];
        if (step.Kind == StepKind::Record) records_.push_back(step.Record);
        if (step.Kind == StepKind::Ban) bans_.push_back(step.Ban);
    }
    if (result.IsComplete())
        ++done_;
    else
        failures_ << result.Message;
    if (!item.done_) return;
    ApplyWhatIsDone();  // whoever is told finds the collection as it is now
    item.done_(result);
}

void FileBatch::Settle() {
    run_->Settle();
    ApplyWhatIsDone();
}

// What cannot be made in the collection now is kept for the next time.
void FileBatch::ApplyWhatIsDone() {
    if (database_ == nullptr) return;
    if (!records_.empty()) {
        const AppliedRecords applied = ApplyRecords(*database_, records_);
        if (!applied.IsDone) return;
        songs_ << applied.Songs;
        records_.clear();
    }
    if (ApplyBans(*database_, std::exchange(bans_, {}))) bannListChanged_ = true;
}

void FileBatch::Finish(const QString& caption) {
    if (!run_) return;
    const auto run = std::move(run_);
    run->Settle();
    ApplyWhatIsDone();
    // Before the batch counts as ended: until then the next start brings the list up to date.
    if (bannListChanged_) database_->Events().BannListChanged.Tell();
    run->Finish(caption, false);
    if (journal_ != nullptr && run->HasBegun()) journal_->Changed.Tell();
}
