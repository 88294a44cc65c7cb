#include "ReadMPEGHeader/mpeg/VbrHeader.h"

#include <algorithm>

#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

constexpr std::size_t kVbriOffset = 36;
constexpr quint32 kFramesFlag = 1;
constexpr quint32 kBytesFlag = 2;

// Six bytes of side information that are zero in every frame with a VBR header: behind the checksum that a
// protected frame has at 4, and before the earliest place of a VBR header at 13.
constexpr std::size_t kSilentFrom = 6;
constexpr std::size_t kSilentCount = 6;

bool MayHoldVbrHeader(ByteSpan frame) {
    if (frame.size() < kVbrHeaderSpan || !IsFrameSync(frame[0], frame[1])) return false;
    const auto silent = frame.subspan(kSilentFrom, kSilentCount);
    return std::all_of(silent.begin(), silent.end(), [](std::uint8_t byte) { return byte == 0; });
}

// For MPEG 2 and 2.5 mono and stereo are exchanged on purpose: stored collections depend on it.
std::size_t XingOffsetClassic(const MpegHeader& header) {
    if (header.Version == MpegVersion::Mpeg1) return header.IsMono() ? 21 : 36;
    return header.IsMono() ? 21 : 13;
}

// Four bytes of header and the side information: 32 or 17 bytes in MPEG 1, 17 or 9 in MPEG 2.
std::size_t XingOffsetModern(const MpegHeader& header) {
    if (header.Version == MpegVersion::Mpeg1) return header.IsMono() ? 21 : 36;
    return header.IsMono() ? 13 : 21;
}

// `tag` begins with "Xing"; the marker is the lowest byte of the flags, which no real header leaves at 0.
VbrHeader ParseXingClassic(ByteSpan tag) {
    VbrHeader header;
    ByteReader reader(tag);
    reader.Skip(4);
    header.Marker = static_cast<quint8>(reader.U32Be() & 0xFF);
    header.FrameCount = reader.U32Be();
    header.StreamBytes = reader.U32Be();
    return header;
}

// `tag` begins with "Xing" or "Info".
VbrHeader ParseXingModern(ByteSpan tag) {
    VbrHeader header;
    ByteReader reader(tag);
    if (reader.Take(4)[0] == 'I') header.Type = VbrHeader::Kind::Info;
    const quint32 flags = reader.U32Be();
    header.Marker = static_cast<quint8>(flags & 0xFF);
    if ((flags & kFramesFlag) != 0) header.FrameCount = reader.U32Be();
    if ((flags & kBytesFlag) != 0) header.StreamBytes = reader.U32Be();
    return header;
}

// "VBRI", version, delay and quality of two bytes each, then the counts.
std::optional<VbrHeader> ParseVbri(ByteSpan frame) {
    ByteReader reader(frame.subspan(kVbriOffset));
    if (!StartsWith(reader.Rest(), "VBRI")) return std::nullopt;
    VbrHeader header;
    header.Type = VbrHeader::Kind::Vbri;
    reader.Skip(4);
    header.Marker = reader.U8();
    reader.Skip(5);
    header.StreamBytes = reader.U32Be();
    header.FrameCount = reader.U32Be();
    return header;
}

}  // namespace

std::optional<VbrHeader> FindVbrHeaderClassic(ByteSpan frame, const MpegHeader& header) {
    if (!MayHoldVbrHeader(frame)) return std::nullopt;
    const auto tag = frame.subspan(XingOffsetClassic(header));
    if (StartsWith(tag, "Xing")) return ParseXingClassic(tag);
    return ParseVbri(frame);
}

std::optional<VbrHeader> FindVbrHeaderModern(ByteSpan frame, const MpegHeader& header) {
    if (!MayHoldVbrHeader(frame)) return std::nullopt;
    const auto tag = frame.subspan(XingOffsetModern(header));
    const bool isXing = StartsWith(tag, "Xing") || StartsWith(tag, "Info");
    std::optional<VbrHeader> found = isXing ? ParseXingModern(tag) : ParseVbri(frame);
    if (found && found->StreamBytes == 0u) found->StreamBytes.reset();
    return found;
}

std::optional<VbrHeader> VbrHeaderIn(ByteSpan frame) {
    if (frame.size() < kVbrHeaderSpan) return std::nullopt;
    return FindVbrHeaderModern(frame, MpegHeader::DecodeModern({frame[0], frame[1], frame[2], frame[3]}));
}
