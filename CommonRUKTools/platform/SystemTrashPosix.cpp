#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>
#include <QUrl>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/FileChange.h"
#include "CommonRUKTools/FileSync.h"
#include "CommonRUKTools/FileWork.h"
#include "CommonRUKTools/PrivateFolder.h"
#include "CommonRUKTools/platform/SystemTrash.h"

using namespace Qt::StringLiterals;

// The freedesktop trash, https://specifications.freedesktop.org/trash-spec/: a folder with "files" and
// "info", one in the user's data folder and one at the top of each other file system. A file NAME in the
// first is told of by NAME.trashinfo in the second.
namespace {

quint64 DeviceOf(const QString& folder) {
    FileCalls::Facts facts;
    return FileCalls::Look(folder, facts) ? facts.State.Device : 0;
}

QString TopOfFileSystem(QString folder) {
    const quint64 device = DeviceOf(folder);
    for (QString above = FolderOfFile(folder); above != folder && DeviceOf(above) == device;
         above = FolderOfFile(above))
        folder = above;
    return folder;
}

QString HomeTrash() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + u"/Trash"_s;
}

// A folder that all users share must be one where nobody can take away what is another's.
bool IsSafelyShared(const QString& folder) {
    struct stat status {};
    return ::lstat(QFile::encodeName(folder).constData(), &status) == 0 && S_ISDIR(status.st_mode) &&
           (status.st_mode & S_ISVTX) != 0;
}

bool IsReady(const QString& trash) {
    return MakePrivateFolder(trash) && MakePrivateFolder(trash + u"/files"_s) &&
           MakePrivateFolder(trash + u"/info"_s) && QFileInfo(trash + u"/files"_s).isWritable();
}

// Empty when there is none.
QString TrashFor(const QString& path) {
    const QString folder = QFileInfo(FolderOfFile(path)).canonicalFilePath();
    const QString home = HomeTrash();
    if (!QDir().mkpath(FolderOfFile(home))) return {};
    if (DeviceOf(folder) == DeviceOf(FolderOfFile(home))) return IsReady(home) ? home : QString();

    const QString top = QDir(TopOfFileSystem(folder)).filePath(u".Trash"_s);
    const QString user = QString::number(::getuid());
    if (IsSafelyShared(top) && IsReady(top + u'/' + user)) return top + u'/' + user;
    const QString own = top + u'-' + user;
    return IsReady(own) ? own : QString();
}

QString InfoOf(const QString& place) {
    const QFileInfo file(place);
    return FolderOfFile(file.absolutePath()) + u"/info/"_s + file.fileName() + u".trashinfo"_s;
}

// "Song.mp3", "Song 2.mp3", ... shortened where the information's name would be too long.
QString NumberedName(const QFileInfo& file, int number) {
    constexpr qsizetype kLongestBase = 60;  // code units; at most three bytes each
    const QString extension =
        file.suffix().isEmpty() ? QString() : u'.' + file.suffix().left(kLongestBase / 4);
    QString base = file.suffix().isEmpty() ? file.fileName() : file.completeBaseName();
    base.truncate(kLongestBase);
    if (!base.isEmpty() && base.back().isHighSurrogate()) base.chop(1);
    return number == 1 ? base + extension : base + u' ' + QString::number(number) + extension;
}

// Paths on other file systems are told from their top, so that they hold wherever it is mounted.
QString ToldPath(const QString& path, const QString& place) {
    const QString trash = FolderOfFile(FolderOfFile(place));
    if (trash == HomeTrash()) return path;
    return QDir(TopOfFileSystem(trash)).relativeFilePath(path);
}

QByteArray InfoText(const QString& path, const QString& place) {
    const QString time = FromDayCount(CurrentClock().Now()).toString(u"yyyy-MM-ddThh:mm:ss"_s);
    return "[Trash Info]\nPath=" + QFile::encodeName(ToldPath(path, place)).toPercentEncoding("/") +
           "\nDeletionDate=" + time.toLatin1() + '\n';
}

bool WriteInfo(const QString& info, const QByteArray& text) {
    if (QFileInfo::exists(info)) return false;
    try {
        WorkFile::New(info).Write(0, AsBytes({text.constData(), static_cast<std::size_t>(text.size())}));
        return true;
    } catch (const EStreamError&) {
        FileCalls::Remove(info);
        return false;
    }
}

class FreedesktopTrash : public Trash {
 public:
    QString PlaceFor(const QString& path) override {
        const QString trash = TrashFor(path);
        if (trash.isEmpty() || !QFileInfo(path).isFile()) return {};
        for (int number = 1; number < 100'000; ++number) {
            QString place = trash + u"/files/"_s + NumberedName(QFileInfo(path), number);
            if (!QFileInfo::exists(place) && !QFileInfo::exists(InfoOf(place))) return place;
        }
        return {};
    }

    bool TakeTo(const QString& path, const QString& place) override {
        const QString info = InfoOf(place);
        if (!WriteInfo(info, InfoText(path, place))) return false;
        if (Moved(path, place)) return true;
        FileCalls::Remove(info);
        return false;
    }

    bool Restore(const QString& place, const QString& path) override {
        if (QFileInfo::exists(place) && !Moved(place, path)) return false;
        FileCalls::Remove(InfoOf(place));
        return FileSource::Exists(path);
    }

 private:
    static bool Moved(const QString& from, const QString& to) {
        return CurrentWriteGate().Before(DiskStep::Move, to) == 0 &&
               FileCalls::RenameWithoutReplacing(from, to);
    }
};

}  // namespace

Trash& SystemTrash() {
    static FreedesktopTrash trash;
    return trash;
}
