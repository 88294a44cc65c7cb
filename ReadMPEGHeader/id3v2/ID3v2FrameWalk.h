#pragma once

#include <QString>
#include <cstdint>
#include <string_view>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameCoding.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"

// A frame as it stands in the tag.
struct StoredFrame {
    std::string_view Id;
    const QString& ShownId;
    std::uint8_t StatusFlags = 0;  // both as the tag's version has them; 0 in version 2.2
    std::uint8_t FormatFlags = 0;
    FrameCoding Coding{};
    ByteSpan Bytes{};
};

// Takes the frames of one tag in their order. Ids are those of ID3v2.3 and 2.4, four characters; `shownId`
// is the id as it stands in the tag.
class ID3v2FrameSink {
 public:
    virtual ~ID3v2FrameSink() = default;
    // False for a frame whose body need not be read.
    virtual bool NeedsBody(std::string_view id) const = 0;
    virtual void Take(std::string_view id, const QString& shownId, ByteSpan body) = 0;
    // For a frame that cannot be decoded: its size and the reason.
    virtual void TakeUnreadable(const QString& shownId, std::int64_t size, const QString& reason) = 0;
    // Asked first. True when the sink wants no more than the stored bytes; the frame is not decoded then.
    virtual bool TakeStored(const StoredFrame&) { return false; }
    // Told where the walk ended: padding, or what is no frame, stands between two positions of `stream`.
    virtual void TakeRest(ByteSource& /*stream*/, std::int64_t /*begin*/, std::int64_t /*end*/) {}
};

// True for the versions 2.2 to 2.4, whose frames can be told apart.
bool HasKnownFrameLayout(const ID3v2Header& tag);

// Hands the frames between two positions to `sink`, as the tag's version lays them out; nothing of an unknown
// layout. Ends at padding, at the end of the stream and at the first frame that cannot be right. Throws
// EMediumError.
void WalkID3v2Frames(ByteSource& stream, std::int64_t begin, std::int64_t end, const ID3v2Header& tag,
                     ID3v2FrameSink& sink);
