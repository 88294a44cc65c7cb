#pragma once

#include <QHash>

#include "CommonRUKTools/Volumes.h"

// Volumes that a test mounts and takes away. Installed for its own lifetime.
class ScriptedVolumes : public VolumeSource {
 public:
    ScriptedVolumes() { SetVolumes(this); }
    ~ScriptedVolumes() override { SetVolumes(nullptr); }

    std::vector<Volume> Now;
    QHash<QString, VolumeSpace> Spaces;  // by mount point

    // A stick; `free` 0 makes it a full disc.
    void Mount(const QString& place, quint32 serial, const QString& label = {}, qint64 free = 1) {
        Now.push_back({.Device = {},
                       .MountPoint = place,
                       .FileSystem = {},
                       .Label = label,
                       .Serials = {serial},
                       .Removable = free > 0,
                       .Optical = free == 0});
        Spaces[place] = {.Size = 1000, .Free = free};
    }
    void Unmount() { Now.clear(); }

    const std::vector<Volume>& Mounted() override { return Now; }
    VolumeSpace SpaceOf(const Volume& volume) override { return Spaces.value(volume.MountPoint); }
};
