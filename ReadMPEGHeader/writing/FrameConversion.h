#pragma once

#include <cstdint>
#include <vector>

#include "ReadMPEGHeader/writing/TagFrame.h"
#include "ReadMPEGHeader/writing/WritingRules.h"

// The frames of a tag as ID3v2.3 has them, in their order. `version`: of the tag they come from, 2 to 4. What
// 2.3 has no frame for keeps id and bytes. Throws EStreamError for a frame that cannot be decoded and whose
// coding 2.3 does not know.
std::vector<TagFrame> ConvertedTo23(std::vector<TagFrame> frames, std::uint8_t version,
                                    const WritingRules& rules);
