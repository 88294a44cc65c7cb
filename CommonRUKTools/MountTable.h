#pragma once

#include <QByteArray>
#include <QString>
#include <vector>

// A line of /proc/self/mountinfo.
struct MountLine {
    QString DeviceNumber;  // "8:17"
    QString Root;          // the folder of the file system that is mounted
    QString MountPoint;
    QString FileSystem;
    QString Source;  // "/dev/sdb1"
};

// The mounts of disks and discs, in the order of the table: what has a device, is mounted whole, and is no
// image of an installed program. Of a device that is mounted in several places the first counts, and a place
// that is used twice is the later one's. Lines that cannot be understood are passed over.
std::vector<MountLine> DisksOf(const QByteArray& table);

// Replaces the escapes of a text: \040 as in mount tables, \x20 as in the names of /dev/disk.
QString WithoutEscapes(const QByteArray& text);
