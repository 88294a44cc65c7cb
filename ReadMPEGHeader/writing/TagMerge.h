#pragma once

#include <optional>
#include <vector>

#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/writing/StoredTag.h"
#include "ReadMPEGHeader/writing/TagFrame.h"

// The frames of the ID3v2.3 tag that takes the place of `tags`, of which our reader reads the first.
// `asRead`: what it made of the whole file. Nothing when that tag says already what the edit asks for. Throws
// EStreamError when a frame cannot be converted.
std::optional<std::vector<TagFrame>> MergedFrames(std::vector<StoredTag> tags, const TagEdit& edit,
                                                  const TID3Tag& asRead, ReadProfile profile);
