#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/CommentFields.h"
#include "ReadMPEGHeader/writing/TagField.h"
#include "ReadMPEGHeader/writing/TagFrame.h"
#include "ReadMPEGHeader/writing/WritingRules.h"

using FrameLanguage = std::array<std::uint8_t, 3>;

// What the frames of a record are made of.
struct RecordContents {
    const TID3Tag& Record;
    CommentFields Comment{};
    int TrackTotal = 0;        // 0 when unknown
    FrameLanguage Language{};  // of the comment; zeros: none
};

// The frames that hold a field, none where the rules write none.
std::vector<TagFrame> FramesOfField(TagField field, const RecordContents& contents,
                                    const WritingRules& rules);
