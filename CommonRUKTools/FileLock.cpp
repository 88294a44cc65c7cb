#include "CommonRUKTools/FileLock.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <QSysInfo>

#include "CommonRUKTools/platform/KernelLock.h"

using namespace Qt::StringLiterals;

namespace {

// One file has one lock, however it is reached.
QString LockFileOf(const QString& path) {
    const QFileInfo file(path);
    const QString real = file.canonicalFilePath();
    if (!real.isEmpty()) return QFileInfo(real).path() + u"/."_s + QFileInfo(real).fileName() + u".lock"_s;
    const QString folder = QFileInfo(file.absolutePath()).canonicalFilePath();
    return (folder.isEmpty() ? file.absolutePath() : folder) + u"/."_s + file.fileName() + u".lock"_s;
}

// Three lines: program, process, computer.
QByteArray OwnName() {
    const QString program = QFileInfo(QCoreApplication::applicationFilePath()).fileName();
    return (program + u'\n' + QString::number(QCoreApplication::applicationPid()) + u'\n' +
            QSysInfo::machineHostName() + u'\n')
        .toUtf8();
}

QString NameOf(const QByteArray& contents) {
    const QStringList lines = QString::fromUtf8(contents.left(1024)).split(u'\n');
    if (lines.size() < 3 || lines[0].isEmpty()) return u"einem anderen Programm"_s;
    const QString text = lines[0] + u" (Prozess "_s + lines[1];
    return lines[2] == QSysInfo::machineHostName() ? text + u')'
                                                   : text + u" auf dem Rechner "_s + lines[2] + u')';
}

}  // namespace

FileLock::FileLock(const QString& path) : lockFile_(LockFileOf(path)) {
    if (QFileInfo::exists(path) && !QFileInfo(path).isFile()) return;  // nobody replaces a device or a folder
    const auto outcome = KernelLock::Take(lockFile_, handle_);
    if (outcome == KernelLock::Outcome::Taken) KernelLock::SetContents(handle_, OwnName());
    if (outcome == KernelLock::Outcome::Held) holder_ = NameOf(KernelLock::Contents(lockFile_));
}

FileLock::~FileLock() {
    if (handle_ != -1) KernelLock::Release(lockFile_, handle_);
}

bool FileLock::IsOf(const QString& path) const {
    return lockFile_ == LockFileOf(path);
}
