#pragma once

#include <QStringList>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteReader.h"
#include "ReadMPEGHeader/writing/WritingRules.h"

// The body of a frame of ID3v2.2 or 2.4 with its texts as 2.3 knows them: encodings 2 and 3 become 0 or 1,
// of several values "/" makes one. Nothing when there is nothing to change, or the frame has no texts, or is
// damaged.
std::optional<std::vector<std::uint8_t>> BodyWithTexts23(std::string_view id, ByteSpan body,
                                                         const WritingRules& rules);

// The values of a text frame of ID3v2.4, empty ones included.
QStringList TextValues(ByteSpan body);
