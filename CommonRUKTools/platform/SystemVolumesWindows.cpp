#include <windows.h>

#include <QDir>
#include <QFileInfo>

#include "CommonRUKTools/platform/SystemVolumes.h"

using namespace Qt::StringLiterals;

namespace {

const wchar_t* Wide(const QString& text) {
    return reinterpret_cast<const wchar_t*>(text.utf16());
}

// `root` is "D:/".
Volume VolumeAt(const QString& root) {
    const QString native = QDir::toNativeSeparators(root);
    wchar_t label[MAX_PATH + 1] = {};
    wchar_t type[MAX_PATH + 1] = {};
    DWORD serial = 0;
    const UINT drive = GetDriveTypeW(Wide(native));
    if (!GetVolumeInformationW(Wide(native), label, MAX_PATH, &serial, nullptr, nullptr, type, MAX_PATH))
        return {};
    Volume volume{.Device = native.left(2),
                  .MountPoint = root.left(2),
                  .FileSystem = QString::fromWCharArray(type),
                  .Label = QString::fromWCharArray(label),
                  .Serials = {},
                  .Removable = drive == DRIVE_REMOVABLE,
                  .Optical = drive == DRIVE_CDROM};
    if (serial != 0) volume.Serials.push_back(serial);
    return volume;
}

// The system has nothing that tells of changes without a window; each question looks anew.
class Drives : public VolumeSource {
 public:
    const std::vector<Volume>& Mounted() override {
        volumes_.clear();
        for (const QFileInfo& root : QDir::drives()) {
            Volume volume = VolumeAt(root.filePath());
            if (!volume.MountPoint.isEmpty()) volumes_.push_back(std::move(volume));
        }
        return volumes_;
    }

 private:
    std::vector<Volume> volumes_;
};

}  // namespace

VolumeSource& SystemVolumes() {
    static Drives volumes;
    return volumes;
}
