#include "MusicManagment/database/journal/BatchRun.h"

#include <utility>

namespace {

// A group's old and new bytes are in memory, and so long does a crash lose what was done.
constexpr qint64 kBytesOfGroup = qint64{32} << 20;
constexpr std::size_t kFilesOfGroup = 1024;
constexpr std::size_t kStepsOfGroup = 20'000;

}  // namespace

namespace {

// Whether a file was read-only is known from the plan alone.
void UseState(FileState& before, const FileState& left) {
    const bool wasReadOnly = before.ReadOnly;
    before = left;
    before.ReadOnly = wasReadOnly;
}

}  // namespace

// An item while it is carried out.
struct BatchRun::Work {
    PlannedItem* Item;
    std::vector<OutcomeOf> Outcomes{};  // one a step
    std::size_t Done = 0;
    QString Message{};

    bool Failed() const { return !Message.isEmpty(); }
    PlannedStep& Step(std::size_t i) const { return Item->Steps[i]; }

    void Fail(std::size_t step, StepOutcome outcome, const QString& message) {
        Outcomes[step].Outcome = outcome;
        Message = message;
    }
    // Brings back what a failed step may have done.
    void FailAndTakeBack(std::size_t step, const QString& message) {
        StepOutcome outcome = StepOutcome::Failed;
        try {
            TakeBackStep(Step(step).Step);
        } catch (const EFileChanged&) {
            // It is somebody else's file now.
        } catch (const EStreamError&) {
            outcome = StepOutcome::Open;
        }
        Fail(step, outcome, message);
    }

    void Prepare() {
        for (std::size_t i = 0; i < Item->Steps.size(); ++i) {
            try {
                PrepareStep(Step(i));
            } catch (const EHalfDone& error) {
                return Fail(i, StepOutcome::Open, error.Message());
            } catch (const EStreamError& error) {
                return FailAndTakeBack(i, error.Message());
            }
        }
    }

    // Steps before one that failed in its preparation are carried out.
    void Finish() {
        FileState left;
        for (; Done < Item->Steps.size() && Outcomes[Done].Outcome == StepOutcome::None; ++Done) {
            JournalStep& step = Step(Done).Step;
            if (step.Kind == StepKind::Move && left.Exists() && StateOf(step.Path).IsStill(left))
                UseState(step.Before, left);
            try {
                Outcomes[Done].After = FinishStep(Step(Done));
                Outcomes[Done].Outcome = StepOutcome::Done;
                if (step.Kind == StepKind::Patch) left = Outcomes[Done].After;
            } catch (const EStreamError& error) {
                FailAndTakeBack(Done, error.Message());
                break;
            }
        }
        for (std::size_t i = Done; i < Outcomes.size(); ++i)
            if (Outcomes[i].Outcome == StepOutcome::None) FailAndTakeBack(i, Message);  // was prepared
    }

    void TakeBackAll(const QString& message) {
        for (std::size_t i = Item->Steps.size(); i-- > 0;) {
            if (Outcomes[i].Outcome == StepOutcome::Failed || Outcomes[i].Outcome == StepOutcome::Open)
                continue;
            FailAndTakeBack(i, message);
            if (Outcomes[i].Outcome == StepOutcome::Failed) Outcomes[i].Outcome = StepOutcome::TakenBack;
        }
        Done = 0;
        Message = message;
    }
};

BatchRun::BatchRun(std::unique_ptr<JournalFile> journal, BatchHeader header)
    : journal_(std::move(journal)), header_(std::move(header)) {
    if (journal_) header_.Id = journal_->NextId();
}

bool BatchRun::Touches(const PlannedItem& item) const {
    for (const PlannedStep& step : item.Steps)
        for (const QString& path : ChangedByStep(step.Step))
            if (touched_.contains(path)) return true;
    return false;
}

void BatchRun::Add(PlannedItem item) {
    if (item.Steps.empty()) {
        if (item.Done) item.Done(0, item.Message);
        return;
    }
    bool hasFile = false;
    for (PlannedStep& step : item.Steps) {
        step.Step.Item = items_;
        waitingBytes_ += step.Bytes();
        hasFile = hasFile || step.Step.IsOfFile();
        for (const QString& path : ChangedByStep(step.Step))
            touched_.insert(path);
    }
    ++items_;
    if (hasFile) ++waitingFiles_;
    waitingSteps_ += item.Steps.size();
    waiting_.push_back(std::move(item));
    if (waitingBytes_ >= kBytesOfGroup || waitingFiles_ >= kFilesOfGroup || waitingSteps_ >= kStepsOfGroup)
        Settle();
}

void BatchRun::Settle() {
    std::vector<PlannedItem> group = std::exchange(waiting_, {});
    touched_.clear();
    waitingBytes_ = 0;
    waitingFiles_ = 0;
    waitingSteps_ = 0;
    if (!group.empty()) CarryOut(group);
}

// --- One group ---

namespace {

void FlushAll(QStringList paths) {
    paths.removeDuplicates();
    if (!paths.isEmpty()) FlushFiles(paths);
}

}  // namespace

void BatchRun::Announce(const std::vector<PlannedItem>& group) {
    if (!broken_.isEmpty()) throw EStreamError(broken_);
    if (!journal_) return;
    if (!hasBegun_) journal_->AddBegin(header_);
    std::size_t count = 0;
    for (const PlannedItem& item : group)
        for (const PlannedStep& step : item.Steps) {
            journal_->AddStep(step.Step);
            ++count;
        }
    try {
        journal_->Write(count);
        journal_->Flush();
    } catch (const EStreamError& error) {
        // What of it is in the file is not known; nothing may come behind it.
        broken_ = error.Message();
        throw;
    }
    hasBegun_ = true;
}

void BatchRun::WriteOutcomes(const std::vector<Work>& works) {
    if (!journal_) return;
    std::vector<OutcomeOf> outcomes;
    for (const Work& work : works)
        outcomes.insert(outcomes.end(), work.Outcomes.begin(), work.Outcomes.end());
    try {
        journal_->AddOutcome(header_.Id, outcomes);
        journal_->Write();
    } catch (const EStreamError& error) {
        broken_ = error.Message();
        throw;
    }
}

void BatchRun::CarryOut(std::vector<PlannedItem>& group) {
    std::vector<Work> works;
    try {
        Announce(group);
        for (PlannedItem& item : group) {
            Work& work = works.emplace_back(Work{.Item = &item});
            for (std::size_t i = 0; i < item.Steps.size(); ++i)
                work.Outcomes.push_back({.Step = steps_++});
        }

        QStringList built;
        for (Work& work : works) {
            work.Prepare();
            for (std::size_t i = 0; i < work.Outcomes.size(); ++i)
                if (const QString name = BuiltBeforeFinish(work.Step(i).Step);
                    !name.isEmpty() && work.Outcomes[i].Outcome == StepOutcome::None)
                    built << name;
        }
        FlushAll(built);

        QStringList changed;
        for (Work& work : works) {
            work.Finish();
            for (std::size_t i = 0; i < work.Done; ++i)
                changed << ChangedByStep(work.Step(i).Step);
        }
        FlushAll(changed);
        WriteOutcomes(works);
    } catch (const EStreamError& error) {
        for (auto work = works.rbegin(); work != works.rend(); ++work)
            work->TakeBackAll(error.Message());
        if (works.empty()) {
            for (PlannedItem& item : group)
                if (item.Done) item.Done(0, error.Message());
            return;
        }
        try {
            WriteOutcomes(works);
        } catch (const EStreamError&) {
            // The batch ends here; the next one takes these steps back again, which does no harm.
        }
    }
    for (Work& work : works)
        if (work.Item->Done) work.Item->Done(work.Done, work.Failed() ? work.Message : work.Item->Message);
}

void BatchRun::Finish(const QString& caption, bool dropsRest) {
    Settle();
    if (!journal_ || !hasBegun_ || !broken_.isEmpty()) return;
    journal_->AddFinish(header_.Id, dropsRest, caption);
    journal_->Write();
    journal_->Flush();
}
