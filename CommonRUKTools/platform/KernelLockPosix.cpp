#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <cerrno>

#include "CommonRUKTools/FileSync.h"
#include "CommonRUKTools/platform/KernelLock.h"

namespace {

// Another user's file may not be written, but it can be locked all the same.
int Open(const QByteArray& name) {
    constexpr mode_t kForAll = 0666;
    const int file = ::open(name.constData(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, kForAll);
    return file >= 0 || errno != EACCES ? file : ::open(name.constData(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW);
}

int LockWithoutWaiting(int file) {
    int result = 0;
    do
        result = ::flock(file, LOCK_EX | LOCK_NB);
    while (result != 0 && errno == EINTR);
    return result;
}

// Whoever had it before may have removed the name since the file was opened.
bool StillHasName(int file, const QByteArray& name) {
    struct stat opened {};
    struct stat named {};
    return ::fstat(file, &opened) == 0 && ::stat(name.constData(), &named) == 0 &&
           opened.st_ino == named.st_ino && opened.st_dev == named.st_dev;
}

}  // namespace

KernelLock::Outcome KernelLock::Take(const QString& file, std::intptr_t& handle) {
    const QByteArray name = QFile::encodeName(file);
    for (;;) {
        const int opened = Open(name);
        if (opened < 0) return Outcome::Unavailable;
        if (LockWithoutWaiting(opened) != 0) {
            const bool held = errno == EWOULDBLOCK;
            ::close(opened);
            return held ? Outcome::Held : Outcome::Unavailable;
        }
        if (StillHasName(opened, name)) {
            handle = opened;
            return Outcome::Taken;
        }
        ::close(opened);
    }
}

QByteArray KernelLock::Contents(const QString& file) {
    QFile opened(file);
    return opened.open(QIODevice::ReadOnly) ? opened.read(4096) : QByteArray();
}

// Without them the lock is one all the same; it only does not tell whose.
void KernelLock::SetContents(std::intptr_t handle, const QByteArray& contents) {
    const int file = static_cast<int>(handle);
    if (::ftruncate(file, 0) != 0) return;
    static_cast<void>(
        WriteAll(file, AsBytes({contents.constData(), static_cast<std::size_t>(contents.size())})));
}

void KernelLock::Release(const QString& file, std::intptr_t handle) {
    ::unlink(QFile::encodeName(file).constData());
    ::close(static_cast<int>(handle));
}
