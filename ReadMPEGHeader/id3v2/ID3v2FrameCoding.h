#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// How the body of a frame is stored.
struct FrameCoding {
    bool Compressed = false;
    bool Encrypted = false;
    bool Grouped = false;
    bool Unsynchronised = false;
    bool HasDataLength = false;

    bool IsPlain() const {
        return !Compressed && !Encrypted && !Grouped && !Unsynchronised && !HasDataLength;
    }
    // From the second flag byte of a frame header; each version has bits of its own.
    static FrameCoding FromFlags23(std::uint8_t flags);
    static FrameCoding FromFlags24(std::uint8_t flags);
};

// Drops the zero behind each 0xFF that keeps a tag from looking like an MPEG frame.
void Resynchronise(std::vector<std::uint8_t>& bytes);

// Undoes the coding of the frames of one tag.
class FrameDecoder {
 public:
    // `version`: 3 or 4, which order the fields before the body differently.
    explicit FrameDecoder(std::uint8_t version) : version_(version) {}

    // The plain body; nothing when it is encrypted, damaged, or would grow beyond what a tag may take.
    std::optional<std::vector<std::uint8_t>> Decode(const FrameCoding& coding, ByteSpan stored);

 private:
    std::optional<std::vector<std::uint8_t>> Inflate(ByteSpan packed, std::size_t length);

    std::uint8_t version_;
    std::size_t inflated_ = 0;  // bytes, of all frames so far
};
