#pragma once

#include <optional>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/CommentFields.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/writing/TagField.h"
#include "ReadMPEGHeader/writing/TagFrame.h"

// What our own reader makes of frames.
struct TagReading {
    TID3Tag Record{};
    CommentFields Comment{};
    std::optional<TID3Tag> Own{};  // what "XRUK" holds
    int TrackTotal = 0;            // 0 when unknown, or the track lies above it
    std::vector<bool> Folded{};    // for each frame: it is part of the comment as it is shown
};

TagReading ReadTagFrames(const std::vector<TagFrame>& frames, TextRules rules);

// True when both say the same of a field.
bool SayTheSame(TagField field, const TagReading& one, const TagReading& other);

// The total of a "TRCK" text ("3/12"); 0 when it has none.
int TrackTotalOf(const QString& text);
