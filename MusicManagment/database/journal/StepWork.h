#pragma once

#include "MusicManagment/database/journal/JournalStep.h"

// Carries out single steps, and takes them back. Steps of records and of the ban list do nothing on the disk.

// A step with what only carrying it out needs.
struct PlannedStep {
    JournalStep Step{};
    FilePatch Patch{};   // of StepKind::Patch
    int OtherNames = 0;  // hard links beside this name, of a patch
    QString Refused{};   // what is told when the bin does not take the file

    qint64 Bytes() const { return Patch.InsertedBytes() + Step.Inverse.InsertedBytes(); }
};

// --- Plans: nothing happens yet; each throws EStreamError when the step is not possible ---
PlannedStep PlanPatchStep(const QString& path, FilePatch patch, const FileState& expected,
                          qint64 modifiedNs = 0);
PlannedStep PlanMoveStep(const QString& from, const QString& to);
PlannedStep PlanTrashStep(const QString& path, bool banned);
PlannedStep PlanRecordStep(RecordChange change);
PlannedStep PlanBanStep(BanChange change);
// What takes back a step that is done. `path` is where the file is now, of a patch. Throws EFileChanged when
// the file is not any more what the step has left.
PlannedStep PlanBackStep(const JournalStep& done, const QString& path);

// --- Carrying out ---
// Does what can be done before the first flush: new versions of files.
void PrepareStep(const PlannedStep& step);
// Does the rest, and returns what the file is now.
FileState FinishStep(const PlannedStep& step);
// Brings back what was before the step, from whatever state it is in. Throws EFileChanged when the file is
// somebody else's now, EStreamError when it cannot be done now.
void TakeBackStep(const JournalStep& step);

// What is to be on the disk before FinishStep, and after it; empty when nothing is.
QString BuiltBeforeFinish(const JournalStep& step);
QStringList ChangedByStep(const JournalStep& step);
