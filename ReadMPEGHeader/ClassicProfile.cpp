#include <algorithm>
#include <array>

#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/SearchRange.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

// The head is examined in whole blocks; the first sync of a block is found before a tag in it.
constexpr std::int64_t kBlock = 32;
// Bytes of the block before that are looked at again, for a sync or "ID3" across the border.
constexpr std::int64_t kOverlap = 2;

// A block with the end of the one before it. What lies in front of the skip position is zero.
class Block {
 public:
    // Positions are those of the file.
    void Load(ByteSpan bytes, std::int64_t start, std::int64_t skip) {
        std::copy_n(bytes_.end() - kOverlap, kOverlap, bytes_.begin());
        std::copy_n(bytes.begin(), kBlock, bytes_.begin() + kOverlap);
        first_ = start - kOverlap;
        const auto hidden = std::clamp<std::int64_t>(skip - first_, 0, kBlock + kOverlap);
        std::fill_n(bytes_.begin(), hidden, std::uint8_t{0});
    }

    std::optional<std::int64_t> FindSync() const {
        for (std::size_t i = 1; i + 1 < bytes_.size(); ++i)
            if (IsFrameSync(bytes_[i], bytes_[i + 1])) return first_ + static_cast<std::int64_t>(i);
        return std::nullopt;
    }

    std::optional<std::int64_t> FindTag() const {
        for (std::size_t i = 0; i + 2 < bytes_.size(); ++i)
            if (StartsWith(ByteSpan(bytes_).subspan(i), "ID3")) return first_ + static_cast<std::int64_t>(i);
        return std::nullopt;
    }

 private:
    std::array<std::uint8_t, kOverlap + kBlock> bytes_{};
    std::int64_t first_ = 0;
};

class Classic : public ReadingProfile {
 public:
    bool ReadTag(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
                 const FrameListener& listener, std::optional<XrukFrame>* xruk) const override {
        return ReadID3v2(stream, position, endPosition, tag, listener, xruk);
    }

    std::optional<std::int64_t> FindFirstFrame(ByteSource& stream,
                                               const LeadingTagReader& readTag) const override {
        const std::int64_t end = std::min(stream.Size(), kSearchBytes);
        SearchRange range(stream);
        Block block;
        std::int64_t skip = 0;
        bool tagRead = false;
        // A block that lies wholly in front of the skip position is not read.
        for (std::int64_t start = 0; start + kBlock <= end;
             start = std::max(start + kBlock, skip / kBlock * kBlock)) {
            const auto bytes = range.From(start, kBlock);
            if (bytes.size() < kBlock) break;  // the file has become shorter
            block.Load(bytes, start, skip);
            if (const auto sync = block.FindSync()) return sync;
            if (tagRead) continue;
            if (const auto tag = block.FindTag()) {
                skip = readTag(*tag);
                tagRead = true;
            }
        }
        return std::nullopt;
    }

    const MpegRules& FrameRules() const override { return kClassicMpegRules; }
    AsfLength WmaLength() const override { return AsfLength::AsStored; }
};

}  // namespace

const ReadingProfile& ClassicProfile() {
    static const Classic profile;
    return profile;
}
