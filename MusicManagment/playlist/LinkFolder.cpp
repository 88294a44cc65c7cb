#include "MusicManagment/playlist/LinkFolder.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QHash>
#include <QSet>

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

// The folder while links are made in it. What is known of it is kept: of songs of one name, as programs for
// ripping CDs give it, there may be thousands, and looking through all numbers for each would take minutes.
class LinkFolder {
 public:
    explicit LinkFolder(const QDir& folder) : folder_(folder) {
        const auto all = QDir::AllEntries | QDir::System | QDir::Hidden | QDir::NoDotAndDotDot;
        for (const QFileInfo& entry : folder.entryInfoList(all, QDir::NoSort))
            if (entry.isSymLink()) linked_.insert(entry.symLinkTarget());
    }

    void Add(const QFileInfo& song) {
        const QString target = song.absoluteFilePath();
        if (linked_.contains(target)) return;
        const QString link = FreePath(song);
        QFile file(target);
        if (!file.link(link))
            throw EStreamError(u"Kann die Verknüpfung nicht anlegen: "_s + link + u": "_s +
                               file.errorString());
        linked_.insert(target);
    }

 private:
    QString FreePath(const QFileInfo& song) {
        for (int& number = numbers_[song.fileName()];;) {
            QString path = folder_.filePath(LinkName(song, ++number));
            if (!IsTaken(QFileInfo(path))) return path;
        }
    }

    QDir folder_;
    QSet<QString> linked_;         // songs with a link
    QHash<QString, int> numbers_;  // of a song's name: the last that was tried
};

}  // namespace

void WriteLinkFolder(const QString& folder, const QStringList& paths) {
    if (!QDir().mkpath(folder)) throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + folder);
    LinkFolder links{QDir(folder)};
    for (const QString& path : paths)
        links.Add(QFileInfo(path));
}
