#include <fcntl.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <cerrno>
#include <cstdio>

#include "CommonRUKTools/FileSync.h"

int CreateNewFile(const QString& path) {
    constexpr mode_t kAsTheUserHasSet = 0666;
    return ::open(QFile::encodeName(path).constData(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC,
                  kAsTheUserHasSet);
}

bool WriteAll(int descriptor, ByteSpan bytes) {
    while (!bytes.empty()) {
        const auto count = ::write(descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return false;
        bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return true;
}

bool SeekTo(int descriptor, qint64 position) {
    return ::lseek(descriptor, static_cast<off_t>(position), SEEK_SET) == static_cast<off_t>(position);
}

bool CloseFile(int descriptor) {
    return ::close(descriptor) == 0;
}

bool FlushToDisk(int descriptor) {
    return ::fsync(descriptor) == 0;
}

bool ReplaceFile(const QString& from, const QString& to) {
    if (std::rename(QFile::encodeName(from).constData(), QFile::encodeName(to).constData()) != 0)
        return false;
    const int folder =
        ::open(QFile::encodeName(QFileInfo(to).absolutePath()).constData(), O_RDONLY | O_CLOEXEC);
    if (folder >= 0) {
        // Some file systems cannot flush folders; the rename itself has happened all the same.
        static_cast<void>(::fsync(folder));
        ::close(folder);
    }
    return true;
}
