#include "ReadMPEGHeader/id3v2/ID3v2FrameCoding.h"

#include <QByteArray>
#include <algorithm>

#include "CommonRUKTools/ByteWriter.h"

namespace {

// The decompressor grows its result until the data end, whatever length was announced. Data shrink to no less
// than 1/1032, so these limits hold the memory of one frame below 70 MB and the work for a tag in
// proportion; compressed frames are texts, which need far less.
constexpr std::size_t kMostPacked = 64 * 1024;
constexpr std::size_t kMostInflated = 16 * 1024 * 1024;

}  // namespace

FrameCoding FrameCoding::FromFlags23(std::uint8_t flags) {
    FrameCoding coding;
    coding.Compressed = (flags & 0x80) != 0;
    coding.Encrypted = (flags & 0x40) != 0;
    coding.Grouped = (flags & 0x20) != 0;
    coding.HasDataLength = coding.Compressed;
    return coding;
}

FrameCoding FrameCoding::FromFlags24(std::uint8_t flags) {
    FrameCoding coding;
    coding.Grouped = (flags & 0x40) != 0;
    coding.Compressed = (flags & 0x08) != 0;
    coding.Encrypted = (flags & 0x04) != 0;
    coding.Unsynchronised = (flags & 0x02) != 0;
    coding.HasDataLength = (flags & 0x01) != 0;
    return coding;
}

void Resynchronise(std::vector<std::uint8_t>& bytes) {
    auto out = bytes.begin();
    bool afterMark = false;
    for (const std::uint8_t byte : bytes) {
        if (!(afterMark && byte == 0)) *out++ = byte;
        afterMark = byte == 0xFF;
    }
    bytes.erase(out, bytes.end());
}

std::optional<std::vector<std::uint8_t>> FrameDecoder::Decode(const FrameCoding& coding, ByteSpan stored) {
    if (coding.Encrypted) return std::nullopt;
    ByteReader reader(stored);
    std::size_t length = 0;
    if (version_ == 4 && coding.Grouped) reader.Skip(1);
    if (coding.HasDataLength) length = version_ == 4 ? reader.SynchSafe32() : reader.U32Be();
    if (version_ == 3 && coding.Grouped) reader.Skip(1);
    if (reader.Failed()) return std::nullopt;
    std::vector<std::uint8_t> body(reader.Rest().begin(), reader.Rest().end());
    if (coding.Unsynchronised) Resynchronise(body);
    return coding.Compressed ? Inflate(body, length) : body;
}

std::optional<std::vector<std::uint8_t>> FrameDecoder::Inflate(ByteSpan packed, std::size_t length) {
    if (packed.size() > kMostPacked || length > kMostInflated - std::min(inflated_, kMostInflated))
        return std::nullopt;
    ByteWriter input;
    input.U32Be(static_cast<std::uint32_t>(length));
    input.Raw(packed);
    const QByteArray body = qUncompress(input.Bytes().data(), static_cast<qsizetype>(input.Size()));
    const auto bytes = AsBytes({body.constData(), static_cast<std::size_t>(body.size())});
    inflated_ += bytes.size();
    if (bytes.empty() || bytes.size() != length) return std::nullopt;
    return std::vector<std::uint8_t>(bytes.begin(), bytes.end());
}
