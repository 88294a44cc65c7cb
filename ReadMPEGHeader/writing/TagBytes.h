#pragma once

#include <cstdint>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/writing/TagFrame.h"

// Zeros behind the frames of a new leading tag, so that the next one fits into its place.
inline constexpr std::int64_t kTagPadding = 1024;

// Bytes of the tag without padding.
std::int64_t SizeOfTag(const std::vector<TagFrame>& frames);
// Whether an ID3v2 header can say so many bytes, its own ten included.
bool IsPossibleTagSize(std::int64_t size);

// A tag of `size` bytes, the padding included, which the size in its header covers. Throws EStreamError when
// that is more than a header can say.
void AppendTag(ByteWriter& stream, const std::vector<TagFrame>& frames, std::int64_t size);
// The trailer that leads to a tag. Throws EStreamError for a position beyond 4 GiB.
void AppendTrailer(ByteWriter& stream, std::int64_t position);
