#include "CommonRUKTools/VolumeSerials.h"

#include <QStringList>
#include <array>
#include <optional>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kBootSector = 512;
constexpr std::size_t kDescriptor = 2048;
constexpr std::int64_t kFirstDescriptor = 32'768;
constexpr int kMostDescriptors = 32;

// FNV-1a, 32 bits, of the UTF-8 bytes. Serial 0 means no medium.
quint32 HashOf(const QString& text) {
    quint32 hash = 2'166'136'261U;
    for (const char byte : text.toUtf8())
        hash = (hash ^ static_cast<unsigned char>(byte)) * 16'777'619U;
    return hash != 0 ? hash : 1;
}

std::optional<quint32> FromHex(const QString& digits) {
    bool isNumber = false;
    const quint32 number = digits.toUInt(&isNumber, 16);
    return isNumber && digits.size() == 8 ? std::optional(number) : std::nullopt;
}

bool IsFat(const QString& type) {
    return QStringList{u"vfat"_s, u"msdos"_s, u"exfat"_s}.contains(type);
}

// "1A2B-3C4D" of FAT and exFAT; the lower half of the 16 digits of NTFS, also where a helper program has it
// mounted under its own name.
std::optional<quint32> FromUuid(const FileSystemFacts& facts) {
    const QString& uuid = facts.Uuid;
    if (uuid.size() == 9 && uuid[4] == u'-') return FromHex(uuid.left(4) + uuid.mid(5));
    return uuid.size() == 16 && !uuid.contains(u'-') ? FromHex(uuid.right(8)) : std::nullopt;
}

std::vector<std::uint8_t> Read(ByteSource& device, std::int64_t position, std::size_t count) {
    try {
        return device.ReadExactly(position, count);
    } catch (const EStreamError&) {
        return {};  // then it is known by other numbers
    }
}

std::optional<quint32> FromBootSector(ByteSource& device) {
    const auto sector = Read(device, 0, kBootSector);
    const ByteSpan bytes(sector);
    if (bytes.size() != kBootSector || bytes[510] != 0x55 || bytes[511] != 0xAA) return std::nullopt;
    const auto numberAt = [&](std::size_t place) { return ByteReader(bytes.subspan(place)).U32Le(); };
    if (StartsWith(bytes.subspan(3), "NTFS    ")) return numberAt(0x48);
    if (StartsWith(bytes.subspan(3), "EXFAT   ")) return numberAt(0x64);
    if (StartsWith(bytes.subspan(0x52), "FAT32   ")) return numberAt(0x43);
    if (StartsWith(bytes.subspan(0x36), "FAT")) return numberAt(0x27);
    return std::nullopt;
}

bool IsJoliet(ByteSpan descriptor) {
    if (descriptor[0] != 2) return false;
    const ByteSpan escape = descriptor.subspan(88);
    return StartsWith(escape, "%/@") || StartsWith(escape, "%/C") || StartsWith(escape, "%/E");
}

// Four sums of its bytes, each modulo 256, the first in the most significant place.
quint32 SumOf(ByteSpan descriptor) {
    std::array<std::uint8_t, 4> sums{};
    for (std::size_t i = 0; i < descriptor.size(); ++i)
        sums[i % 4] = static_cast<std::uint8_t>(sums[i % 4] + descriptor[i]);
    return ByteReader(sums).U32Be();
}

// Of the descriptor in use: Joliet's where there is one, else the primary.
std::optional<quint32> FromDescriptors(ByteSource& device) {
    constexpr std::uint8_t kPrimary = 1;
    constexpr std::uint8_t kLast = 255;
    std::optional<quint32> sum;
    for (int i = 0; i < kMostDescriptors; ++i) {
        const auto sector =
            Read(device, kFirstDescriptor + i * static_cast<std::int64_t>(kDescriptor), kDescriptor);
        const ByteSpan descriptor(sector);
        if (descriptor.empty() || !StartsWith(descriptor.subspan(1), "CD001") || descriptor[0] == kLast)
            return sum;
        if (IsJoliet(descriptor)) return SumOf(descriptor);
        if (descriptor[0] == kPrimary && !sum) sum = SumOf(descriptor);
    }
    return sum;
}

std::vector<quint32> SerialsOfDisc(const FileSystemFacts& facts, ByteSource* device) {
    std::vector<quint32> serials;
    const auto computed = device != nullptr ? FromDescriptors(*device) : std::nullopt;
    if (computed && *computed != 0) serials.push_back(*computed);
    // Its UUID is only a date, which two discs may share.
    if (!facts.Uuid.isEmpty()) serials.push_back(HashOf(facts.Uuid + u'\n' + facts.Label));
    return serials;
}

}  // namespace

std::vector<quint32> VolumeSerialsOf(const FileSystemFacts& facts, ByteSource* device) {
    if (facts.Type == u"iso9660"_s) return SerialsOfDisc(facts, device);
    const bool hasNumber =
        IsFat(facts.Type) || facts.Type.startsWith(u"ntfs"_s) || facts.Type == u"fuseblk"_s;
    if (hasNumber) {
        auto number = FromUuid(facts);
        if (!number && device != nullptr) number = FromBootSector(*device);
        if (number && *number != 0) return {*number};
    }
    return facts.Uuid.isEmpty() ? std::vector<quint32>() : std::vector<quint32>{HashOf(facts.Uuid.toLower())};
}
