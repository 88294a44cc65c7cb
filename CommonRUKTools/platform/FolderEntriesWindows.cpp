#include <windows.h>

#include <QDir>
#include <QFileInfo>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FolderEntries.h"

using namespace Qt::StringLiterals;

namespace {

const wchar_t* Wide(const QString& path) {
    return reinterpret_cast<const wchar_t*>(path.utf16());
}

[[noreturn]] void Fail(const QString& what, const QString& folder, DWORD error) {
    throw EStreamError(what + folder + u": "_s + qt_error_string(static_cast<int>(error)));
}

EntryKind KindOf(DWORD attributes) {
    if ((attributes & FILE_ATTRIBUTE_DIRECTORY) != 0) return EntryKind::Folder;
    return (attributes & FILE_ATTRIBUTE_DEVICE) != 0 ? EntryKind::Other : EntryKind::File;
}

FolderIdentity IdentityOf(const QString& folder) {
    constexpr DWORD kShareAll = FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE;
    const HANDLE handle = CreateFileW(Wide(folder), FILE_READ_ATTRIBUTES, kShareAll, nullptr, OPEN_EXISTING,
                                      FILE_FLAG_BACKUP_SEMANTICS, nullptr);
    if (handle == INVALID_HANDLE_VALUE) Fail(u"Kann den Ordner nicht öffnen: "_s, folder, GetLastError());
    BY_HANDLE_FILE_INFORMATION info{};
    const bool known = GetFileInformationByHandle(handle, &info) != 0;
    const DWORD error = GetLastError();
    CloseHandle(handle);
    if (!known) Fail(u"Kann den Ordner nicht öffnen: "_s, folder, error);
    return {info.dwVolumeSerialNumber, std::uint64_t{info.nFileIndexHigh} << 32 | info.nFileIndexLow};
}

}  // namespace

std::optional<FolderIdentity> IdentifyFolder(const QString& folder) {
    if (!QFileInfo(folder).isDir()) return std::nullopt;
    try {
        return IdentityOf(folder);
    } catch (const EStreamError&) {
        return std::nullopt;  // it went meanwhile
    }
}

struct FolderEntries::Handle {
    ~Handle() {
        if (Search != INVALID_HANDLE_VALUE) FindClose(Search);
    }

    FolderIdentity Identity;
    WIN32_FIND_DATAW Data{};  // the entry that comes next
    HANDLE Search = INVALID_HANDLE_VALUE;
    bool AtEnd = false;
};

FolderEntries::FolderEntries(const QString& folder) : handle_(std::make_unique<Handle>()), folder_(folder) {
    handle_->Identity = IdentityOf(folder);
    const QString pattern = QDir::toNativeSeparators(folder + u"/*"_s);
    handle_->Search = FindFirstFileExW(Wide(pattern), FindExInfoBasic, &handle_->Data, FindExSearchNameMatch,
                                       nullptr, FIND_FIRST_EX_LARGE_FETCH);
    if (handle_->Search != INVALID_HANDLE_VALUE) return;
    // The root folder of an empty volume does not even have "." and "..".
    if (GetLastError() != ERROR_FILE_NOT_FOUND)
        Fail(u"Kann den Ordner nicht öffnen: "_s, folder, GetLastError());
    handle_->AtEnd = true;
}

FolderEntries::~FolderEntries() = default;

FolderIdentity FolderEntries::Identity() const {
    return handle_->Identity;
}

bool FolderEntries::Next(FolderEntry& entry) {
    while (!handle_->AtEnd) {
        entry.Name = QString::fromWCharArray(handle_->Data.cFileName);
        entry.Kind = KindOf(handle_->Data.dwFileAttributes);
        entry.Reachable = true;
        constexpr DWORD kHiddenBySystem = FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM;
        entry.IsSystem = (handle_->Data.dwFileAttributes & kHiddenBySystem) == kHiddenBySystem;
        if (FindNextFileW(handle_->Search, &handle_->Data) == 0) {
            if (GetLastError() != ERROR_NO_MORE_FILES)
                Fail(u"Kann den Ordner nicht weiter lesen: "_s, folder_, GetLastError());
            handle_->AtEnd = true;
        }
        if (entry.Name != u"."_s && entry.Name != u".."_s) return true;
    }
    return false;
}
