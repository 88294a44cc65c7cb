#pragma once

#include <QString>
#include <vector>

#include "CommonRUKTools/FileSource.h"

// What is known of a file system from outside.
struct FileSystemFacts {
    QString Type;   // as the system names it: "vfat"
    QString Uuid;   // as it stands in /dev/disk/by-uuid; empty where it is not known
    QString Label;  // empty where it has none
};

// The 32-bit volume serial numbers by which a file system may be known, best first, never 0: the number that
// FAT, exFAT and NTFS carry, the one that is computed of the descriptor of an ISO 9660 disc, and for others,
// and discs that may not be read, a hash of ours (docs/formats.md). They are stored in paths and never
// change. `device` holds the bytes of the file system; nullptr where they may not be read.
std::vector<quint32> VolumeSerialsOf(const FileSystemFacts& facts, ByteSource* device);
