#include "ReadMPEGHeader/writing/TagBytes.h"

#include <limits>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::int64_t kFrameHeaderSize = 10;
constexpr auto kHeaderSize = static_cast<std::int64_t>(kId3v2HeaderSize);
constexpr std::int64_t kLargestSize = (1 << 28) - 1;  // four groups of seven bits

void AppendSynchSafe(ByteWriter& stream, std::int64_t size) {
    for (int shift = 21; shift >= 0; shift -= 7)
        stream.U8(static_cast<std::uint8_t>((size >> shift) & 0x7F));
}

}  // namespace

std::int64_t SizeOfTag(const std::vector<TagFrame>& frames) {
    std::int64_t size = kHeaderSize;
    for (const TagFrame& frame : frames)
        size += kFrameHeaderSize + static_cast<std::int64_t>(frame.Stored.size());
    return size;
}

bool IsPossibleTagSize(std::int64_t size) {
    return size - kHeaderSize <= kLargestSize;
}

void AppendTag(ByteWriter& stream, const std::vector<TagFrame>& frames, std::int64_t size) {
    if (!IsPossibleTagSize(size)) throw EStreamError(u"der ID3v2-Tag wäre größer als 256 MB"_s);
    const std::size_t end = stream.Size() + static_cast<std::size_t>(size);
    stream.Raw("ID3");
    stream.U8(3);  // version 2.3.0
    stream.U8(0);
    stream.U8(0);
    AppendSynchSafe(stream, size - kHeaderSize);
    for (const TagFrame& frame : frames)
        AppendFrame(stream, frame);
    stream.Zeros(end - stream.Size());
}

void AppendTrailer(ByteWriter& stream, std::int64_t position) {
    if (position > std::numeric_limits<std::uint32_t>::max())
        throw EStreamError(u"die Datei ist zu groß für einen Tag hinter der Musik"_s);
    stream.Raw("ID32");
    stream.U32Le(static_cast<std::uint32_t>(position));
}
