#pragma once

#include <QString>
#include <QStringList>
#include <cstdint>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FilePatch.h"

// Changes files of the user in a way that never loses one. Each change is a plan first, which says everything
// that is needed to take it back, also by a later process that finds it half done; nothing happens before it
// is carried out. Failures are EStreamErrors that name the file, which is then as it was.

// By what a file is known to be still the one that was looked at.
struct FileState {
    std::int64_t Size = -1;       // bytes; -1 when there is no such file
    std::int64_t ModifiedNs = 0;  // since 1970, UTC
    std::uint64_t Device = 0;
    std::uint64_t Inode = 0;
    bool ReadOnly = false;

    bool Exists() const { return Size >= 0; }
    // Whether its bytes must be the same: size and time are.
    bool HasBytesOf(const FileState& other) const {
        return Size == other.Size && ModifiedNs == other.ModifiedNs;
    }
    // Whether it is the same file with the same bytes.
    bool IsStill(const FileState& other) const {
        return HasBytesOf(other) && Device == other.Device && Inode == other.Inode;
    }
    bool operator==(const FileState&) const = default;
};

// The time that a file gets which is written now. Of the file system's clock, not the program's: a file that
// changes twice must have two times.
std::int64_t FileTimeNow();

// Of the file that the name leads to, links followed.
FileState StateOf(const QString& path);

// Another program has changed, replaced or removed the file since it was looked at.
class EFileChanged : public EStreamError {
 public:
    using EStreamError::EStreamError;
};

// A change failed in its middle and could not be taken back: the file is damaged until that succeeds.
class EHalfDone : public EStreamError {
 public:
    using EStreamError::EStreamError;
};

// --- New contents ---

// How a file gets its new version: written over in its place, or built anew beside it, from where it takes
// the name in one step. The latter keeps owner, mode, access lists and further attributes; where it would cut
// a hard link or lose the owner, a file of up to 256 MiB is written over in its place as a whole instead.
struct PatchPlan {
    QString Path{};  // of the file itself: a symbolic link stays one
    FileState Before{};
    FileState After{};  // size and time only
    FilePatch Patch{};
    FilePatch Inverse{};  // makes the old version again
    QString Temporary{};  // under which the new version is built; empty when it is written in place
    int OtherNames = 0;   // hard links beside this name; they see the new version unless it is built anew

    bool IsInPlace() const { return Temporary.isEmpty(); }
    std::int64_t Bytes() const { return Patch.InsertedBytes() + Inverse.InsertedBytes(); }
};

// `expected`: what the patch was made for. `modifiedNs`: the time that the file is to have; 0 for now. Throws
// EFileChanged when the file is another one now, EStreamError when it is read-only, a device or a pipe.
PatchPlan PlanPatch(const QString& path, FilePatch patch, const FileState& expected,
                    std::int64_t modifiedNs = 0);
// Writes the new version, in place or beside. Throws; EHalfDone only in place.
void WritePatch(const PatchPlan& plan);
// Gives what was built the file's name, once it is on the disk; in place nothing is left to do.
// Returns what the file is now. Throws EFileChanged when the file was changed meanwhile.
FileState FinishPatch(const PatchPlan& plan);
// Brings the old version back, whatever WritePatch and FinishPatch have done of the plan, also nothing, and
// however often it is called. Of the plan it needs all but Patch and OtherNames. Throws EFileChanged when the
// file is somebody else's by now, EStreamError when it cannot be done now.
void TakeBackPatch(const PatchPlan& plan);

// --- New places ---

struct MovePlan {
    QString From{};
    QString To{};
    FileState Before{};
    QStringList Folders{};  // that are missing, outermost first
    QStringList Emptied{};  // that go afterwards where they are empty, likewise
    QString Temporary{};    // of a copy on another file system, until it is complete
};

// Throws EStreamError when there is no such file, or something has the new name.
MovePlan PlanMove(const QString& from, const QString& to);
// Makes the folders and moves the file; it never replaces one that is there. On another file system it is
// copied, flushed, compared, and only then removed here; times and attributes go with it. A read-only file
// can be written afterwards. Throws; no new folder is left then.
FileState CarryOutMove(const MovePlan& plan);
// Brings the file back and removes the plan's folders where they are empty, whatever has been done of it.
void TakeBackMove(const MovePlan& plan);
void RemoveEmptyFolders(const QStringList& folders);

FileState MoveFile(const QString& from, const QString& to);

// --- On the disk ---

// Waits until the changes of these files, and of the folders that name them, are on the disk: few by
// themselves, many in one step a file system. Throws.
void FlushFiles(const QStringList& paths);
// Bytes that can still be written into the folder; -1 when the system does not tell.
std::int64_t FreeBytes(const QString& folder);
// A name beside `path` that nobody has, for a file that will not stay.
QString TemporaryBeside(const QString& path);
