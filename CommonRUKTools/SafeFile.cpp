#include "CommonRUKTools/SafeFile.h"

#include <QFileInfo>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSync.h"

using namespace Qt::StringLiterals;

namespace {

QString FollowLink(const QString& path) {
    const QFileInfo info(path);
    if (!info.isSymLink()) return path;
    const QString real = info.canonicalFilePath();
    return real.isEmpty() ? path : real;
}

}  // namespace

SafeFile::SafeFile(const QString& target) : target_(FollowLink(target)), file_(target_ + u".tmp"_s) {
    if (!file_.open(QIODevice::WriteOnly | QIODevice::Truncate))
        throw EStreamError(u"Kann die Datei nicht anlegen: "_s + file_.fileName() + u": "_s +
                           file_.errorString());
}

SafeFile::~SafeFile() {
    if (committed_) return;
    file_.close();
    QFile::remove(file_.fileName());
}

void SafeFile::Write(ByteSpan bytes) {
    const auto size = static_cast<qint64>(bytes.size());
    if (file_.write(reinterpret_cast<const char*>(bytes.data()), size) != size)
        throw EStreamError(u"Kann die Datei nicht schreiben: "_s + file_.fileName() + u": "_s +
                           file_.errorString());
}

void SafeFile::Seek(qint64 position) {
    if (!file_.seek(position))
        throw EStreamError(u"Kann die Datei nicht schreiben: "_s + file_.fileName() + u": "_s +
                           file_.errorString());
}

void SafeFile::Commit() {
    if (!file_.flush() || !FlushToDisk(file_.handle()))
        throw EStreamError(u"Kann die Datei nicht schreiben: "_s + file_.fileName() + u": "_s +
                           file_.errorString());
    // The new file keeps who may read it; that it can be written is what saving again needs.
    if (QFile::exists(target_))
        file_.setPermissions(QFile::permissions(target_) | QFile::WriteOwner | QFile::WriteUser);
    file_.close();
    if (!ReplaceFile(file_.fileName(), target_))
        throw EStreamError(u"Fehler beim Speichern: Kann "_s + target_ + u".tmp nicht in "_s + target_ +
                           u" umbenennen"_s);
    committed_ = true;
}
