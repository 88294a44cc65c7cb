#pragma once

#include <QString>
#include <cstdint>

#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/WriteGate.h"
#include "CommonRUKTools/platform/FileCalls.h"

// The steps of which changes of files are made. Each asks the write gate first, and a failure is an
// EStreamError that names the file.

// Throws when the gate is closed for this step, with what could not be done: "Kann die Datei nicht schreiben:
// ".
void PassGate(DiskStep step, const QString& path, const QString& failure);
[[noreturn]] void ThrowSystemError(const QString& failure, const QString& path, int error);

extern const QString kCannotOpen;
extern const QString kCannotRead;
extern const QString kCannotWrite;
extern const QString kCannotMake;
extern const QString kCannotRemove;

// A regular file that is open.
class WorkFile {
 public:
    static WorkFile Existing(const QString& path, FileCalls::Access access);
    static WorkFile New(const QString& path);
    ~WorkFile();
    WorkFile(WorkFile&& other) noexcept;
    WorkFile(const WorkFile&) = delete;
    WorkFile& operator=(const WorkFile&) = delete;

    const QString& Path() const { return path_; }
    FileCalls::Facts Look() const;
    // Exactly as many bytes as the target holds.
    void Read(std::int64_t position, std::span<std::uint8_t> target) const;
    void Write(std::int64_t position, ByteSpan bytes);
    // A range of another file, by the system where it can.
    void Copy(const WorkFile& from, std::int64_t position, std::int64_t target, std::int64_t length);
    void Resize(std::int64_t size);
    void SetModified(std::int64_t nanoseconds);
    void TakeAttributes(const WorkFile& from, FileCalls::Attributes which);
    void Flush();
    void ForgetCached() const { FileCalls::ForgetCached(file_); }

 private:
    WorkFile(int file, QString path) : file_(file), path_(std::move(path)) {}

    int file_ = -1;
    QString path_;
};

// Whether two files have the same bytes. Throws when one cannot be read.
bool HaveSameBytes(const WorkFile& a, const WorkFile& b);
// Removes a file that may be there.
void RemoveIfThere(const QString& path);
// Whether two states are of the same bytes, as far as file systems keep times: some to two seconds.
bool IsAbout(const FileState& a, const FileState& b);
QString FolderOfFile(const QString& path);
