#include <gtest/gtest.h>

#include <QStringList>

#include "CommonRUKTools/MountTable.h"
#include "CommonRUKTools/VolumeSerials.h"
#include "CommonRUKTools/Volumes.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

using Bytes = std::vector<std::uint8_t>;
using Serials = std::vector<quint32>;

void Put(Bytes& bytes, std::size_t position, std::string_view text) {
    if (bytes.size() < position + text.size()) bytes.resize(position + text.size());
    std::copy(text.begin(), text.end(), bytes.begin() + static_cast<std::ptrdiff_t>(position));
}

Bytes BootSector(std::size_t namePosition, std::string_view name, std::size_t numberPosition) {
    Bytes sector(512);
    Put(sector, namePosition, name);
    Put(sector, numberPosition, "\x4D\x3C\x2B\x1A");
    Put(sector, 510, "\x55\xAA");
    return sector;
}

// A disc whose primary descriptor sums up to 01000000 and 02, plus the given one behind it.
Bytes Disc(const std::string& second) {
    Bytes disc(32'768 + 4 * 2048);
    Put(disc, 32'768,
        "\x01"
        "CD001\x01");
    Put(disc, 32'768 + 2048, second);
    Put(disc, 32'768 + 2 * 2048,
        "\xFF"
        "CD001\x01");
    return disc;
}

Serials SerialsOf(const FileSystemFacts& facts, const Bytes& device = {}) {
    MemorySource source(device);
    return VolumeSerialsOf(facts, device.empty() ? nullptr : &source);
}

}  // namespace

TEST(VolumeSerials, AreThoseThatFileSystemsCarry) {
    EXPECT_EQ(SerialsOf({u"vfat"_s, u"1A2B-3C4D"_s, {}}), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"exfat"_s, u"1A2B-3C4D"_s, {}}), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"fuseblk"_s, u"0123456789ABCDEF"_s, {}}), Serials{0x89ABCDEF});
    EXPECT_EQ(SerialsOf({u"vfat"_s, {}, {}}, BootSector(0x52, "FAT32   ", 0x43)), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"vfat"_s, {}, {}}, BootSector(0x36, "FAT16   ", 0x27)), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"exfat"_s, {}, {}}, BootSector(3, "EXFAT   ", 0x64)), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"ntfs3"_s, {}, {}}, BootSector(3, "NTFS    ", 0x48)), Serials{0x1A2B3C4D});
    EXPECT_EQ(SerialsOf({u"vfat"_s, {}, {}}, Bytes(100)), Serials{});
    // Hashes stand in stored paths and may never be others; this is a published test vector.
    EXPECT_EQ(SerialsOf({u"ext4"_s, u"FooBar"_s, {}}), Serials{0xBF9CF968});
    EXPECT_EQ(SerialsOf({u"udf"_s, {}, u"ALBUM"_s}), Serials{});
}

TEST(VolumeSerials, OfADiscAreTheSumsOfTheDescriptorInUse) {
    const QString date = u"2024-05-01-12-30-00-00"_s;
    const Serials hash = SerialsOf({u"iso9660"_s, date, u"ALBUM"_s});
    ASSERT_EQ(hash.size(), 1U);
    // 01 'C' 'D' '0' / '0' '1' 01
    EXPECT_EQ(SerialsOf({u"iso9660"_s, date, u"ALBUM"_s}, Disc({})), (Serials{0x31744530, hash.front()}));
    std::string joliet =
        "\x02"
        "CD001\x01" +
        std::string(81, '\0') + "%/E";
    // 02 'C' 'D' '0' / '0' '1' 01, and '%' '/' 'E' at 88
    EXPECT_EQ(SerialsOf({u"iso9660"_s, date, u"ALBUM"_s}, Disc(joliet)).front(), 0x57A38A30U);
    joliet[90] = 'X';  // a supplementary descriptor that is not Joliet's
    EXPECT_EQ(SerialsOf({u"iso9660"_s, date, u"ALBUM"_s}, Disc(joliet)).front(), 0x31744530U);
}

TEST(MountTable, HasDisksInTheirPlacesOnly) {
    const std::vector<MountLine> disks = DisksOf(
        "25 30 0:23 / /proc rw,nosuid shared:12 - proc proc rw\n"
        "30 1 259:2 / / rw,relatime shared:1 - ext4 /dev/nvme0n1p2 rw\n"
        "36 30 7:3 / /snap/core/1 ro - squashfs /dev/loop3 ro\n"
        "40 30 8:17 / /media/u/Alte\\040CD rw shared:3 master:1 - vfat /dev/sdb1 rw,iocharset=utf8\n"
        "41 30 8:17 / /mnt/nochmal rw - vfat /dev/sdb1 rw\n"
        "42 30 8:33 /sub /mnt/teil rw - ext4 /dev/sdc1 rw\n"
        "43 30 0:50 / /mnt/netz rw - nfs4 server:/x rw\n"
        "44 30 11:0 / /mnt/cd ro - iso9660 /dev/sr0 ro\n"
        "45 30 8:49 / /mnt/cd rw - exfat /dev/sdd1 rw\n"
        "unsinn\n");
    QStringList places;
    for (const MountLine& disk : disks)
        places << disk.Source + u' ' + disk.MountPoint;
    EXPECT_EQ(places,
              (QStringList{u"/dev/nvme0n1p2 /"_s, u"/dev/sdb1 /media/u/Alte CD"_s, u"/dev/sdd1 /mnt/cd"_s}));
    EXPECT_EQ(WithoutEscapes("K\\xc3\\xb6ln\\x20\\"), u"Köln \\"_s);
}
