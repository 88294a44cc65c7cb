#include "CommonRUKTools/SafeFile.h"

#include <QFile>
#include <QFileInfo>
#include <cerrno>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileChange.h"
#include "CommonRUKTools/FileSync.h"
#include "CommonRUKTools/SystemError.h"

using namespace Qt::StringLiterals;

namespace {

// A folder is let through: it cannot be replaced, and renaming says so.
void RefuseUnlessFile(const QString& path) {
    const QFileInfo info(path);
    if (info.exists() && !info.isFile() && !info.isDir())
        throw EStreamError(u"Das ist keine gewöhnliche Datei und wird deshalb nicht ersetzt: "_s + path);
}

QString FollowLink(const QString& path) {
    const QFileInfo info(path);
    if (!info.isSymLink()) return path;
    const QString real = info.canonicalFilePath();
    return real.isEmpty() ? path : real;
}

[[noreturn]] void Throw(const QString& what, const QString& path, int error) {
    throw EStreamError(what + path + u": "_s + SystemErrorText(error));
}

}  // namespace

SafeFile::SafeFile(const QString& target) : target_(FollowLink(target)), temporary_(target_ + u".tmp"_s) {
    RefuseUnlessFile(target);
    Create();
    // The new file keeps who may read it; that it can be written is what saving again needs.
    if (QFileInfo(target_).isFile())
        QFile::setPermissions(temporary_, QFile::permissions(target_) | QFile::WriteOwner | QFile::WriteUser);
}

SafeFile::~SafeFile() {
    Close();
    if (!committed_) QFile::remove(temporary_);
}

void SafeFile::Create() {
    file_ = CreateNewFile(temporary_);
    if (file_ >= 0) return;
    temporary_ = TemporaryBeside(target_);
    file_ = CreateNewFile(temporary_);
    if (file_ < 0) Throw(u"Kann die Datei nicht anlegen: "_s, target_, errno);
}

void SafeFile::Close() {
    if (file_ >= 0) CloseFile(file_);
    file_ = -1;
}

void SafeFile::Write(ByteSpan bytes) {
    if (!WriteAll(file_, bytes)) Throw(u"Kann die Datei nicht schreiben: "_s, target_, errno);
}

void SafeFile::Seek(qint64 position) {
    if (!SeekTo(file_, position)) Throw(u"Kann die Datei nicht schreiben: "_s, target_, errno);
}

void SafeFile::Commit() {
    if (!FlushToDisk(file_)) Throw(u"Kann die Datei nicht schreiben: "_s, target_, errno);
    Close();
    if (!ReplaceFile(temporary_, target_))
        throw EStreamError(u"Fehler beim Speichern: Kann "_s + temporary_ + u" nicht in "_s + target_ +
                           u" umbenennen"_s);
    committed_ = true;
}
