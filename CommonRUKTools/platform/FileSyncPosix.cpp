#include <fcntl.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <cstdio>

#include "CommonRUKTools/FileSync.h"

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
