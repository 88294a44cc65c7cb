#pragma once

#include <cstdint>
#include <optional>

#include "CommonRUKTools/FileSource.h"

inline constexpr std::size_t kId3v2HeaderSize = 10;

// The ten bytes at the head of an ID3v2 tag.
struct ID3v2Header {
    std::uint8_t Version = 0;  // 2, 3 or 4 in "ID3v2.x"
    std::uint8_t Revision = 0;
    std::uint8_t Flags = 0;
    std::uint32_t Size = 0;  // bytes behind the header, at most 2^28 - 1

    // Nothing when no "ID3" stands at `position`. Throws EStreamError when fewer than ten bytes follow.
    static std::optional<ID3v2Header> Read(ByteSource& stream, std::int64_t position);
};
