#pragma once

#include <array>
#include <cstdint>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/AudioFile.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"
#include "tests/ReadMPEGHeader/Id3v2Builder.h"

using Bytes = std::vector<std::uint8_t>;

// A kind of MPEG frame: its header and the bytes that it takes with it.
struct FrameKind {
    std::array<std::uint8_t, 4> Header;
    std::size_t Size;
};

inline constexpr FrameKind kStereo128 = {{0xFF, 0xFB, 0x90, 0x64}, 417};  // MPEG 1 Layer III, 44100 Hz
inline constexpr FrameKind kMono64 = {{0xFF, 0xFB, 0x50, 0xC4}, 208};
inline constexpr FrameKind kLsfStereo64 = {{0xFF, 0xF3, 0x80, 0x04}, 208};  // MPEG 2 Layer III, 22050 Hz
inline constexpr FrameKind kLsfMono64 = {{0xFF, 0xF3, 0x80, 0xC4}, 208};

// A tag with the two texts without which it does not count.
inline Id3v2Builder TitledTag(std::string_view title, std::string_view artist, std::uint8_t version = 3) {
    return Id3v2Builder(version).Text("TIT2", title).Text("TPE1", artist);
}

inline Bytes Id3v1Bytes(std::string_view title, std::string_view artist, std::string_view album,
                        std::string_view year, std::string_view comment, std::uint8_t genre) {
    ByteWriter bytes;
    bytes.Raw("TAG");
    bytes.Block(title, 30);
    bytes.Block(artist, 30);
    bytes.Block(album, 30);
    bytes.Block(year, 4);
    bytes.Block(comment, 30);
    bytes.U8(genre);
    return bytes.Bytes();
}

// Builds a sound file piece by piece.
class Mp3Builder {
 public:
    const Bytes& Data() const { return file_.Bytes(); }
    std::size_t Size() const { return file_.Size(); }

    Mp3Builder& Raw(ByteSpan bytes) {
        file_.Raw(bytes);
        return *this;
    }
    Mp3Builder& Zeros(std::size_t count) {
        file_.Zeros(count);
        return *this;
    }
    Mp3Builder& ZerosUpTo(std::size_t size) { return Zeros(size - file_.Size()); }
    // Bytes that hold no sync and no "ID3".
    Mp3Builder& Noise(std::size_t count) {
        for (std::size_t i = 0; i < count; ++i)
            file_.U8(static_cast<std::uint8_t>(1 + i % 64));
        return *this;
    }
    Mp3Builder& Frames(std::size_t count, const FrameKind& kind = kStereo128) {
        for (std::size_t i = 0; i < count; ++i) {
            Raw(kind.Header);
            Noise(kind.Size - kind.Header.size());
        }
        return *this;
    }
    // A silent frame with `text` and big-endian numbers of 32 bits behind it at `offset`.
    Mp3Builder& FrameWith(const FrameKind& kind, std::size_t offset, std::string_view text,
                          std::initializer_list<std::uint32_t> numbers) {
        const auto end = file_.Size() + kind.Size;
        Raw(kind.Header).Zeros(offset - kind.Header.size());
        file_.Raw(text);
        for (const auto number : numbers)
            file_.U32Be(number);
        return ZerosUpTo(end);
    }
    Mp3Builder& Id3v1(std::string_view title, std::string_view artist, std::uint8_t genre = 255) {
        return Raw(Id3v1Bytes(title, artist, "", "1999", "", genre));
    }
    // A tag behind the audio and the mark that leads to it.
    Mp3Builder& TrailingTag(ByteSpan tag) {
        const auto position = static_cast<std::uint32_t>(file_.Size());
        return Raw(tag).Trailer(position);
    }
    Mp3Builder& Trailer(std::uint32_t position) {
        file_.Raw("ID32");
        file_.U32Le(position);
        return *this;
    }

 private:
    ByteWriter file_;
};

// Builds a WAV file chunk by chunk.
class WaveBuilder {
 public:
    WaveBuilder() { Chunk("RIFF", 0).file_.Raw("WAVE"); }

    WaveBuilder& Chunk(std::string_view id, std::uint32_t size) {
        file_.Raw(id);
        file_.U32Le(size);
        return *this;
    }
    WaveBuilder& Format(std::uint16_t channels = 2, std::uint32_t rate = 44100, std::uint16_t extra = 0) {
        Chunk("fmt ", 16u + extra);
        file_.U16Le(extra > 0 ? 0xFFFE : 1);
        file_.U16Le(channels);
        file_.U32Le(rate);
        file_.U32Le(rate * channels * 2);
        file_.U16Le(static_cast<std::uint16_t>(channels * 2));
        file_.U16Le(16);
        file_.Zeros(extra);
        return *this;
    }
    WaveBuilder& Zeros(std::size_t count) {
        file_.Zeros(count);
        return *this;
    }
    const Bytes& Data() const { return file_.Bytes(); }

 private:
    ByteWriter file_;
};

// What the first frame of a file tells.
struct FrameAnalysis {
    TID3Tag Tag;
    MpegResults Results;
};

inline FrameAnalysis AnalyseFirstFrame(const Mp3Builder& file, const MpegRules& rules = kClassicMpegRules) {
    MemorySource source(file.Data());
    FrameAnalysis analysis;
    analysis.Results = AnalyseMpegFrame(source, 0, rules, analysis.Tag);
    return analysis;
}

inline ReadOptions InProfile(ReadProfile profile) {
    ReadOptions options;
    options.Profile = profile;
    options.FileTime = 1;
    return options;
}

inline SongReading ReadingOf(ByteSpan bytes, ReadProfile profile = ReadProfile::Classic,
                             const QString& path = QStringLiteral("/music/Folder/name.mp3")) {
    MemorySource source(bytes);
    return ReadSong(source, path, InProfile(profile));
}

inline TID3Tag Read(ByteSpan bytes, const ReadOptions& options = InProfile(ReadProfile::Classic),
                    const QString& path = QStringLiteral("/music/Folder/name.mp3")) {
    MemorySource source(bytes);
    return ReadSong(source, path, options).Tag;
}

inline TID3Tag ReadModern(ByteSpan bytes) {
    return Read(bytes, InProfile(ReadProfile::Modern));
}
