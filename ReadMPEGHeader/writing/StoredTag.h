#pragma once

#include <cstdint>
#include <vector>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/writing/TagFrame.h"

// An ID3v2 tag as it stands in a file.
struct StoredTag {
    std::uint8_t Version = 0;
    std::vector<TagFrame> Frames{};
};

// The frames of the tag whose header stands at `position`, coded ones with what they decode to. Throws
// EStreamError.
StoredTag ReadStoredTag(ByteSource& file, std::int64_t position);

// True when nothing but frames and padding stands in the tag, so that its frames are all there is to it.
bool IsWholeTag(ByteSource& file, std::int64_t position);
