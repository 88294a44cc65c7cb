#include "MusicManagment/database/journal/JournalLists.h"

#include <QSet>
#include <algorithm>
#include <map>

#include "MusicManagment/database/journal/StepWork.h"

namespace {

RestOfBatch DoneSteps(const StoredBatch& batch) {
    RestOfBatch rest{.Batch = &batch};
    for (std::size_t i = 0; i < batch.Steps.size(); ++i)
        if (batch.Steps[i].Outcome == StepOutcome::Done) rest.Steps.push_back(static_cast<quint32>(i));
    return rest;
}

// What `later` has taken back does not stand any more.
void Subtract(RestOfBatch& rest, const StoredBatch& later) {
    if (later.DropsRest) rest.Steps.clear();
    QSet<qint64> taken;
    for (const StoredBatch::Step& step : later.Steps)
        if (step.Outcome == StepOutcome::Done) taken.insert(step.Head.Takes);
    std::erase_if(rest.Steps, [&taken](quint32 step) { return taken.contains(step); });
}

bool IsUnfinished(const StoredBatch& batch) {
    return !batch.IsFinished || std::ranges::any_of(batch.Steps, [](const StoredBatch::Step& step) {
        return step.Outcome == StepOutcome::Open;
    });
}

}  // namespace

JournalLists ListsOf(const JournalContents& contents) {
    std::map<quint64, RestOfBatch> rests;  // by id, which grows
    quint64 lastChange = 0;
    for (const StoredBatch& batch : contents.Batches) {
        if (const auto of = rests.find(batch.Header.Of); of != rests.end()) Subtract(of->second, batch);
        RestOfBatch rest = DoneSteps(batch);
        if (batch.Header.Kind == BatchKind::Change && !rest.Steps.empty()) lastChange = batch.Header.Id;
        rests.insert_or_assign(batch.Header.Id, std::move(rest));
    }
    JournalLists lists;
    for (auto& [id, rest] : rests) {
        if (rest.Steps.empty()) continue;
        if (rest.Batch->Header.Kind != BatchKind::Undo)
            lists.ToUndo.push_back(std::move(rest));
        else if (id > lastChange)
            lists.ToRedo.push_back(std::move(rest));
    }
    return lists;
}

bool HasUnfinished(const JournalContents& contents) {
    return std::ranges::any_of(contents.Batches, IsUnfinished);
}

// --- Half-done steps ---

namespace {

class Recovery {
 public:
    explicit Recovery(JournalFile& file) : file_(file) {}

    RecoveryResult Run() {
        for (StoredBatch& batch : file_.EditContents().Batches)
            if (IsUnfinished(batch)) Take(batch);
        if (hasWritten_) {
            file_.Write();
            file_.Flush();
        }
        return std::move(result_);
    }

 private:
    void Take(StoredBatch& batch) {
        if (!batch.IsFinished) {
            result_.Caption = batch.Header.Caption;
            result_.Database = batch.Header.Database;
        }
        outcomes_.clear();
        for (std::size_t i = batch.Steps.size(); i-- > 0;) {
            const StepOutcome outcome = batch.Steps[i].Outcome;
            if (outcome == StepOutcome::None || outcome == StepOutcome::Open) TakeBack(batch.Steps[i], i);
        }
        if (!outcomes_.empty()) file_.AddOutcome(batch.Header.Id, outcomes_);
        if (!batch.IsFinished) file_.AddFinish(batch.Header.Id, false, {});
        hasWritten_ = hasWritten_ || !outcomes_.empty() || !batch.IsFinished;
    }

    void TakeBack(StoredBatch::Step& step, std::size_t number) {
        StepOutcome outcome = StepOutcome::TakenBack;
        // What was not whole in the journal was never begun.
        if (const auto loaded = file_.Load(step)) outcome = TakeBack(*loaded);
        if (outcome == step.Outcome) return;
        step.Outcome = outcome;
        outcomes_.push_back(
            {.Step = static_cast<quint32>(number), .Outcome = outcome, .After = step.Head.After});
    }

    StepOutcome TakeBack(const JournalStep& step) {
        // Records change only when the outcome is written.
        if (!step.IsOfFile()) return StepOutcome::TakenBack;
        try {
            const FileState before = StateOf(step.Path);
            TakeBackStep(step);
            if (!before.IsStill(StateOf(step.Path)) && !result_.TakenBack.contains(step.Path))
                result_.TakenBack << step.Path;
            return StepOutcome::TakenBack;
        } catch (const EFileChanged& error) {
            result_.Problems << error.Message();
            return StepOutcome::Failed;
        } catch (const EStreamError& error) {
            result_.Problems << error.Message();
            return StepOutcome::Open;
        }
    }

    JournalFile& file_;
    RecoveryResult result_;
    std::vector<OutcomeOf> outcomes_;
    bool hasWritten_ = false;
};

}  // namespace

RecoveryResult Recover(JournalFile& file) {
    return Recovery(file).Run();
}

void DropOldest(JournalFile& file, const JournalLimits& limits) {
    const JournalContents& contents = file.Contents();
    const std::size_t count = contents.Batches.size();
    std::size_t first = 0;
    while (first < count && !IsUnfinished(contents.Batches[first])) {
        const qint64 bytes = contents.End - contents.Batches[first].From;
        if (count - first <= limits.Batches && bytes <= limits.Bytes) break;
        ++first;
    }
    file.DropBefore(first);
}
