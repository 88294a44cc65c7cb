#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"
#include "ReadMPEGHeader/id3v2/ID3v2Frames.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"
#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"

namespace {

constexpr std::uint8_t kFooter = 0x10;  // flag of the tag header

}  // namespace

bool ReadID3v2Modern(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
                     const FrameListener& listener, std::optional<XrukFrame>* xruk) {
    ResetTag(true, tag, 0);
    const auto header = ID3v2Header::Read(stream, position);
    if (!header) return false;
    const std::int64_t firstFrame = position + static_cast<std::int64_t>(kId3v2HeaderSize);
    const std::int64_t lastFrameEnd = firstFrame + header->Size;
    const bool hasFooter = header->Version == 4 && (header->Flags & kFooter) != 0;
    endPosition = lastFrameEnd + (hasFooter ? static_cast<std::int64_t>(kId3v2HeaderSize) : 0);
    if (!HasKnownFrameLayout(*header)) return false;
    ID3v2Frames frames(header->Version == 4 ? TextRules::Id3v24 : TextRules::Id3v23, tag, listener, xruk);
    frames.Fill([&] { WalkID3v2Frames(stream, firstFrame, lastFrameEnd, *header, frames); });
    return true;
}
