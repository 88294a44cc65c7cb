#include "ReadMPEGHeader/mpeg/FrameSearch.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <string_view>

#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/SearchRange.h"
#include "ReadMPEGHeader/mpeg/IsoFrame.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

// A frame and the header of the one behind it.
constexpr std::size_t kLookAhead = std::max(kLargestIsoFrame + 4, kVbrHeaderSpan);

constexpr std::array<std::string_view, 4> kBehindAudio = {"TAG", "APETAGEX", "LYRICSBEGIN", "ID3"};

// True when `bytes` begin with a frame that proves to be one: by a VBR header in it, or by what stands where
// it ends. `bytes` hold what follows it, too, or reach to the end of the file.
bool IsConfirmedFrame(ByteSpan bytes) {
    const auto frame = IsoFrame::Parse(bytes);
    if (!frame) return false;
    if (VbrHeaderIn(bytes)) return true;
    if (frame->Size == 0 || frame->Size > bytes.size()) return false;
    const ByteSpan behind = bytes.subspan(frame->Size);
    if (behind.empty()) return true;  // the file ends with the frame
    const auto next = IsoFrame::Parse(behind);
    return next ? next->Matches(*frame) : IsBehindAudio(behind);
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

}  // namespace

bool IsBehindAudio(ByteSpan bytes) {
    return std::ranges::any_of(kBehindAudio, [bytes](auto mark) { return StartsWith(bytes, mark); });
}

std::optional<FoundFrame> FindMpegFrame(ByteSource& stream, std::int64_t begin) {
    const std::int64_t end = std::min(stream.Size(), begin + kSearchBytes);
    std::optional<FoundFrame> firstSync;
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
            if (!firstSync) firstSync = {found, false};
            if (IsConfirmedFrame(loaded.subspan(at))) return FoundFrame{found, true};
        }
        if (usable == 0) break;  // the file has become shorter
        position += static_cast<std::int64_t>(usable);
    }
    return firstSync;
}
