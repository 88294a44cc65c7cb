#include <windows.h>

#include <QDir>

#include "CommonRUKTools/platform/KernelLock.h"

namespace {

// Far behind the contents, which stay readable.
constexpr DWORD kLockedByte = 0x40000000;

HANDLE Open(const QString& file, DWORD access, DWORD disposition, DWORD flags) {
    constexpr DWORD kNobodyRemovesIt = FILE_SHARE_READ | FILE_SHARE_WRITE;
    const QString native = QDir::toNativeSeparators(file);
    return CreateFileW(reinterpret_cast<const wchar_t*>(native.utf16()), access, kNobodyRemovesIt, nullptr,
                       disposition, flags, nullptr);
}

}  // namespace

KernelLock::Outcome KernelLock::Take(const QString& file, std::intptr_t& handle) {
    const HANDLE opened = Open(file, GENERIC_READ | GENERIC_WRITE, OPEN_ALWAYS, FILE_ATTRIBUTE_HIDDEN);
    if (opened == INVALID_HANDLE_VALUE) return Outcome::Unavailable;
    OVERLAPPED place{};
    place.Offset = kLockedByte;
    if (LockFileEx(opened, LOCKFILE_EXCLUSIVE_LOCK | LOCKFILE_FAIL_IMMEDIATELY, 0, 1, 0, &place) != 0) {
        handle = reinterpret_cast<std::intptr_t>(opened);
        return Outcome::Taken;
    }
    const DWORD error = GetLastError();
    CloseHandle(opened);
    return error == ERROR_LOCK_VIOLATION || error == ERROR_IO_PENDING ? Outcome::Held : Outcome::Unavailable;
}

QByteArray KernelLock::Contents(const QString& file) {
    const HANDLE opened = Open(file, GENERIC_READ, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL);
    if (opened == INVALID_HANDLE_VALUE) return {};
    QByteArray contents(4096, '\0');
    DWORD count = 0;
    if (ReadFile(opened, contents.data(), static_cast<DWORD>(contents.size()), &count, nullptr) == 0)
        count = 0;
    CloseHandle(opened);
    contents.truncate(static_cast<qsizetype>(count));
    return contents;
}

// Without them the lock is one all the same; it only does not tell whose.
void KernelLock::SetContents(std::intptr_t handle, const QByteArray& contents) {
    DWORD count = 0;
    SetEndOfFile(reinterpret_cast<HANDLE>(handle));
    WriteFile(reinterpret_cast<HANDLE>(handle), contents.constData(), static_cast<DWORD>(contents.size()),
              &count, nullptr);
}

void KernelLock::Release(const QString& file, std::intptr_t handle) {
    CloseHandle(reinterpret_cast<HANDLE>(handle));
    const QString native = QDir::toNativeSeparators(file);
    DeleteFileW(reinterpret_cast<const wchar_t*>(native.utf16()));  // refused when somebody has it again
}
