#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <cerrno>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"

using namespace Qt::StringLiterals;

namespace {

QString SystemMessage(const QString& text, const QString& path, int error) {
    return text + path + u": "_s + qt_error_string(error);
}

}  // namespace

FileSource::FileSource(const QString& path) : path_(path) {
    // O_NONBLOCK: opening a pipe without a writer would wait for ever; for regular files it has no effect.
    const int file = ::open(QFile::encodeName(path).constData(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (file < 0) throw EStreamError(SystemMessage(u"Kann die Datei nicht öffnen: "_s, path, errno));
    struct stat status {};
    if (::fstat(file, &status) != 0 || !S_ISREG(status.st_mode)) {
        ::close(file);
        throw EStreamError(u"Keine gewöhnliche Datei: "_s + path);
    }
    handle_ = file;
    size_ = status.st_size;
}

FileSource::~FileSource() {
    ::close(static_cast<int>(handle_));
}

bool FileSource::Exists(const QString& path) {
    return ::access(QFile::encodeName(path).constData(), F_OK) == 0;
}

std::size_t FileSource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    std::size_t done = 0;
    while (done < target.size()) {
        const auto at = static_cast<off_t>(position) + static_cast<off_t>(done);
        const auto count = ::pread(static_cast<int>(handle_), target.data() + done, target.size() - done, at);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) throw EStreamError(SystemMessage(u"Kann die Datei nicht lesen: "_s, path_, errno));
        if (count == 0) break;
        done += static_cast<std::size_t>(count);
        if (static_cast<std::int64_t>(at) + count >= size_)
            break;  // spares the call that would only return 0
    }
    return done;
}
