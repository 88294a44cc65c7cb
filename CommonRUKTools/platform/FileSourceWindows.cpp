#include <windows.h>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"

using namespace Qt::StringLiterals;

namespace {

const wchar_t* Wide(const QString& path) {
    return reinterpret_cast<const wchar_t*>(path.utf16());
}

// The system would cut such a name at the zero character and find another file.
bool IsNoName(const QString& path) {
    return path.contains(QChar(u'\0'));
}

HANDLE OpenForReading(const QString& path) {
    if (IsNoName(path)) return INVALID_HANDLE_VALUE;
    return CreateFileW(Wide(path), GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr);
}

[[noreturn]] void ThrowNotOpened(const QString& path) {
    throw EStreamError(u"Kann die Datei nicht öffnen: "_s + path);
}

}  // namespace

FileSource::FileSource(std::intptr_t handle, const QString& path) : handle_(handle), path_(path) {
    const HANDLE file = reinterpret_cast<HANDLE>(handle);
    LARGE_INTEGER size{};
    if (GetFileType(file) != FILE_TYPE_DISK || GetFileSizeEx(file, &size) == 0) {
        CloseHandle(file);
        throw EStreamError(u"Keine gewöhnliche Datei: "_s + path);
    }
    size_ = size.QuadPart;
}

FileSource::FileSource(const QString& path)
    : FileSource(
          [&path] {
              const HANDLE file = OpenForReading(path);
              if (file == INVALID_HANDLE_VALUE) ThrowNotOpened(path);
              return reinterpret_cast<std::intptr_t>(file);
          }(),
          path) {}

std::unique_ptr<FileSource> FileSource::TryOpen(const QString& path) {
    const HANDLE file = OpenForReading(path);
    if (file != INVALID_HANDLE_VALUE)
        return std::unique_ptr<FileSource>(new FileSource(reinterpret_cast<std::intptr_t>(file), path));
    if (!Exists(path)) return nullptr;
    ThrowNotOpened(path);
}

FileSource::~FileSource() {
    CloseHandle(reinterpret_cast<HANDLE>(handle_));
}

bool FileSource::Exists(const QString& path) {
    return !IsNoName(path) && GetFileAttributesW(Wide(path)) != INVALID_FILE_ATTRIBUTES;
}

std::size_t FileSource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    std::size_t done = 0;
    while (done < target.size()) {
        const auto at = static_cast<std::uint64_t>(position) + done;
        OVERLAPPED place{};
        place.Offset = static_cast<DWORD>(at);
        place.OffsetHigh = static_cast<DWORD>(at >> 32);
        DWORD count = 0;
        const auto wanted = static_cast<DWORD>(std::min<std::size_t>(target.size() - done, 1u << 30));
        if (ReadFile(reinterpret_cast<HANDLE>(handle_), target.data() + done, wanted, &count, &place) == 0) {
            if (GetLastError() == ERROR_HANDLE_EOF) break;
            throw EMediumError(u"Kann die Datei nicht lesen: "_s + path_);
        }
        if (count == 0) break;
        done += count;
    }
    return done;
}
