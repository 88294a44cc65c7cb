#include "CommonRUKTools/platform/FileCalls.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <string_view>
#include <vector>

namespace {

constexpr std::int64_t kNanosecondsPerSecond = 1'000'000'000;
constexpr mode_t kPermissions = 07777;

bool IsInGroup(gid_t group) {
    if (group == ::getegid()) return true;
    const int count = ::getgroups(0, nullptr);
    std::vector<gid_t> groups(static_cast<std::size_t>(std::max(count, 0)));
    const int got = ::getgroups(count, groups.data());
    return got > 0 && std::find(groups.begin(), groups.begin() + got, group) != groups.begin() + got;
}

FileCalls::Facts FactsOf(const struct stat& status) {
    FileCalls::Facts facts;
    facts.State = {.Size = status.st_size,
                   .ModifiedNs = status.st_mtim.tv_sec * kNanosecondsPerSecond + status.st_mtim.tv_nsec,
                   .Device = status.st_dev,
                   .Inode = status.st_ino,
                   .ReadOnly = (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0};
    facts.IsFile = S_ISREG(status.st_mode);
    facts.IsOurs = ::geteuid() == 0 || (status.st_uid == ::geteuid() && IsInGroup(status.st_gid));
    facts.Names = static_cast<int>(status.st_nlink);
    return facts;
}

// Attributes of the system's own making, which it gives or refuses by its own rules.
bool IsOfTheSystem(std::string_view name) {
    return name.starts_with("security.") || name.starts_with("trusted.");
}

bool CopyAttribute(int from, int to, const char* name) {
    const auto size = ::fgetxattr(from, name, nullptr, 0);
    if (size < 0) return errno == ENODATA;
    std::vector<char> value(static_cast<std::size_t>(size));
    const auto read = ::fgetxattr(from, name, value.data(), value.size());
    return read >= 0 && ::fsetxattr(to, name, value.data(), static_cast<std::size_t>(read), 0) == 0;
}

bool CopyExtendedAttributes(int from, int to) {
    const auto size = ::flistxattr(from, nullptr, 0);
    if (size < 0) return errno == ENOTSUP;
    std::vector<char> names(static_cast<std::size_t>(size));
    const auto read = ::flistxattr(from, names.data(), names.size());
    if (read < 0) return false;
    for (std::size_t at = 0; at < static_cast<std::size_t>(read);) {
        const std::string_view name(names.data() + at);
        if (!CopyAttribute(from, to, name.data()) && !IsOfTheSystem(name)) return false;
        at += name.size() + 1;
    }
    return true;
}

bool CopyOwner(const struct stat& status, int to) {
    struct stat made {};
    if (::fstat(to, &made) != 0) return false;
    return (made.st_uid == status.st_uid && made.st_gid == status.st_gid) ||
           ::fchown(to, status.st_uid, status.st_gid) == 0;
}

bool FlushOpened(const QByteArray& name, int (*flush)(int)) {
    const int file = ::open(name.constData(), O_RDONLY | O_CLOEXEC);
    if (file < 0) return false;
    const bool done = flush(file) == 0;
    const int error = errno;
    ::close(file);
    errno = error;
    return done;
}

}  // namespace

bool FileCalls::Look(const QString& path, Facts& facts) {
    struct stat status {};
    if (::stat(QFile::encodeName(path).constData(), &status) != 0) return false;
    facts = FactsOf(status);
    return true;
}

bool FileCalls::Look(int file, Facts& facts) {
    struct stat status {};
    if (::fstat(file, &status) != 0) return false;
    facts = FactsOf(status);
    return true;
}

bool FileCalls::IsRelativeLink(const QString& path) {
    char first = '/';
    const auto length = ::readlink(QFile::encodeName(path).constData(), &first, 1);
    return length > 0 && first != '/';
}

int FileCalls::Open(const QString& path, Access access) {
    const int how = access == Access::Change ? O_RDWR : O_RDONLY;
    return ::open(QFile::encodeName(path).constData(), how | O_CLOEXEC | O_NONBLOCK);
}

std::int64_t FileCalls::ReadAt(int file, std::int64_t position, std::span<std::uint8_t> target) {
    ssize_t count = 0;
    do
        count = ::pread(file, target.data(), target.size(), position);
    while (count < 0 && errno == EINTR);
    return count;
}

bool FileCalls::WriteAt(int file, std::int64_t position, ByteSpan bytes) {
    while (!bytes.empty()) {
        const auto count = ::pwrite(file, bytes.data(), bytes.size(), position);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return false;
        bytes = bytes.subspan(static_cast<std::size_t>(count));
        position += count;
    }
    return true;
}

bool FileCalls::Resize(int file, std::int64_t size) {
    return ::ftruncate(file, size) == 0;
}

std::int64_t FileCalls::CopyRange(int from, std::int64_t position, int to, std::int64_t target,
                                  std::int64_t length) {
    off_t source = position;
    off_t place = target;
    const auto count = ::copy_file_range(from, &source, to, &place, static_cast<std::size_t>(length), 0);
    if (count >= 0) return count;
    // EIO and a full disk are failures, everything else says that it is not done for these two files.
    return errno == EIO || errno == ENOSPC || errno == EDQUOT || errno == EFBIG ? -1 : 0;
}

bool FileCalls::CopyAttributes(int from, int to, Attributes which) {
    struct stat status {};
    if (::fstat(from, &status) != 0) return false;
    const bool owner = CopyOwner(status, to);
    const bool mode = owner && ::fchmod(to, status.st_mode & kPermissions) == 0;
    const bool rest = mode && CopyExtendedAttributes(from, to);
    return rest || which == Attributes::WhatFits;
}

bool FileCalls::SetModified(int file, std::int64_t nanoseconds) {
    std::int64_t seconds = nanoseconds / kNanosecondsPerSecond;
    std::int64_t rest = nanoseconds % kNanosecondsPerSecond;
    if (rest < 0) {
        rest += kNanosecondsPerSecond;
        --seconds;
    }
    timespec times[2] = {{.tv_sec = 0, .tv_nsec = UTIME_OMIT}, {}};
    times[1].tv_sec = static_cast<time_t>(seconds);
    times[1].tv_nsec = static_cast<long>(rest);
    return ::futimens(file, times) == 0;
}

bool FileCalls::SetReadOnly(const QString& path, bool readOnly) {
    const QByteArray name = QFile::encodeName(path);
    struct stat status {};
    if (::stat(name.constData(), &status) != 0) return false;
    constexpr mode_t kWriting = S_IWUSR | S_IWGRP | S_IWOTH;
    const mode_t mode = (status.st_mode & kPermissions & ~kWriting) | (readOnly ? 0 : S_IWUSR);
    return ::chmod(name.constData(), mode) == 0;
}

void FileCalls::ForgetCached(int file) {
    static_cast<void>(::posix_fadvise(file, 0, 0, POSIX_FADV_DONTNEED));
}

bool FileCalls::Replace(const QString& from, const QString& to) {
    return std::rename(QFile::encodeName(from).constData(), QFile::encodeName(to).constData()) == 0;
}

bool FileCalls::RenameWithoutReplacing(const QString& from, const QString& to) {
    const QByteArray source = QFile::encodeName(from);
    const QByteArray target = QFile::encodeName(to);
    if (::renameat2(AT_FDCWD, source.constData(), AT_FDCWD, target.constData(), RENAME_NOREPLACE) == 0)
        return true;
    if (errno != EINVAL && errno != ENOSYS) return false;
    // File systems that do not know this. A second name is never made over another.
    if (::link(source.constData(), target.constData()) == 0) return ::unlink(source.constData()) == 0;
    if (errno == EEXIST || errno == EXDEV) return false;
    struct stat status {};
    if (::lstat(target.constData(), &status) == 0) {
        errno = EEXIST;
        return false;
    }
    return std::rename(source.constData(), target.constData()) == 0;
}

bool FileCalls::Remove(const QString& path) {
    return ::unlink(QFile::encodeName(path).constData()) == 0;
}

bool FileCalls::MakeFolder(const QString& path) {
    constexpr mode_t kAsTheUserHasSet = 0777;
    return ::mkdir(QFile::encodeName(path).constData(), kAsTheUserHasSet) == 0;
}

bool FileCalls::RemoveFolder(const QString& path) {
    return ::rmdir(QFile::encodeName(path).constData()) == 0;
}

bool FileCalls::FlushFolder(const QString& path) {
    // Some file systems cannot flush folders.
    return FlushOpened(QFile::encodeName(path), ::fsync) || errno == EINVAL;
}

bool FileCalls::FlushFileSystem(const QString& path) {
    return FlushOpened(QFile::encodeName(path), ::syncfs);
}

bool FileCalls::CanMakeFiles(const QString& folder) {
    return ::access(QFile::encodeName(folder).constData(), W_OK | X_OK) == 0;
}

std::int64_t FileCalls::FreeBytes(const QString& folder) {
    struct statvfs status {};
    if (::statvfs(QFile::encodeName(folder).constData(), &status) != 0) return -1;
    return static_cast<std::int64_t>(status.f_bavail) * static_cast<std::int64_t>(status.f_frsize);
}
