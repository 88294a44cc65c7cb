#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

#include <QFile>
#include <cerrno>
#include <string_view>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FolderEntries.h"
#include "CommonRUKTools/SystemError.h"

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void Fail(const QString& what, const QString& folder, int error) {
    throw EStreamError(what + folder + u": "_s + SystemErrorText(error));
}

EntryKind KindOfMode(mode_t mode) {
    if (S_ISREG(mode)) return EntryKind::File;
    return S_ISDIR(mode) ? EntryKind::Folder : EntryKind::Other;
}

// Most file systems tell the kind with the name; only links, and the few that do not, cost another call.
EntryKind KindOf(int folder, const dirent& entry) {
    switch (entry.d_type) {
        case DT_REG:
            return EntryKind::File;
        case DT_DIR:
            return EntryKind::Folder;
        case DT_LNK:
        case DT_UNKNOWN: {
            struct stat status {};
            return ::fstatat(folder, entry.d_name, &status, 0) == 0 ? KindOfMode(status.st_mode)
                                                                    : EntryKind::Other;
        }
        default:
            return EntryKind::Other;
    }
}

bool IsAscii(std::string_view text) {
    return std::all_of(text.begin(), text.end(), [](char c) { return static_cast<signed char>(c) >= 0; });
}

// Length of the valid sequence at the beginning, 0 when there is none.
std::size_t SequenceLength(ByteSpan bytes) {
    for (std::size_t length = 1; length <= std::min<std::size_t>(4, bytes.size()); ++length)
        if (CodePage::IsValidUtf8(bytes.first(length))) return length;
    return 0;
}

QString WithEscapedBytes(std::string_view name) {
    QString text;
    for (ByteSpan rest = AsBytes(name); !rest.empty();) {
        const std::size_t length = SequenceLength(rest);
        if (length > 0)
            text += CodePage::FromUtf8(rest.first(length));
        else
            text += u"\\x"_s + QString::number(rest[0], 16).toUpper();
        rest = rest.subspan(std::max<std::size_t>(1, length));
    }
    return text;
}

void SetName(std::string_view name, FolderEntry& entry) {
    entry.Reachable = true;
    if (IsAscii(name)) {
        entry.Name = QString::fromLatin1(name.data(), static_cast<qsizetype>(name.size()));
        return;
    }
    const QByteArray bytes(name.data(), static_cast<qsizetype>(name.size()));
    entry.Name = QFile::decodeName(bytes);
    if (QFile::encodeName(entry.Name) == bytes) return;
    entry.Reachable = false;
    entry.Name = WithEscapedBytes(name);
}

}  // namespace

std::optional<FolderIdentity> IdentifyFolder(const QString& folder) {
    struct stat status {};
    if (::stat(QFile::encodeName(folder).constData(), &status) != 0 || !S_ISDIR(status.st_mode))
        return std::nullopt;
    return FolderIdentity{status.st_dev, status.st_ino};
}

struct FolderEntries::Handle {
    struct Close {
        void operator()(DIR* folder) const { ::closedir(folder); }
    };
    std::unique_ptr<DIR, Close> Stream;
    FolderIdentity Identity;
};

FolderEntries::FolderEntries(const QString& folder) : handle_(std::make_unique<Handle>()), folder_(folder) {
    handle_->Stream.reset(::opendir(QFile::encodeName(folder).constData()));
    struct stat status {};
    if (!handle_->Stream || ::fstat(::dirfd(handle_->Stream.get()), &status) != 0)
        Fail(u"Kann den Ordner nicht öffnen: "_s, folder, errno);
    handle_->Identity = {status.st_dev, status.st_ino};
}

FolderEntries::~FolderEntries() = default;

FolderIdentity FolderEntries::Identity() const {
    return handle_->Identity;
}

bool FolderEntries::Next(FolderEntry& entry) {
    DIR* const stream = handle_->Stream.get();
    for (;;) {
        errno = 0;
        const dirent* const found = ::readdir(stream);
        if (found == nullptr && errno != 0) Fail(u"Kann den Ordner nicht weiter lesen: "_s, folder_, errno);
        if (found == nullptr) return false;
        const std::string_view name = found->d_name;
        if (name == "." || name == "..") continue;
        SetName(name, entry);
        entry.Kind = KindOf(::dirfd(stream), *found);
        return true;
    }
}
