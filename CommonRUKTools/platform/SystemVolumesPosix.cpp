#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QHash>
#include <QPointer>
#include <QSocketNotifier>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/MountTable.h"
#include "CommonRUKTools/VolumeSerials.h"
#include "CommonRUKTools/platform/SystemVolumes.h"

using namespace Qt::StringLiterals;

namespace {

constexpr char kMountTable[] = "/proc/self/mountinfo";

class Descriptor {
 public:
    explicit Descriptor(const QString& path)
        : file_(::open(QFile::encodeName(path).constData(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {}
    ~Descriptor() {
        if (file_ >= 0) ::close(file_);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    int File() const { return file_; }
    bool IsOpen() const { return file_ >= 0; }

 private:
    int file_;
};

// The bytes of a disk, where the user may read them.
class DeviceSource : public ByteSource {
 public:
    explicit DeviceSource(const Descriptor& device)
        : file_(device.File()), size_(::lseek(device.File(), 0, SEEK_END)) {}
    std::int64_t Size() const override { return size_; }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override {
        const auto count = ::pread(file_, target.data(), target.size(), static_cast<off_t>(position));
        if (count < 0) throw EMediumError(u"Kann den Datenträger nicht lesen."_s);
        return static_cast<std::size_t>(count);
    }

 private:
    int file_;
    std::int64_t size_;
};

// Device to the name of its link in a folder of /dev/disk.
QHash<QString, QString> NamesIn(const QString& folder) {
    QHash<QString, QString> names;
    const QFileInfoList links =
        QDir(folder).entryInfoList(QDir::AllEntries | QDir::System | QDir::NoDotAndDotDot);
    for (const QFileInfo& link : links)
        names.insert(link.canonicalFilePath(), WithoutEscapes(QFile::encodeName(link.fileName())));
    return names;
}

QByteArray FirstLine(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readLine().trimmed() : QByteArray();
}

// Of a partition the disk that it lies on.
QString DiskFolder(const QString& deviceNumber) {
    const QString folder = QFileInfo(u"/sys/dev/block/"_s + deviceNumber).canonicalFilePath();
    const bool isPartition = QFileInfo::exists(folder + u"/partition"_s);
    return isPartition ? QFileInfo(folder).path() : folder;
}

// A disk that hangs on a cable, a card, an image in a file: all these go without the program being asked.
bool IsRemovable(const QString& disk) {
    return FirstLine(disk + u"/removable"_s) == "1" || disk.contains(u"/usb"_s) ||
           FirstLine(disk + u"/device/type"_s) == "SD" || QFileInfo(disk).fileName().startsWith(u"loop"_s);
}

bool IsOptical(const MountLine& line, const QString& disk) {
    constexpr char kCdDrive[] = "5";  // SCSI peripheral device type
    return FirstLine(disk + u"/device/type"_s) == kCdDrive || line.FileSystem == u"iso9660"_s ||
           line.FileSystem == u"udf"_s;
}

class MountedVolumes : public VolumeSource {
 public:
    const std::vector<Volume>& Mounted() override {
        if (!isKnown_ || HasChanged()) Look();
        return volumes_;
    }
    void Forget() override { isKnown_ = false; }
    void Watch() override {
        if (notifier_ || !watched_.IsOpen()) return;
        // Goes with the program's event loop, which ends before this object does.
        notifier_ =
            new QSocketNotifier(watched_.File(), QSocketNotifier::Exception, QCoreApplication::instance());
        QObject::connect(notifier_.data(), &QSocketNotifier::activated, [this] {
            Forget();
            Changed.Tell();
        });
    }

 private:
    // The system tells each reader once.
    bool HasChanged() const {
        pollfd question{.fd = asked_.File(), .events = POLLPRI, .revents = 0};
        return !asked_.IsOpen() || (::poll(&question, 1, 0) > 0 && (question.revents & POLLPRI) != 0);
    }

    void Look() {
        volumes_.clear();
        isKnown_ = true;
        QFile table(QString::fromLatin1(kMountTable));
        if (!table.open(QIODevice::ReadOnly)) return;
        const auto uuids = NamesIn(u"/dev/disk/by-uuid"_s);
        const auto labels = NamesIn(u"/dev/disk/by-label"_s);
        for (const MountLine& line : DisksOf(table.readAll())) {
            const QString device = QFileInfo(line.Source).canonicalFilePath();
            volumes_.push_back(VolumeOf(
                line, device,
                {.Type = line.FileSystem, .Uuid = uuids.value(device), .Label = labels.value(device)}));
        }
    }

    static Volume VolumeOf(const MountLine& line, const QString& device, const FileSystemFacts& facts) {
        const QString disk = DiskFolder(line.DeviceNumber);
        Volume volume{.Device = device,
                      .MountPoint = line.MountPoint,
                      .FileSystem = line.FileSystem,
                      .Label = facts.Label,
                      .Serials = {},
                      .Removable = line.MountPoint != u"/"_s && IsRemovable(disk),
                      .Optical = IsOptical(line, disk)};
        const Descriptor opened(device);
        if (opened.IsOpen()) {
            DeviceSource bytes(opened);
            volume.Serials = VolumeSerialsOf(facts, &bytes);
        } else {
            volume.Serials = VolumeSerialsOf(facts, nullptr);
        }
        return volume;
    }

    Descriptor asked_{QString::fromLatin1(kMountTable)};
    Descriptor watched_{QString::fromLatin1(kMountTable)};
    QPointer<QSocketNotifier> notifier_;
    std::vector<Volume> volumes_;
    bool isKnown_ = false;
};

}  // namespace

VolumeSource& SystemVolumes() {
    static MountedVolumes volumes;
    return volumes;
}
