#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"

// Puts an ID3v2 tag together frame by frame; sizes are written as the version wants them.
class Id3v2Builder {
 public:
    explicit Id3v2Builder(std::uint8_t version = 3, std::uint8_t flags = 0)
        : version_(version), flags_(flags) {}

    Id3v2Builder& Frame(std::string_view id, std::string_view body, std::uint8_t flags = 0) {
        const auto size = static_cast<std::uint32_t>(body.size());
        return SizedFrame(id, version_ == 4 ? SynchSafe(size) : size, body, flags);
    }
    // The number as given, whatever the body is.
    Id3v2Builder& SizedFrame(std::string_view id, std::uint32_t size, std::string_view body,
                             std::uint8_t flags = 0) {
        content_.Raw(id);
        if (version_ > 2) {
            content_.U32Be(size);
            content_.U8(0);
            content_.U8(flags);
        } else {
            content_.U8(static_cast<std::uint8_t>(size >> 16));
            content_.U16Be(static_cast<std::uint16_t>(size));
        }
        content_.Raw(body);
        return *this;
    }
    // Single-byte text.
    Id3v2Builder& Text(std::string_view id, std::string_view text) {
        return Frame(id, std::string(1, '\0') + std::string(text));
    }
    Id3v2Builder& Raw(std::string_view bytes) {
        content_.Raw(bytes);
        return *this;
    }
    Id3v2Builder& Padding(std::size_t count) {
        content_.Zeros(count);
        return *this;
    }
    // A zero behind each 0xFF of all that was added so far.
    Id3v2Builder& Unsynchronise() {
        ByteWriter spread;
        for (const std::uint8_t byte : content_.Bytes()) {
            spread.U8(byte);
            if (byte == 0xFF) spread.U8(0);
        }
        content_ = spread;
        return *this;
    }

    std::vector<std::uint8_t> Build() const {
        ByteWriter tag;
        tag.Raw("ID3");
        tag.U8(version_);
        tag.U8(0);
        tag.U8(flags_);
        tag.U32Be(SynchSafe(static_cast<std::uint32_t>(content_.Size())));
        tag.Raw(content_.Bytes());
        return tag.Bytes();
    }

    static std::uint32_t SynchSafe(std::uint32_t size) {
        return (size & 0x7F) | (size & 0x3F80) << 1 | (size & 0x1FC000) << 2 | (size & 0xFE00000) << 3;
    }

 private:
    std::uint8_t version_;
    std::uint8_t flags_;
    ByteWriter content_;
};

using Id3v2ReadFunction = decltype(ReadID3v2);

// What reading one tag gave.
struct Id3v2Outcome {
    bool Read = false;
    bool Threw = false;
    std::int64_t End = -1;
    TID3Tag Tag;
    std::optional<XrukFrame> Xruk;
    std::vector<FrameReport> Reports;
};

Id3v2Outcome ReadWith(Id3v2ReadFunction& read, ByteSpan bytes, std::int64_t position = 0);

// The body of the program's own frame, for what it keeps of a record.
std::string XrukBody(const TID3Tag& tag);
// Nothing but the format text "Wave".
TID3Tag WaveRecord();
