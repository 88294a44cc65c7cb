#include "ReadMPEGHeader/mpeg/FrameCount.h"

#include <algorithm>
#include <optional>

#include "ReadMPEGHeader/SearchRange.h"
#include "ReadMPEGHeader/mpeg/FrameSearch.h"
#include "ReadMPEGHeader/mpeg/VbrHeader.h"

namespace {

constexpr std::size_t kHeaderSize = 4;
constexpr std::size_t kLookAhead = kLargestIsoFrame + kHeaderSize;

// Beside the tags: they end a stream that is known to be one, but are no proof of a frame before them.
bool EndsStream(ByteSpan bytes) {
    return IsBehindAudio(bytes) || StartsWith(bytes, "RIFF") || StartsWith(bytes, "3DI");
}

std::optional<IsoFrame> FollowableFrame(ByteSpan bytes) {
    auto frame = IsoFrame::Parse(bytes);
    if (frame && frame->Size == 0) frame.reset();
    return frame;
}

class FrameWalk {
 public:
    FrameWalk(ByteSource& stream, std::int64_t begin) : stream_(stream), range_(stream), position_(begin) {}

    FrameCount Run() {
        const auto first = FollowableFrame(Here());
        if (!first) return count_;
        count_.First = *first;
        ReadVbrHeader(*first);
        while (Step()) {
        }
        return count_;
    }

 private:
    static std::int64_t Length(const IsoFrame& frame) { return static_cast<std::int64_t>(frame.Size); }
    ByteSpan Here() { return range_.From(position_, kLookAhead); }

    // The frame that holds one has no sound.
    void ReadVbrHeader(const IsoFrame& frame) {
        const ByteSpan bytes = Here();
        const auto vbr = VbrHeaderIn(bytes.first(std::min(bytes.size(), frame.Size)));
        if (!vbr) return;
        count_.Announced = vbr->FrameCount;
        position_ += Length(frame);
    }

    // One frame further; false at the end.
    bool Step() {
        const ByteSpan bytes = Here();
        if (bytes.size() < kHeaderSize || EndsStream(bytes)) return false;
        const auto frame = FollowableFrame(bytes);
        if (!frame || !frame->Matches(count_.First)) return SkipToNextFrame();
        if (frame->Size > bytes.size()) return false;  // cut off, as the last frame of many files is
        ++count_.Frames;
        count_.Bytes += Length(*frame);
        count_.Samples += frame->Coefficient * 8;
        position_ += Length(*frame);
        return true;
    }

    // To the next frame that another one follows. What stands between counts as damage, unless no frame
    // comes any more and it is filled with zeros.
    bool SkipToNextFrame() {
        std::int64_t skipped = 0;
        bool isPadding = true;
        for (; position_ < stream_.Size(); ++position_, ++skipped) {
            const ByteSpan bytes = Here();
            if (bytes.empty() || EndsStream(bytes)) break;
            if (IsConfirmed(bytes)) {
                count_.Skipped += skipped;
                return true;
            }
            isPadding = isPadding && bytes[0] == 0;
        }
        if (!isPadding) count_.Skipped += skipped;
        return false;
    }

    bool IsConfirmed(ByteSpan bytes) const {
        const auto frame = FollowableFrame(bytes);
        if (!frame || !frame->Matches(count_.First) || frame->Size > bytes.size()) return false;
        const auto next = FollowableFrame(bytes.subspan(frame->Size));
        return next && next->Matches(count_.First);
    }

    ByteSource& stream_;
    SearchRange range_;
    std::int64_t position_;
    FrameCount count_;
};

}  // namespace

std::int64_t FrameCount::Seconds() const {
    return Frames == 0 ? 0 : Samples / First.SampleRate();
}

std::int64_t FrameCount::BitRate() const {
    if (Samples == 0) return 0;
    const std::int64_t bitsPerSecond = Bytes * 8 * First.SampleRate() / Samples;
    return (bitsPerSecond + 500) / 1000;
}

FrameCount CountMpegFrames(ByteSource& stream, std::int64_t begin) {
    return FrameWalk(stream, begin).Run();
}
