#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>
#include <string_view>

using ByteSpan = std::span<const std::uint8_t>;

// A cursor over bytes in memory. No read leaves the range: a read beyond the end gives zeros, moves the
// cursor to the end and sets Failed(), so that a parser can read a whole structure and ask once.
class ByteReader {
 public:
    explicit ByteReader(ByteSpan bytes) : bytes_(bytes) {}

    bool Failed() const { return failed_; }
    bool AtEnd() const { return position_ >= bytes_.size(); }
    std::size_t Position() const { return position_; }
    std::size_t Remaining() const { return bytes_.size() - position_; }
    ByteSpan Rest() const { return bytes_.subspan(position_); }

    // Moves to an absolute offset; beyond the end it fails.
    void Seek(std::size_t position) {
        if (position > bytes_.size()) return Fail();
        position_ = position;
    }
    void Skip(std::size_t count) { Take(count); }

    std::uint8_t U8() {
        const auto bytes = Take(1);
        return bytes.empty() ? std::uint8_t{0} : bytes[0];
    }
    std::uint16_t U16Le() { return static_cast<std::uint16_t>(Little(2)); }
    std::uint32_t U32Le() { return static_cast<std::uint32_t>(Little(4)); }
    std::uint64_t U64Le() { return Little(8); }
    std::uint16_t U16Be() { return static_cast<std::uint16_t>(Big(2)); }
    std::uint32_t U24Be() { return static_cast<std::uint32_t>(Big(3)); }
    std::uint32_t U32Be() { return static_cast<std::uint32_t>(Big(4)); }
    double F64Le() { return std::bit_cast<double>(Little(8)); }

    // Four groups of 7 bits, most significant first (the size fields of ID3v2). Bit 7 of each byte is
    // ignored.
    std::uint32_t SynchSafe32() {
        std::uint32_t value = 0;
        for (int i = 0; i < 4; ++i)
            value = (value << 7) | (U8() & 0x7Fu);
        return value;
    }

    // The next `count` bytes; empty, and Failed(), when fewer are left.
    ByteSpan Take(std::size_t count) {
        if (count > Remaining()) {
            Fail();
            return {};
        }
        const auto taken = bytes_.subspan(position_, count);
        position_ += count;
        return taken;
    }

 private:
    std::uint64_t Little(std::size_t count) {
        const auto bytes = Take(count);
        std::uint64_t value = 0;
        for (std::size_t i = bytes.size(); i > 0; --i)
            value = (value << 8) | bytes[i - 1];
        return value;
    }
    std::uint64_t Big(std::size_t count) {
        std::uint64_t value = 0;
        for (const std::uint8_t byte : Take(count))
            value = (value << 8) | byte;
        return value;
    }
    void Fail() {
        position_ = bytes_.size();
        failed_ = true;
    }

    ByteSpan bytes_;
    std::size_t position_ = 0;
    bool failed_ = false;
};

// True when `bytes` begin with the characters of `text`.
inline bool StartsWith(ByteSpan bytes, std::string_view text) {
    return bytes.size() >= text.size() && std::memcmp(bytes.data(), text.data(), text.size()) == 0;
}

inline std::string_view AsText(ByteSpan bytes) {
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

inline ByteSpan AsBytes(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}
