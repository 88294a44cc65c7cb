#include <io.h>
#include <windows.h>

#include "CommonRUKTools/FileSync.h"

bool FlushToDisk(int descriptor) {
    return _commit(descriptor) == 0;
}

bool ReplaceFile(const QString& from, const QString& to) {
    const auto* target = reinterpret_cast<const wchar_t*>(to.utf16());
    if (GetFileAttributesW(target) != INVALID_FILE_ATTRIBUTES)
        SetFileAttributesW(target, FILE_ATTRIBUTE_NORMAL);
    return MoveFileExW(reinterpret_cast<const wchar_t*>(from.utf16()), target,
                       MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) != 0;
}
