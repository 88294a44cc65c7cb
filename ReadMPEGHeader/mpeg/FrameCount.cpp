#include "ReadMPEGHeader/mpeg/FrameCount.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>

#include "ReadMPEGHeader/SearchRange.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

constexpr std::size_t kHeaderSize = 4;
constexpr std::size_t kLookAhead = kLargestIsoFrame + kHeaderSize;

// What may stand behind the last frame.
constexpr std::array<std::string_view, 6> kBehindAudio = {"TAG", "APETAGEX", "LYRICSBEGIN",
                                                          "ID3", "RIFF",     "3DI"};

bool IsBehindAudio(ByteSpan bytes) {
    return std::ranges::any_of(kBehindAudio, [bytes](auto mark) { return StartsWith(bytes, mark); });
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
        const ByteSpan bytes = Here().first(std::min(Here().size(), frame.Size));
        if (bytes.size() < kVbrHeaderSpan) return;
        const auto header = MpegHeader::DecodeModern({bytes[0], bytes[1], bytes[2], bytes[3]});
        const auto vbr = FindVbrHeaderModern(bytes, header);
        if (!vbr) return;
        count_.Announced = vbr->FrameCount;
        position_ += Length(frame);
    }

    // One frame further; false at the end.
    bool Step() {
        const ByteSpan bytes = Here();
        if (bytes.size() < kHeaderSize || IsBehindAudio(bytes)) return false;
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
            if (bytes.empty() || IsBehindAudio(bytes)) break;
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
