#pragma once

#include <QString>
#include <cstdint>
#include <span>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/FileChange.h"

// The system's side of FileChange. Files are known by their descriptors, as in FileSync.h. Whoever returns
// false or -1 leaves the reason in errno.
namespace FileCalls {

struct Facts {
    FileState State;
    bool IsFile = false;  // neither folder nor device nor pipe
    bool IsOurs = true;   // we can give a new file the same owner
    int Names = 1;        // hard links
};

// Links are followed.
bool Look(const QString& path, Facts& facts);
// Whether it is a symbolic link whose target is told from the folder in which it lies.
bool IsRelativeLink(const QString& path);
bool Look(int file, Facts& facts);

enum class Access { Read, Change };
// A file that is there; a pipe is not waited for.
int Open(const QString& path, Access access);
std::int64_t ReadAt(int file, std::int64_t position, std::span<std::uint8_t> target);
bool WriteAt(int file, std::int64_t position, ByteSpan bytes);
bool Resize(int file, std::int64_t size);
// Has the system copy a range from one file into another. Returns how many bytes it has copied; 0 when it
// cannot do it with these files.
std::int64_t CopyRange(int from, std::int64_t position, int to, std::int64_t target, std::int64_t length);
enum class Attributes { All, WhatFits };
// Gives a new file owner, mode, access lists and further attributes of another.
bool CopyAttributes(int from, int to, Attributes which);
// Nanoseconds since 1970.
bool SetModified(int file, std::int64_t nanoseconds);
bool SetReadOnly(const QString& path, bool readOnly);
// Has what is read next come from the disk and not from memory, where the system can.
void ForgetCached(int file);

bool Replace(const QString& from, const QString& to);
// Fails with EEXIST when something has the new name, with EXDEV when it lies on another file system.
bool RenameWithoutReplacing(const QString& from, const QString& to);
bool Remove(const QString& path);
bool MakeFolder(const QString& path);
bool RemoveFolder(const QString& path);  // only an empty one
bool FlushFolder(const QString& path);
// Everything that was written to the file system of this path.
bool FlushFileSystem(const QString& path);
// Whether files can be made in the folder.
bool CanMakeFiles(const QString& folder);
// Bytes that this user may still write there; -1 when the system does not tell.
std::int64_t FreeBytes(const QString& folder);

}  // namespace FileCalls
