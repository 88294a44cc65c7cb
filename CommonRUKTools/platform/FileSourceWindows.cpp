#include <windows.h>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"

using namespace Qt::StringLiterals;

namespace {

const wchar_t* Wide(const QString& path) {
    return reinterpret_cast<const wchar_t*>(path.utf16());
}

}  // namespace

FileSource::FileSource(const QString& path) : path_(path) {
    const HANDLE file =
        CreateFileW(Wide(path), GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr);
    LARGE_INTEGER size{};
    if (file == INVALID_HANDLE_VALUE) throw EStreamError(u"Kann die Datei nicht öffnen: "_s + path);
    if (GetFileType(file) != FILE_TYPE_DISK || GetFileSizeEx(file, &size) == 0) {
        CloseHandle(file);
        throw EStreamError(u"Keine gewöhnliche Datei: "_s + path);
    }
    handle_ = reinterpret_cast<std::intptr_t>(file);
    size_ = size.QuadPart;
}

FileSource::~FileSource() {
    CloseHandle(reinterpret_cast<HANDLE>(handle_));
}

bool FileSource::Exists(const QString& path) {
    return GetFileAttributesW(Wide(path)) != INVALID_FILE_ATTRIBUTES;
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
            throw EStreamError(u"Kann die Datei nicht lesen: "_s + path_);
        }
        if (count == 0) break;
        done += count;
    }
    return done;
}
