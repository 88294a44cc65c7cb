#include "CommonRUKTools/MusicFolder.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"

using namespace Qt::StringLiterals;

namespace {

// What desktops and people call it.
constexpr QStringView kNames[] = {u"Musik",  u"Music", u"Musique", u"Música", u"Musica", u"Muziek",
                                  u"Muzyka", u"Hudba", u"Zene",    u"MP3s",   u"MP3",    u"Songs"};

bool HoldsSomething(const QString& folder) {
    return !QDir(folder).isEmpty(QDir::AllEntries | QDir::NoDotAndDotDot);
}

QStringList Candidates(const QString& named, const QString& home) {
    QStringList folders;
    // A system without a folder of music names the home folder.
    if (QFileInfo(named).isDir() && QFileInfo(named) != QFileInfo(home)) folders << named;
    const QDir inHome(home);
    const QStringList entries = inHome.entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    for (const QStringView name : kNames)
        for (const QString& entry : entries)
            if (entry.compare(name, Qt::CaseInsensitive) == 0) folders << inHome.filePath(entry);
    return folders;
}

}  // namespace

QString MusicFolder(const QString& named, const QString& home) {
    const QStringList folders = Candidates(named, home);
    const auto used = std::ranges::find_if(folders, HoldsSomething);
    if (used != folders.end()) return AbsolutePath(*used);
    if (!folders.isEmpty()) return AbsolutePath(folders.first());
    const bool isNamed = !named.isEmpty() && QDir::cleanPath(named) != QDir::cleanPath(home);
    return AbsolutePath(isNamed ? named : home + u"/Musik"_s);
}

QString MusicFolder() {
    return MusicFolder(QStandardPaths::writableLocation(QStandardPaths::MusicLocation), QDir::homePath());
}
