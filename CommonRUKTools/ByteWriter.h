#pragma once

#include <bit>
#include <cstdint>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// Builds a structure of a file format field by field.
class ByteWriter {
 public:
    const std::vector<std::uint8_t>& Bytes() const { return bytes_; }
    std::size_t Size() const { return bytes_.size(); }
    void Clear() { bytes_.clear(); }

    void U8(std::uint8_t value) { bytes_.push_back(value); }
    void U16Le(std::uint16_t value) { Little(value, 2); }
    void U32Le(std::uint32_t value) { Little(value, 4); }
    void U64Le(std::uint64_t value) { Little(value, 8); }
    void F64Le(double value) { Little(std::bit_cast<std::uint64_t>(value), 8); }
    void U16Be(std::uint16_t value) { Big(value, 2); }
    void U32Be(std::uint32_t value) { Big(value, 4); }
    void Raw(ByteSpan bytes) { bytes_.insert(bytes_.end(), bytes.begin(), bytes.end()); }
    void Raw(std::string_view text) { Raw(AsBytes(text)); }
    void Zeros(std::size_t count) { bytes_.resize(bytes_.size() + count); }

    // A block of fixed size: the text, cut to it, and zeros behind.
    void Block(std::string_view text, std::size_t size) {
        const std::size_t end = bytes_.size() + size;
        Raw(text.substr(0, size));
        bytes_.resize(end);
    }

 private:
    void Little(std::uint64_t value, int count) {
        for (int i = 0; i < count; ++i)
            U8(static_cast<std::uint8_t>(value >> (8 * i)));
    }
    void Big(std::uint64_t value, int count) {
        for (int i = count - 1; i >= 0; --i)
            U8(static_cast<std::uint8_t>(value >> (8 * i)));
    }

    std::vector<std::uint8_t> bytes_;
};
