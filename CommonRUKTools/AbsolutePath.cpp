#include "CommonRUKTools/AbsolutePath.h"

#include <QDir>
#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace {

// Says yes only to what certainly needs no cleaning; that is nearly every path, and a look costs next to
// nothing.
bool IsClean(const QString& path) {
    return path.startsWith(u'/') && !path.contains("//"_L1) && !path.contains("/."_L1) &&
           (path.size() == 1 || !path.endsWith(u'/'));
}

// Where the last ".." ends; 0 without one.
qsizetype EndOfLastUp(const QString& path) {
    if (path.endsWith("/.."_L1)) return path.size();
    const qsizetype up = path.lastIndexOf("/../"_L1);
    return up < 0 ? 0 : up + 3;
}

// What a ".." leads to is the file system's knowledge. A folder that is not there is taken by its text.
QString WithoutUps(const QString& path) {
    const qsizetype end = EndOfLastUp(path);
    if (end == 0) return path;
    const QString folder = QFileInfo(path.left(end)).canonicalFilePath();
    return folder.isEmpty() ? path : folder + path.sliced(end);
}

}  // namespace

QString AbsolutePath(const QString& path) {
    if (path.isEmpty() || IsClean(path)) return path;
    const QString native = QDir::fromNativeSeparators(path);
    const QString absolute = QDir::isAbsolutePath(native) ? native : QDir::currentPath() + u'/' + native;
    return QDir::cleanPath(WithoutUps(absolute));
}
