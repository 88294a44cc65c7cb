#include "CommonRUKTools/platform/FileCalls.h"

#include <fcntl.h>
#include <io.h>
#include <windows.h>

#include <QDir>
#include <QFileInfo>
#include <algorithm>
#include <cerrno>

#include "CommonRUKTools/FileSync.h"

namespace {

// FILETIME counts 100 ns from 1601.
constexpr std::int64_t kUnixEpoch = 116'444'736'000'000'000;
constexpr std::int64_t kNanosecondsPerTick = 100;

std::wstring Native(const QString& path) {
    return QDir::toNativeSeparators(path).toStdWString();
}

bool Failed(DWORD error) {
    switch (error) {
        case ERROR_FILE_NOT_FOUND:
        case ERROR_PATH_NOT_FOUND:
            errno = ENOENT;
            break;
        case ERROR_ALREADY_EXISTS:
        case ERROR_FILE_EXISTS:
            errno = EEXIST;
            break;
        case ERROR_ACCESS_DENIED:
            errno = EACCES;
            break;
        case ERROR_SHARING_VIOLATION:
        case ERROR_LOCK_VIOLATION:
            errno = EBUSY;
            break;
        case ERROR_NOT_SAME_DEVICE:
            errno = EXDEV;
            break;
        case ERROR_DISK_FULL:
        case ERROR_HANDLE_DISK_FULL:
            errno = ENOSPC;
            break;
        case ERROR_WRITE_PROTECT:
            errno = EROFS;
            break;
        default:
            errno = EIO;
    }
    return false;
}

bool Done(BOOL result) {
    return result != 0 || Failed(GetLastError());
}

HANDLE HandleOf(int file) {
    return reinterpret_cast<HANDLE>(_get_osfhandle(file));
}

std::int64_t Together(DWORD high, DWORD low) {
    return static_cast<std::int64_t>((static_cast<std::uint64_t>(high) << 32) | low);
}

}  // namespace

bool FileCalls::Look(int file, Facts& facts) {
    BY_HANDLE_FILE_INFORMATION info{};
    if (!Done(GetFileInformationByHandle(HandleOf(file), &info))) return false;
    const std::int64_t ticks =
        Together(info.ftLastWriteTime.dwHighDateTime, info.ftLastWriteTime.dwLowDateTime);
    facts.State = {.Size = Together(info.nFileSizeHigh, info.nFileSizeLow),
                   .ModifiedNs = (ticks - kUnixEpoch) * kNanosecondsPerTick,
                   .Device = info.dwVolumeSerialNumber,
                   .Inode = static_cast<std::uint64_t>(Together(info.nFileIndexHigh, info.nFileIndexLow)),
                   .ReadOnly = (info.dwFileAttributes & FILE_ATTRIBUTE_READONLY) != 0};
    facts.IsFile = (info.dwFileAttributes & (FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_DEVICE)) == 0;
    facts.Names = static_cast<int>(info.nNumberOfLinks);
    return true;
}

bool FileCalls::Look(const QString& path, Facts& facts) {
    const HANDLE handle = CreateFileW(Native(path).c_str(), FILE_READ_ATTRIBUTES,
                                      FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                                      OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr);
    if (handle == INVALID_HANDLE_VALUE) return Failed(GetLastError());
    const int file = _open_osfhandle(reinterpret_cast<intptr_t>(handle), _O_RDONLY | _O_BINARY);
    const bool done = Look(file, facts);
    CloseFile(file);
    return done;
}

bool FileCalls::IsRelativeLink(const QString&) {
    return false;  // links are looked through by the system
}

int FileCalls::Open(const QString& path, Access access) {
    const bool changes = access == Access::Change;
    const HANDLE handle =
        CreateFileW(Native(path).c_str(), changes ? GENERIC_READ | GENERIC_WRITE : GENERIC_READ,
                    FILE_SHARE_READ | FILE_SHARE_DELETE | (changes ? 0 : FILE_SHARE_WRITE), nullptr,
                    OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (handle == INVALID_HANDLE_VALUE) return Failed(GetLastError()) ? 0 : -1;
    return _open_osfhandle(reinterpret_cast<intptr_t>(handle),
                           (changes ? _O_RDWR : _O_RDONLY) | _O_BINARY | _O_NOINHERIT);
}

std::int64_t FileCalls::ReadAt(int file, std::int64_t position, std::span<std::uint8_t> target) {
    constexpr std::size_t kMostAtOnce = std::size_t{1} << 30;
    if (!SeekTo(file, position)) return -1;
    return _read(file, target.data(), static_cast<unsigned>(std::min(target.size(), kMostAtOnce)));
}

bool FileCalls::WriteAt(int file, std::int64_t position, ByteSpan bytes) {
    return SeekTo(file, position) && WriteAll(file, bytes);
}

bool FileCalls::Resize(int file, std::int64_t size) {
    return _chsize_s(file, size) == 0;
}

std::int64_t FileCalls::CopyRange(int, std::int64_t, int, std::int64_t, std::int64_t) {
    return 0;
}

// What a new file of this folder gets is what the old one has, but for its attributes.
bool FileCalls::CopyAttributes(int from, int to, Attributes) {
    FILE_BASIC_INFO old{};
    FILE_BASIC_INFO made{};
    if (!Done(GetFileInformationByHandleEx(HandleOf(from), FileBasicInfo, &old, sizeof old))) return false;
    made.FileAttributes = old.FileAttributes;
    made.CreationTime = old.CreationTime;
    return Done(SetFileInformationByHandle(HandleOf(to), FileBasicInfo, &made, sizeof made));
}

bool FileCalls::SetModified(int file, std::int64_t nanoseconds) {
    const std::int64_t ticks = nanoseconds / kNanosecondsPerTick + kUnixEpoch;
    const FILETIME time{.dwLowDateTime = static_cast<DWORD>(ticks),
                        .dwHighDateTime = static_cast<DWORD>(ticks >> 32)};
    return Done(SetFileTime(HandleOf(file), nullptr, nullptr, &time));
}

bool FileCalls::SetReadOnly(const QString& path, bool readOnly) {
    const std::wstring name = Native(path);
    const DWORD attributes = GetFileAttributesW(name.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES) return Failed(GetLastError());
    const DWORD others = attributes & ~static_cast<DWORD>(FILE_ATTRIBUTE_READONLY);
    return Done(SetFileAttributesW(name.c_str(), readOnly ? others | FILE_ATTRIBUTE_READONLY : others));
}

void FileCalls::ForgetCached(int) {}

bool FileCalls::Replace(const QString& from, const QString& to) {
    return Done(MoveFileExW(Native(from).c_str(), Native(to).c_str(),
                            MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH));
}

bool FileCalls::RenameWithoutReplacing(const QString& from, const QString& to) {
    return Done(MoveFileExW(Native(from).c_str(), Native(to).c_str(), MOVEFILE_WRITE_THROUGH));
}

bool FileCalls::Remove(const QString& path) {
    return Done(DeleteFileW(Native(path).c_str()));
}

bool FileCalls::MakeFolder(const QString& path) {
    return Done(CreateDirectoryW(Native(path).c_str(), nullptr));
}

bool FileCalls::RemoveFolder(const QString& path) {
    return Done(RemoveDirectoryW(Native(path).c_str()));
}

bool FileCalls::FlushFolder(const QString&) {
    return true;  // renames are written through
}

// Whole volumes can be flushed by an administrator only: false, so that the files are flushed one by one.
bool FileCalls::FlushFileSystem(const QString&) {
    errno = ENOSYS;
    return false;
}

bool FileCalls::CanMakeFiles(const QString& folder) {
    return QFileInfo(folder).isWritable();
}

std::int64_t FileCalls::FreeBytes(const QString& folder) {
    ULARGE_INTEGER bytes{};
    return Done(GetDiskFreeSpaceExW(Native(folder).c_str(), &bytes, nullptr, nullptr))
               ? static_cast<std::int64_t>(bytes.QuadPart)
               : -1;
}
