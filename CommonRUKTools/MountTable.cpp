#include "CommonRUKTools/MountTable.h"

#include <QFile>
#include <algorithm>
#include <optional>

using namespace Qt::StringLiterals;

namespace {

// Bytes that an escape takes up behind its backslash, and the byte that it means.
struct Escape {
    qsizetype Length = 0;
    char Byte = 0;
};

Escape EscapeAt(const QByteArray& text, qsizetype backslash) {
    const bool isHex = text.mid(backslash + 1, 1) == "x";
    const QByteArray digits = text.mid(backslash + (isHex ? 2 : 1), isHex ? 2 : 3);
    bool isNumber = false;
    const int value = digits.toInt(&isNumber, isHex ? 16 : 8);
    if (!isNumber || digits.size() != (isHex ? 2 : 3) || value < 0 || value > 255) return {};
    return {3, static_cast<char>(value)};
}

std::optional<MountLine> ParseLine(const QByteArray& line) {
    constexpr qsizetype kFixedFields = 6;
    const QList<QByteArray> fields = line.split(' ');
    // Optional fields end with a hyphen of its own.
    const qsizetype hyphen = fields.indexOf("-", kFixedFields);
    if (hyphen < 0 || fields.size() < hyphen + 3) return std::nullopt;
    return MountLine{.DeviceNumber = QString::fromLatin1(fields[2]),
                     .Root = WithoutEscapes(fields[3]),
                     .MountPoint = WithoutEscapes(fields[4]),
                     .FileSystem = WithoutEscapes(fields[hyphen + 1]),
                     .Source = WithoutEscapes(fields[hyphen + 2])};
}

// Of Btrfs a subvolume is mounted, never the whole.
bool IsDisk(const MountLine& line) {
    return line.Source.startsWith(u"/dev/"_s) && line.FileSystem != u"squashfs"_s &&
           (line.Root == u"/"_s || line.FileSystem == u"btrfs"_s);
}

}  // namespace

QString WithoutEscapes(const QByteArray& text) {
    QByteArray plain;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const Escape escape = text[i] == '\\' ? EscapeAt(text, i) : Escape();
        plain += escape.Length > 0 ? escape.Byte : text[i];
        i += escape.Length;
    }
    return QFile::decodeName(plain);
}

std::vector<MountLine> DisksOf(const QByteArray& table) {
    std::vector<MountLine> disks;
    for (const QByteArray& text : table.split('\n')) {
        auto line = ParseLine(text);
        if (!line) continue;
        std::erase_if(disks, [&](const MountLine& disk) { return disk.MountPoint == line->MountPoint; });
        const bool isKnown = std::ranges::any_of(
            disks, [&](const MountLine& disk) { return disk.DeviceNumber == line->DeviceNumber; });
        if (IsDisk(*line) && !isKnown) disks.push_back(std::move(*line));
    }
    return disks;
}
