#pragma once

#include <cstdint>
#include <optional>

#include "CommonRUKTools/FileSource.h"

struct FoundFrame {
    std::int64_t Position = 0;
    bool Confirmed = false;  // by a VBR header in it or by what stands where it ends
};

// Whether the bytes begin with what may follow the last frame of a file.
bool IsBehindAudio(ByteSpan bytes);

// The first confirmed MPEG frame of the kSearchBytes from `begin` on; without one, the first sync. Throws
// EMediumError.
std::optional<FoundFrame> FindMpegFrame(ByteSource& stream, std::int64_t begin);
