#include <QDir>
#include <QFileInfo>

#include "CommonRUKTools/PrivateFolder.h"

// The temporary folder is each user's own there, and what is made in it inherits that.
bool MakePrivateFolder(const QString& path) {
    const QFileInfo info(path);
    if (info.isSymLink() || info.isJunction()) return false;
    return info.isDir() || QDir().mkdir(path);
}
