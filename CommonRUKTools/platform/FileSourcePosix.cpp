#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <cerrno>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SystemError.h"

using namespace Qt::StringLiterals;

namespace {

QString SystemMessage(const QString& text, const QString& path, int error) {
    return text + path + u": "_s + SystemErrorText(error);
}

// The system would cut such a name at the zero character and find another file.
bool IsNoName(const QString& path) {
    return path.contains(QChar(u'\0'));
}

// The descriptor, -1 when the system refuses.
int OpenForReading(const QString& path) {
    if (IsNoName(path)) {
        errno = ENOENT;
        return -1;
    }
    // O_NONBLOCK: opening a pipe without a writer would wait for ever; for regular files it has no effect.
    return ::open(QFile::encodeName(path).constData(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
}

[[noreturn]] void ThrowNotOpened(const QString& path, int error) {
    throw EStreamError(SystemMessage(u"Kann die Datei nicht öffnen: "_s, path, error));
}

}  // namespace

FileSource::FileSource(std::intptr_t handle, const QString& path) : handle_(handle), path_(path) {
    const int file = static_cast<int>(handle);
    struct stat status {};
    if (::fstat(file, &status) != 0 || !S_ISREG(status.st_mode)) {
        ::close(file);
        throw EStreamError(u"Keine gewöhnliche Datei: "_s + path);
    }
    size_ = status.st_size;
}

FileSource::FileSource(const QString& path)
    : FileSource(
          [&path] {
              const int file = OpenForReading(path);
              if (file < 0) ThrowNotOpened(path, errno);
              return std::intptr_t{file};
          }(),
          path) {}

std::unique_ptr<FileSource> FileSource::TryOpen(const QString& path) {
    const int file = OpenForReading(path);
    if (file >= 0) return std::unique_ptr<FileSource>(new FileSource(file, path));
    const int error = errno;
    if (error == ENOENT || error == ENOTDIR || !Exists(path)) return nullptr;
    ThrowNotOpened(path, error);
}

FileSource::~FileSource() {
    ::close(static_cast<int>(handle_));
}

bool FileSource::Exists(const QString& path) {
    return !IsNoName(path) && ::access(QFile::encodeName(path).constData(), F_OK) == 0;
}

std::size_t FileSource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    std::size_t done = 0;
    while (done < target.size()) {
        const auto at = static_cast<off_t>(position) + static_cast<off_t>(done);
        const auto count = ::pread(static_cast<int>(handle_), target.data() + done, target.size() - done, at);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) throw EMediumError(SystemMessage(u"Kann die Datei nicht lesen: "_s, path_, errno));
        if (count == 0) break;
        done += static_cast<std::size_t>(count);
        if (static_cast<std::int64_t>(at) + count >= size_)
            break;  // spares the call that would only return 0
    }
    return done;
}
