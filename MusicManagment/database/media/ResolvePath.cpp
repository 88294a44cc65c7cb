#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/media/CachePlace.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

// Where the files of songs are whose media can be taken away.

using namespace Qt::StringLiterals;

namespace {

// A drive with a medium that is full, as a disc that can only be read is; none where there is none such.
QString FullDrive() {
    for (const Volume& volume : CurrentVolumes().Mounted()) {
        if (!volume.CanBeTakenAway()) continue;
        const VolumeSpace space = CurrentVolumes().SpaceOf(volume);
        if (space.Free == 0 && space.Size > 0) return volume.MountPoint;
    }
    return {};
}

// nullptr while nothing is mounted there.
const Volume* VolumeIn(const QString& mountPoint) {
    const auto& volumes = CurrentVolumes().Mounted();
    const auto found = std::ranges::find(volumes, mountPoint, &Volume::MountPoint);
    return found != volumes.end() ? &*found : nullptr;
}

// Without what stands for the drive: a mount point, or a letter and a colon.
QString WithoutDrive(const QString& path) {
    if (IsCdPath(path)) return PathOnMedium(path);
    const Volume* volume = CurrentVolumes().Holding(path);
    const qsizetype drive = volume != nullptr ? volume->MountPoint.size() : 2;
    QString rest = volume != nullptr && volume->MountPoint == u"/"_s ? path : path.mid(drive);
    return rest.replace(u'/', u'\\');
}

}  // namespace

QString TMusicDatabase::ResolveSongPath(const QString& path, const ResolveOptions& options) {
    if (!IsCdPath(path)) return path;
    if (options.UseCache)
        if (QString copy = CachedCopy(*this, path); !copy.isEmpty()) return copy;
    const quint32 serial = SerialOfCdPath(path);
    while (true) {
        if (drive_.MountPoint.isEmpty()) drive_.MountPoint = FullDrive();
        const Volume* volume = VolumeIn(drive_.MountPoint);
        if (volume != nullptr && volume->HasSerial(serial)) {
            NoteDriveSerial(volume->Serials.front());
            return FileAt(drive_.MountPoint, path);
        }
        NoteDriveSerial(volume != nullptr && !volume->Serials.empty() ? volume->Serials.front() : 0);
        if (modernMedia_)
            if (const Volume* other = CurrentVolumes().WithSerial(serial); other != nullptr)
                return FileAt(other->MountPoint, path);
        if (!options.Ask || !AskForMedium(path)) return {};
    }
}

// Songs look different when another medium is in the drive.
void TMusicDatabase::NoteDriveSerial(quint32 serial) {
    if (serial == drive_.LastSerial) return;
    drive_.LastSerial = serial;
    events_.MediaChanged.Tell();
}

// False when the user does not want to look for it. A second question while one stands would stand behind it.
bool TMusicDatabase::AskForMedium(const QString& path) {
    if (drive_.Asking) return false;
    drive_.Asking = true;
    std::optional<QString> chosen;
    try {
        chosen = UserDialogs().ChooseVolume(
            CDNameOf(path), u"Bitte legen Sie die passende CD ins CD-Laufwerk:"_s, drive_.MountPoint);
    } catch (...) {
        drive_.Asking = false;
        throw;
    }
    drive_.Asking = false;
    if (chosen) drive_.MountPoint = *chosen;
    return chosen.has_value();
}

QString TMusicDatabase::CDNameOf(const QString& path) const {
    const quint32 serial = SerialOfCdPath(path);
    if (serial == 0) return path;
    const auto found = std::ranges::find(cdNames_, serial, &CdName::Serial);
    return found != cdNames_.end() ? found->Name
                                   : side_.Values(kMediumNames, SerialText(serial)).value(0, path);
}

bool TMusicDatabase::SameFileIgnoringMedium(const QString& a, const QString& b) {
    return IsCdPath(a) != IsCdPath(b) && WithoutDrive(a) == WithoutDrive(b);
}
