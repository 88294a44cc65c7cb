#include "MusicManagment/database/media/CataloguedMedia.h"

#include <algorithm>

#include "MusicManagment/database/media/CachePlace.h"

using namespace Qt::StringLiterals;

CataloguedMedia::CataloguedMedia(const TMusicDatabase& database) {
    for (const CdName& name : database.CDNames())
        named_.insert(name.Serial);
    for (const SideRow& row : database.Side().Rows(kMediumNames))
        named_.insert(row.Song.toUInt(nullptr, 16));
    named_.remove(0);
    for (const auto& song : database.Songs())
        if (IsCdPath(song->FileName)) ofSongs_.insert(SerialOfCdPath(song->FileName));
    ofSongs_.remove(0);
}

quint32 CataloguedMedia::SerialOf(const Volume& volume) const {
    const auto isKnown = [&](quint32 serial) {
        return named_.contains(serial) || (volume.CanBeTakenAway() && ofSongs_.contains(serial));
    };
    const auto found = std::ranges::find_if(volume.Serials, isKnown);
    return found != volume.Serials.end() ? *found : 0;
}

QString CataloguedMedia::StoredPath(const QString& path) const {
    if (IsCdPath(path) || path.contains(u'\\')) return path;
    const Volume* volume = CurrentVolumes().Holding(path);
    const quint32 serial = volume != nullptr ? SerialOf(*volume) : 0;
    if (serial == 0) return path;
    return MakeCdPath(serial, volume->MountPoint == u"/"_s ? path : path.mid(volume->MountPoint.size()));
}

QString CatalogueMedium(TMusicDatabase& database, const QString& path, const QString& name) {
    const Volume* volume = CurrentVolumes().Holding(path);
    if (volume == nullptr || volume->Serials.empty())
        throw EMusicDatabaseException(
            u"Der Datenträger hat keine Seriennummer und kann nicht katalogisiert werden: "_s + path);
    const quint32 known = CataloguedMedia(database).SerialOf(*volume);
    return NameMedium(database, known != 0 ? known : volume->Serials.front(), name, volume->Label);
}

QString NameMedium(TMusicDatabase& database, quint32 serial, const QString& name, const QString& label) {
    QString given = name.trimmed();
    const QString onMedium = MakeCdPath(serial, u"/"_s);
    if (given.isEmpty() && database.CDNameOf(onMedium) != onMedium) return database.CDNameOf(onMedium);
    if (given.isEmpty()) given = label.isEmpty() ? SerialText(serial) : label;
    std::vector<CdName> names = database.CDNames();
    names.push_back({given, serial});  // of one serial number the last counts
    database.SetCDNames(std::move(names));
    for (const QString& old : database.Side().Values(kMediumNames, SerialText(serial)))
        database.Side().Remove(kMediumNames, {SerialText(serial), old});
    database.Side().Add(kMediumNames, {SerialText(serial), given});
    database.SetModified(true);
    return given;
}

QString PathForPeople(const TMusicDatabase& database, const QString& path) {
    const QString name = database.CDNameOf(path);
    return name != path ? u'[' + name + u"] "_s + PathOnMedium(path) : path;
}

QString FileWithinReach(const TMusicDatabase& database, const QString& path) {
    if (!IsCdPath(path)) return path;
    const Volume* volume = CurrentVolumes().WithSerial(SerialOfCdPath(path));
    return volume != nullptr ? FileAt(volume->MountPoint, path) : NotedFiles(database, path).value(0);
}
