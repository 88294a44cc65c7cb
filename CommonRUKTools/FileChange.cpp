#include "CommonRUKTools/FileChange.h"

#include <QFileInfo>
#include <QRandomGenerator>
#include <QSet>
#include <algorithm>
#include <cerrno>
#include <chrono>

#include "CommonRUKTools/FileWork.h"

using namespace Qt::StringLiterals;

namespace {

// A file that would be written over as a whole has its old bytes in memory and in the journal.
constexpr std::int64_t kLargestWhole = std::int64_t{256} << 20;

[[noreturn]] void ThrowChanged(const QString& path) {
    throw EFileChanged(u"Die Datei "_s + path + u" wurde inzwischen von einem anderen Programm geändert."_s);
}

// The device may not be there now; then nothing is known of the file.
[[noreturn]] void ThrowMissing(const QString& path) {
    if (QFileInfo::exists(FolderOfFile(path)))
        throw EFileChanged(u"Die Datei "_s + path + u" gibt es nicht mehr."_s);
    ThrowSystemError(kCannotOpen, path, ENOENT);
}

QString RealPath(const QString& path) {
    QString real = QFileInfo(path).canonicalFilePath();
    if (real.isEmpty()) ThrowSystemError(kCannotOpen, path, ENOENT);
    return real;
}

// A file that is open for changing, as a source of its old bytes.
class OpenedSource : public ByteSource {
 public:
    explicit OpenedSource(const WorkFile& file) : file_(file), size_(file.Look().State.Size) {}

    std::int64_t Size() const override { return size_; }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override {
        const std::int64_t left = std::max<std::int64_t>(0, size_ - position);
        const auto count = static_cast<std::size_t>(std::min<std::int64_t>(left, std::ssize(target)));
        file_.Read(position, target.first(count));
        return count;
    }

 private:
    const WorkFile& file_;
    std::int64_t size_;
};

// The same change in one that needs no second file, where that would lose something.
void WriteOverWhole(PatchPlan& plan, ByteSource& old) {
    plan.Patch = plan.Patch.Whole(old);
    plan.Inverse = FilePatch().Inverse(old);
}

bool CanBeBuiltAnew(const FileCalls::Facts& facts, const QString& path) {
    return facts.Names == 1 && facts.IsOurs && FileCalls::CanMakeFiles(FolderOfFile(path));
}

// A second name for what is built while a change is taken back.
QString BackName(const PatchPlan& plan) {
    return plan.Temporary + u".alt"_s;
}

void WriteOver(WorkFile& file, const FilePatch& patch) {
    std::int64_t at = 0;
    for (const FilePatch::Piece& piece : patch.Pieces()) {
        if (!piece.IsKept()) file.Write(at, piece.Bytes);
        at += piece.Length;
    }
    if (file.Look().State.Size != at) file.Resize(at);
}

void Build(const QString& temporary, const WorkFile& old, const FilePatch& patch, std::int64_t modifiedNs) {
    WorkFile built = WorkFile::New(temporary);
    std::int64_t at = 0;
    for (const FilePatch::Piece& piece : patch.Pieces()) {
        if (piece.IsKept())
            built.Copy(old, piece.From, at, piece.Length);
        else
            built.Write(at, piece.Bytes);
        at += piece.Length;
    }
    built.TakeAttributes(old, FileCalls::Attributes::All);
    built.SetModified(modifiedNs);
}

void TakeName(const QString& temporary, const QString& path) {
    PassGate(DiskStep::TakeName, path, kCannotWrite);
    if (!FileCalls::Replace(temporary, path)) ThrowSystemError(kCannotWrite, path, errno);
}

// Best effort where the failure is told already.
void RemoveQuietly(const QString& path) {
    try {
        RemoveIfThere(path);
    } catch (const EStreamError&) {
        // It stays behind; whoever takes the change back later removes it.
    }
}

void RestoreInPlace(const PatchPlan& plan) {
    WorkFile file = WorkFile::Existing(plan.Path, FileCalls::Access::Change);
    WriteOver(file, plan.Inverse);
    file.SetModified(plan.Before.ModifiedNs);
    file.Flush();
}

void WriteInPlace(const PatchPlan& plan) {
    WorkFile file = WorkFile::Existing(plan.Path, FileCalls::Access::Change);
    if (!file.Look().State.IsStill(plan.Before)) ThrowChanged(plan.Path);
    try {
        WriteOver(file, plan.Patch);
        file.SetModified(plan.After.ModifiedNs);
    } catch (const EStreamError& failure) {
        try {
            RestoreInPlace(plan);
        } catch (const EStreamError&) {
            throw EHalfDone(failure.Message());
        }
        throw;
    }
}

// A file that is half written has a size between both, whatever its time.
bool MayBeHalfWritten(const FileState& now, const PatchPlan& plan) {
    if (now.Inode == plan.Before.Inode) return true;
    const auto [least, most] = std::minmax(plan.Before.Size, plan.After.Size);
    return now.Size >= least && now.Size <= most;
}

}  // namespace

std::int64_t FileTimeNow() {
    using namespace std::chrono;
    return duration_cast<nanoseconds>(system_clock::now().time_since_epoch()).count();
}

FileState StateOf(const QString& path) {
    FileCalls::Facts facts;
    return FileCalls::Look(path, facts) ? facts.State : FileState();
}

PatchPlan PlanPatch(const QString& path, FilePatch patch, const FileState& expected,
                    std::int64_t modifiedNs) {
    PatchPlan plan;
    plan.Path = RealPath(path);
    FileCalls::Facts facts;
    if (!FileCalls::Look(plan.Path, facts)) ThrowSystemError(kCannotOpen, plan.Path, errno);
    if (!facts.State.IsStill(expected)) ThrowChanged(path);
    if (facts.State.ReadOnly) throw EStreamError(u"Die Datei "_s + path + u" ist schreibgeschützt."_s);
    const WorkFile file = WorkFile::Existing(plan.Path, FileCalls::Access::Change);
    if (!file.Look().State.IsStill(expected)) ThrowChanged(path);
    OpenedSource old(file);

    plan.Before = facts.State;
    plan.OtherNames = facts.Names - 1;
    plan.Inverse = patch.Inverse(old);
    plan.Patch = std::move(patch);
    if (!plan.Patch.FitsInPlace()) {
        const bool isSmall = std::max(plan.Patch.NewSize(), old.Size()) <= kLargestWhole;
        if (isSmall && !CanBeBuiltAnew(facts, plan.Path))
            WriteOverWhole(plan, old);
        else
            plan.Temporary = TemporaryBeside(plan.Path);
    }
    plan.After = {.Size = plan.Patch.NewSize(), .ModifiedNs = modifiedNs != 0 ? modifiedNs : FileTimeNow()};
    return plan;
}

void WritePatch(const PatchPlan& plan) {
    if (plan.IsInPlace()) return WriteInPlace(plan);
    const WorkFile old = WorkFile::Existing(plan.Path, FileCalls::Access::Read);
    if (!old.Look().State.IsStill(plan.Before)) ThrowChanged(plan.Path);
    try {
        Build(plan.Temporary, old, plan.Patch, plan.After.ModifiedNs);
    } catch (const EStreamError&) {
        RemoveQuietly(plan.Temporary);
        throw;
    }
}

FileState FinishPatch(const PatchPlan& plan) {
    if (plan.IsInPlace()) return StateOf(plan.Path);
    try {
        if (!StateOf(plan.Path).IsStill(plan.Before)) ThrowChanged(plan.Path);
        TakeName(plan.Temporary, plan.Path);
    } catch (const EStreamError&) {
        RemoveQuietly(plan.Temporary);
        throw;
    }
    return StateOf(plan.Path);
}

void TakeBackPatch(const PatchPlan& plan) {
    if (!plan.IsInPlace()) {
        RemoveIfThere(plan.Temporary);
        RemoveIfThere(BackName(plan));
    }
    const FileState now = StateOf(plan.Path);
    if (!now.Exists()) ThrowMissing(plan.Path);
    if (plan.IsInPlace()) {
        if (!MayBeHalfWritten(now, plan)) ThrowChanged(plan.Path);
        return RestoreInPlace(plan);
    }
    if (now.HasBytesOf(plan.Before)) return;
    if (!IsAbout(now, plan.After)) ThrowChanged(plan.Path);
    {
        const WorkFile current = WorkFile::Existing(plan.Path, FileCalls::Access::Read);
        Build(BackName(plan), current, plan.Inverse, plan.Before.ModifiedNs);
    }
    WorkFile::Existing(BackName(plan), FileCalls::Access::Read).Flush();
    TakeName(BackName(plan), plan.Path);
    FlushFiles({plan.Path});
}

// --- On the disk ---

namespace {

// The folder of a file may have gone itself when it was emptied.
QString FolderThatIsThere(const QString& path) {
    QString folder = FolderOfFile(path);
    while (!FileSource::Exists(folder) && FolderOfFile(folder) != folder)
        folder = FolderOfFile(folder);
    return folder;
}

void FlushOne(const QString& path) {
    if (FileSource::Exists(path)) WorkFile::Existing(path, FileCalls::Access::Read).Flush();
    PassGate(DiskStep::Flush, path, kCannotWrite);
    if (CurrentWriteGate().WaitsForDisk() && !FileCalls::FlushFolder(FolderThatIsThere(path)))
        ThrowSystemError(kCannotWrite, path, errno);
}

}  // namespace

void FlushFiles(const QStringList& paths) {
    // A whole file system may have other programs' bytes to write as well.
    constexpr qsizetype kFew = 4;
    if (paths.size() <= kFew) {
        std::ranges::for_each(paths, FlushOne);
        return;
    }
    QSet<quint64> flushed;
    QSet<QString> looked;
    for (const QString& path : paths) {
        const QString own = path.left(path.lastIndexOf(u'/'));
        if (looked.contains(own)) continue;
        looked.insert(own);
        const QString folder = FolderThatIsThere(path);
        FileCalls::Facts facts;
        if (!FileCalls::Look(folder, facts) || flushed.contains(facts.State.Device)) continue;
        flushed.insert(facts.State.Device);
        PassGate(DiskStep::Flush, path, kCannotWrite);
        if (!CurrentWriteGate().WaitsForDisk() || FileCalls::FlushFileSystem(folder)) continue;
        if (errno != ENOSYS) ThrowSystemError(kCannotWrite, path, errno);
        std::ranges::for_each(paths, FlushOne);
        return;
    }
}

std::int64_t FreeBytes(const QString& folder) {
    return FileCalls::FreeBytes(folder);
}

// A short name, because that of the file may be as long as names can be.
QString TemporaryBeside(const QString& path) {
    return FolderOfFile(path) + u"/.tunestead-"_s +
           QString::number(QRandomGenerator::system()->generate64(), 36) + u".tmp"_s;
}
