#include "CommonRUKTools/Volumes.h"

#include <QStorageInfo>
#include <algorithm>
#include <functional>

#include "CommonRUKTools/platform/SystemVolumes.h"

using namespace Qt::StringLiterals;

namespace {

VolumeSource*& Installed() {
    static VolumeSource* volumes = nullptr;
    return volumes;
}

bool LiesOn(const QString& path, const QString& mountPoint) {
    if (!path.startsWith(mountPoint)) return false;
    return mountPoint.endsWith(u'/') || path.size() == mountPoint.size() || path[mountPoint.size()] == u'/';
}

}  // namespace

bool Volume::HasSerial(quint32 serial) const {
    return serial != 0 && std::ranges::find(Serials, serial) != Serials.end();
}

VolumeSpace VolumeSource::SpaceOf(const Volume& volume) {
    const QStorageInfo info(volume.MountPoint);
    return {.Size = info.bytesTotal(), .Free = info.bytesFree()};
}

const Volume* VolumeSource::WithSerial(quint32 serial) {
    for (const Volume& volume : Mounted())
        if (volume.HasSerial(serial)) return &volume;
    return nullptr;
}

const Volume* VolumeSource::Holding(const QString& path) {
    const Volume* found = nullptr;
    // Of two at the same place the later one hides the earlier.
    for (const Volume& volume : Mounted()) {
        const bool isCloser = found == nullptr || volume.MountPoint.size() >= found->MountPoint.size();
        if (isCloser && LiesOn(path, volume.MountPoint)) found = &volume;
    }
    return found;
}

std::vector<VolumeChoice> VolumeChoices(const QString& preset) {
    std::vector<Volume> volumes = CurrentVolumes().Mounted();
    std::stable_partition(volumes.begin(), volumes.end(), std::mem_fn(&Volume::CanBeTakenAway));
    std::vector<VolumeChoice> choices;
    for (const Volume& volume : volumes) {
        const QString& place = volume.MountPoint;
        choices.push_back({volume.Label.isEmpty() ? place : volume.Label + u" ("_s + place + u')', place});
    }
    if (!preset.isEmpty() && std::ranges::find(choices, preset, &VolumeChoice::MountPoint) == choices.end())
        choices.push_back({preset + u" (nichts eingelegt)"_s, preset});
    if (choices.empty()) choices.push_back({u"(kein Datenträger eingelegt)"_s, {}});
    return choices;
}

VolumeSource& CurrentVolumes() {
    return Installed() != nullptr ? *Installed() : SystemVolumes();
}

void SetVolumes(VolumeSource* volumes) {
    Installed() = volumes;
}
