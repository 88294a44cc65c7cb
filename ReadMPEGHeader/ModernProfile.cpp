#include <algorithm>
#include <cstring>
#include <string_view>

#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/SearchRange.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"
#include "ReadMPEGHeader/mpeg/IsoFrame.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

constexpr std::int64_t kTagHeader = static_cast<std::int64_t>(kId3v2HeaderSize);
// Taggers that do not see the tag of another one put theirs in front of it; nobody has met more than a few.
constexpr int kMostStackedTags = 16;
constexpr std::uint8_t kHasFooter = 0x10;

// A frame and the header of the one behind it.
constexpr std::size_t kLookAhead = std::max(kLargestIsoFrame + 4, kVbrHeaderSpan);

// What may follow the last frame of a file.
constexpr std::array<std::string_view, 4> kBehindAudio = {"TAG", "APETAGEX", "LYRICSBEGIN", "ID3"};

// End of the ID3v2 tag at `position`; nothing when none stands there or it reaches beyond the file.
std::optional<std::int64_t> EndOfTag(ByteSource& stream, std::int64_t position) {
    if (stream.Size() - position < kTagHeader) return std::nullopt;
    const auto header = ID3v2Header::Read(stream, position);
    if (!header) return std::nullopt;
    const bool hasFooter = header->Version == 4 && (header->Flags & kHasFooter) != 0;
    const std::int64_t end = position + kTagHeader + header->Size + (hasFooter ? kTagHeader : 0);
    if (end > stream.Size()) return std::nullopt;
    return end;
}

// Gives the tag at the head of the file to `readTag` and returns where the audio may begin: behind it and
// behind all further tags that follow at once.
std::int64_t ReadLeadingTags(ByteSource& stream, const LeadingTagReader& readTag) {
    if (stream.Size() < kTagHeader || !ID3v2Header::Read(stream, 0)) return 0;
    std::int64_t end = std::max(readTag(0), kTagHeader);
    for (int i = 0; i < kMostStackedTags; ++i) {
        const auto next = EndOfTag(stream, end);
        if (!next) break;
        end = *next;
    }
    return end;
}

bool HoldsVbrHeader(ByteSpan frame) {
    if (frame.size() < kVbrHeaderSpan) return false;
    const auto header = MpegHeader::DecodeModern({frame[0], frame[1], frame[2], frame[3]});
    return FindVbrHeaderModern(frame, header).has_value();
}

// True when `bytes` begin with a frame that proves to be one: by a VBR header in it, or by what stands where
// it ends. `bytes` hold what follows it, too, or reach to the end of the file.
bool IsConfirmedFrame(ByteSpan bytes) {
    const auto frame = IsoFrame::Parse(bytes);
    if (!frame) return false;
    if (HoldsVbrHeader(bytes)) return true;
    if (frame->Size == 0 || frame->Size > bytes.size()) return false;
    const ByteSpan behind = bytes.subspan(frame->Size);
    if (behind.empty()) return true;  // the file ends with the frame
    const auto next = IsoFrame::Parse(behind);
    return next ? next->Matches(*frame)
                : std::ranges::any_of(kBehindAudio, [behind](auto mark) { return StartsWith(behind, mark); });
}

// Index of the next pair of bytes that is a sync, `bytes.size()` when there is none.
std::size_t NextSync(ByteSpan bytes, std::size_t from) {
    while (from + 1 < bytes.size()) {
        const void* found = std::memchr(bytes.data() + from, 0xFF, bytes.size() - 1 - from);
        if (found == nullptr) break;
        from = static_cast<std::size_t>(static_cast<const std::uint8_t*>(found) - bytes.data());
        if (IsFrameSync(bytes[from], bytes[from + 1])) return from;
        ++from;
    }
    return bytes.size();
}

// The first confirmed frame of a range; without one, the first sync.
std::optional<std::int64_t> FindConfirmedFrame(ByteSource& stream, std::int64_t begin) {
    const std::int64_t end = std::min(stream.Size(), begin + kSearchBytes);
    std::optional<std::int64_t> firstSync;
    SearchRange range(stream);
    for (std::int64_t position = begin; position < end;) {
        const ByteSpan loaded = range.From(position, kLookAhead);
        const auto loadedEnd = position + static_cast<std::int64_t>(loaded.size());
        // Up to here everything that a confirmation needs is loaded.
        const auto usable = loadedEnd < stream.Size() && loaded.size() >= kLookAhead
                                ? loaded.size() - kLookAhead + 1
                                : loaded.size();
        for (auto at = NextSync(loaded, 0); at < usable; at = NextSync(loaded, at + 1)) {
            const auto found = position + static_cast<std::int64_t>(at);
            if (found >= end) break;
            if (!firstSync) firstSync = found;
            if (IsConfirmedFrame(loaded.subspan(at))) return found;
        }
        if (usable == 0) break;  // the file has become shorter
        position += static_cast<std::int64_t>(usable);
    }
    return firstSync;
}

class Modern : public ReadingProfile {
 public:
    bool ReadTag(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
                 const FrameListener& listener, std::optional<XrukFrame>* xruk) const override {
        return ReadID3v2Modern(stream, position, endPosition, tag, listener, xruk);
    }

    // A tag counts only at the head of the file: "ID3" amid the sound is chance.
    std::optional<std::int64_t> FindFirstFrame(ByteSource& stream,
                                               const LeadingTagReader& readTag) const override {
        return FindConfirmedFrame(stream, ReadLeadingTags(stream, readTag));
    }

    const MpegRules& FrameRules() const override { return kModernMpegRules; }
    AsfLength WmaLength() const override { return AsfLength::LessPreroll; }
};

}  // namespace

const ReadingProfile& ModernProfile() {
    static const Modern profile;
    return profile;
}
