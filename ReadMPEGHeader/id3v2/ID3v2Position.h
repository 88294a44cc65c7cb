#pragma once

#include <cstdint>
#include <optional>

#include "CommonRUKTools/FileSource.h"

// Where ID3v2 tags stand. All of these throw EMediumError only.

// "ID32" and the position of a tag behind the sound, as an unsigned little-endian number.
inline constexpr std::int64_t kTagTrailerSize = 8;

// The first byte behind the tag at `position`, its footer included, which may lie beyond the file; nothing
// when no tag stands there.
std::optional<std::int64_t> EndOfID3v2Tag(ByteSource& file, std::int64_t position);
// What the trailer that ends at `end` says; nothing when none does.
std::optional<std::int64_t> TagOfTrailerBefore(ByteSource& file, std::int64_t end);
// The tag that the readers take: the one that a trailer at the end of the file leads to, else the one at its
// head.
std::optional<std::int64_t> FindID3v2Tag(ByteSource& file);
