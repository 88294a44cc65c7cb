#include "ReadMPEGHeader/id3v2/ID3v2Position.h"

#include <array>

#include "ReadMPEGHeader/id3v2/ID3v2Header.h"

namespace {

constexpr std::uint8_t kHasFooter = 0x10;
constexpr auto kHeaderSize = static_cast<std::int64_t>(kId3v2HeaderSize);

}  // namespace

std::optional<std::int64_t> EndOfID3v2Tag(ByteSource& file, std::int64_t position) {
    if (position < 0 || file.Size() - position < kHeaderSize) return std::nullopt;
    const auto header = ID3v2Header::Read(file, position);
    if (!header) return std::nullopt;
    const bool hasFooter = header->Version == 4 && (header->Flags & kHasFooter) != 0;
    return position + kHeaderSize + header->Size + (hasFooter ? kHeaderSize : 0);
}

std::optional<std::int64_t> TagOfTrailerBefore(ByteSource& file, std::int64_t end) {
    std::array<std::uint8_t, kTagTrailerSize> trailer{};
    if (end < kTagTrailerSize || file.ReadAt(end - kTagTrailerSize, trailer) != trailer.size() ||
        !StartsWith(trailer, "ID32"))
        return std::nullopt;
    ByteReader reader(trailer);
    reader.Skip(4);
    return reader.U32Le();
}

std::optional<std::int64_t> FindID3v2Tag(ByteSource& file) {
    const auto trailed = TagOfTrailerBefore(file, file.Size());
    if (trailed && EndOfID3v2Tag(file, *trailed)) return trailed;
    if (EndOfID3v2Tag(file, 0)) return 0;
    return std::nullopt;
}
