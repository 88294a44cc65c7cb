#include "CommonRUKTools/FileWork.h"

#include <QFileInfo>
#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <utility>

#include "CommonRUKTools/FileSync.h"
#include "CommonRUKTools/SystemError.h"

using namespace Qt::StringLiterals;

const QString kCannotOpen = u"Kann die Datei nicht öffnen: "_s;
const QString kCannotRead = u"Kann die Datei nicht lesen: "_s;
const QString kCannotWrite = u"Kann die Datei nicht schreiben: "_s;
const QString kCannotMake = u"Kann die Datei nicht anlegen: "_s;
const QString kCannotRemove = u"Kann die Datei nicht entfernen: "_s;

void ThrowSystemError(const QString& failure, const QString& path, int error) {
    throw EStreamError(failure + path + u": "_s + SystemErrorText(error));
}

void PassGate(DiskStep step, const QString& path, const QString& failure) {
    if (const int error = CurrentWriteGate().Before(step, path); error != 0)
        ThrowSystemError(failure, path, error);
}

// --- One file ---

WorkFile WorkFile::Existing(const QString& path, FileCalls::Access access) {
    const int opened = FileCalls::Open(path, access);
    if (opened < 0) ThrowSystemError(kCannotOpen, path, errno);
    WorkFile file(opened, path);
    if (!file.Look().IsFile)
        throw EStreamError(u"Das ist keine gewöhnliche Datei und wird deshalb nicht geändert: "_s + path);
    return file;
}

WorkFile WorkFile::New(const QString& path) {
    PassGate(DiskStep::Create, path, kCannotMake);
    const int made = CreateNewFile(path);
    if (made < 0) ThrowSystemError(kCannotMake, path, errno);
    return {made, path};
}

WorkFile::~WorkFile() {
    if (file_ >= 0) CloseFile(file_);
}

WorkFile::WorkFile(WorkFile&& other) noexcept
    : file_(std::exchange(other.file_, -1)), path_(std::move(other.path_)) {}

FileCalls::Facts WorkFile::Look() const {
    FileCalls::Facts facts;
    if (!FileCalls::Look(file_, facts)) ThrowSystemError(kCannotOpen, path_, errno);
    return facts;
}

void WorkFile::Read(std::int64_t position, std::span<std::uint8_t> target) const {
    while (!target.empty()) {
        const std::int64_t count = FileCalls::ReadAt(file_, position, target);
        if (count < 0) ThrowSystemError(kCannotRead, path_, errno);
        if (count == 0) throw EStreamError(u"Unerwartetes Ende der Datei "_s + path_);
        target = target.subspan(static_cast<std::size_t>(count));
        position += count;
    }
}

void WorkFile::Write(std::int64_t position, ByteSpan bytes) {
    while (!bytes.empty()) {
        PassGate(DiskStep::Write, path_, kCannotWrite);
        const ByteSpan piece = bytes.first(std::min(bytes.size(), CurrentWriteGate().LongestWrite()));
        if (!FileCalls::WriteAt(file_, position, piece)) ThrowSystemError(kCannotWrite, path_, errno);
        bytes = bytes.subspan(piece.size());
        position += static_cast<std::int64_t>(piece.size());
    }
}

void WorkFile::Copy(const WorkFile& from, std::int64_t position, std::int64_t target, std::int64_t length) {
    constexpr std::int64_t kPiece = std::int64_t{1} << 20;
    std::vector<std::uint8_t> buffer;
    while (length > 0) {
        PassGate(DiskStep::Write, path_, kCannotWrite);
        const auto most =
            std::min<std::uint64_t>(static_cast<std::uint64_t>(length), CurrentWriteGate().LongestWrite());
        std::int64_t count =
            FileCalls::CopyRange(from.file_, position, file_, target, static_cast<std::int64_t>(most));
        if (count < 0) ThrowSystemError(kCannotWrite, path_, errno);
        if (count == 0) {
            count = std::min(static_cast<std::int64_t>(most), kPiece);
            buffer.resize(static_cast<std::size_t>(count));
            from.Read(position, buffer);
            if (!FileCalls::WriteAt(file_, target, buffer)) ThrowSystemError(kCannotWrite, path_, errno);
        }
        position += count;
        target += count;
        length -= count;
    }
}

void WorkFile::Resize(std::int64_t size) {
    PassGate(DiskStep::Resize, path_, kCannotWrite);
    if (!FileCalls::Resize(file_, size)) ThrowSystemError(kCannotWrite, path_, errno);
}

void WorkFile::SetModified(std::int64_t nanoseconds) {
    PassGate(DiskStep::Describe, path_, kCannotWrite);
    if (!FileCalls::SetModified(file_, nanoseconds)) ThrowSystemError(kCannotWrite, path_, errno);
}

void WorkFile::TakeAttributes(const WorkFile& from, FileCalls::Attributes which) {
    const QString failure = u"Kann Besitzer und Rechte der Datei nicht übertragen: "_s;
    PassGate(DiskStep::Describe, path_, failure);
    if (!FileCalls::CopyAttributes(from.file_, file_, which)) ThrowSystemError(failure, from.path_, errno);
}

void WorkFile::Flush() {
    PassGate(DiskStep::Flush, path_, kCannotWrite);
    if (CurrentWriteGate().WaitsForDisk() && !FlushToDisk(file_))
        ThrowSystemError(kCannotWrite, path_, errno);
}

// --- Helpers ---

bool HaveSameBytes(const WorkFile& a, const WorkFile& b) {
    const std::int64_t size = a.Look().State.Size;
    if (b.Look().State.Size != size) return false;
    constexpr std::int64_t kPiece = std::int64_t{1} << 20;
    std::vector<std::uint8_t> first;
    std::vector<std::uint8_t> second;
    for (std::int64_t at = 0; at < size; at += kPiece) {
        first.resize(static_cast<std::size_t>(std::min(kPiece, size - at)));
        second.resize(first.size());
        a.Read(at, first);
        b.Read(at, second);
        if (first != second) return false;
    }
    return true;
}

void RemoveIfThere(const QString& path) {
    if (path.isEmpty() || !FileSource::Exists(path)) return;
    PassGate(DiskStep::Remove, path, kCannotRemove);
    if (!FileCalls::Remove(path) && errno != ENOENT) ThrowSystemError(kCannotRemove, path, errno);
}

bool IsAbout(const FileState& a, const FileState& b) {
    constexpr std::int64_t kCoarsest = 2'000'000'000;
    return a.Size == b.Size && std::abs(a.ModifiedNs - b.ModifiedNs) <= kCoarsest;
}

QString FolderOfFile(const QString& path) {
    return QFileInfo(path).absolutePath();
}
