#include <QFileInfo>
#include <algorithm>
#include <cerrno>

#include "CommonRUKTools/FileChange.h"
#include "CommonRUKTools/FileWork.h"

using namespace Qt::StringLiterals;

namespace {

QString Failure(const MovePlan& plan) {
    return u"Kann die Datei "_s + plan.From + u" nicht nach "_s + plan.To + u" verschieben."_s;
}

[[noreturn]] void ThrowNotMoved(const MovePlan& plan, int error) {
    // The reason stands behind the message, which is the same whatever it is.
    ThrowSystemError(Failure(plan) + u"\n"_s, plan.To, error);
}

QStringList MissingFolders(const QString& path) {
    QStringList missing;
    QString folder = FolderOfFile(path);
    while (!QFileInfo::exists(folder) && FolderOfFile(folder) != folder) {
        missing.prepend(folder);
        folder = FolderOfFile(folder);
    }
    return missing;
}

void MakeFolders(const QStringList& folders) {
    const QString failure = u"Kann den Ordner nicht anlegen: "_s;
    for (const QString& folder : folders) {
        PassGate(DiskStep::Folder, folder, failure);
        if (!FileCalls::MakeFolder(folder) && errno != EEXIST) ThrowSystemError(failure, folder, errno);
    }
}

// Where the copy of a file that is brought back over file systems is made.
QString BackName(const MovePlan& plan) {
    return FolderOfFile(plan.From) + u'/' + QFileInfo(plan.Temporary).fileName();
}

void CopyComplete(const WorkFile& from, const QString& temporary) {
    const FileState state = from.Look().State;
    WorkFile copy = WorkFile::New(temporary);
    copy.Copy(from, 0, 0, state.Size);
    copy.TakeAttributes(from, FileCalls::Attributes::WhatFits);
    copy.SetModified(state.ModifiedNs);
    copy.Flush();
    copy.ForgetCached();
}

// The file is here until it is complete and durable there.
void MoveAcross(const QString& from, const QString& to, const QString& temporary, const MovePlan& plan) {
    if (QFileInfo(from).isSymLink()) ThrowNotMoved(plan, EXDEV);
    try {
        const WorkFile source = WorkFile::Existing(from, FileCalls::Access::Read);
        CopyComplete(source, temporary);
        if (!HaveSameBytes(source, WorkFile::Existing(temporary, FileCalls::Access::Read)))
            ThrowNotMoved(plan, EIO);
        PassGate(DiskStep::TakeName, to, Failure(plan) + u'\n');
        if (!FileCalls::RenameWithoutReplacing(temporary, to)) ThrowNotMoved(plan, errno);
    } catch (const EStreamError&) {
        FileCalls::Remove(temporary);
        throw;
    }
    try {
        FlushFiles({to});
        PassGate(DiskStep::Remove, from, kCannotRemove);
        if (!FileCalls::Remove(from)) ThrowSystemError(kCannotRemove, from, errno);
    } catch (const EStreamError& failure) {
        if (!FileCalls::Remove(to)) throw EHalfDone(failure.Message());
        throw;
    }
}

void Rename(const QString& from, const QString& to, const QString& temporary, const MovePlan& plan) {
    int error = CurrentWriteGate().Before(DiskStep::Move, to);
    if (error == 0 && FileCalls::RenameWithoutReplacing(from, to)) return;
    if (error == 0) error = errno;
    if (error != EXDEV) ThrowNotMoved(plan, error);
    MoveAcross(from, to, temporary, plan);
}

void MakeWritable(const MovePlan& plan) {
    if (!plan.Before.ReadOnly) return;
    PassGate(DiskStep::Describe, plan.From, Failure(plan) + u'\n');
    if (!FileCalls::SetReadOnly(plan.From, false)) ThrowNotMoved(plan, errno);
}

// A move that stopped between making the second name or copy and removing the first.
void RemoveSecond(const MovePlan& plan, const FileState& from, const FileState& to) {
    if (!to.Exists()) return;
    if (from.Inode == to.Inode && from.Device == to.Device) return RemoveIfThere(plan.To);
    if (!IsAbout(to, plan.Before) || !IsAbout(from, plan.Before)) return;
    if (HaveSameBytes(WorkFile::Existing(plan.From, FileCalls::Access::Read),
                      WorkFile::Existing(plan.To, FileCalls::Access::Read)))
        RemoveIfThere(plan.To);
}

void BringBack(const MovePlan& plan, const FileState& to) {
    if (!to.Exists()) {
        if (QFileInfo::exists(FolderOfFile(plan.To)))
            throw EFileChanged(u"Die Datei "_s + plan.To + u" gibt es nicht mehr."_s);
        ThrowNotMoved({.From = plan.To, .To = plan.From}, ENOENT);
    }
    if (!IsAbout(to, plan.Before))
        throw EFileChanged(u"Die Datei "_s + plan.To +
                           u" wurde inzwischen von einem anderen Programm geändert."_s);
    MakeFolders(plan.Emptied);
    Rename(plan.To, plan.From, BackName(plan), {.From = plan.To, .To = plan.From});
}

}  // namespace

MovePlan PlanMove(const QString& from, const QString& to) {
    MovePlan plan{.From = from, .To = to};
    plan.Before = StateOf(from);
    if (!plan.Before.Exists()) ThrowNotMoved(plan, ENOENT);
    if (FileSource::Exists(to) || QFileInfo(to).isSymLink()) ThrowNotMoved(plan, EEXIST);
    if (FileCalls::IsRelativeLink(from) && FolderOfFile(from) != FolderOfFile(to))
        throw EStreamError(Failure(plan) + u"\nSie ist eine Verknüpfung, deren Ziel vom Ordner abhängt."_s);
    plan.Folders = MissingFolders(to);
    plan.Temporary = TemporaryBeside(to);
    return plan;
}

FileState CarryOutMove(const MovePlan& plan) {
    if (!StateOf(plan.From).HasBytesOf(plan.Before))
        throw EFileChanged(u"Die Datei "_s + plan.From +
                           u" wurde inzwischen von einem anderen Programm geändert."_s);
    try {
        MakeFolders(plan.Folders);
        MakeWritable(plan);
        Rename(plan.From, plan.To, plan.Temporary, plan);
    } catch (const EStreamError&) {
        if (plan.Before.ReadOnly) FileCalls::SetReadOnly(plan.From, true);
        RemoveEmptyFolders(plan.Folders);
        throw;
    }
    RemoveEmptyFolders(plan.Emptied);
    return StateOf(plan.To);
}

void TakeBackMove(const MovePlan& plan) {
    RemoveIfThere(plan.Temporary);
    RemoveIfThere(BackName(plan));
    const FileState from = StateOf(plan.From);
    const FileState to = StateOf(plan.To);
    if (from.Exists())
        RemoveSecond(plan, from, to);
    else
        BringBack(plan, to);
    if (plan.Before.ReadOnly) FileCalls::SetReadOnly(plan.From, true);
    RemoveEmptyFolders(plan.Folders);
}

void RemoveEmptyFolders(const QStringList& folders) {
    for (auto folder = folders.rbegin(); folder != folders.rend(); ++folder)
        if (CurrentWriteGate().Before(DiskStep::Folder, *folder) == 0) FileCalls::RemoveFolder(*folder);
}

FileState MoveFile(const QString& from, const QString& to) {
    const FileState after = CarryOutMove(PlanMove(from, to));
    FlushFiles({to});
    return after;
}
