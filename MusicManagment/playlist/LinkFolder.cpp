#include "MusicManagment/playlist/LinkFolder.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

#ifdef Q_OS_WIN
constexpr auto kLinkExtension = u".lnk";
#else
constexpr auto kLinkExtension = u"";
#endif

QString LinkName(const QFileInfo& song, int number) {
    const QString extension = QString::fromUtf16(kLinkExtension);
    if (number == 1) return song.fileName() + extension;
    const QString suffix = song.suffix().isEmpty() ? QString() : u'.' + song.suffix();
    return u"%1 (%2)"_s.arg(song.completeBaseName()).arg(number) + suffix + extension;
}

// Whether something has the name, be it a link that leads nowhere.
bool IsTaken(const QFileInfo& link) {
    return link.exists() || link.isSymLink();
}

void MakeLink(const QDir& folder, const QString& path) {
    const QFileInfo song(path);
    for (int number = 1;; ++number) {
        const QFileInfo link(folder.filePath(LinkName(song, number)));
        if (link.isSymLink() && link.symLinkTarget() == song.absoluteFilePath()) return;
        if (IsTaken(link)) continue;
        QFile file(song.absoluteFilePath());
        if (!file.link(link.filePath()))
            throw EStreamError(u"Kann die Verknüpfung nicht anlegen: "_s + link.filePath() + u": "_s +
                               file.errorString());
        return;
    }
}

}  // namespace

void WriteLinkFolder(const QString& folder, const QStringList& paths) {
    if (!QDir().mkpath(folder)) throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + folder);
    for (const QString& path : paths)
        MakeLink(QDir(folder), path);
}
