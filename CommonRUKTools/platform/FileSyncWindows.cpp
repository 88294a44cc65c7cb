#include <fcntl.h>
#include <io.h>
#include <sys/stat.h>
#include <windows.h>

#include <QDir>
#include <algorithm>

#include "CommonRUKTools/FileSync.h"

int CreateNewFile(const QString& path) {
    const QString native = QDir::toNativeSeparators(path);
    return _wopen(reinterpret_cast<const wchar_t*>(native.utf16()),
                  _O_WRONLY | _O_CREAT | _O_EXCL | _O_BINARY | _O_NOINHERIT, _S_IREAD | _S_IWRITE);
}

bool WriteAll(int descriptor, ByteSpan bytes) {
    constexpr std::size_t kMostAtOnce = std::size_t{1} << 30;
    while (!bytes.empty()) {
        const auto piece = static_cast<unsigned>(std::min(bytes.size(), kMostAtOnce));
        const int count = _write(descriptor, bytes.data(), piece);
        if (count < 0) return false;
        bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return true;
}

bool SeekTo(int descriptor, qint64 position) {
    return _lseeki64(descriptor, position, SEEK_SET) == position;
}

bool CloseFile(int descriptor) {
    return _close(descriptor) == 0;
}

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
