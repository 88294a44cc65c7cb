#include <algorithm>

#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/mpeg/FrameSearch.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

namespace {

constexpr std::int64_t kTagHeader = static_cast<std::int64_t>(kId3v2HeaderSize);
// Taggers that do not see the tag of another one put theirs in front of it; nobody has met more than a few.
constexpr int kMostStackedTags = 16;

// Gives the tag at the head of the file to `readTag` and returns where the audio may begin: behind it and
// behind all further tags that follow at once.
std::int64_t ReadLeadingTags(ByteSource& stream, const LeadingTagReader& readTag) {
    if (stream.Size() < kTagHeader || !ID3v2Header::Read(stream, 0)) return 0;
    std::int64_t end = std::max(readTag(0), kTagHeader);
    for (int i = 0; i < kMostStackedTags; ++i) {
        const auto next = EndOfID3v2Tag(stream, end);
        if (!next || *next > stream.Size()) break;
        end = *next;
    }
    return end;
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
        const auto frame = FindMpegFrame(stream, ReadLeadingTags(stream, readTag));
        if (!frame) return std::nullopt;
        return frame->Position;
    }

    const MpegRules& FrameRules() const override { return kModernMpegRules; }
    AsfLength WmaLength() const override { return AsfLength::LessPreroll; }
};

}  // namespace

const ReadingProfile& ModernProfile() {
    static const Modern profile;
    return profile;
}
