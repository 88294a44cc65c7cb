#include "ReadMPEGHeader/TagWriting.h"

#include <iterator>
#include <vector>

#include "ReadMPEGHeader/writing/RecordFrames.h"
#include "ReadMPEGHeader/writing/TagBytes.h"

namespace {

std::vector<TagFrame> FramesOf(const TID3Tag& tag, int trackTotal, ReadProfile profile) {
    const WritingRules& rules = WritingRulesOf(profile);
    const RecordContents contents{
        .Record = tag, .Comment = rules.SplitComment(tag.Comment), .TrackTotal = trackTotal};
    std::vector<TagFrame> frames;
    for (const TagField field : kTagFields) {
        auto made = FramesOfField(field, contents, rules);
        frames.insert(frames.end(), std::make_move_iterator(made.begin()),
                      std::make_move_iterator(made.end()));
    }
    return frames;
}

}  // namespace

void WriteID3v2Frames(ByteWriter& stream, int trackTotal, const TID3Tag& tag, ReadProfile profile) {
    for (const TagFrame& frame : FramesOf(tag, trackTotal, profile))
        AppendFrame(stream, frame);
}

void WriteID3v2Tag(ByteWriter& file, const TID3Tag& tag, TagPlace place, ReadProfile profile) {
    const auto frames = FramesOf(tag, 0, profile);
    if (place == TagPlace::BehindAudio) {
        const auto position = static_cast<std::int64_t>(file.Size());
        AppendTag(file, frames, SizeOfTag(frames));
        AppendTrailer(file, position);
        return;
    }
    const std::vector<std::uint8_t> old = file.Bytes();
    file.Clear();
    AppendTag(file, frames, SizeOfTag(frames) + kTagPadding);
    file.Raw(old);
}
