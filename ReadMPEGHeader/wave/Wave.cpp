#include "ReadMPEGHeader/wave/Wave.h"

#include <algorithm>
#include <array>

#include "ReadMPEGHeader/FieldValues.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::int64_t kFirstChunk = 12;  // behind "RIFF", size and "WAVE"
constexpr std::int64_t kChunkHeader = 8;
constexpr std::size_t kFormatSize = 14;  // up to the block alignment; every format begins with these
// No writer makes so many; a file of empty chunks would be walked for minutes.
constexpr int kMostChunks = 1000;

struct Chunk {
    std::array<std::uint8_t, 4> Id{};
    std::int64_t Body = 0;  // position
    std::int64_t Size = 0;  // as it stands in the header

    bool Is(std::string_view id) const { return StartsWith(Id, id); }
    std::int64_t Next() const { return Body + Size + (Size & 1); }
};

std::optional<Chunk> ReadChunk(ByteSource& stream, std::int64_t position) {
    std::array<std::uint8_t, kChunkHeader> bytes{};
    if (stream.ReadAt(position, bytes) != bytes.size()) return std::nullopt;
    Chunk chunk;
    std::copy_n(bytes.begin(), chunk.Id.size(), chunk.Id.begin());
    ByteReader reader(bytes);
    reader.Skip(chunk.Id.size());
    chunk.Size = reader.U32Le();
    chunk.Body = position + kChunkHeader;
    return chunk;
}

bool IsPlausible(const Chunk& chunk, std::int64_t fileSize) {
    const bool named =
        std::all_of(chunk.Id.begin(), chunk.Id.end(), [](auto byte) { return byte >= 0x20 && byte < 0x7F; });
    return named && chunk.Body + chunk.Size <= fileSize;
}

// A recorder that was cut off leaves size 0 or 0xFFFFFFFF: then the sound reaches to the end of the file.
std::int64_t SoundBytes(ByteSource& stream, const Chunk& data) {
    const std::int64_t left = stream.Size() - data.Body;
    if (data.Size > 0) return std::min(data.Size, left);
    const auto next = ReadChunk(stream, data.Body);
    return next && IsPlausible(*next, stream.Size()) ? 0 : left;
}

bool ReadFormat(ByteSource& stream, const Chunk& chunk, WaveInfo& info) {
    std::array<std::uint8_t, kFormatSize> bytes{};
    if (chunk.Size < static_cast<std::int64_t>(bytes.size()) ||
        stream.ReadAt(chunk.Body, bytes) != bytes.size())
        return false;
    ByteReader reader(bytes);
    reader.Skip(2);  // coding
    info.Channels = reader.U16Le();
    info.SampleRate = reader.U32Le();
    info.ByteRate = reader.U32Le();
    info.BlockAlign = reader.U16Le();
    return true;
}

bool IsWave(ByteSource& stream) {
    std::array<std::uint8_t, kFirstChunk> head{};
    return stream.ReadAt(0, head) == head.size() && StartsWith(head, "RIFF") &&
           StartsWith(ByteSpan(head).subspan(8), "WAVE");
}

}  // namespace

std::optional<WaveInfo> ReadWaveHeader(ByteSource& stream) {
    if (!IsWave(stream)) return std::nullopt;
    WaveInfo info;
    bool hasFormat = false;
    bool hasData = false;
    std::int64_t position = kFirstChunk;
    for (int i = 0; i < kMostChunks && !(hasFormat && hasData); ++i) {
        const auto chunk = ReadChunk(stream, position);
        if (!chunk) break;
        if (!hasFormat && chunk->Is("fmt ")) hasFormat = ReadFormat(stream, *chunk, info);
        if (!hasData && chunk->Is("data")) {
            info.DataBytes = SoundBytes(stream, *chunk);
            hasData = true;
        }
        position = chunk->Next();
    }
    if (!hasFormat) return std::nullopt;
    return info;
}

TID3Tag TagFromWave(const WaveInfo& info, double fileTime) {
    TID3Tag tag;
    ResetTag(false, tag, fileTime);
    tag.MPEGLayer = u"Wave"_s;
    if (info.ByteRate > 0) tag.Length = Saturated<quint16>(info.DataBytes / info.ByteRate);
    tag.BitRate = Saturated<quint16>(std::int64_t{info.ByteRate} * 8 / 1000);
    tag.SampleRate = Saturated<quint16>(info.SampleRate);
    tag.ChannelMode = ChannelModeByCount(info.Channels);
    tag.Emphasis = 1;
    tag.FrameSize = info.BlockAlign;
    return tag;
}
