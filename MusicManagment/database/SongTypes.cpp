#include "MusicManagment/database/SongTypes.h"

#include <QLocale>
#include <algorithm>

using namespace Qt::StringLiterals;

QString FormatSongFlags(quint32 flags) {
    QStringList names;
    if ((flags & sfBurned) != 0) names << u"Auf CD gebrannt"_s;
    if ((flags & sfDamaged) != 0) names << u"Beschädigt"_s;
    if ((flags & sfLengthCorrect) != 0) names << u"Länge korrekt"_s;
    if ((flags & sfRemixed) != 0) names << u"Remixed"_s;
    return names.isEmpty() ? u"(keine)"_s : names.join(u", "_s);
}

QStringList SongFlagNames() {
    return {u"Gebrannt"_s, u"Beschädigt"_s, u"Korrekte Länge"_s, u"Remixed"_s};
}

QString SongCountText(std::size_t count) {
    return count == 1 ? u"1 Song"_s : QLocale(QLocale::German).toString(count) + u" Songs"_s;
}

QStringList DefaultGenreFolderNames() {
    return {u"Unsorted"_s,
            u"Alternative, Psychedelic, Punk, Funk"_s,
            u"Comedy"_s,
            u"German Rock"_s,
            u"Jazz, Blues, Latin, Reggae"_s,
            u"Mystic"_s,
            u"Oldies"_s,
            u"Rap"_s,
            u"Rock, Pop"_s,
            u"Soul, Soft"_s,
            u"Wave, Rave"_s,
            u"Trailers & Game-Soundtracks"_s,
            u"Party-Hits"_s,
            u"Hard Rock"_s,
            u"Metal"_s,
            u"Techno"_s,
            u"Trance"_s,
            u"Dance"_s,
            u"Hip-Hop"_s,
            u"Classic"_s};
}

qsizetype LastSeparator(const QString& path) {
    const qsizetype slash = path.lastIndexOf(u'/');
    return IsCdPath(path) ? std::max(slash, path.lastIndexOf(u'\\')) : slash;
}

QString FolderOf(const QString& path) {
    const qsizetype separator = LastSeparator(path);
    return path.left(std::max<qsizetype>(separator, separator == 0 ? 1 : 0));
}
