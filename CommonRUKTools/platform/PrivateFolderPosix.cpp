#include <QFile>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

#include "CommonRUKTools/PrivateFolder.h"

bool MakePrivateFolder(const QString& path) {
    const QByteArray name = QFile::encodeName(path);
    if (mkdir(name.constData(), S_IRWXU) != 0 && errno != EEXIST) return false;
    // Whoever holds the name: it is looked at through a handle, so that it cannot change between the looks.
    const int folder = open(name.constData(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
    if (folder < 0) return false;
    struct stat status {};
    const bool isOurs = fstat(folder, &status) == 0 && status.st_uid == geteuid();
    const bool isPrivate = isOurs && fchmod(folder, S_IRWXU) == 0;
    close(folder);
    return isPrivate;
}
