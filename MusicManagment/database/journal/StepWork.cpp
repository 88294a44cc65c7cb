#include "MusicManagment/database/journal/StepWork.h"

#include "CommonRUKTools/FileWork.h"
#include "MusicManagment/database/RecycleBin.h"

using namespace Qt::StringLiterals;

namespace {

void RefuseUnlessLeft(const QString& path, const FileState& left) {
    const FileState now = StateOf(path);
    if (!now.Exists()) throw EFileChanged(u"Die Datei "_s + path + u" gibt es nicht mehr."_s);
    if (!now.HasBytesOf(left))
        throw EFileChanged(u"Die Datei "_s + path + u" wurde inzwischen geändert und bleibt, wie sie ist."_s);
}

PlannedStep FromMove(const MovePlan& plan) {
    PlannedStep planned;
    planned.Step = {.Kind = StepKind::Move,
                    .Path = plan.From,
                    .To = plan.To,
                    .Temporary = plan.Temporary,
                    .Folders = plan.Folders,
                    .Before = plan.Before,
                    .After = plan.Before};
    planned.Step.After.ReadOnly = false;
    return planned;
}

PlannedStep PlanMoveBack(const JournalStep& done) {
    PlannedStep back = FromMove(PlanMove(done.To, done.Path));
    back.Step.Emptied = done.Folders;
    back.Step.After.ReadOnly = done.Before.ReadOnly;
    return back;
}

PlannedStep PlanUntrash(const JournalStep& done) {
    const FileState thrown = StateOf(done.To);
    if (!thrown.Exists())
        throw EFileChanged(u"Die Datei "_s + done.Path + u" liegt nicht mehr im Papierkorb."_s);
    if (FileSource::Exists(done.Path))
        throw EFileChanged(u"Statt der Datei "_s + done.Path + u" gibt es dort inzwischen eine andere."_s);
    PlannedStep back;
    back.Step = {
        .Kind = StepKind::Untrash, .Path = done.Path, .To = done.To, .Before = thrown, .After = thrown};
    back.Refused = u"Kann die Datei "_s + done.Path + u" nicht aus dem Papierkorb zurückholen."_s;
    return back;
}

FileState FinishMove(const JournalStep& step) {
    FileState after = CarryOutMove(step.AsMove());
    if (step.After.ReadOnly && FileCalls::SetReadOnly(step.To, true)) after.ReadOnly = true;
    return after;
}

// Exactly one of the two names leads to the file.
void TakeBackTrash(const JournalStep& step) {
    if (StateOf(step.Path).Exists()) {
        if (!StateOf(step.To).Exists()) static_cast<void>(BringBack(step.To, step.Path));
        return;
    }
    if (!StateOf(step.To).Exists())
        throw EFileChanged(u"Die Datei "_s + step.Path + u" gibt es nicht mehr."_s);
    if (!BringBack(step.To, step.Path))
        throw EStreamError(u"Kann die Datei "_s + step.Path + u" nicht aus dem Papierkorb zurückholen."_s);
}

void TakeBackUntrash(const JournalStep& step) {
    if (StateOf(step.To).Exists()) return;
    if (!IsAbout(StateOf(step.Path), step.Before))
        throw EFileChanged(u"Die Datei "_s + step.Path + u" wurde inzwischen geändert."_s);
    if (!MoveToRecyclePlace(step.Path, step.To))
        throw EStreamError(u"Kann die Datei "_s + step.Path + u" nicht in den Papierkob verschieben."_s);
}

}  // namespace

// --- Plans ---

PlannedStep PlanPatchStep(const QString& path, FilePatch patch, const FileState& expected,
                          qint64 modifiedNs) {
    PatchPlan plan = PlanPatch(path, std::move(patch), expected, modifiedNs);
    PlannedStep planned;
    planned.Step = {.Kind = StepKind::Patch,
                    .Path = plan.Path,
                    .Temporary = plan.Temporary,
                    .Before = plan.Before,
                    .After = plan.After,
                    .Inverse = std::move(plan.Inverse)};
    planned.Patch = std::move(plan.Patch);
    planned.OtherNames = plan.OtherNames;
    return planned;
}

PlannedStep PlanMoveStep(const QString& from, const QString& to) {
    return FromMove(PlanMove(from, to));
}

PlannedStep PlanTrashStep(const QString& path, bool banned) {
    PlannedStep planned;
    planned.Refused = RecycleFailure(path, banned);
    const FileState before = StateOf(path);
    const QString place = before.Exists() ? RecyclePlaceFor(path) : QString();
    if (place.isEmpty()) throw EStreamError(planned.Refused);
    planned.Step = {.Kind = StepKind::Trash, .Path = path, .To = place, .Before = before, .After = before};
    return planned;
}

PlannedStep PlanRecordStep(RecordChange change) {
    PlannedStep planned;
    planned.Step = {.Kind = StepKind::Record, .Record = std::move(change)};
    return planned;
}

PlannedStep PlanBanStep(BanChange change) {
    PlannedStep planned;
    planned.Step = {.Kind = StepKind::Ban, .Ban = std::move(change)};
    return planned;
}

PlannedStep PlanBackStep(const JournalStep& done, const QString& path) {
    switch (done.Kind) {
        case StepKind::Patch:
            RefuseUnlessLeft(path, done.After);
            return PlanPatchStep(path, done.Inverse, StateOf(path), done.Before.ModifiedNs);
        case StepKind::Move:
            RefuseUnlessLeft(done.To, done.After);
            return PlanMoveBack(done);
        case StepKind::Trash:
            return PlanUntrash(done);
        case StepKind::Untrash:
            RefuseUnlessLeft(done.Path, done.After);
            return PlanTrashStep(done.Path, false);
        case StepKind::Record:
            return PlanRecordStep(done.Record.Opposite());
        case StepKind::Ban:
            break;
    }
    return PlanBanStep(done.Ban.Opposite());
}

// --- Carrying out ---

namespace {

PatchPlan PlanOf(const PlannedStep& step) {
    PatchPlan plan = step.Step.AsPatch();
    plan.Patch = step.Patch;
    return plan;
}

}  // namespace

void PrepareStep(const PlannedStep& step) {
    if (step.Step.Kind == StepKind::Patch) WritePatch(PlanOf(step));
}

FileState FinishStep(const PlannedStep& planned) {
    const JournalStep& step = planned.Step;
    switch (step.Kind) {
        case StepKind::Patch:
            return FinishPatch(step.AsPatch());
        case StepKind::Move:
            return FinishMove(step);
        case StepKind::Trash:
            if (!MoveToRecyclePlace(step.Path, step.To)) throw EStreamError(planned.Refused);
            return step.After;
        case StepKind::Untrash:
            if (!BringBack(step.To, step.Path)) throw EStreamError(planned.Refused);
            return StateOf(step.Path);
        case StepKind::Record:
        case StepKind::Ban:
            break;
    }
    return {};
}

void TakeBackStep(const JournalStep& step) {
    switch (step.Kind) {
        case StepKind::Patch:
            return TakeBackPatch(step.AsPatch());
        case StepKind::Move:
            return TakeBackMove(step.AsMove());
        case StepKind::Trash:
            return TakeBackTrash(step);
        case StepKind::Untrash:
            return TakeBackUntrash(step);
        case StepKind::Record:
        case StepKind::Ban:
            break;
    }
}

QString BuiltBeforeFinish(const JournalStep& step) {
    return step.Kind == StepKind::Patch ? step.Temporary : QString();
}

QStringList ChangedByStep(const JournalStep& step) {
    if (!step.IsOfFile()) return {};
    if (step.Kind == StepKind::Patch) return {step.Path};
    return {step.Path, step.To};
}
