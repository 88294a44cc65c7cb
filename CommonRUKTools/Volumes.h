#pragma once

#include <QString>
#include <vector>

#include "CommonRUKTools/Listeners.h"

// A file system of a disk or disc that is mounted now.
struct Volume {
    QString Device{};      // "/dev/sdb1"
    QString MountPoint{};  // without a separator at its end, unless it is the root
    QString FileSystem{};  // as the system names it: "vfat"
    QString Label{};       // empty where it has none
    // The volume serial numbers by which it may be known, never 0; the first is the one that is stored. Empty
    // where it has none (VolumeSerials.h).
    std::vector<quint32> Serials{};
    bool Removable = false;  // the disk or its drive can be taken away
    bool Optical = false;

    bool HasSerial(quint32 serial) const;
    bool CanBeTakenAway() const { return Removable || Optical; }
};

struct VolumeSpace {
    qint64 Size = 0;  // bytes
    qint64 Free = 0;  // bytes
};

// What is mounted. Never file systems without a disk (memory, network, images of installed programs).
class VolumeSource {
 public:
    virtual ~VolumeSource() = default;

    // In the order in which they were mounted. Valid until the next call.
    virtual const std::vector<Volume>& Mounted() = 0;
    virtual VolumeSpace SpaceOf(const Volume& volume);
    // Has the next question ask the system anew, also where nothing tells that something has changed.
    virtual void Forget() {}
    // From now on Changed is told when a volume comes or goes. Needs an event loop.
    virtual void Watch() {}

    Listeners<> Changed;

    // nullptr where there is none.
    const Volume* WithSerial(quint32 serial);
    // The one on which a clean absolute path lies.
    const Volume* Holding(const QString& path);
};

// A volume as the user is offered it: "ALBUM (/media/cd)".
struct VolumeChoice {
    QString Caption;
    QString MountPoint;
};
// Those that can be taken away first, then the others; `preset` also while nothing is mounted there. Never
// empty: without any there is one that stands for none.
std::vector<VolumeChoice> VolumeChoices(const QString& preset);

// The volumes in use; the system's own unless others were set. The caller keeps ownership; nullptr restores
// them.
VolumeSource& CurrentVolumes();
void SetVolumes(VolumeSource* volumes);
